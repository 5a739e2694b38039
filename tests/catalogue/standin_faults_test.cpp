// What only the stand-in can show: the Win32 calls given a module or block
// they do not know. (The catalogue fuzzer makes menus and memory fail on
// demand.)
#include <gtest/gtest.h>

#include "catalogue_helpers.h"
#include "resources/resource_ids.h"
#include "standin_win32.h"

namespace {

using catalogue_test::GuardedBuffer;

TEST(StandinFaults, ForeignModuleOrBlockIsAnError) {
  const std::size_t menusBefore = StandinLiveMenuCount(), blocksBefore = StandinLiveLocalBlockCount();
  static char elsewhere;
  GuardedBuffer text(16);
  EXPECT_EQ(LoadStringA(reinterpret_cast<HINSTANCE>(&elsewhere), IDS_OBJECT_NAME, text.data(), text.size()), 0);
  EXPECT_EQ(text.text(), "");
  EXPECT_EQ(LoadMenuA(reinterpret_cast<HINSTANCE>(&elsewhere), MAKEINTRESOURCEA(IDM_ACTIONS)), nullptr);
  HLOCAL block = LocalAlloc(LPTR, 80);
  EXPECT_EQ(LocalFree(block), nullptr);
  EXPECT_EQ(LocalFree(block), block);  // freed already: handed back, not freed again
  EXPECT_EQ(LocalFree(&elsewhere), &elsewhere);
  EXPECT_EQ(StandinLiveMenuCount(), menusBefore);
  EXPECT_EQ(StandinLiveLocalBlockCount(), blocksBefore);
}

}  // namespace
