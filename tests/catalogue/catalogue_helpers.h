// Helpers for tests that talk to the catalogue and to the Win32 calls
// beneath it: editor hosts with a chosen version word, text buffers that
// show what was written, and a readable dump of a menu read back through Win32.
#pragma once

#include <windows.h>

#include <cstdint>
#include <cstdio>
#include <string>

#include "frame/host_services.h"

namespace catalogue_test {

inline uint32_t g_hostVersion = 0;
inline uint32_t TVCALL AnswerVersion() { return g_hostVersion; }

// An editor-time host record whose version service answers `version`. By
// default version 2.0, build 218: the oldest host that can show the object,
// so every test that uses it also proves the boundary is inclusive.
inline EditorHost HostWithVersion(uint32_t version = 0x02000000u | 218u) {
  g_hostVersion = version;
  EditorHost host{};
  host.slot[kEditorSlotGetVersion] = reinterpret_cast<void*>(&AnswerVersion);
  return host;
}

// A text buffer of `size` bytes with guard bytes on both sides, all filled
// with a sentinel so that any byte written shows.
class GuardedBuffer {
 public:
  static constexpr char kSentinel = '\xCD';
  static constexpr std::size_t kGuard = 16;

  explicit GuardedBuffer(std::size_t size) : size_(size), bytes_(kGuard + size + kGuard, kSentinel) {}
  char* data() { return bytes_.data() + kGuard; }
  int16_t size() const { return static_cast<int16_t>(size_); }
  bool guardsIntact() const {
    return bytes_.find_first_not_of(kSentinel) >= kGuard && bytes_.find_last_not_of(kSentinel) + 1 <= kGuard + size_;
  }
  // The text up to its terminator, "<no terminator>" when none lies inside,
  // or "<untouched>" when no byte was written.
  std::string text() const {
    if (bytes_.find_first_not_of(kSentinel) == std::string::npos) return "<untouched>";
    const std::string inside = bytes_.substr(kGuard, size_);
    const std::size_t end = inside.find('\0');
    return end == std::string::npos ? "<no terminator>" : inside.substr(0, end);
  }

 private:
  std::size_t size_;
  std::string bytes_;
};

// The items of a menu read back through the Win32 calls, separated by "|":
// "text=id", with " state=0x.." when the item has state bits, and for a
// popup "text{its submenu's items}".
inline std::string DumpMenu(HMENU menu) {
  std::string dump;
  for (int position = 0; position < GetMenuItemCount(menu); ++position) {
    char text[256] = "";
    GetMenuStringA(menu, static_cast<UINT>(position), text, sizeof text, MF_BYPOSITION);
    dump += (position > 0 ? "|" : "") + std::string(text);
    if (const UINT id = GetMenuItemID(menu, position); id == 0xFFFFFFFFu) {
      dump += "{" + DumpMenu(GetSubMenu(menu, position)) + "}";
    } else {
      char bits[32] = "";
      if (const UINT state = GetMenuState(menu, static_cast<UINT>(position), MF_BYPOSITION); state != 0) {
        std::snprintf(bits, sizeof bits, " state=0x%X", state);
      }
      dump += "=" + std::to_string(id) + bits;
    }
  }
  return dump;
}

}  // namespace catalogue_test
