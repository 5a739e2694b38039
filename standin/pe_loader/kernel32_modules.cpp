// KERNEL32's module and page calls. The modules are the images the loader
// mapped; any other DLL is not there, and none is looked for on disk. The
// process's own program answers a null name.
#include <sys/auxv.h>

#include "kernel32_shim.h"
#include "loaded_images.h"

namespace pe::kernel32 {

namespace {

constexpr DWORD kMemCommit = 0x1000;
constexpr DWORD kMemImage = 0x1000000;
constexpr DWORD kPageExecuteWriteCopy = 0x80;

}  // namespace

HMODULE WINAPI GetModuleHandleA(LPCSTR name) {
  // The program that started the process, never a DLL: the page that holds
  // its program headers.
  if (name == nullptr) return reinterpret_cast<HMODULE>(getauxval(AT_PHDR) & ~uintptr_t{kPageSize - 1});
  LoadedImage* image = ImageNamed(name);
  if (image == nullptr) SetLastError(kErrorModNotFound);
  return image == nullptr ? nullptr : reinterpret_cast<HMODULE>(image->base);
}

// Only what is loaded already can be loaded.
HMODULE WINAPI LoadLibraryA(LPCSTR name) {
  if (name != nullptr) return GetModuleHandleA(name);
  SetLastError(kErrorInvalidParameter);
  return nullptr;
}

// Every module stays loaded until the loader frees it.
BOOL WINAPI FreeLibrary(HMODULE module) {
  if (ImageOfHandle(module) != nullptr) return TRUE;
  SetLastError(kErrorModNotFound);
  return FALSE;
}

// Exports by name; an ordinal finds nothing here.
FARPROC WINAPI GetProcAddress(HMODULE module, LPCSTR name) {
  LoadedImage* image = ImageOfHandle(module);
  if (image == nullptr) {
    SetLastError(kErrorModNotFound);
    return nullptr;
  }
  void* address = IS_INTRESOURCE(name) ? nullptr : ExportAddress(*image, name);
  if (address == nullptr) SetLastError(kErrorProcNotFound);
  return address;
}

// Pages of a loaded image only; any other address fails.
SIZE_T WINAPI VirtualQuery(const void* address, MemoryBasicInformation* information, SIZE_T size) {
  LoadedImage* image = ImageContaining(address);
  if (image == nullptr || information == nullptr || size < sizeof(MemoryBasicInformation)) {
    SetLastError(image == nullptr ? kErrorInvalidAddress : kErrorInvalidParameter);
    return 0;
  }
  const auto page = static_cast<uint32_t>((reinterpret_cast<uintptr_t>(address) - reinterpret_cast<uintptr_t>(image->base)) / kPageSize);
  uint32_t end = page;
  while (end < image->pageProtections.size() && image->pageProtections[end] == image->pageProtections[page]) ++end;
  *information = MemoryBasicInformation{image->base + page * kPageSize, image->base, kPageExecuteWriteCopy,
                                        (end - page) * kPageSize, kMemCommit, image->pageProtections[page], kMemImage};
  return sizeof(MemoryBasicInformation);
}

BOOL WINAPI VirtualProtect(void* address, SIZE_T size, DWORD protection, DWORD* previous) {
  LoadedImage* image = ImageContaining(address);
  const uintptr_t start = reinterpret_cast<uintptr_t>(address) - reinterpret_cast<uintptr_t>(image == nullptr ? nullptr : image->base);
  if (image == nullptr || previous == nullptr || size > image->layout.sizeOfImage - start) {
    SetLastError(image == nullptr ? kErrorInvalidAddress : kErrorInvalidParameter);
    return FALSE;
  }
  const auto first = static_cast<uint32_t>(start / kPageSize);
  const auto last = static_cast<uint32_t>((start + (size == 0 ? 1 : size) - 1) / kPageSize);
  const DWORD old = image->pageProtections[first];
  if (!ProtectPages(*image, first, last - first + 1, protection)) {
    SetLastError(kErrorInvalidParameter);
    return FALSE;
  }
  *previous = old;
  return TRUE;
}

}  // namespace pe::kernel32
