// What only the stand-in can show: the catalogue when memory runs out, and
// the Win32 calls given a module or block they do not know. Every menu and
// block the catalogue makes is either handed over or released.
#include <gtest/gtest.h>

#include "catalogue_helpers.h"
#include "frame/exports.h"
#include "frame/module.h"
#include "resources/resource_ids.h"
#include "standin_win32.h"

namespace {

using catalogue_test::GuardedBuffer;
using catalogue_test::HostWithVersion;
using catalogue_test::kCompatibleVersion;

class StandinFaults : public ::testing::Test {
 protected:
  void SetUp() override {
    menusBefore_ = StandinLiveMenuCount();
    blocksBefore_ = StandinLiveLocalBlockCount();
  }
  void TearDown() override {
    StandinFailLocalAlloc(0, 0);
    StandinFailCreatePopupMenu(0, 0);
  }
  bool NothingLeftBehind() const {
    return StandinLiveMenuCount() == menusBefore_ && StandinLiveLocalBlockCount() == blocksBefore_;
  }

  EditorHost host_ = HostWithVersion(kCompatibleVersion);

 private:
  std::size_t menusBefore_ = 0;
  std::size_t blocksBefore_ = 0;
};

TEST_F(StandinFaults, MenuIsNullWhenAnyScratchBufferIsMissing) {
  // The action menu copies its popup and three submenus: four scratch buffers.
  for (int successes = 0; successes < 4; ++successes) {
    StandinFailLocalAlloc(successes);
    EXPECT_EQ(GetActionMenu(&host_, nullptr, nullptr), nullptr) << successes;
    EXPECT_TRUE(NothingLeftBehind()) << successes;
  }
  StandinFailLocalAlloc(4);
  const HMENU menu = GetActionMenu(&host_, nullptr, nullptr);
  EXPECT_NE(menu, nullptr);
  DestroyMenu(menu);
  EXPECT_TRUE(NothingLeftBehind());
}

TEST_F(StandinFaults, MenuIsNullWhenAnyPopupCannotBeCreated) {
  for (int successes = 0; successes < 5; ++successes) {
    StandinFailCreatePopupMenu(successes);
    EXPECT_EQ(GetExpressionMenu(&host_, nullptr, nullptr), nullptr) << successes;
    EXPECT_TRUE(NothingLeftBehind()) << successes;
  }
}

TEST_F(StandinFaults, HandedOverMenuIsAllThatStaysAlive) {
  const HMENU menu = GetExpressionMenu(&host_, nullptr, nullptr);
  ASSERT_NE(menu, nullptr);
  EXPECT_TRUE(DestroyMenu(menu));  // the popup and its four submenus
  EXPECT_TRUE(NothingLeftBehind());

  GuardedBuffer<32> buffer;
  GetExpressionTitle(nullptr, 3, buffer.data(), buffer.size());  // loads and drops the menu
  EXPECT_EQ(buffer.text(), "Get Anchor Y");
  EXPECT_TRUE(NothingLeftBehind());
}

TEST_F(StandinFaults, ForeignModuleOrBlockIsAnError) {
  static char elsewhere;
  const auto foreign = reinterpret_cast<HINSTANCE>(&elsewhere);
  GuardedBuffer<16> text;
  EXPECT_EQ(LoadStringA(foreign, IDS_OBJECT_NAME, text.data(), text.size()), 0);
  EXPECT_EQ(text.text(), "");
  EXPECT_EQ(LoadMenuA(foreign, MAKEINTRESOURCEA(IDM_ACTIONS)), nullptr);
  EXPECT_EQ(FindResourceA(foreign, MAKEINTRESOURCEA(IDR_OBJECT_DATA), RT_RCDATA), nullptr);
  const HRSRC found = FindResourceA(TavrinModule(), MAKEINTRESOURCEA(IDR_OBJECT_DATA), RT_RCDATA);
  ASSERT_NE(found, nullptr);
  EXPECT_EQ(LoadResource(foreign, found), nullptr);
  EXPECT_EQ(LockResource(&elsewhere), nullptr);

  HLOCAL block = LocalAlloc(LPTR, 80);
  EXPECT_EQ(LocalFree(block), nullptr);
  EXPECT_EQ(LocalFree(block), block);  // freed already: handed back, not freed again
  EXPECT_EQ(LocalFree(&elsewhere), &elsewhere);
  EXPECT_TRUE(NothingLeftBehind());
}

}  // namespace
