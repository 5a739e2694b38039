// One frame of C chains of M links: the library's swing step through the
// stand-in host (an "On Swing" handler that does nothing), and the limit
// loop doing the same arithmetic and writes on the same host objects.
#include <benchmark/benchmark.h>

#include "bench_scene.h"
#include "swing_limit.h"

namespace {

void SwingStep(benchmark::State& state) {
  BenchScene scene(static_cast<int>(state.range(0)), static_cast<int>(state.range(1)));
  scene.host.onEvent = [](int32_t, int32_t) {};
  for (auto _ : state) scene.host.RunFrame();
  CountChainsAndLinks(state);
}

void SwingLimit(benchmark::State& state) {
  BenchScene scene(static_cast<int>(state.range(0)), static_cast<int>(state.range(1)));
  LimitChains limit = LimitChainsOf(scene.rd);
  for (auto _ : state) {
    LimitFrame(limit);
    benchmark::ClobberMemory();
  }
  CountChainsAndLinks(state);
}

BENCHMARK(SwingStep)->Apply(ChainSizes);
BENCHMARK(SwingLimit)->Apply(ChainSizes);

}  // namespace
