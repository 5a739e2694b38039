// Calls the sixteen catalogue routines with any host version, code,
// parameter index, menu id and buffer size (0, negative and 1 included),
// with menus and local memory failing on demand. Text buffers sit between
// guard bytes: a routine may write only inside the size it was given, and
// what it writes ends inside it. Menus it hands over are real and complete;
// a code it reports belongs to an event; an entry it describes has that code.
#include <windows.h>

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <vector>

#include "catalogue/catalogue_helpers.h"
#include "frame/exports.h"
#include "frame/host_services.h"
#include "fuzz_input.h"
#include "standin_win32.h"

namespace {

// Mostly the menu ids of `count` events numbered from `first` in steps of
// 10, sometimes one beside them, sometimes any 32-bit value.
int32_t MenuId(FuzzInput& in, int32_t first, int count) {
  const uint8_t b = in.Byte();
  if (b < 192) return first + 10 * (b % (count + 1));
  return b < 224 ? first + b % 20 - 2 : in.Int();
}

// Calls `write(buffer, size)` on a fenced buffer of max(size, 0) bytes and
// checks the fence and the terminator.
template <typename Write>
void WithBuffer(int16_t size, Write write) {
  catalogue_test::GuardedBuffer buffer(size > 0 ? static_cast<size_t>(size) : 0);
  write(buffer.data(), size);
  Check(buffer.guardsIntact() && buffer.text() != "<no terminator>");
}

// The items of a menu and of its submenus.
int ItemCount(HMENU menu) {
  int count = GetMenuItemCount(menu);
  for (int i = 0, top = count; i < top; ++i) {
    if (const HMENU submenu = GetSubMenu(menu, i)) count += ItemCount(submenu);
  }
  return count;
}

// A menu handed over holds every item of its family: `items` in all.
void CheckMenu(HMENU menu, bool compatible, int items) {
  if (!compatible) Check(menu == nullptr);
  if (menu == nullptr) return;
  Check(ItemCount(menu) == items);
  Check(DestroyMenu(menu) == TRUE);
}

// The menu ids of an event family run from `first` in steps of 10, in code
// order; any other id names no event.
template <typename Lookup>
void CheckCode(int32_t menuId, int32_t first, int count, Lookup lookup) {
  const int32_t offset = static_cast<int32_t>(static_cast<uint16_t>(menuId)) - first;
  const bool named = offset >= 0 && offset % 10 == 0 && offset / 10 < count;
  Check(lookup(menuId) == (named ? offset / 10 : -1));
}

// An entry is handed over from its code word on.
void CheckEntry(const void* entry, int32_t code, int count) {
  if (entry == nullptr) {
    Check(static_cast<uint16_t>(code) >= count);
    return;
  }
  uint16_t word = 0;
  std::memcpy(&word, entry, sizeof word);
  Check(word == static_cast<uint16_t>(code));
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  FuzzInput in(data, size);
  const uint8_t hostKind = in.Byte();
  const uint32_t version = hostKind % 4 == 1 ? (0x02000000u | 218u) : static_cast<uint32_t>(in.Int());
  EditorHost host = hostKind % 4 != 0 ? catalogue_test::HostWithVersion(version) : EditorHost{};
  const bool compatible = hostKind % 4 != 0 && (version & 0xFFFu) >= 218 && (version & 0xFFFF0000u) >= 0x02000000u &&
                          (version & 0x8000u) == 0;
  const size_t menusBefore = StandinLiveMenuCount();
  const size_t blocksBefore = StandinLiveLocalBlockCount();

  while (!in.done()) {
    const uint8_t routine = in.Byte() % 17;
    const int32_t code = in.Near(0, 20);
    const auto param = static_cast<int16_t>(in.Near(0, 6));
    const auto bufferSize = static_cast<int16_t>(in.Near(2, 40));
    switch (routine) {
      case 0: CheckMenu(GetConditionMenu(&host, nullptr, nullptr), compatible, 2); break;
      case 1: CheckMenu(GetActionMenu(&host, nullptr, nullptr), compatible, 18); break;
      case 2: CheckMenu(GetExpressionMenu(&host, nullptr, nullptr), compatible, 21); break;
      case 3: CheckCode(MenuId(in, 26000, 2), 26000, 2, [&](int32_t id) { return GetConditionCodeFromMenu(&host, id); }); break;
      case 4: CheckCode(MenuId(in, 25000, 16), 25000, 16, [&](int32_t id) { return GetActionCodeFromMenu(&host, id); }); break;
      case 5: CheckCode(MenuId(in, 27000, 17), 27000, 17, [&](int32_t id) { return GetExpressionCodeFromMenu(&host, id); }); break;
      case 6: CheckEntry(GetConditionInfos(&host, code), code, 2); break;
      case 7: CheckEntry(GetActionInfos(&host, code), code, 16); break;
      case 8: CheckEntry(GetExpressionInfos(&host, code), code, 17); break;
      case 9: WithBuffer(bufferSize, [&](char* b, int16_t s) { GetConditionTitle(&host, code, param, b, s); }); break;
      case 10: WithBuffer(bufferSize, [&](char* b, int16_t s) { GetActionTitle(&host, code, param, b, s); }); break;
      case 11: WithBuffer(bufferSize, [&](char* b, int16_t s) { GetExpressionTitle(&host, code, b, s); }); break;
      case 12: WithBuffer(bufferSize, [&](char* b, int16_t s) { GetExpressionParam(&host, code, param, b, s); }); break;
      case 13: WithBuffer(bufferSize, [&](char* b, int16_t s) { GetConditionString(&host, code, b, s); }); break;
      case 14: WithBuffer(bufferSize, [&](char* b, int16_t s) { GetActionString(&host, code, b, s); }); break;
      case 15: WithBuffer(bufferSize, [&](char* b, int16_t s) { GetExpressionString(&host, code, b, s); }); break;
      default:
        // The next few menu or memory requests fail, as when memory runs out.
        StandinFailCreatePopupMenu(in.Byte() % 8, in.Byte() % 3);
        StandinFailLocalAlloc(in.Byte() % 8, in.Byte() % 3);
        break;
    }
  }
  StandinFailCreatePopupMenu(0, 0);
  StandinFailLocalAlloc(0, 0);
  // Every menu and block the routines made was handed over or released.
  Check(StandinLiveMenuCount() == menusBefore);
  Check(StandinLiveLocalBlockCount() == blocksBefore);
  return 0;
}
