// The editor routines that answer without a dialog, called through their
// exported entry points with fenced buffers, as the host calls them.
#include <gtest/gtest.h>

#include <climits>
#include <cstring>
#include <vector>

#include "catalogue/catalogue_helpers.h"
#include "frame/edit_data.h"
#include "frame/exports.h"
#include "frame/module.h"
#include "resources/resource_ids.h"

namespace {

using catalogue_test::GuardedBuffer;

// The host's rectangle is four 32-bit integers; words behind it must stay.
TEST(EditorRoutines, ObjectRectAddsSignedSixteenBitSizesWithoutTouchingMore) {
  const struct {
    int32_t left, top;
    uint16_t width, height;
    int32_t right, bottom;
  } cases[] = {{100, 40, 32, 32, 132, 72},
               {100, 40, 65535, 65535, 99, 39},  // a stored 65535 is -1
               {INT32_MAX, INT32_MIN, 1, 65535, INT32_MIN, INT32_MAX}};  // wraps as 32-bit arithmetic does
  for (const auto& c : cases) {
    struct {
      int32_t rect[4];
      uint32_t guard[4];
    } host = {{c.left, c.top, 0x5A5A5A5A, 0x5A5A5A5A}, {0xDEADBEEF, 0xDEADBEEF, 0xDEADBEEF, 0xDEADBEEF}};
    EditData edit{};
    std::memcpy(&edit.objectWidth, &c.width, 2);
    std::memcpy(&edit.objectHeight, &c.height, 2);
    GetObjectRect(nullptr, reinterpret_cast<RECT*>(host.rect), nullptr, &edit);
    EXPECT_EQ(std::vector<int32_t>(host.rect, host.rect + 4), (std::vector<int32_t>{c.left, c.top, c.right, c.bottom}));
    for (uint32_t word : host.guard) EXPECT_EQ(word, 0xDEADBEEFu);
  }
}

TEST(EditorRoutines, IconIsTheWholeBitmapResource) {
  constexpr std::size_t kIconSize = 2088;
  GuardedBuffer buffer(kIconSize);
  EXPECT_EQ(MakeIcon(nullptr, buffer.data(), nullptr, nullptr, nullptr), 0);
  EXPECT_TRUE(buffer.guardsIntact());

  const HRSRC found = FindResourceA(TavrinModule(), MAKEINTRESOURCEA(IDB_ICON), RT_BITMAP);
  ASSERT_NE(found, nullptr);
  ASSERT_EQ(SizeofResource(TavrinModule(), found), kIconSize);
  const void* bitmap = LockResource(LoadResource(TavrinModule(), found));
  EXPECT_EQ(std::memcmp(buffer.data(), bitmap, kIconSize), 0);
}

TEST(EditorRoutines, ObjectTextsNameTheObjectWithAnEmptyComment) {
  std::vector<GuardedBuffer> texts(5, GuardedBuffer(255));
  GetObjInfos(nullptr, nullptr, texts[0].data(), texts[1].data(), texts[2].data(), texts[3].data(), texts[4].data());
  EXPECT_EQ(texts[0].text(), "Tavrin object");
  EXPECT_EQ(texts[3].text(), "");
  for (int i : {1, 2, 4}) EXPECT_FALSE(texts[i].text().empty()) << i;
  for (const GuardedBuffer& text : texts) EXPECT_TRUE(text.guardsIntact());
}

}  // namespace
