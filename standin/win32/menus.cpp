// The menu calls of USER32 that the library uses, with their Windows
// results: -1 (or 0xFFFFFFFF) and FALSE for a bad handle or position,
// depth-first search through submenus for MF_BYCOMMAND, and destruction
// that takes the submenus along.
#include <algorithm>
#include <cstring>
#include <new>
#include <unordered_map>

#include "call_faults.h"
#include "menu_store.h"
#include "standin_win32.h"

namespace standin {

namespace {

std::unordered_map<uintptr_t, Menu>& Menus() {
  // Never destroyed: a loaded DLL shutting down at exit still calls in.
  static auto& menus = *new std::unordered_map<uintptr_t, Menu>;
  return menus;
}

uintptr_t g_nextHandle = 0x100;
CallFaults g_popupFaults;

MenuItem* FindItem(HMENU handle, UINT item, UINT flags) {
  Menu* menu = FindMenu(handle);
  if (menu == nullptr) return nullptr;
  if ((flags & MF_BYPOSITION) != 0) return item < menu->items.size() ? &menu->items[item] : nullptr;
  for (MenuItem& candidate : menu->items) {
    if ((candidate.flags & MF_POPUP) != 0) {
      if (MenuItem* found = FindItem(candidate.submenu, item, flags)) return found;
    } else if (candidate.id == item) {
      return &candidate;
    }
  }
  return nullptr;
}

MenuItem* ItemAt(HMENU handle, int position) {
  return position < 0 ? nullptr : FindItem(handle, static_cast<UINT>(position), MF_BYPOSITION);
}

// True when `menu` is `candidate` or lies inside it: appending `candidate`
// to `menu` as a popup would make a menu its own submenu.
bool WouldNestInItself(HMENU menu, HMENU candidate) {
  for (HMENU h = menu; h != nullptr;) {
    if (h == candidate) return true;
    const Menu* m = FindMenu(h);
    h = m == nullptr ? nullptr : m->parent;
  }
  return false;
}

}  // namespace

HMENU NewMenu() {
  const uintptr_t handle = g_nextHandle++;
  try {
    Menus().emplace(handle, Menu{});
  } catch (const std::bad_alloc&) {
    return nullptr;  // out of memory: no menu, as on Windows
  }
  return reinterpret_cast<HMENU>(handle);
}

Menu* FindMenu(HMENU handle) {
  auto found = Menus().find(reinterpret_cast<uintptr_t>(handle));
  return found == Menus().end() ? nullptr : &found->second;
}

}  // namespace standin

using standin::FindMenu;
using standin::MenuItem;

HMENU WINAPI CreatePopupMenu(void) {
  if (standin::g_popupFaults.NextCallFails()) return nullptr;
  return standin::NewMenu();
}

BOOL WINAPI DestroyMenu(HMENU hMenu) {
  standin::Menu* menu = FindMenu(hMenu);
  if (menu == nullptr) return FALSE;
  const std::vector<MenuItem> items = std::move(menu->items);
  standin::Menus().erase(reinterpret_cast<uintptr_t>(hMenu));
  for (const MenuItem& item : items) {
    if ((item.flags & MF_POPUP) != 0) DestroyMenu(item.submenu);
  }
  return TRUE;
}

int WINAPI GetMenuItemCount(HMENU hMenu) {
  const standin::Menu* menu = FindMenu(hMenu);
  return menu == nullptr ? -1 : static_cast<int>(menu->items.size());
}

HMENU WINAPI GetSubMenu(HMENU hMenu, int nPos) {
  const MenuItem* item = standin::ItemAt(hMenu, nPos);
  if (item == nullptr || (item->flags & MF_POPUP) == 0 || FindMenu(item->submenu) == nullptr) return nullptr;
  return item->submenu;
}

UINT WINAPI GetMenuItemID(HMENU hMenu, int nPos) {
  const MenuItem* item = standin::ItemAt(hMenu, nPos);
  if (item == nullptr || (item->flags & MF_POPUP) != 0) return 0xFFFFFFFFu;
  return item->id;
}

int WINAPI GetMenuStringA(HMENU hMenu, UINT uIDItem, LPSTR lpString, int cchMax, UINT flags) {
  const bool copies = lpString != nullptr && cchMax > 0;
  if (copies) lpString[0] = '\0';
  const MenuItem* item = standin::FindItem(hMenu, uIDItem, flags);
  if (item == nullptr || (item->flags & MF_SEPARATOR) != 0) return 0;
  // Without a buffer to fill, the result is the text's length.
  if (!copies) return static_cast<int>(item->text.size());
  const std::size_t copied = std::min(item->text.size(), static_cast<std::size_t>(cchMax) - 1);
  std::memcpy(lpString, item->text.data(), copied);
  lpString[copied] = '\0';
  return static_cast<int>(copied);
}

UINT WINAPI GetMenuState(HMENU hMenu, UINT uId, UINT uFlags) {
  const MenuItem* item = standin::FindItem(hMenu, uId, uFlags);
  if (item == nullptr) return 0xFFFFFFFFu;
  if ((item->flags & MF_POPUP) == 0) return item->flags;
  // A popup item: its flags in the low byte, its submenu's item count in
  // the high byte.
  const standin::Menu* submenu = FindMenu(item->submenu);
  if (submenu == nullptr) return 0xFFFFFFFFu;
  return (static_cast<UINT>(submenu->items.size()) << 8) | (item->flags & 0xFFu);
}

BOOL WINAPI AppendMenuA(HMENU hMenu, UINT uFlags, UINT_PTR uIDNewItem, LPCSTR lpNewItem) {
  standin::Menu* menu = FindMenu(hMenu);
  // Bitmap and owner-drawn items carry no text; the library appends none.
  if (menu == nullptr || (uFlags & (MF_BITMAP | MF_OWNERDRAW)) != 0) return FALSE;

  MenuItem item;
  item.flags = uFlags & ~UINT{MF_BYPOSITION};
  standin::Menu* child = nullptr;
  if ((uFlags & MF_POPUP) != 0) {
    item.submenu = reinterpret_cast<HMENU>(uIDNewItem);
    child = FindMenu(item.submenu);
    // A menu may hang in one place only, and never inside itself.
    if (child == nullptr || child->parent != nullptr || standin::WouldNestInItself(hMenu, item.submenu)) {
      return FALSE;
    }
  } else {
    item.id = static_cast<UINT>(uIDNewItem);
    // A string item without a string is a separator.
    if (lpNewItem == nullptr) item.flags |= MF_SEPARATOR;
  }
  // A separator can never be chosen: USER32 reports it grayed and disabled.
  if ((item.flags & MF_SEPARATOR) != 0) item.flags |= MF_GRAYED | MF_DISABLED;
  try {
    if ((item.flags & MF_SEPARATOR) == 0 && lpNewItem != nullptr) item.text = lpNewItem;
    menu->items.push_back(std::move(item));
  } catch (const std::bad_alloc&) {
    return FALSE;
  }
  if (child != nullptr) child->parent = hMenu;
  return TRUE;
}

void StandinFailCreatePopupMenu(int successes, int failures) { standin::g_popupFaults.Arm(successes, failures); }

std::size_t StandinLiveMenuCount() { return standin::Menus().size(); }
