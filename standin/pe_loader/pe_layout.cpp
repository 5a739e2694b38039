// The headers and section table of a PE32 x86 DLL, and the image they lay
// out. Offsets are those of the PE format's DOS, file and optional headers.
#include <algorithm>

#include "image_bytes.h"
#include "pe_image.h"

namespace pe {

namespace {

constexpr uint16_t kMachineX86 = 0x014C;
constexpr uint16_t kMagicPe32 = 0x010B;
constexpr uint16_t kMagicPe32Plus = 0x020B;
constexpr uint16_t kFileRelocationsStripped = 0x0001;
constexpr uint16_t kFileExecutable = 0x0002;
constexpr uint16_t kFileDll = 0x2000;
constexpr uint32_t kFileHeaderSize = 20;
constexpr uint32_t kDirectoriesOffset = 96;  // in the PE32 optional header
constexpr uint32_t kSectionHeaderSize = 40;
constexpr uint16_t kMostSections = 96;  // as many as Windows loads

bool ReadSections(const ImageBytes& file, uint64_t table, uint16_t count, Layout& layout, std::string& error) {
  for (uint16_t i = 0; i < count; ++i) {
    const uint64_t at = table + uint64_t{kSectionHeaderSize} * i;
    Section section;
    char name[9] = {};
    for (int c = 0; c < 8; ++c) name[c] = static_cast<char>(file.U8(at + c));
    section.name = name;
    const uint32_t virtualSize = file.U32(at + 8);
    section.rva = file.U32(at + 12);
    const uint32_t rawSize = file.U32(at + 16);
    section.fileOffset = file.U32(at + 20);
    section.characteristics = file.U32(at + 36);
    // A section without a virtual size takes the size of its raw data;
    // raw data beyond the virtual size is not part of the image.
    section.memorySize = virtualSize != 0 ? virtualSize : rawSize;
    section.fileSize = std::min(rawSize, section.memorySize);
    const char* shown = section.name.c_str();
    if (section.rva < layout.sizeOfHeaders || uint64_t{section.rva} + section.memorySize > layout.sizeOfImage) {
      return Fail(error, "section %s (RVA 0x%x, 0x%x bytes) lies outside the image (0x%x bytes)", shown,
                  section.rva, section.memorySize, layout.sizeOfImage);
    }
    if (section.fileSize > 0 && !file.Has(section.fileOffset, section.fileSize)) {
      return Fail(error, "section %s is truncated: its 0x%x bytes at file offset 0x%x run past the end of the file (0x%llx bytes)",
                  shown, section.fileSize, section.fileOffset, static_cast<unsigned long long>(file.size()));
    }
    layout.sections.push_back(std::move(section));
  }
  std::sort(layout.sections.begin(), layout.sections.end(),
            [](const Section& a, const Section& b) { return a.rva < b.rva; });
  for (std::size_t i = 1; i < layout.sections.size(); ++i) {
    const Section& before = layout.sections[i - 1];
    if (uint64_t{before.rva} + before.memorySize > layout.sections[i].rva) {
      return Fail(error, "sections %s and %s overlap", before.name.c_str(), layout.sections[i].name.c_str());
    }
  }
  return true;
}

}  // namespace

bool ReadLayout(std::span<const uint8_t> bytes, Layout& layout, std::string& error) {
  const ImageBytes file(bytes);
  layout = Layout{};
  if (!file.Has(0, 0x40) || file.U16(0) != 0x5A4D) return Fail(error, "not a PE image: no MZ header");
  const uint32_t pe = file.U32(0x3C);
  if (!file.Has(pe, 4 + kFileHeaderSize) || file.U32(pe) != 0x00004550) {
    return Fail(error, "not a PE image: no PE signature where the MZ header points");
  }
  const uint64_t header = uint64_t{pe} + 4;
  const uint16_t machine = file.U16(header);
  const uint16_t sectionCount = file.U16(header + 2);
  const uint16_t optionalSize = file.U16(header + 16);
  const uint16_t characteristics = file.U16(header + 18);
  const uint64_t optional = header + kFileHeaderSize;
  if (!file.Has(optional, 2)) return Fail(error, "truncated PE header: no optional header");
  const uint16_t magic = file.U16(optional);
  if (magic == kMagicPe32Plus) return Fail(error, "a PE32+ (64-bit) image; only PE32 x86 images load here");
  if (magic != kMagicPe32) return Fail(error, "unknown optional header magic 0x%x", magic);
  if (machine != kMachineX86) return Fail(error, "machine 0x%x is not x86 (0x14c)", machine);
  if ((characteristics & (kFileExecutable | kFileDll)) != (kFileExecutable | kFileDll)) {
    return Fail(error, "not a DLL (file characteristics 0x%x)", characteristics);
  }
  if (optionalSize < kDirectoriesOffset || !file.Has(optional, optionalSize)) {
    return Fail(error, "truncated PE header: optional header of 0x%x bytes", optionalSize);
  }
  layout.entryPoint = file.U32(optional + 16);
  layout.imageBase = file.U32(optional + 28);
  const uint32_t sectionAlignment = file.U32(optional + 32);
  layout.sizeOfImage = file.U32(optional + 56);
  layout.sizeOfHeaders = file.U32(optional + 60);
  layout.relocationsStripped = (characteristics & kFileRelocationsStripped) != 0;
  if (layout.imageBase % 0x10000 != 0) return Fail(error, "image base 0x%x is not a multiple of 64 KB", layout.imageBase);
  if (sectionAlignment == 0 || (sectionAlignment & (sectionAlignment - 1)) != 0) {
    return Fail(error, "section alignment 0x%x is not a power of two", sectionAlignment);
  }
  if (layout.sizeOfImage == 0 || layout.sizeOfImage > kLargestImage ||
      uint64_t{layout.imageBase} + layout.sizeOfImage > 0x100000000ull) {
    return Fail(error, "image size 0x%x at base 0x%x does not fit (at most 0x%x bytes below 4 GB)",
                layout.sizeOfImage, layout.imageBase, kLargestImage);
  }
  const uint64_t table = optional + optionalSize;
  const uint64_t tableEnd = table + uint64_t{kSectionHeaderSize} * sectionCount;
  if (sectionCount > kMostSections || !file.Has(table, tableEnd - table)) {
    return Fail(error, "truncated PE header: %u sections do not fit in the file", sectionCount);
  }
  if (layout.sizeOfHeaders < tableEnd || layout.sizeOfHeaders > layout.sizeOfImage ||
      !file.Has(0, layout.sizeOfHeaders)) {
    return Fail(error, "headers of 0x%x bytes do not hold the section table or do not fit", layout.sizeOfHeaders);
  }
  if (layout.entryPoint >= layout.sizeOfImage) {
    return Fail(error, "entry point RVA 0x%x lies outside the image", layout.entryPoint);
  }
  const uint32_t directoryCount = std::min<uint32_t>(file.U32(optional + 92), kDirectoryCount);
  if (kDirectoriesOffset + 8ull * directoryCount > optionalSize) {
    return Fail(error, "truncated PE header: %u data directories do not fit", directoryCount);
  }
  for (uint32_t d = 0; d < directoryCount; ++d) {
    layout.directories[d] = {file.U32(optional + kDirectoriesOffset + 8 * d),
                             file.U32(optional + kDirectoriesOffset + 8 * d + 4)};
  }
  return ReadSections(file, table, sectionCount, layout, error);
}

void CopyImage(std::span<const uint8_t> file, const Layout& layout, std::span<uint8_t> image) {
  std::copy_n(file.begin(), layout.sizeOfHeaders, image.begin());
  for (const Section& section : layout.sections) {
    std::copy_n(file.begin() + section.fileOffset, section.fileSize, image.begin() + section.rva);
  }
}

}  // namespace pe
