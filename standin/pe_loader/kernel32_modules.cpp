// KERNEL32's module and page calls. The modules are the images the loader
// mapped and the DLLs it stands in for (found as loaded, as on Windows, and
// offering the functions of their tables); any other DLL is not there. The
// process's own program answers a null name.
#include <sys/auxv.h>


#include "import_tables.h"
#include "kernel32_shim.h"
#include "loaded_images.h"

namespace pe::kernel32 {

namespace {

constexpr DWORD kMemCommit = 0x1000;
constexpr DWORD kMemImage = 0x1000000;
constexpr DWORD kPageExecuteWriteCopy = 0x80;

constexpr std::size_t kLongestPath = 260;

// A module name as the A calls take it; false for one longer than a path.
bool Narrow(LPCWSTR wide, char (&name)[kLongestPath]) {
  for (std::size_t i = 0; i < kLongestPath; ++i) {
    name[i] = wide[i] < 0x100 ? static_cast<char>(wide[i]) : '?';
    if (wide[i] == 0) return true;
  }
  return false;
}

// The handle of a module loaded under `name`, or null.
HMODULE FindModule(LPCSTR name) {
  if (LoadedImage* image = ImageNamed(name)) return reinterpret_cast<HMODULE>(image->base);
  if (const ImportTable* table = FindImportTable(name)) return reinterpret_cast<HMODULE>(const_cast<ImportTable*>(table));
  return nullptr;
}

const ImportTable* TableOfHandle(HMODULE module) {
  for (const char* dll : {"KERNEL32.dll", "USER32.dll", "msvcrt.dll", "DRAVO2.dll"}) {
    const ImportTable* table = FindImportTable(dll);
    if (reinterpret_cast<HMODULE>(const_cast<ImportTable*>(table)) == module) return table;
  }
  return nullptr;
}

}  // namespace

HMODULE WINAPI GetModuleHandleA(LPCSTR name) {
  // The program that started the process, never a DLL: the page that holds
  // its program headers.
  if (name == nullptr) return reinterpret_cast<HMODULE>(getauxval(AT_PHDR) & ~uintptr_t{kPageSize - 1});
  const HMODULE module = FindModule(name);
  if (module == nullptr) SetLastError(kErrorModNotFound);
  return module;
}

HMODULE WINAPI GetModuleHandleW(LPCWSTR name) {
  char narrow[kLongestPath];
  if (name == nullptr) return GetModuleHandleA(nullptr);
  if (!Narrow(name, narrow)) {
    SetLastError(kErrorModNotFound);
    return nullptr;
  }
  return GetModuleHandleA(narrow);
}

// Only what is loaded already can be loaded: no DLL is looked for on disk.
HMODULE WINAPI LoadLibraryA(LPCSTR name) {
  if (name != nullptr) return GetModuleHandleA(name);
  SetLastError(kErrorInvalidParameter);
  return nullptr;
}

HMODULE WINAPI LoadLibraryW(LPCWSTR name) {
  if (name != nullptr) return GetModuleHandleW(name);
  SetLastError(kErrorInvalidParameter);
  return nullptr;
}

// Every module stays loaded until the loader frees it.
BOOL WINAPI FreeLibrary(HMODULE module) {
  if (ImageOfHandle(module) != nullptr || TableOfHandle(module) != nullptr) return TRUE;
  SetLastError(kErrorModNotFound);
  return FALSE;
}

FARPROC WINAPI GetProcAddress(HMODULE module, LPCSTR name) {
  void* address = nullptr;
  if (LoadedImage* image = ImageOfHandle(module)) {
    const uint32_t rva = IS_INTRESOURCE(name) ? 0 : FindExport({image->base, image->layout.sizeOfImage}, image->layout, name);
    address = rva == 0 ? nullptr : image->base + rva;
  } else if (const ImportTable* table = TableOfHandle(module)) {
    const ImportRow* row = IS_INTRESOURCE(name) ? FindImportRow(*table, {}, LOWORD(name)) : FindImportRow(*table, name, 0);
    address = row == nullptr ? nullptr : row->address;
  } else {
    SetLastError(kErrorModNotFound);
    return nullptr;
  }
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
