// LoadMenuA: builds a menu from a standard menu template. The template is
// a header (version 0, offset to the items), then the items: a flags word,
// a command id word unless the item opens a popup, and a zero-terminated
// UTF-16 text. A popup's items follow it directly; the last item of each
// list carries MF_END.
#include <new>

#include "menu_store.h"
#include "module_resources.h"

namespace {

struct Template {
  const unsigned char* bytes;
  std::size_t size;
};

bool ReadWordAt(const Template& t, std::size_t& offset, uint16_t& word) {
  if (offset + 2 > t.size) return false;
  word = standin::ReadWord(t.bytes + offset);
  offset += 2;
  return true;
}

// False at the template's end, or when memory for the text runs out.
bool ReadText(const Template& t, std::size_t& offset, std::string& text) {
  try {
    for (uint16_t c = 0; ReadWordAt(t, offset, c);) {
      if (c == 0) return true;
      text.push_back(standin::NarrowChar(c));
    }
  } catch (const std::bad_alloc&) {
  }
  return false;
}

// Appends the items of one list to `menu`; false when the template ends
// before the list does or an item cannot be appended.
bool ParseItems(const Template& t, std::size_t& offset, HMENU menu) {
  for (;;) {
    uint16_t flags = 0;
    uint16_t id = 0;
    std::string text;
    if (!ReadWordAt(t, offset, flags)) return false;
    if ((flags & MF_POPUP) == 0 && !ReadWordAt(t, offset, id)) return false;
    if (!ReadText(t, offset, text)) return false;
    // MF_END shares its bit with MF_HILITE: it ends the list, it is no state.
    const bool last = (flags & MF_END) != 0;
    const UINT itemFlags = flags & ~UINT{MF_END};
    if ((flags & MF_POPUP) != 0) {
      const HMENU popup = standin::NewMenu();
      if (popup == nullptr) return false;
      if (!ParseItems(t, offset, popup) ||
          !AppendMenuA(menu, itemFlags, reinterpret_cast<UINT_PTR>(popup), text.c_str())) {
        DestroyMenu(popup);
        return false;
      }
    } else if (!AppendMenuA(menu, itemFlags, id, text.empty() ? nullptr : text.c_str())) {
      return false;
    }
    if (last) return true;
  }
}

}  // namespace

HMENU WINAPI LoadMenuA(HINSTANCE hInstance, LPCSTR lpMenuName) {
  const standin::ResourceEntry* entry = standin::FindModuleResource(hInstance, lpMenuName, RT_MENU);
  if (entry == nullptr) return nullptr;
  const Template t{entry->data, entry->size};
  std::size_t offset = 0;
  uint16_t version = 0;
  uint16_t itemsOffset = 0;
  // Only standard templates (version 0); extended ones are not used here.
  if (!ReadWordAt(t, offset, version) || !ReadWordAt(t, offset, itemsOffset) || version != 0) return nullptr;
  offset += itemsOffset;
  const HMENU menu = standin::NewMenu();
  if (menu == nullptr) return nullptr;
  if (!ParseItems(t, offset, menu)) {
    DestroyMenu(menu);
    return nullptr;
  }
  return menu;
}
