// The library's exported entry points: the only names it exports, as plain
// C symbols. The host (or the stand-in host) calls them directly.
#pragma once

#include <windows.h>

#include <cstdint>

#include "frame/abi.h"

struct RunData;
struct RunInfo;
struct EditData;
struct EditorHost;

// Run-time routines.
TAVRIN_EXPORT int16_t TVCALL GetRunObjectInfos(void* host, RunInfo* info);
TAVRIN_EXPORT uint16_t TVCALL GetRunObjectDataSize(void* host, EditData* edit);
TAVRIN_EXPORT int16_t TVCALL CreateRunObject(RunData* rd, EditData* edit, void* creation);
TAVRIN_EXPORT int16_t TVCALL DestroyRunObject(RunData* rd, int32_t unused);
TAVRIN_EXPORT int16_t TVCALL HandleRunObject(RunData* rd);
TAVRIN_EXPORT int16_t TVCALL DisplayRunObject(RunData* rd);
TAVRIN_EXPORT int16_t TVCALL PauseRunObject(RunData* rd);
TAVRIN_EXPORT int16_t TVCALL ContinueRunObject(RunData* rd);

// General routines.
TAVRIN_EXPORT uint32_t TVCALL GetInfos(int32_t query);
TAVRIN_EXPORT int32_t TVCALL Initialize(void*, int32_t);
TAVRIN_EXPORT int32_t TVCALL Free(void*);
TAVRIN_EXPORT int32_t TVCALL LoadObject(void*, void*, void*, int32_t);
TAVRIN_EXPORT int32_t TVCALL UpdateEditStructure(void*, void*);
TAVRIN_EXPORT int32_t TVCALL UsesFile(void*, void*);

// Editor routines.
TAVRIN_EXPORT int32_t TVCALL CreateObject(EditorHost* host, void*, EditData* edit);
TAVRIN_EXPORT int32_t TVCALL SelectPopup(EditorHost* host, int32_t command, void*, void*, EditData* edit,
                                         void*, void*);
TAVRIN_EXPORT int32_t TVCALL ModifyObject(EditorHost* host, EditData* edit, void*, void*, int32_t kind,
                                          const void* sizeRecord);
TAVRIN_EXPORT void TVCALL CreateFromFile(void*, void*, EditData* edit);
TAVRIN_EXPORT void TVCALL GetObjectRect(EditorHost* host, RECT* rect, void*, EditData* edit);
TAVRIN_EXPORT int32_t TVCALL MakeIcon(void*, void* buffer, void*, void*, void*);
TAVRIN_EXPORT void TVCALL GetObjInfos(void*, void*, char* name, char* author, char* copyright,
                                      char* comment, char* web);
TAVRIN_EXPORT int32_t TVCALL IsTransparent(void*, void*, void*, int32_t, int32_t);
TAVRIN_EXPORT int32_t TVCALL EnumElts(void*, void*, void*, void*, intptr_t, intptr_t);
TAVRIN_EXPORT int32_t TVCALL RebuildExt(void*, void*, void*, void*, void*, void*);
TAVRIN_EXPORT void TVCALL PutObject(void*, void*, void*, uint16_t);
TAVRIN_EXPORT void TVCALL RemoveObject(void*, void*, void*, uint16_t);
TAVRIN_EXPORT void TVCALL UpdateFileNames(void*, void*, void*, void*);
TAVRIN_EXPORT void TVCALL AppendPopup(void*, HMENU, void*, void*, int32_t);
TAVRIN_EXPORT void TVCALL UnloadObject(void*, void*, int32_t);
TAVRIN_EXPORT void TVCALL PrepareToWriteObject(void*, void*, void*);
TAVRIN_EXPORT void TVCALL EndModifyObject(void*, void*, void*);
TAVRIN_EXPORT void TVCALL EditorDisplay(EditorHost* host, void*, void* placed, EditData* edit, RECT* rect);

// Event catalogue routines.
TAVRIN_EXPORT HMENU TVCALL GetConditionMenu(EditorHost* host, void*, void*);
TAVRIN_EXPORT HMENU TVCALL GetActionMenu(EditorHost* host, void*, void*);
TAVRIN_EXPORT HMENU TVCALL GetExpressionMenu(EditorHost* host, void*, void*);
TAVRIN_EXPORT int16_t TVCALL GetConditionCodeFromMenu(EditorHost* host, int32_t menuId);
TAVRIN_EXPORT int16_t TVCALL GetActionCodeFromMenu(EditorHost* host, int32_t menuId);
TAVRIN_EXPORT int16_t TVCALL GetExpressionCodeFromMenu(EditorHost* host, int32_t menuId);
TAVRIN_EXPORT const void* TVCALL GetConditionInfos(EditorHost* host, int32_t code);
TAVRIN_EXPORT const void* TVCALL GetActionInfos(EditorHost* host, int32_t code);
TAVRIN_EXPORT const void* TVCALL GetExpressionInfos(EditorHost* host, int32_t code);
TAVRIN_EXPORT void TVCALL GetConditionTitle(EditorHost* host, int32_t code, int16_t param, char* buffer,
                                            int16_t size);
TAVRIN_EXPORT void TVCALL GetActionTitle(EditorHost* host, int32_t code, int16_t param, char* buffer,
                                         int16_t size);
TAVRIN_EXPORT void TVCALL GetExpressionTitle(EditorHost* host, int32_t code, char* buffer, int16_t size);
TAVRIN_EXPORT void TVCALL GetExpressionParam(EditorHost* host, int32_t code, int16_t param, char* buffer,
                                             int16_t size);
TAVRIN_EXPORT void TVCALL GetConditionString(EditorHost* host, int32_t code, char* buffer, int16_t size);
TAVRIN_EXPORT void TVCALL GetActionString(EditorHost* host, int32_t code, char* buffer, int16_t size);
TAVRIN_EXPORT void TVCALL GetExpressionString(EditorHost* host, int32_t code, char* buffer, int16_t size);
