// Placeholder: the routines arrive with the event interface. Until then each
// table is only its terminating entry, so no code resolves to a routine.
#include "frame/run_info.h"

const ConditionRoutine kConditionRoutines[kConditionCount + 1] = {};
const ActionRoutine kActionRoutines[kActionCount + 1] = {};
const ExpressionRoutine kExpressionRoutines[kExpressionCount + 1] = {};
