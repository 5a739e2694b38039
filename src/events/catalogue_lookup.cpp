// Walking the description tables: entries by code, codes by menu id, and
// the entry information the host reads.
#include "events/event_tables.h"
#include "frame/exports.h"

const uint16_t* FindEventEntry(const EventFamily& family, int32_t code) {
  const auto wanted = static_cast<uint16_t>(code);
  // The walk stops at the table's end, so a code that no entry carries
  // finds nothing instead of reading past the table.
  for (std::size_t at = 0; at + kEntryParameterTypes <= family.wordCount;) {
    const uint16_t* entry = family.words + at;
    if (entry[kEntryCode] == wanted) return entry;
    at += kEntryParameterTypes + 2 * std::size_t{entry[kEntryParameterCount]};
  }
  return nullptr;
}

int16_t EventCodeFromMenu(const EventFamily& family, int32_t menuId) {
  const auto wanted = static_cast<uint16_t>(menuId);
  const uint16_t* entry = family.words;
  for (int16_t i = 0; i < family.entryCount; ++i) {
    if (entry[kEntryMenuId] == wanted) return static_cast<int16_t>(entry[kEntryCode]);
    entry += kEntryParameterTypes + 2 * entry[kEntryParameterCount];
  }
  return -1;
}

uint16_t ParameterTitleId(const uint16_t* entry, int16_t index) {
  const auto parameters = static_cast<int16_t>(entry[kEntryParameterCount]);
  if (index < 0 || index >= parameters) return 0;
  return entry[kEntryParameterTypes + parameters + index];
}

namespace {

// The address of the entry's code word: the host reads the entry from there.
const void* EventInfos(const EventFamily& family, int32_t code) {
  const uint16_t* entry = FindEventEntry(family, code);
  return entry == nullptr ? nullptr : entry + kEntryCode;
}

}  // namespace

TAVRIN_EXPORT int16_t TVCALL GetConditionCodeFromMenu(EditorHost*, int32_t menuId) {
  return EventCodeFromMenu(kConditionEvents, menuId);
}

TAVRIN_EXPORT int16_t TVCALL GetActionCodeFromMenu(EditorHost*, int32_t menuId) {
  return EventCodeFromMenu(kActionEvents, menuId);
}

TAVRIN_EXPORT int16_t TVCALL GetExpressionCodeFromMenu(EditorHost*, int32_t menuId) {
  return EventCodeFromMenu(kExpressionEvents, menuId);
}

TAVRIN_EXPORT const void* TVCALL GetConditionInfos(EditorHost*, int32_t code) {
  return EventInfos(kConditionEvents, code);
}

TAVRIN_EXPORT const void* TVCALL GetActionInfos(EditorHost*, int32_t code) {
  return EventInfos(kActionEvents, code);
}

TAVRIN_EXPORT const void* TVCALL GetExpressionInfos(EditorHost*, int32_t code) {
  return EventInfos(kExpressionEvents, code);
}
