// Run-time services of the host, reached through the run context of the
// extension's own object. The context is an array of pointer-sized slots; the
// service that the 32-bit layout puts at byte B sits at slot B / 4.
#pragma once

#include <cstdint>

#include "frame/host_object.h"

using HostGenerateEventFn = void(TVCALL*)(HostObjectHeader* own, int32_t code, int32_t param);
using HostGetExpressionParameterFn = int32_t(TVCALL*)(HostObjectHeader* own, int32_t zero, intptr_t token);
using HostGetFloatParameterFn = int32_t(TVCALL*)(HostObjectHeader* own, int32_t one, int32_t zero);
using HostGetVersionFn = uint32_t(TVCALL*)();

// A slot holds a service of one of the types above; it is stored as a plain
// function pointer and converted back to its own type before the call.
using HostServiceSlot = void (*)();

constexpr int kSlotGenerateEvent = 864 / 4;
constexpr int kSlotGetFirstExpressionParameter = 876 / 4;
constexpr int kSlotGetNextExpressionParameter = 880 / 4;
constexpr int kSlotGetFloatParameter = 936 / 4;
constexpr int kRunContextSlots = kSlotGetFloatParameter + 1;

struct HostRunContext {
  HostServiceSlot slot[kRunContextSlots];
};

static_assert(sizeof(HostRunContext) == kRunContextSlots * sizeof(void*));

inline void HostGenerateEvent(HostObjectHeader* own, int32_t code, int32_t param) {
  reinterpret_cast<HostGenerateEventFn>(own->context->slot[kSlotGenerateEvent])(own, code, param);
}

inline int32_t HostGetFirstExpressionParameter(HostObjectHeader* own, intptr_t token) {
  return reinterpret_cast<HostGetExpressionParameterFn>(
      own->context->slot[kSlotGetFirstExpressionParameter])(own, 0, token);
}

inline int32_t HostGetNextExpressionParameter(HostObjectHeader* own, intptr_t token) {
  return reinterpret_cast<HostGetExpressionParameterFn>(
      own->context->slot[kSlotGetNextExpressionParameter])(own, 0, token);
}

// The running action's second parameter as a float.
float HostGetFloatParameter(HostObjectHeader* own);

// An expression's float result: the float-result flag is set on the own
// object and the float's bit pattern is the routine's result.
int32_t FloatResult(HostObjectHeader* own, float value);

// Editor-time host record: pointer-sized slots, the 32-bit byte offset / 4.
constexpr int kEditorSlotEditorWindow = 12 / 4;
constexpr int kEditorSlotOwnerWindow = 20 / 4;
constexpr int kEditorSlotGetVersion = 336 / 4;
constexpr int kEditorHostSlots = kEditorSlotGetVersion + 1;

struct EditorHost {
  void* slot[kEditorHostSlots];
};

// True when the editor-time host can show this object's menus, strings and
// dialog: a version service is present, build at least 218, version at least
// 0x0200 in the high half, and the 0x8000 flag clear. Each test asks the
// service afresh.
bool HostIsCompatible(const EditorHost* host);
