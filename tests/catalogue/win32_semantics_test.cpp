// The Win32 string and menu behaviour that the catalogue relies on, checked
// against the library's own resources: what gets copied into a short
// buffer, what the calls return, and what a destroyed menu handle gives.
#include <gtest/gtest.h>

#include <string>

#include "catalogue_helpers.h"
#include "frame/module.h"
#include "resources/resource_ids.h"

namespace {

using catalogue_test::GuardedBuffer;

std::string LoadText(UINT id) {
  GuardedBuffer<256> buffer;
  const int length = LoadStringA(TavrinModule(), id, buffer.data(), buffer.size());
  EXPECT_EQ(static_cast<std::size_t>(length), buffer.text().size()) << "string " << id;
  EXPECT_TRUE(buffer.guardsIntact());
  return buffer.text();
}

TEST(Win32Strings, StringTableHoldsTheObjectTexts) {
  EXPECT_EQ(LoadText(IDS_HOST_SIGNATURE), "DV2");
  EXPECT_EQ(LoadText(IDS_HOST_OBJECT_NAME), "Tavrin object");
  EXPECT_EQ(LoadText(IDS_HOST_TITLE_FORMAT), " %s : Tavrin object");
  EXPECT_EQ(LoadText(IDS_OBJECT_NAME), "Tavrin object");
  EXPECT_FALSE(LoadText(IDS_OBJECT_AUTHOR).empty());
  EXPECT_FALSE(LoadText(IDS_OBJECT_COPYRIGHT).empty());
  EXPECT_FALSE(LoadText(IDS_OBJECT_WEB).empty());
  EXPECT_EQ(LoadText(IDS_OBJECT_COMMENT), "");  // absent: a hole in a block that exists
  EXPECT_EQ(LoadText(3), "");
  EXPECT_EQ(LoadText(5000), "");  // a block that does not exist
}

TEST(Win32Strings, ShortBufferGetsSizeMinusOneCharacters) {
  GuardedBuffer<5> five;
  EXPECT_EQ(LoadStringA(TavrinModule(), IDS_OBJECT_NAME, five.data(), five.size()), 4);
  EXPECT_EQ(five.text(), "Tavr");
  EXPECT_TRUE(five.guardsIntact());

  GuardedBuffer<1> one;
  EXPECT_EQ(LoadStringA(TavrinModule(), IDS_OBJECT_NAME, one.data(), one.size()), 0);
  EXPECT_EQ(one.text(), "");
  EXPECT_TRUE(one.guardsIntact());
}

TEST(Win32Menus, MenuResourceIsOneUntitledPopup) {
  const HMENU menu = LoadMenuA(TavrinModule(), MAKEINTRESOURCEA(IDM_ACTIONS));
  ASSERT_NE(menu, nullptr);
  EXPECT_EQ(GetMenuItemCount(menu), 1);
  EXPECT_EQ(GetMenuItemID(menu, 0), 0xFFFFFFFFu);
  char title[8] = "x";
  EXPECT_EQ(GetMenuStringA(menu, 0, title, sizeof title, MF_BYPOSITION), 0);
  EXPECT_STREQ(title, "");
  EXPECT_EQ(GetMenuItemCount(GetSubMenu(menu, 0)), 6);
  EXPECT_TRUE(DestroyMenu(menu));
}

TEST(Win32Menus, MenuTextIsCutToTheBufferSize) {
  const HMENU menu = CreatePopupMenu();
  ASSERT_NE(menu, nullptr);
  const std::string longText(100, 'm');
  ASSERT_TRUE(AppendMenuA(menu, MF_STRING, 7, longText.c_str()));
  GuardedBuffer<80> text;
  // Whether the 80th byte then holds a terminator differs between USER32
  // versions; the library terminates such text itself.
  EXPECT_EQ(GetMenuStringA(menu, 0, text.data(), text.size(), MF_BYPOSITION), 79);
  EXPECT_EQ(std::string(text.data(), 79), std::string(79, 'm'));
  EXPECT_TRUE(text.guardsIntact());
  EXPECT_EQ(GetMenuStringA(menu, 0, nullptr, 0, MF_BYPOSITION), 100);  // no buffer: the length
  DestroyMenu(menu);
}

TEST(Win32Menus, StateBitsSurviveAndPopupsCountTheirItems) {
  const HMENU menu = CreatePopupMenu();
  const HMENU submenu = CreatePopupMenu();
  ASSERT_TRUE(AppendMenuA(menu, MF_STRING | MF_GRAYED | MF_CHECKED, 10, "grayed, checked"));
  ASSERT_TRUE(AppendMenuA(menu, MF_STRING | MF_DISABLED, 11, "disabled"));
  ASSERT_TRUE(AppendMenuA(menu, MF_SEPARATOR, 0, nullptr));
  ASSERT_TRUE(AppendMenuA(submenu, MF_STRING, 20, "inner"));
  ASSERT_TRUE(AppendMenuA(menu, MF_POPUP, reinterpret_cast<UINT_PTR>(submenu), "popup"));

  EXPECT_EQ(GetMenuState(menu, 0, MF_BYPOSITION), UINT{MF_GRAYED | MF_CHECKED});
  EXPECT_EQ(GetMenuState(menu, 11, MF_BYCOMMAND), UINT{MF_DISABLED});
  EXPECT_EQ(GetMenuState(menu, 2, MF_BYPOSITION), UINT{MF_SEPARATOR | MF_GRAYED | MF_DISABLED});
  EXPECT_EQ(GetMenuItemID(menu, 2), 0u);
  EXPECT_EQ(GetMenuState(menu, 3, MF_BYPOSITION), (1u << 8) | MF_POPUP);
  EXPECT_EQ(GetMenuItemID(menu, 3), 0xFFFFFFFFu);
  EXPECT_EQ(GetSubMenu(menu, 3), submenu);
  EXPECT_EQ(GetSubMenu(menu, 0), nullptr);

  EXPECT_EQ(GetMenuState(menu, 4, MF_BYPOSITION), 0xFFFFFFFFu);  // no such position
  EXPECT_EQ(GetMenuItemID(menu, -1), 0xFFFFFFFFu);
  DestroyMenu(menu);
}

TEST(Win32Menus, DestroyedMenuHandleIsAnError) {
  const HMENU menu = CreatePopupMenu();
  const HMENU submenu = CreatePopupMenu();
  ASSERT_TRUE(AppendMenuA(submenu, MF_STRING, 1, "inner"));
  ASSERT_TRUE(AppendMenuA(menu, MF_POPUP, reinterpret_cast<UINT_PTR>(submenu), "popup"));
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

}  // namespace
