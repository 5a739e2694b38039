// The record through which the extension describes itself to the host at run
// time, and the routine types of its three routine tables.
#pragma once

#include <cstddef>
#include <cstdint>

#include "frame/abi.h"

struct RunData;

using ActionRoutine = int16_t(TVCALL*)(RunData* rd, intptr_t param1, intptr_t param2);
using ConditionRoutine = int32_t(TVCALL*)(RunData* rd, intptr_t param1, intptr_t param2);
using ExpressionRoutine = int32_t(TVCALL*)(RunData* rd, intptr_t token);

struct RunInfo {
  const ConditionRoutine* conditionRoutines;
  const ActionRoutine* actionRoutines;
  const ExpressionRoutine* expressionRoutines;
  uint16_t conditionCount;
  uint16_t actionCount;
  uint16_t expressionCount;
  uint16_t editDataSize;
  int32_t objectFlags;
  uint8_t priority;
  uint8_t reserved;
  uint16_t editorOptions;
  uint32_t identifier;
  uint16_t version;
};

#if TAVRIN_I686
static_assert(offsetof(RunInfo, conditionRoutines) == 0);
static_assert(offsetof(RunInfo, actionRoutines) == 4);
static_assert(offsetof(RunInfo, expressionRoutines) == 8);
static_assert(offsetof(RunInfo, conditionCount) == 12);
static_assert(offsetof(RunInfo, actionCount) == 14);
static_assert(offsetof(RunInfo, expressionCount) == 16);
static_assert(offsetof(RunInfo, editDataSize) == 18);
static_assert(offsetof(RunInfo, objectFlags) == 20);
static_assert(offsetof(RunInfo, priority) == 24);
static_assert(offsetof(RunInfo, reserved) == 25);
static_assert(offsetof(RunInfo, editorOptions) == 26);
static_assert(offsetof(RunInfo, identifier) == 28);
static_assert(offsetof(RunInfo, version) == 32);
#endif

constexpr uint16_t kConditionCount = 2;
constexpr uint16_t kActionCount = 16;
constexpr uint16_t kExpressionCount = 17;

// The four characters of the identifier, the first in the most significant byte.
constexpr uint32_t kObjectIdentifier = (uint32_t{'T'} << 24) | (uint32_t{'V'} << 16) |
                                       (uint32_t{'R'} << 8) | uint32_t{'N'};

// The routine tables, in code order, each ended by a null entry.
extern const ConditionRoutine kConditionRoutines[kConditionCount + 1];
extern const ActionRoutine kActionRoutines[kActionCount + 1];
extern const ExpressionRoutine kExpressionRoutines[kExpressionCount + 1];
