// Entry point, self-description and the life of the run-time object.
#include <cstdlib>
#include <new>

#include "chains/run_data.h"
#include "chains/swing_step.h"
#include "frame/edit_data.h"
#include "frame/exports.h"
#include "frame/module.h"
#include "frame/run_info.h"
#include "frame/setting_text.h"
#include "chains/float_math.h"

namespace {

HINSTANCE g_module = nullptr;

float SettingValue(const char (&text)[kSettingTextSize]) {
  return RoundToFloat(ParseDecimalPrefix(text));
}

// A new empty list, or null when memory ran out. The lists are built in
// storage from malloc, and freed with free, like the elements they hold.
template <typename List>
List* NewList() {
  void* storage = std::malloc(sizeof(List));
  return storage != nullptr ? new (storage) List : nullptr;
}

template <typename List>
void DeleteList(List*& list) {
  if (list == nullptr) return;
  list->~List();
  std::free(list);
  list = nullptr;
}

}  // namespace

HINSTANCE TavrinModule() { return g_module; }
void SetTavrinModule(HINSTANCE module) { g_module = module; }

extern "C" BOOL WINAPI DllMain(HINSTANCE instance, DWORD reason, LPVOID) {
  if (reason == DLL_PROCESS_ATTACH) SetTavrinModule(instance);
  return TRUE;
}

TAVRIN_EXPORT uint32_t TVCALL GetInfos(int32_t query) {
  switch (query) {
    case 0: return 0x300;
    case 2: return 0x100;
    default: return 0;
  }
}

TAVRIN_EXPORT int16_t TVCALL GetRunObjectInfos(void*, RunInfo* info) {
  info->conditionRoutines = kConditionRoutines;
  info->actionRoutines = kActionRoutines;
  info->expressionRoutines = kExpressionRoutines;
  info->conditionCount = kConditionCount;
  info->actionCount = kActionCount;
  info->expressionCount = kExpressionCount;
  info->editDataSize = sizeof(EditData);
  info->objectFlags = 0;
  info->priority = 100;
  info->editorOptions = 0;
  info->identifier = kObjectIdentifier;
  info->version = 1;
  return 1;
}

TAVRIN_EXPORT uint16_t TVCALL GetRunObjectDataSize(void*, EditData*) { return sizeof(RunData); }

TAVRIN_EXPORT int16_t TVCALL CreateRunObject(RunData* rd, EditData* edit, void*) {
  rd->links = NewList<ObjectList>();
  rd->platforms = NewList<ObjectList>();
  rd->chains = NewList<ChainList>();
  if (rd->links == nullptr || rd->platforms == nullptr || rd->chains == nullptr) {
    DeleteList(rd->links);
    DeleteList(rd->platforms);
    DeleteList(rd->chains);
    return -1;  // the host's convention for a refused creation
  }
  rd->startAngle = SettingValue(edit->startAngleText);
  rd->defaultLinkSpacing = SettingValue(edit->linkSpacingText);
  rd->gravity = SettingValue(edit->gravityText);
  rd->defaultMass = SettingValue(edit->massText);
  // No chain has raised "On Swing" yet: -1 makes the condition false for
  // every chain index until the first event.
  rd->currentChain = -1;
  return 0;
}

TAVRIN_EXPORT int16_t TVCALL DestroyRunObject(RunData* rd, int32_t) {
  DeleteList(rd->links);
  DeleteList(rd->platforms);
  DeleteList(rd->chains);
  return 0;
}

TAVRIN_EXPORT int16_t TVCALL HandleRunObject(RunData* rd) {
  SwingStep(*rd);
  return 0;
}

TAVRIN_EXPORT int16_t TVCALL DisplayRunObject(RunData*) { return 0; }
TAVRIN_EXPORT int16_t TVCALL PauseRunObject(RunData*) { return 0; }
TAVRIN_EXPORT int16_t TVCALL ContinueRunObject(RunData*) { return 0; }

TAVRIN_EXPORT int32_t TVCALL Initialize(void*, int32_t) { return 0; }
TAVRIN_EXPORT int32_t TVCALL Free(void*) { return 0; }
TAVRIN_EXPORT int32_t TVCALL LoadObject(void*, void*, void*, int32_t) { return 0; }
// The stored record has only ever had one layout, so it is never converted.
TAVRIN_EXPORT int32_t TVCALL UpdateEditStructure(void*, void*) { return 0; }
TAVRIN_EXPORT int32_t TVCALL UsesFile(void*, void*) { return 0; }
