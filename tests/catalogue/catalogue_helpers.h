// Helpers for tests that talk to the catalogue and to the Win32 calls
// beneath it: editor hosts with a chosen version word, text buffers fenced
// by guard bytes, and a readable dump of a menu read back through Win32.
#pragma once

#include <windows.h>

#include <array>
#include <cstdint>
#include <cstdio>
#include <cstring>
#include <string>

#include "frame/host_services.h"

namespace catalogue_test {

inline uint32_t g_hostVersion = 0;
inline uint32_t TVCALL AnswerVersion() { return g_hostVersion; }

// Version 2.0, build 218: the oldest host that can show the object, so
// every test that uses it also proves the boundary is inclusive.
constexpr uint32_t kCompatibleVersion = 0x02000000u | 218u;

// An editor-time host record whose version service answers `version`.
inline EditorHost HostWithVersion(uint32_t version) {
  g_hostVersion = version;
  EditorHost host{};
  host.slot[kEditorSlotGetVersion] = reinterpret_cast<void*>(&AnswerVersion);
  return host;
}

// A text buffer of Size bytes with guard bytes on both sides, all filled
// with a sentinel so that any byte written shows.
template <std::size_t Size>
class GuardedBuffer {
 public:
  static constexpr unsigned char kSentinel = 0xCD;
  static constexpr std::size_t kGuard = 16;

  GuardedBuffer() { bytes_.fill(kSentinel); }
  char* data() { return reinterpret_cast<char*>(bytes_.data() + kGuard); }
  int16_t size() const { return static_cast<int16_t>(Size); }

  // The text up to its terminator; "<no terminator>" when none lies inside.
  std::string text() const {
    const auto* begin = reinterpret_cast<const char*>(bytes_.data() + kGuard);
    const void* end = std::memchr(begin, '\0', Size);
    return end == nullptr ? "<no terminator>" : std::string(begin, static_cast<const char*>(end));
  }
  bool guardsIntact() const { return AllSentinel(0, kGuard) && AllSentinel(kGuard + Size, kGuard); }
  bool untouched() const { return AllSentinel(0, bytes_.size()); }

 private:
  bool AllSentinel(std::size_t from, std::size_t count) const {
    for (std::size_t i = from; i < from + count; ++i) {
      if (bytes_[i] != kSentinel) return false;
    }
    return true;
  }
  std::array<unsigned char, kGuard + Size + kGuard> bytes_;
};

// One line per item, read back through the Win32 calls: the quoted text and
// the command id, " state=0x.." when an item has state bits, and for a
// popup its submenu's items indented below it.
inline std::string DumpMenu(HMENU menu, const std::string& indent = "") {
  std::string dump;
  const int count = GetMenuItemCount(menu);
  for (int position = 0; position < count; ++position) {
    char text[256];
    GetMenuStringA(menu, static_cast<UINT>(position), text, sizeof text, MF_BYPOSITION);
    const UINT id = GetMenuItemID(menu, position);
    const UINT state = GetMenuState(menu, static_cast<UINT>(position), MF_BYPOSITION);
    dump += indent + "\"" + text + "\"";
    if (id == 0xFFFFFFFFu) {
      dump += " popup\n" + DumpMenu(GetSubMenu(menu, position), indent + "  ");
      continue;
    }
    dump += " " + std::to_string(id);
    if (state != 0) {
      char bits[32];
      std::snprintf(bits, sizeof bits, " state=0x%X", state);
      dump += bits;
    }
    dump += "\n";
  }
  return dump;
}

}  // namespace catalogue_test
