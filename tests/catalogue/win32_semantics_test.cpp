// The Win32 string and menu behaviour that the catalogue relies on, checked
// against the library's own resources: what gets copied into a short
// buffer, what the calls return, and what a destroyed menu handle gives.
#include <gtest/gtest.h>

#include <string>

#include "catalogue_helpers.h"
#include "frame/module.h"
#include "resources/resource_ids.h"

#if !defined(_WIN32)
#include "standin_win32.h"
#endif

namespace {

using catalogue_test::GuardedBuffer;

// A short buffer gets size - 1 characters and a terminator.
TEST(Win32Strings, StringTableHoldsTheObjectTextsCutToTheBuffer) {
  const struct {
    UINT id;
    std::size_t size;
    const char* text;
  } strings[] = {{IDS_HOST_SIGNATURE, 256, "DV2"}, {IDS_HOST_OBJECT_NAME, 256, "Tavrin object"},
                 {IDS_HOST_TITLE_FORMAT, 256, " %s : Tavrin object"}, {IDS_OBJECT_NAME, 256, "Tavrin object"},
                 {IDS_OBJECT_NAME, 5, "Tavr"}, {IDS_OBJECT_NAME, 1, ""},
                 // Absent: a hole in a block that exists, and a block that does not.
                 {IDS_OBJECT_COMMENT, 256, ""}, {3, 256, ""}, {5000, 256, ""}};
  for (const auto& s : strings) {
    GuardedBuffer buffer(s.size);
    const int length = LoadStringA(TavrinModule(), s.id, buffer.data(), buffer.size());
    EXPECT_EQ(static_cast<std::size_t>(length), buffer.text().size()) << s.id;
    EXPECT_EQ(buffer.text(), s.text) << s.id;
  }
}

TEST(Win32Menus, StateBitsSurviveAndPopupsCountTheirItems) {
  const HMENU menu = CreatePopupMenu();
  const HMENU submenu = CreatePopupMenu();
  ASSERT_TRUE(AppendMenuA(menu, MF_STRING | MF_GRAYED | MF_CHECKED, 10, "grayed, checked"));
  ASSERT_TRUE(AppendMenuA(menu, MF_STRING | MF_DISABLED, 11, "disabled"));
  ASSERT_TRUE(AppendMenuA(menu, MF_SEPARATOR, 0, nullptr));
  ASSERT_TRUE(AppendMenuA(submenu, MF_STRING, 20, "inner"));
  ASSERT_TRUE(AppendMenuA(menu, MF_POPUP, reinterpret_cast<UINT_PTR>(submenu), "popup"));

  // A separator has id 0 and reports itself grayed and disabled.
  EXPECT_EQ(catalogue_test::DumpMenu(menu),
            "grayed, checked=10 state=0x9|disabled=11 state=0x2|=0 state=0x803|popup{inner=20}");
  EXPECT_EQ(GetMenuState(menu, 11, MF_BYCOMMAND), UINT{MF_DISABLED});
  EXPECT_EQ(GetMenuState(menu, 3, MF_BYPOSITION), (1u << 8) | MF_POPUP);
  EXPECT_EQ(GetSubMenu(menu, 0), nullptr);
  EXPECT_EQ(GetMenuState(menu, 4, MF_BYPOSITION), 0xFFFFFFFFu);  // no such position
  EXPECT_EQ(GetMenuItemID(menu, -1), 0xFFFFFFFFu);

  ASSERT_TRUE(DestroyMenu(menu));
  for (HMENU stale : {menu, submenu}) {  // the submenu went with its menu
    char text[8] = "x";
    EXPECT_EQ(GetMenuItemCount(stale), -1);
    EXPECT_EQ(GetMenuItemID(stale, 0), 0xFFFFFFFFu);
    EXPECT_EQ(GetMenuState(stale, 0, MF_BYPOSITION), 0xFFFFFFFFu);
    EXPECT_EQ(GetMenuStringA(stale, 0, text, sizeof text, MF_BYPOSITION), 0);
    EXPECT_EQ(GetSubMenu(stale, 0), nullptr);
    EXPECT_FALSE(AppendMenuA(stale, MF_STRING, 2, "more"));
    EXPECT_FALSE(DestroyMenu(stale));
  }
}

#if !defined(_WIN32)
// Only the stand-in can be given a module or a block it does not know.
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
#endif

}  // namespace
