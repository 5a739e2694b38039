// The event menus the host receives, read back through the Win32 menu calls,
// and what a host that fails the compatibility test gets instead.
#include <gtest/gtest.h>

#include <utility>

#include "catalogue_helpers.h"
#include "frame/exports.h"

namespace {

using MenuRoutine = HMENU(TVCALL*)(EditorHost*, void*, void*);

// The action menu has no "Set Speed"; the condition menu keeps its spelling.
TEST(EventMenus, ListItemsThenSubmenusWithTheirIdsInOrder) {
  const struct {
    MenuRoutine routine;
    const char* dump;
  } menus[] = {
      {GetActionMenu,
       "Add Anchor=25000|Add Link=25010|Add Platform=25020|Anchor{Set Anchor X =25030|Set Anchor Y=25040}|"
       "Chain{Set Mass=25050|Set Acceleration=25150|Set Angle=25060|Set Link Spacing=25080}|"
       "Swing{Start All=25090|Start Chain=25100|Stop All=25110|Stop Chain=25120|Update All=25130|Update Chain=25140}"},
      {GetConditionMenu, "Is chain swingging?=26000|On Swing=26010"},
      {GetExpressionMenu,
       "Get number of chains=27000|Get number of links per chain=27010|"
       "Anchor{Get Anchor X=27020|Get Anchor Y=27030}|"
       "Chain{Get Platform Mass=27040|Get Chain Angle=27050|Get Chain Acceleration=27130|Get Chain Speed=27060|"
       "Get Chain Index=27100|Get DeltaX=27110|Get DeltaY=27120}|"
       "Link{Get Link Index=27140|Get Link X=27150|Get Link Y=27160|Get Link Spacing=27070}|"
       "Platform{Get Platform X=27080|Get Platform Y=27090}"}};
  for (const auto& menu : menus) {
    EditorHost host = catalogue_test::CompatibleHost();
    const HMENU handle = menu.routine(&host, nullptr, nullptr);
    ASSERT_NE(handle, nullptr);
    EXPECT_EQ(catalogue_test::DumpMenu(handle), menu.dump);
    EXPECT_TRUE(DestroyMenu(handle));
  }
}

// No menus and no display strings: the routines return null and leave the
// buffers as they were.
TEST(EventMenus, IncompatibleHostGetsNoMenusAndNoDisplayStrings) {
  const std::pair<const char*, uint32_t> hosts[] = {{"no version service", 0},
                                                    {"build 217", 0x02000000u | 217u},
                                                    {"version 0x0100", 0x01000000u | 300u},
                                                    {"flag 0x8000 set", 0x02000000u | 0x8000u | 300u}};
  for (const auto& [why, version] : hosts) {
    EditorHost host = version != 0 ? catalogue_test::HostWithVersion(version) : EditorHost{};
    EXPECT_EQ(GetConditionMenu(&host, nullptr, nullptr), nullptr) << why;
    EXPECT_EQ(GetActionMenu(&host, nullptr, nullptr), nullptr) << why;
    EXPECT_EQ(GetExpressionMenu(&host, nullptr, nullptr), nullptr) << why;
    catalogue_test::GuardedBuffer text(64);
    GetConditionString(&host, 0, text.data(), text.size());
    GetActionString(&host, 0, text.data(), text.size());
    GetExpressionString(&host, 0, text.data(), text.size());
    EXPECT_TRUE(text.untouched()) << why;
  }
}

}  // namespace
