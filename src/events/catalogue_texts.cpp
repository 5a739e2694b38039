// The texts the event editor shows: display strings of events, titles of
// their parameters, and the parameter texts of expressions. A text routine
// writes nothing when the buffer has no room (a size of 0 or less) or when
// no entry carries the code.
#include "events/event_tables.h"
#include "events/menu_text.h"
#include "frame/exports.h"
#include "frame/host_services.h"
#include "frame/module.h"

namespace {

bool HasRoom(const char* buffer, int16_t size) { return buffer != nullptr && size > 0; }

// The title of parameter `index`: its own string, or else the text of the
// event's menu item (for an expression, "Get Anchor X" and the like). When
// the menu cannot be loaded the buffer stays as it was.
void LoadParameterTitle(const EventFamily& family, int32_t code, int16_t index, char* buffer, int16_t size) {
  if (!HasRoom(buffer, size)) return;
  const uint16_t* entry = FindEventEntry(family, code);
  if (entry == nullptr) return;
  if (const uint16_t title = ParameterTitleId(entry, index); title != 0) {
    LoadStringA(TavrinModule(), title, buffer, size);
    return;
  }
  const HMENU menu = LoadMenuA(TavrinModule(), MAKEINTRESOURCEA(family.menuResource));
  if (menu == nullptr) return;
  ReadMenuText(menu, entry[kEntryMenuId], buffer, size, MF_BYCOMMAND);
  DestroyMenu(menu);
}

void LoadDisplayString(const EditorHost* host, const EventFamily& family, int32_t code, char* buffer,
                       int16_t size) {
  if (!HostIsCompatible(host) || !HasRoom(buffer, size)) return;
  const uint16_t* entry = FindEventEntry(family, code);
  if (entry == nullptr) return;
  LoadStringA(TavrinModule(), entry[kEntryStringId], buffer, size);
}

}  // namespace

TAVRIN_EXPORT void TVCALL GetConditionTitle(EditorHost*, int32_t code, int16_t param, char* buffer,
                                            int16_t size) {
  LoadParameterTitle(kConditionEvents, code, param, buffer, size);
}

TAVRIN_EXPORT void TVCALL GetActionTitle(EditorHost*, int32_t code, int16_t param, char* buffer,
                                         int16_t size) {
  LoadParameterTitle(kActionEvents, code, param, buffer, size);
}

// Also for the two expressions without parameters: parameter 0 has no title
// of its own there, so the menu text serves as for every other expression.
TAVRIN_EXPORT void TVCALL GetExpressionTitle(EditorHost*, int32_t code, char* buffer, int16_t size) {
  LoadParameterTitle(kExpressionEvents, code, 0, buffer, size);
}

TAVRIN_EXPORT void TVCALL GetExpressionParam(EditorHost*, int32_t code, int16_t param, char* buffer,
                                             int16_t size) {
  if (!HasRoom(buffer, size)) return;
  const uint16_t* entry = FindEventEntry(kExpressionEvents, code);
  if (entry == nullptr) return;
  if (const uint16_t title = ParameterTitleId(entry, param); title != 0) {
    LoadStringA(TavrinModule(), title, buffer, size);
  } else {
    buffer[0] = '\0';
  }
}

TAVRIN_EXPORT void TVCALL GetConditionString(EditorHost* host, int32_t code, char* buffer, int16_t size) {
  LoadDisplayString(host, kConditionEvents, code, buffer, size);
}

TAVRIN_EXPORT void TVCALL GetActionString(EditorHost* host, int32_t code, char* buffer, int16_t size) {
  LoadDisplayString(host, kActionEvents, code, buffer, size);
}

TAVRIN_EXPORT void TVCALL GetExpressionString(EditorHost* host, int32_t code, char* buffer, int16_t size) {
  LoadDisplayString(host, kExpressionEvents, code, buffer, size);
}
