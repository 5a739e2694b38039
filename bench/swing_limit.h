// The least work that one frame of swinging chains can cost: the swing
// step's arithmetic and its writes to the host objects' records (x, y and
// changed of every link and platform, the chain's values), and nothing else:
// no lists to consult, no pairing by position, no guards for values that
// cannot be represented, no event. The benchmarks measure the step against
// it; a test checks that it writes exactly what the library writes.
#pragma once

#include <cstdint>
#include <vector>

#include "chains/run_data.h"

struct LimitChains {
  std::vector<ChainRecord> chains;
  std::vector<HostObject*> links;      // chain i's links from i * linksPerChain on
  std::vector<HostObject*> platforms;  // one per chain
  uint32_t linksPerChain = 0;
  float gravity = 0.0f;
};

// The chains of a run-time object whose every chain swings, has a platform
// and at least one link, with the objects the library would place.
LimitChains LimitChainsOf(const RunData& rd);

// One frame of every chain.
void LimitFrame(LimitChains& limit);
