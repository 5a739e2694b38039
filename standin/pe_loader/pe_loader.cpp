// PeLoadLibrary, PeGetProcAddress and PeFreeLibrary: the checked layout and
// import tables of pe_image.h put into memory and run.
#include "pe_loader.h"

#include <sys/mman.h>

#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <fstream>
#include <iterator>
#include <new>
#include <vector>

#include "image_bytes.h"
#include "import_tables.h"
#include "loaded_images.h"
#include "standin_win32.h"
#include "thread_block.h"

namespace pe {

namespace {

constexpr uint32_t kProcessDetach = 0;
constexpr uint32_t kProcessAttach = 1;
constexpr uint16_t kWindowsFpuControl = PE_WINDOWS_FPU_CONTROL;

using EntryPoint = int(__attribute__((stdcall)) *)(void* module, uint32_t reason, void* reserved);

// Runs the image's code under the x87 control word Windows gives threads.
class WindowsFpuControl {
 public:
  WindowsFpuControl() {
    asm volatile("fnstcw %0" : "=m"(saved_));
    asm volatile("fldcw %0" : : "m"(kWindowsFpuControl));
  }
  ~WindowsFpuControl() { asm volatile("fldcw %0" : : "m"(saved_)); }
  WindowsFpuControl(const WindowsFpuControl&) = delete;
  WindowsFpuControl& operator=(const WindowsFpuControl&) = delete;

 private:
  uint16_t saved_ = 0;
};

// The TLS callbacks, then the entry point; the entry point's answer.
int RunEntryPoints(LoadedImage& image, uint32_t reason) {
  const WindowsFpuControl windows;
  for (uint32_t callback : image.threadStorage.callbacks) {
    reinterpret_cast<EntryPoint>(image.base + callback)(image.base, reason, nullptr);
  }
  if (image.layout.entryPoint == 0) return 1;
  return reinterpret_cast<EntryPoint>(image.base + image.layout.entryPoint)(image.base, reason, nullptr);
}

void Unmap(LoadedImage* image) {
  StandinRemoveModule(reinterpret_cast<HMODULE>(image->base));
  for (uint32_t index = 0; image->threadData != nullptr && ThreadStorageSlot(index) != nullptr; ++index) {
    if (*ThreadStorageSlot(index) == image->threadData) *ThreadStorageSlot(index) = nullptr;
  }
  std::free(image->threadData);
  if (image->base != nullptr) munmap(image->base, image->layout.sizeOfImage);
  delete image;
}

// Writes each import's address into its slot.
bool ResolveImports(LoadedImage& image, std::string& error) {
  std::vector<ImportedDll> dlls;
  if (!ReadImports(image.bytes(), image.layout, dlls, error)) return false;
  for (const ImportedDll& dll : dlls) {
    const ImportTable* table = FindImportTable(dll.name);
    if (table == nullptr) return Fail(error, "it imports from %s, which the loader does not provide", dll.name.c_str());
    for (const Import& import : dll.functions) {
      const ImportRow* row = FindImportRow(*table, import.name, import.ordinal);
      if (row == nullptr) {
        const std::string what = import.name.empty() ? " ordinal " + std::to_string(import.ordinal) : "!" + import.name;
        return Fail(error, "it imports %s%s, which the loader does not provide", dll.name.c_str(), what.c_str());
      }
      const auto address = static_cast<uint32_t>(reinterpret_cast<uintptr_t>(row->address));
      std::memcpy(image.base + import.slotRva, &address, 4);
    }
  }
  return true;
}

// Makes the image's resources what the resource calls find under its handle.
bool AddResources(LoadedImage& image, std::string& error) {
  std::vector<Resource> resources;
  if (!ReadResources(image.bytes(), image.layout, resources, error)) return false;
  std::vector<standin::ResourceEntry> entries;
  for (const Resource& resource : resources) {
    entries.push_back({{resource.type.id, resource.type.text}, {resource.name.id, resource.name.text},
                       resource.language, image.base + resource.dataRva, resource.size});
  }
  if (!StandinAddModule(reinterpret_cast<HMODULE>(image.base), std::move(entries))) {
    return Fail(error, "no memory for its resources");
  }
  return true;
}

// Each page gets the protection of the sections on it (all of them, where
// small alignment puts several on one page); the headers are read-only.
bool ProtectSections(LoadedImage& image, std::string& error) {
  const uint32_t pages = (image.layout.sizeOfImage + kPageSize - 1) / kPageSize;
  std::vector<uint32_t> characteristics(pages, kSectionRead);
  for (const Section& section : image.layout.sections) {
    if (section.memorySize == 0) continue;
    for (uint32_t page = section.rva / kPageSize; page <= (section.rva + section.memorySize - 1) / kPageSize; ++page) {
      characteristics[page] |= section.characteristics;
    }
  }
  image.pageProtections.assign(pages, 0);
  for (uint32_t page = 0; page < pages; ++page) {
    if (!ProtectPages(image, page, 1, SectionProtection(characteristics[page]))) {
      return Fail(error, "cannot protect its pages: %s", std::strerror(errno));
    }
  }
  return true;
}

// Gives the image its TLS index and this thread its copy of the image's TLS
// data, as the Windows loader does for an image with a TLS directory.
bool SetUpThreadStorage(LoadedImage& image, std::string& error) {
  if (!ReadThreadStorage(image.bytes(), image.layout, static_cast<uint32_t>(reinterpret_cast<uintptr_t>(image.base)),
                         image.threadStorage, error)) {
    return error.empty();
  }
  uint32_t index = 0;
  while (ThreadStorageSlot(index) != nullptr && *ThreadStorageSlot(index) != nullptr) ++index;
  void** slot = ThreadStorageSlot(index);
  const ThreadStorage& storage = image.threadStorage;
  image.threadData = std::calloc(1, uint64_t{storage.dataSize} + storage.zeroFill + 1);
  if (slot == nullptr || image.threadData == nullptr) return Fail(error, "no room for its thread-local data");
  std::memcpy(image.threadData, image.base + storage.dataRva, storage.dataSize);
  std::memcpy(image.base + storage.indexRva, &index, 4);
  *slot = image.threadData;
  return true;
}

// Everything but running the image; on failure the caller unmaps it.
bool MapImage(const char* path, LoadedImage& image, std::string& error) {
  std::ifstream in(path, std::ios::binary);
  std::vector<uint8_t> file((std::istreambuf_iterator<char>(in)), std::istreambuf_iterator<char>());
  if (!in.good() && !in.eof()) return Fail(error, "cannot read it: %s", std::strerror(errno));
  if (!ReadLayout(file, image.layout, error)) return false;
  const char* slash = std::strrchr(path, '/');
  image.name = slash == nullptr ? path : slash + 1;
  // Its preferred base if that is free; anywhere else means relocating.
  void* wanted = reinterpret_cast<void*>(uintptr_t{image.layout.imageBase});
  void* base = mmap(wanted, image.layout.sizeOfImage, PROT_READ | PROT_WRITE, MAP_PRIVATE | MAP_ANONYMOUS, -1, 0);
  if (base == MAP_FAILED) return Fail(error, "no room for its image: %s", std::strerror(errno));
  image.base = static_cast<uint8_t*>(base);
  CopyImage(file, image.layout, image.bytes());
  return Relocate(image.bytes(), image.layout, static_cast<uint32_t>(reinterpret_cast<uintptr_t>(base)), error) &&
         ResolveImports(image, error) && AddResources(image, error) && EnsureThreadBlock(error) &&
         SetUpThreadStorage(image, error) && ProtectSections(image, error);
}

void Report(const char* path, const std::string& reason, char* error, size_t size) {
  if (error != nullptr && size > 0) std::snprintf(error, size, "%s: %s", path, reason.c_str());
}

}  // namespace

}  // namespace pe

