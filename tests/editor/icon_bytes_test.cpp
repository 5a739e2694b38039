// How many bytes MakeIcon copies, from the bitmap's own header.
#include <gtest/gtest.h>

#include <cstring>
#include <vector>

#include "editor/icon_bytes.h"

namespace {

// A header that asks for more than the resource holds gets what it holds.
TEST(EditorRoutines, IconCopyNeverExceedsTheResource) {
  const auto header = [](uint16_t width, uint16_t height, uint16_t bits) {
    std::vector<unsigned char> bytes(40, 0);
    std::memcpy(&bytes[4], &width, 2);
    std::memcpy(&bytes[8], &height, 2);
    std::memcpy(&bytes[14], &bits, 2);
    return bytes;
  };
  const struct {
    uint16_t width, height, bits;
    uint32_t available, copied;
  } cases[] = {{32, 32, 8, 2088, 2088},  {32, 32, 8, 5000, 2088},  {32, 32, 24, 5000, 40 + 3072},
               {32, 32, 8, 1000, 1000},  {4000, 4000, 32, 300, 300}, {65535, 65535, 32, 100000, 44},
               {32, 32, 8, 39, 0}};
  for (const auto& c : cases) {
    EXPECT_EQ(IconBytesToCopy(header(c.width, c.height, c.bits).data(), c.available), c.copied)
        << c.width << "x" << c.height << "x" << c.bits << " in " << c.available;
  }
}

}  // namespace
