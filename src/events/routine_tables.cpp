// The three routine tables handed to the host in RunInfo. An event's code is
// its routine's position, so each table lists its routines in code order and
// ends with a null entry.
#include <iterator>

#include "events/event_routines.h"
#include "frame/run_info.h"

constexpr ConditionRoutine kConditionRoutines[kConditionCount + 1] = {
    ChainIsSwinging,  // 0 "Chain %0 is swinging"
    OnSwing,          // 1 "On Swing %0"
    nullptr,
};

constexpr ActionRoutine kActionRoutines[kActionCount + 1] = {
    AddAnchor,        // 0
    AddLink,          // 1
    AddPlatform,      // 2
    SetAnchorX,       // 3
    SetAnchorY,       // 4
    SetMass,          // 5
    SetAngle,         // 6
    SetSpeed,         // 7 (not in the action menu)
    SetLinkSpacing,   // 8
    StartAll,         // 9
    StartChain,       // 10
    StopAll,          // 11
    StopChain,        // 12
    UpdateAll,        // 13
    UpdateChain,      // 14
    SetAcceleration,  // 15
    nullptr,
};

constexpr ExpressionRoutine kExpressionRoutines[kExpressionCount + 1] = {
    ChainNum,      // 0
    ChainLinks,    // 1
    AnchorX,       // 2
    AnchorY,       // 3
    PlatformMass,  // 4
    ChainAngle,    // 5
    ChainSpeed,    // 6
    LinkSpacing,   // 7
    PlatformX,     // 8
    PlatformY,     // 9
    ChainIndex,    // 10
    DeltaX,        // 11
    DeltaY,        // 12
    ChainAccel,    // 13
    LinkIndex,     // 14
    LinkX,         // 15
    LinkY,         // 16
    nullptr,
};

// Each table holds its count of routines and then the terminator: the bound
// leaves room for no more, and the last routine standing at position
// count - 1 shows that none was left out before it (a missing one would leave
// a null the host would call).
static_assert(kConditionCount == 2 && std::size(kConditionRoutines) == 2 + 1);
static_assert(kConditionRoutines[1] == OnSwing && kConditionRoutines[2] == nullptr);
static_assert(kActionCount == 16 && std::size(kActionRoutines) == 16 + 1);
static_assert(kActionRoutines[15] == SetAcceleration && kActionRoutines[16] == nullptr);
static_assert(kExpressionCount == 17 && std::size(kExpressionRoutines) == 17 + 1);
static_assert(kExpressionRoutines[16] == LinkY && kExpressionRoutines[17] == nullptr);
