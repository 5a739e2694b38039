// Cost of one frame: C chains of M links each, stepped through the stand-in
// host with an event handler that does nothing.
#include <benchmark/benchmark.h>

#include "chains/run_data.h"
#include "frame/edit_data.h"
#include "host.h"

namespace {

void SwingFrame(benchmark::State& state) {
  const auto chains = static_cast<int>(state.range(0));
  const auto linksPerChain = static_cast<int>(state.range(1));
  EditData edit{};
  WriteEditDataDefaults(edit);
  standin::Host host(edit);
  host.onEvent = [](int32_t, int32_t) {};
  RunData& rd = host.extension();
  for (int c = 0; c < chains; ++c) {
    AddChain(rd, host.AddObject(100 * c, 0, 32));
    rd.chains->At(static_cast<uint32_t>(c)).swinging = 1;
    rd.platforms->Append(host.AddObject(0, 0, 16));
  }
  for (int l = 0; l < chains * linksPerChain; ++l) rd.links->Append(host.AddObject(0, 0, 8));

  for (auto _ : state) host.RunFrame();

  const double links = static_cast<double>(chains) * linksPerChain;
  state.counters["ns_per_chain"] =
      benchmark::Counter(chains, benchmark::Counter::kIsIterationInvariantRate | benchmark::Counter::kInvert);
  state.counters["ns_per_link"] =
      benchmark::Counter(links, benchmark::Counter::kIsIterationInvariantRate | benchmark::Counter::kInvert);
}

BENCHMARK(SwingFrame)
    ->ArgNames({"chains", "links"})
    ->ArgsProduct({{1, 10}, {1, 10, 100, 1000}})
    ->Unit(benchmark::kMicrosecond);

}  // namespace

BENCHMARK_MAIN();
