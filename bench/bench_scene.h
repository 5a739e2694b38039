// The chains every benchmark of the step measures: C chains of M links, all
// swinging, anchors 100 pixels apart, 8-pixel links, one platform per chain,
// built in the stand-in host with the stored defaults.
#pragma once

#include <benchmark/benchmark.h>

#include "chains/run_data.h"
#include "frame/edit_data.h"
#include "host.h"

inline EditData BenchSettings() {
  EditData edit{};
  WriteEditDataDefaults(edit);
  return edit;
}

struct BenchScene {
  BenchScene(int chains, int linksPerChain) {
    for (int c = 0; c < chains; ++c) {
      AddChain(rd, host.AddObject(100 * c, 0, 32));
      rd.chains->At(static_cast<uint32_t>(c)).swinging = 1;
      rd.platforms->Append(host.AddObject(0, 0, 16));
    }
    for (int l = 0; l < chains * linksPerChain; ++l) rd.links->Append(host.AddObject(0, 0, 8));
  }

  standin::Host host{BenchSettings()};
  RunData& rd = host.extension();
};

// C x M from 1 x 1 to 100 x 1000, and one chain of 100000 links.
inline void ChainSizes(benchmark::internal::Benchmark* b) {
  b->ArgNames({"chains", "links"});
  for (int chains : {1, 10, 100}) {
    for (int links : {1, 10, 100, 1000}) b->Args({chains, links});
  }
  b->Args({1, 100000});
  b->Unit(benchmark::kMicrosecond);
}

// Time per chain and per link of one frame of `state`'s C x M chains.
inline void CountChainsAndLinks(benchmark::State& state) {
  const double chains = static_cast<double>(state.range(0));
  const double links = chains * static_cast<double>(state.range(1));
  const auto kPerItem = benchmark::Counter::kIsIterationInvariantRate | benchmark::Counter::kInvert;
  state.counters["ns_per_chain"] = benchmark::Counter(chains, kPerItem);
  state.counters["ns_per_link"] = benchmark::Counter(links, kPerItem);
}
