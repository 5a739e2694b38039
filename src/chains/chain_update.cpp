#include "chains/run_data.h"
#include "chains/swing_step.h"

void UpdateAllChains(RunData& rd) {
  for (uint32_t i = 0; i < ChainCount(rd); ++i) AdvanceChain(rd, i, true);
}

void UpdateChainAt(RunData& rd, int32_t index) {
  if (AddressesChain(rd, index)) AdvanceChain(rd, static_cast<uint32_t>(index), true);
}
