#include "loaded_images.h"

#include <sys/mman.h>

#include <algorithm>

namespace pe {

namespace {

constexpr uint32_t kPageNoAccess = 0x01, kPageReadOnly = 0x02, kPageReadWrite = 0x04, kPageWriteCopy = 0x08,
                   kPageExecute = 0x10, kPageExecuteRead = 0x20, kPageExecuteReadWrite = 0x40,
                   kPageExecuteWriteCopy = 0x80;

int PosixProtection(uint32_t protection) {
  switch (protection) {
    case kPageNoAccess: return PROT_NONE;
    case kPageReadOnly: return PROT_READ;
    case kPageReadWrite:
    case kPageWriteCopy: return PROT_READ | PROT_WRITE;
    case kPageExecute:
    case kPageExecuteRead: return PROT_READ | PROT_EXEC;
    case kPageExecuteReadWrite:
    case kPageExecuteWriteCopy: return PROT_READ | PROT_WRITE | PROT_EXEC;
    default: return -1;
  }
}

char Lower(char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c; }

bool SameName(std::string_view a, std::string_view b) {
  return a.size() == b.size() && std::equal(a.begin(), a.end(), b.begin(), [](char x, char y) { return Lower(x) == Lower(y); });
}

}  // namespace

std::vector<LoadedImage*>& LoadedImages() {
  // Never destroyed: a loaded DLL shutting down at exit still calls in.
  static auto& images = *new std::vector<LoadedImage*>;
  return images;
}

LoadedImage* ImageOfHandle(const void* handle) {
  for (LoadedImage* image : LoadedImages()) {
    if (image->base == handle) return image;
  }
  return nullptr;
}

void* ExportAddress(const LoadedImage& image, std::string_view name) {
  const uint32_t rva = FindExport(image.bytes(), image.layout, name);
  return rva == 0 ? nullptr : image.base + rva;
}

LoadedImage* ImageContaining(const void* address) {
  const auto at = reinterpret_cast<uintptr_t>(address);
  for (LoadedImage* image : LoadedImages()) {
    const auto base = reinterpret_cast<uintptr_t>(image->base);
    if (at >= base && at - base < image->layout.sizeOfImage) return image;
  }
  return nullptr;
}

bool NamesFile(std::string_view name, std::string_view file) {
  if (name.find('.') != std::string_view::npos) return SameName(name, file);
  return file.size() == name.size() + 4 && SameName(file.substr(0, name.size()), name) &&
         SameName(file.substr(name.size()), ".dll");
}

LoadedImage* ImageNamed(std::string_view name) {
  for (LoadedImage* image : LoadedImages()) {
    if (NamesFile(name, image->name)) return image;
  }
  return nullptr;
}

uint32_t SectionProtection(uint32_t characteristics) {
  const bool execute = (characteristics & kSectionExecute) != 0;
  const bool write = (characteristics & kSectionWrite) != 0;
  const bool read = (characteristics & kSectionRead) != 0;
  if (execute) return write ? kPageExecuteReadWrite : read ? kPageExecuteRead : kPageExecute;
  if (write) return kPageReadWrite;
  return read ? kPageReadOnly : kPageNoAccess;
}

bool ProtectPages(LoadedImage& image, uint32_t firstPage, uint32_t count, uint32_t protection) {
  const int posix = PosixProtection(protection);
  if (posix < 0 || firstPage > image.pageProtections.size() || count > image.pageProtections.size() - firstPage) {
    return false;
  }
  if (count > 0 && mprotect(image.base + uint64_t{firstPage} * kPageSize, uint64_t{count} * kPageSize, posix) != 0) {
    return false;
  }
  std::fill_n(image.pageProtections.begin() + firstPage, count, protection);
  return true;
}

}  // namespace pe
