// "ChainIndex(" and "LinkIndex(" as the host calls them, through the
// expression table, with N objects in the lists (a tenth anchors, a tenth
// platforms, the rest links, every identifier distinct): for the object
// that a walk would reach last, and for an identifier that no object has.
#include <benchmark/benchmark.h>

#include "bench_scene.h"

namespace {

constexpr int kChainIndex = 10, kLinkIndex = 14;

void Lookup(benchmark::State& state, int code) {
  const int objects = static_cast<int>(state.range(0));
  const bool found = state.range(1) != 0;
  standin::Host host(BenchSettings());
  RunData& rd = host.extension();
  int32_t id = 0;
  const auto next = [&] {
    ++id;
    return host.AddObject(0, 0, 8, {static_cast<int16_t>(id & 0xFFFF), static_cast<uint16_t>(id >> 16)});
  };
  for (int i = 0; i < objects / 10; ++i) rd.platforms->Append(next());
  for (int i = 0; i < objects - 2 * (objects / 10); ++i) rd.links->Append(next());
  const int32_t lastLink = id;
  for (int i = 0; i < objects / 10; ++i) AddChain(rd, next());
  const int32_t target = !found ? 0 : code == kChainIndex ? id : lastLink;

  benchmark::DoNotOptimize(host.Expression(code, {target}));  // the index is built by the first lookup
  for (auto _ : state) benchmark::DoNotOptimize(host.Expression(code, {target}));
}

// The first lookup after a removal rebuilds the index of the list that lost
// an object: the cost an event pays once in a frame that pruned the links.
void LinkIndexAfterRemoval(benchmark::State& state) {
  standin::Host host(BenchSettings());
  RunData& rd = host.extension();
  const int objects = static_cast<int>(state.range(0));
  AddChain(rd, host.AddObject(0, 0, 8, {-1, 0}));
  for (int i = 0; i < objects; ++i) rd.links->Append(host.AddObject(0, 0, 8, {static_cast<int16_t>(i), 0}));
  HostObject* last = rd.links->At(rd.links->Count() - 1);
  for (auto _ : state) {
    rd.links->RemoveAt(rd.links->Count() - 1);
    rd.links->Append(last);
    benchmark::DoNotOptimize(host.Expression(kLinkIndex, {0}));
  }
}

void ChainIndexLookup(benchmark::State& state) { Lookup(state, kChainIndex); }
void LinkIndexLookup(benchmark::State& state) { Lookup(state, kLinkIndex); }

void LookupSizes(benchmark::internal::Benchmark* b) {
  b->ArgNames({"objects", "found"})->ArgsProduct({{10, 1000, 100000}, {1, 0}});
}

BENCHMARK(ChainIndexLookup)->Apply(LookupSizes);
BENCHMARK(LinkIndexLookup)->Apply(LookupSizes);
BENCHMARK(LinkIndexAfterRemoval)->ArgName("objects")->Arg(1000)->Arg(100000)->Unit(benchmark::kMicrosecond);

}  // namespace
