// Base relocations: blocks of one page each, a page RVA and a block size,
// then 16-bit entries of a type (high four bits) and an offset in the page.
#include "image_bytes.h"
#include "pe_image.h"

namespace pe {

namespace {

constexpr uint16_t kRelocationAbsolute = 0;  // padding, relocates nothing
constexpr uint16_t kRelocationHighLow = 3;   // a 32-bit address

}  // namespace

bool Relocate(std::span<uint8_t> image, const Layout& layout, uint32_t base, std::string& error) {
  const Directory directory = layout.directories[kRelocationDirectory];
  const bool moves = base != layout.imageBase;
  if (moves && (layout.relocationsStripped || directory.size == 0)) {
    return Fail(error, "the image must move from its preferred base 0x%x, which is taken, and has no relocations",
                layout.imageBase);
  }
  const ImageBytes bytes(image);
  if (!bytes.Has(directory.rva, directory.size)) {
    return Fail(error, "relocation directory (RVA 0x%x, 0x%x bytes) lies outside the image", directory.rva,
                directory.size);
  }
  const uint32_t delta = base - layout.imageBase;  // modulo 2^32, as the addresses wrap
  uint64_t block = directory.rva;
  const uint64_t end = uint64_t{directory.rva} + directory.size;
  while (end - block >= 8) {
    const uint32_t page = bytes.U32(block);
    const uint32_t blockSize = bytes.U32(block + 4);
    if (blockSize < 8 || blockSize > end - block) {
      return Fail(error, "relocation block at RVA 0x%llx has a size of 0x%x bytes", static_cast<unsigned long long>(block),
                  blockSize);
    }
    for (uint64_t entry = block + 8; entry + 2 <= block + blockSize; entry += 2) {
      const uint16_t word = bytes.U16(entry);
      const uint16_t type = word >> 12;
      const uint64_t target = uint64_t{page} + (word & 0x0FFF);
      if (type == kRelocationAbsolute) continue;
      if (type != kRelocationHighLow) return Fail(error, "relocation of type %u at RVA 0x%llx is not one x86 images use", type,
                                                  static_cast<unsigned long long>(target));
      if (!bytes.Has(target, 4)) {
        return Fail(error, "a relocation at RVA 0x%llx lies outside the image", static_cast<unsigned long long>(target));
      }
      if (moves) {
        const uint32_t moved = bytes.U32(target) + delta;
        for (int b = 0; b < 4; ++b) image[target + b] = static_cast<uint8_t>(moved >> (8 * b));
      }
    }
    block += blockSize;
  }
  return true;
}

}  // namespace pe
