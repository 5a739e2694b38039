// The menus the stand-in has created, by handle. Handles are never reused,
// so a destroyed or made-up handle is simply not found.
#pragma once

#include <windows.h>

#include <string>
#include <vector>

namespace standin {

struct MenuItem {
  UINT flags = 0;  // type and state bits as appended (MF_POPUP, MF_SEPARATOR, MF_GRAYED, ...)
  UINT id = 0;     // command id; not used for popup items
  HMENU submenu = nullptr;  // popup items only
  std::string text;
};

struct Menu {
  std::vector<MenuItem> items;
  HMENU parent = nullptr;  // the menu holding this one as a popup item, if any
};

// A new empty menu; CreatePopupMenu and LoadMenuA make theirs here.
HMENU NewMenu();

// The live menu of a handle, or null for a stale or foreign handle.
Menu* FindMenu(HMENU handle);

}  // namespace standin
