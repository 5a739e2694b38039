// The images the loader has mapped and not yet freed, for the loader and for
// the KERNEL32 calls that ask about modules and pages. One thread only.
#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "pe_image.h"

namespace pe {

constexpr uint32_t kPageSize = 0x1000;

struct LoadedImage {
  std::string name;  // the file's name, as GetModuleHandleA finds it
  uint8_t* base = nullptr;
  Layout layout;
  std::vector<uint32_t> pageProtections;  // each page's PAGE_* value
  ThreadStorage threadStorage;
  void* threadData = nullptr;  // this thread's copy of the TLS template

  std::span<uint8_t> bytes() const { return {base, layout.sizeOfImage}; }
};

std::vector<LoadedImage*>& LoadedImages();

// The image whose handle (its base) is `handle`, or null.
LoadedImage* ImageOfHandle(const void* handle);
// The address of the function `image` exports as `name`, or null.
void* ExportAddress(const LoadedImage& image, std::string_view name);
// The image whose pages hold `address`, or null.
LoadedImage* ImageContaining(const void* address);
// True when `name` names the file `file` as Windows finds modules: without
// regard to case, and with ".dll" understood when `name` has no extension.
bool NamesFile(std::string_view name, std::string_view file);

// The image loaded from a file of this name, compared without regard to
// case; a name without an extension means the ".dll" file. Null for none.
LoadedImage* ImageNamed(std::string_view name);

// The Windows protection (PAGE_*) of a section's pages.
uint32_t SectionProtection(uint32_t characteristics);
// Gives `count` pages from `firstPage` the Windows protection `protection`.
// False when the range leaves the image or the system refuses.
bool ProtectPages(LoadedImage& image, uint32_t firstPage, uint32_t count, uint32_t protection);

}  // namespace pe