using pe::LoadedImage;

void* PeLoadLibrary(const char* path, char* error, size_t error_size) {
  if (path == nullptr) {
    pe::Report("PeLoadLibrary", "no path given", error, error_size);
    return nullptr;
  }
  std::string reason;
  LoadedImage* image = nullptr;
  try {
    image = new LoadedImage;
    if (!pe::MapImage(path, *image, reason)) {
      pe::Unmap(image);
      pe::Report(path, reason, error, error_size);
      return nullptr;
    }
    pe::LoadedImages().push_back(image);
  } catch (const std::bad_alloc&) {
    if (image != nullptr) pe::Unmap(image);
    pe::Report(path, "out of memory", error, error_size);
    return nullptr;
  }
  // As on Windows, an entry point that refuses to attach is told to detach.
  if (pe::RunEntryPoints(*image, pe::kProcessAttach) == 0) {
    PeFreeLibrary(image->base);
    pe::Report(path, "its entry point refused to attach", error, error_size);
    return nullptr;
  }
  return image->base;
}

void* PeGetProcAddress(void* module, const char* name) {
  LoadedImage* image = pe::ImageOfHandle(module);
  return image == nullptr || name == nullptr ? nullptr : pe::ExportAddress(*image, name);
}

void PeFreeLibrary(void* module) {
  LoadedImage* image = pe::ImageOfHandle(module);
  if (image == nullptr) return;
  pe::RunEntryPoints(*image, pe::kProcessDetach);
  auto& images = pe::LoadedImages();
  images.erase(std::find(images.begin(), images.end(), image));
  pe::Unmap(image);
}
