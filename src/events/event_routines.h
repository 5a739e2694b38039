// The routines of the three routine tables, named for the events they serve.
// The host reaches them only through the tables; nothing else calls them.
#pragma once

#include <cstdint>

#include "frame/abi.h"

struct RunData;

// Actions, codes 0 to 15.
int16_t TVCALL AddAnchor(RunData* rd, intptr_t object, intptr_t unused);
int16_t TVCALL AddLink(RunData* rd, intptr_t object, intptr_t unused);
int16_t TVCALL AddPlatform(RunData* rd, intptr_t object, intptr_t unused);
int16_t TVCALL SetAnchorX(RunData* rd, intptr_t index, intptr_t x);
int16_t TVCALL SetAnchorY(RunData* rd, intptr_t index, intptr_t y);
int16_t TVCALL SetMass(RunData* rd, intptr_t index, intptr_t unused);
int16_t TVCALL SetAngle(RunData* rd, intptr_t index, intptr_t unused);
int16_t TVCALL SetSpeed(RunData* rd, intptr_t index, intptr_t unused);
int16_t TVCALL SetLinkSpacing(RunData* rd, intptr_t index, intptr_t unused);
int16_t TVCALL StartAll(RunData* rd, intptr_t unused1, intptr_t unused2);
int16_t TVCALL StartChain(RunData* rd, intptr_t index, intptr_t unused);
int16_t TVCALL StopAll(RunData* rd, intptr_t unused1, intptr_t unused2);
int16_t TVCALL StopChain(RunData* rd, intptr_t index, intptr_t unused);
int16_t TVCALL UpdateAll(RunData* rd, intptr_t unused1, intptr_t unused2);
int16_t TVCALL UpdateChain(RunData* rd, intptr_t index, intptr_t unused);
int16_t TVCALL SetAcceleration(RunData* rd, intptr_t index, intptr_t unused);

// Conditions, codes 0 and 1.
int32_t TVCALL ChainIsSwinging(RunData* rd, intptr_t index, intptr_t unused);
int32_t TVCALL OnSwing(RunData* rd, intptr_t index, intptr_t unused);

// Expressions, codes 0 to 16.
int32_t TVCALL ChainNum(RunData* rd, intptr_t token);
int32_t TVCALL ChainLinks(RunData* rd, intptr_t token);
int32_t TVCALL AnchorX(RunData* rd, intptr_t token);
int32_t TVCALL AnchorY(RunData* rd, intptr_t token);
int32_t TVCALL PlatformMass(RunData* rd, intptr_t token);
int32_t TVCALL ChainAngle(RunData* rd, intptr_t token);
int32_t TVCALL ChainSpeed(RunData* rd, intptr_t token);
int32_t TVCALL LinkSpacing(RunData* rd, intptr_t token);
int32_t TVCALL PlatformX(RunData* rd, intptr_t token);
int32_t TVCALL PlatformY(RunData* rd, intptr_t token);
int32_t TVCALL ChainIndex(RunData* rd, intptr_t token);
int32_t TVCALL DeltaX(RunData* rd, intptr_t token);
int32_t TVCALL DeltaY(RunData* rd, intptr_t token);
int32_t TVCALL ChainAccel(RunData* rd, intptr_t token);
int32_t TVCALL LinkIndex(RunData* rd, intptr_t token);
int32_t TVCALL LinkX(RunData* rd, intptr_t token);
int32_t TVCALL LinkY(RunData* rd, intptr_t token);
