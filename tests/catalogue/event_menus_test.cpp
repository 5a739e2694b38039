// The event menus the host receives, read back through the Win32 menu calls.
#include <gtest/gtest.h>

#include "catalogue_helpers.h"
#include "frame/exports.h"

namespace {

using catalogue_test::DumpMenu;
using catalogue_test::HostWithVersion;
using catalogue_test::kCompatibleVersion;

using MenuRoutine = HMENU(TVCALL*)(EditorHost*, void*, void*);

std::string MenuOf(MenuRoutine routine) {
  EditorHost host = HostWithVersion(kCompatibleVersion);
  const HMENU menu = routine(&host, nullptr, nullptr);
  if (menu == nullptr) return "<no menu>";
  std::string dump = DumpMenu(menu);
  EXPECT_TRUE(DestroyMenu(menu));
  return dump;
}

TEST(EventMenus, ActionMenuListsItemsThenSubmenusWithoutTheSpeedAction) {
  EXPECT_EQ(MenuOf(GetActionMenu),
            "\"Add Anchor\" 25000\n"
            "\"Add Link\" 25010\n"
            "\"Add Platform\" 25020\n"
            "\"Anchor\" popup\n"
            "  \"Set Anchor X \" 25030\n"
            "  \"Set Anchor Y\" 25040\n"
            "\"Chain\" popup\n"
            "  \"Set Mass\" 25050\n"
            "  \"Set Acceleration\" 25150\n"
            "  \"Set Angle\" 25060\n"
            "  \"Set Link Spacing\" 25080\n"
            "\"Swing\" popup\n"
            "  \"Start All\" 25090\n"
            "  \"Start Chain\" 25100\n"
            "  \"Stop All\" 25110\n"
            "  \"Stop Chain\" 25120\n"
            "  \"Update All\" 25130\n"
            "  \"Update Chain\" 25140\n");
}

TEST(EventMenus, ConditionMenuKeepsItsSpelling) {
  EXPECT_EQ(MenuOf(GetConditionMenu),
            "\"Is chain swingging?\" 26000\n"
            "\"On Swing\" 26010\n");
}

TEST(EventMenus, ExpressionMenuListsTwoItemsThenFourSubmenus) {
  EXPECT_EQ(MenuOf(GetExpressionMenu),
            "\"Get number of chains\" 27000\n"
            "\"Get number of links per chain\" 27010\n"
            "\"Anchor\" popup\n"
            "  \"Get Anchor X\" 27020\n"
            "  \"Get Anchor Y\" 27030\n"
            "\"Chain\" popup\n"
            "  \"Get Platform Mass\" 27040\n"
            "  \"Get Chain Angle\" 27050\n"
            "  \"Get Chain Acceleration\" 27130\n"
            "  \"Get Chain Speed\" 27060\n"
            "  \"Get Chain Index\" 27100\n"
            "  \"Get DeltaX\" 27110\n"
            "  \"Get DeltaY\" 27120\n"
            "\"Link\" popup\n"
            "  \"Get Link Index\" 27140\n"
            "  \"Get Link X\" 27150\n"
            "  \"Get Link Y\" 27160\n"
            "  \"Get Link Spacing\" 27070\n"
            "\"Platform\" popup\n"
            "  \"Get Platform X\" 27080\n"
            "  \"Get Platform Y\" 27090\n");
}

}  // namespace
