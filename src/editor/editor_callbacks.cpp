// Editor routines that only size the object or do nothing at all.
#include <cstring>

#include "editor/wrapping_arithmetic.h"
#include "frame/edit_data.h"
#include "frame/exports.h"

TAVRIN_EXPORT int32_t TVCALL ModifyObject(EditorHost*, EditData* edit, void*, void*, int32_t kind,
                                          const void* sizeRecord) {
  if (kind == 0) {
    // The new width and height are the 16-bit words at bytes 4 and 6.
    const auto* bytes = static_cast<const unsigned char*>(sizeRecord);
    std::memcpy(&edit->objectWidth, bytes + 4, sizeof edit->objectWidth);
    std::memcpy(&edit->objectHeight, bytes + 6, sizeof edit->objectHeight);
  }
  return 0;
}

TAVRIN_EXPORT void TVCALL CreateFromFile(void*, void*, EditData* edit) {
  edit->objectWidth = 32;
  edit->objectHeight = 32;
}

TAVRIN_EXPORT void TVCALL GetObjectRect(EditorHost*, RECT* rect, void*, EditData* edit) {
  // The sizes are signed 16-bit: a stored 65535 is -1.
  rect->right = WrapAdd(rect->left, edit->objectWidth);
  rect->bottom = WrapAdd(rect->top, edit->objectHeight);
}

TAVRIN_EXPORT int32_t TVCALL IsTransparent(void*, void*, void*, int32_t, int32_t) { return 0; }
TAVRIN_EXPORT int32_t TVCALL EnumElts(void*, void*, void*, void*, intptr_t, intptr_t) { return 0; }
TAVRIN_EXPORT int32_t TVCALL RebuildExt(void*, void*, void*, void*, void*, void*) { return 0; }
TAVRIN_EXPORT void TVCALL PutObject(void*, void*, void*, uint16_t) {}
TAVRIN_EXPORT void TVCALL RemoveObject(void*, void*, void*, uint16_t) {}
TAVRIN_EXPORT void TVCALL UpdateFileNames(void*, void*, void*, void*) {}
// The setup dialog opens from the host's own popup command; nothing is added.
TAVRIN_EXPORT void TVCALL AppendPopup(void*, HMENU, void*, void*, int32_t) {}
TAVRIN_EXPORT void TVCALL UnloadObject(void*, void*, int32_t) {}
TAVRIN_EXPORT void TVCALL PrepareToWriteObject(void*, void*, void*) {}
TAVRIN_EXPORT void TVCALL EndModifyObject(void*, void*, void*) {}
