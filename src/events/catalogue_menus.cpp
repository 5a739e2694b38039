// The event menus handed to the host: a fresh copy of the untitled popup of
// the family's menu resource, built item by item so that the host owns a
// menu of its own that outlives the loaded resource.
#include "events/event_tables.h"
#include "events/menu_text.h"
#include "frame/exports.h"
#include "frame/host_services.h"
#include "frame/module.h"

namespace {

// A menu text of up to 79 characters and its terminator; longer texts are cut.
constexpr int kScratchSize = 80;

bool CopyMenuItems(HMENU source, HMENU destination);

// Appends a popup item with `text` to `destination` and fills it with the
// items of the source's submenu at `position`.
bool CopySubmenu(HMENU source, int position, HMENU destination, const char* text) {
  const HMENU popup = CreatePopupMenu();
  if (popup == nullptr) return false;
  if (!AppendMenuA(destination, MF_POPUP, reinterpret_cast<UINT_PTR>(popup), text)) {
    DestroyMenu(popup);
    return false;
  }
  return CopyMenuItems(GetSubMenu(source, position), popup);
}

// Appends copies of the items of `source` to `destination`, keeping their
// order, ids, texts, states and submenus. False when memory for a scratch
// buffer or a popup could not be had; what was appended by then stays in
// `destination` for the caller to destroy.
bool CopyMenuItems(HMENU source, HMENU destination) {
  const int count = GetMenuItemCount(source);
  auto* text = static_cast<char*>(LocalAlloc(LPTR, kScratchSize));
  if (text == nullptr) return false;
  bool copied = true;
  for (int position = 0; copied && position < count; ++position) {
    const UINT id = GetMenuItemID(source, position);
    if (id == 0) {
      copied = AppendMenuA(destination, MF_SEPARATOR, 0, nullptr) != FALSE;
      continue;
    }
    text[0] = '\0';  // an item whose text cannot be read gets none, not the last item's
    ReadMenuText(source, static_cast<UINT>(position), text, kScratchSize, MF_BYPOSITION);
    if (id == 0xFFFFFFFFu) {  // the item opens a submenu
      copied = CopySubmenu(source, position, destination, text);
    } else {
      const UINT state = GetMenuState(source, static_cast<UINT>(position), MF_BYPOSITION);
      copied = state != 0xFFFFFFFFu && AppendMenuA(destination, state, id, text) != FALSE;
    }
  }
  LocalFree(text);
  return copied;
}

HMENU BuildEventMenu(const EditorHost* host, const EventFamily& family) {
  if (!HostIsCompatible(host)) return nullptr;
  const HMENU resource = LoadMenuA(TavrinModule(), MAKEINTRESOURCEA(family.menuResource));
  if (resource == nullptr) return nullptr;
  HMENU menu = nullptr;
  if (const HMENU source = GetSubMenu(resource, 0)) {
    menu = CreatePopupMenu();
    // A partial menu would offer the author an incomplete list: all or nothing.
    if (menu != nullptr && !CopyMenuItems(source, menu)) {
      DestroyMenu(menu);
      menu = nullptr;
    }
  }
  DestroyMenu(resource);
  return menu;
}

}  // namespace

TAVRIN_EXPORT HMENU TVCALL GetConditionMenu(EditorHost* host, void*, void*) {
  return BuildEventMenu(host, kConditionEvents);
}

TAVRIN_EXPORT HMENU TVCALL GetActionMenu(EditorHost* host, void*, void*) {
  return BuildEventMenu(host, kActionEvents);
}

TAVRIN_EXPORT HMENU TVCALL GetExpressionMenu(EditorHost* host, void*, void*) {
  return BuildEventMenu(host, kExpressionEvents);
}
