// What only the stand-in can show: the catalogue when memory runs out, and
// the Win32 calls given a module or block they do not know. Every menu and
// block the catalogue makes is either handed over or released.
#include <gtest/gtest.h>

#include "catalogue_helpers.h"
#include "frame/exports.h"
#include "resources/resource_ids.h"
#include "standin_win32.h"

namespace {

using catalogue_test::GuardedBuffer;

class StandinFaults : public ::testing::Test {
 protected:
  void TearDown() override {
    StandinFailLocalAlloc(0, 0);
    StandinFailCreatePopupMenu(0, 0);
  }
  bool NothingLeftBehind() const {
    return StandinLiveMenuCount() == menusBefore_ && StandinLiveLocalBlockCount() == blocksBefore_;
  }

  EditorHost host_ = catalogue_test::HostWithVersion();
  const std::size_t menusBefore_ = StandinLiveMenuCount();
  const std::size_t blocksBefore_ = StandinLiveLocalBlockCount();
};

// The action menu copies its popup and three submenus through four scratch
// buffers; the expression menu creates a popup and four submenus. A menu
// handed over is whole and live, and goes with its submenus.
TEST_F(StandinFaults, MenuIsNullWhenAnyScratchBufferOrPopupIsMissingAndLeavesNothing) {
  const struct {
    void (*fail)(int, int);
    HMENU(TVCALL* routine)(EditorHost*, void*, void*);
    int needed;
  } cases[] = {{StandinFailLocalAlloc, GetActionMenu, 4}, {StandinFailCreatePopupMenu, GetExpressionMenu, 5}};
  for (const auto& c : cases) {
    for (int successes = 0; successes <= c.needed; ++successes) {
      c.fail(successes, 1);
      const HMENU menu = c.routine(&host_, nullptr, nullptr);
      const char* got = menu == nullptr ? "null" : DestroyMenu(menu) ? "a menu" : "a stale handle";
      EXPECT_STREQ(got, successes == c.needed ? "a menu" : "null") << successes;
      EXPECT_TRUE(NothingLeftBehind()) << successes;
      c.fail(0, 0);
    }
  }
  GuardedBuffer buffer(32);
  GetExpressionTitle(nullptr, 3, buffer.data(), buffer.size());  // loads and drops the menu
  EXPECT_EQ(buffer.text(), "Get Anchor Y");
  EXPECT_TRUE(NothingLeftBehind());
}

TEST_F(StandinFaults, ForeignModuleOrBlockIsAnError) {
  static char elsewhere;
  GuardedBuffer text(16);
  EXPECT_EQ(LoadStringA(reinterpret_cast<HINSTANCE>(&elsewhere), IDS_OBJECT_NAME, text.data(), text.size()), 0);
  EXPECT_EQ(text.text(), "");
  EXPECT_EQ(LoadMenuA(reinterpret_cast<HINSTANCE>(&elsewhere), MAKEINTRESOURCEA(IDM_ACTIONS)), nullptr);
  HLOCAL block = LocalAlloc(LPTR, 80);
  EXPECT_EQ(LocalFree(block), nullptr);
  EXPECT_EQ(LocalFree(block), block);  // freed already: handed back, not freed again
  EXPECT_EQ(LocalFree(&elsewhere), &elsewhere);
  EXPECT_TRUE(NothingLeftBehind());
}

}  // namespace
