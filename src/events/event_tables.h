// The three description tables through which the host's event editor learns
// the extension's events. Each table is a run of 16-bit little-endian words:
// its entries back to back in code order, then one 0 word. An entry is
//   menu id, display-string id, code, flags, parameter count n,
//   n parameter types, n parameter title ids (0: no title of its own),
// 10 + 4n bytes in all.
#pragma once

#include <windows.h>

#include <cstddef>
#include <cstdint>

// Word positions inside an entry.
constexpr int kEntryMenuId = 0;
constexpr int kEntryStringId = 1;
constexpr int kEntryCode = 2;
constexpr int kEntryFlags = 3;
constexpr int kEntryParameterCount = 4;
constexpr int kEntryParameterTypes = 5;

// One table with what belongs to it: the menu resource that lists its
// events and the number of its entries.
struct EventFamily {
  const uint16_t* words;    // the entries, then the 0 word
  std::size_t wordCount;    // words before the 0 word
  int16_t entryCount;
  WORD menuResource;
};

extern const EventFamily kConditionEvents;
extern const EventFamily kActionEvents;
extern const EventFamily kExpressionEvents;

// The entry whose code word equals the low 16 bits of `code`, or null when
// the table holds none.
const uint16_t* FindEventEntry(const EventFamily& family, int32_t code);

// The code of the first entry whose menu id equals the low 16 bits of
// `menuId`, or -1. The table decides, not the menu: an event without a menu
// item still has its code.
int16_t EventCodeFromMenu(const EventFamily& family, int32_t menuId);

// The title id of parameter `index` of an entry. A parameter that the entry
// does not have has no title of its own: 0.
uint16_t ParameterTitleId(const uint16_t* entry, int16_t index);
