// The two conditions. Both take a chain index in their first parameter and
// call no host service.
#include "chains/run_data.h"
#include "events/chain_lookup.h"
#include "events/event_routines.h"

int32_t TVCALL ChainIsSwinging(RunData* rd, intptr_t index, intptr_t) {
  const ChainRecord* chain = ChainAt(*rd, IntegerParameter(index));
  return chain != nullptr ? chain->swinging : 0;
}

// The swing step sets currentChain just before it raises this condition, so
// during that event it is true only for the chain just moved. Outside the
// event it compares with the chain that last raised it. Before the first event
// currentChain is -1, and a negative index names no chain, so it is false.
int32_t TVCALL OnSwing(RunData* rd, intptr_t index, intptr_t) {
  const int32_t chain = IntegerParameter(index);
  return chain >= 0 && chain == rd->currentChain ? 1 : 0;
}
