// A fixed scene played for many frames gives the same bits on every build:
// the native library and the Windows ones hash to one golden value. A change
// of this value means results changed, on one build or on all. The
// benchmarks' limit loop is a fair yardstick only if it writes the same bits
// as the library into the chains and the host objects.
#include <cstdint>

#include <gtest/gtest.h>

#include "chain_scene.h"
#include "chains/swing_step.h"
#include "swing_limit.h"

namespace {

struct Fnv1a {
  uint64_t value = 0xCBF29CE484222325ull;
  void Add(uint32_t word) {
    for (int i = 0; i < 4; ++i) value = (value ^ ((word >> (8 * i)) & 0xFFu)) * 0x100000001B3ull;
  }
};

// Four swinging chains of differing angles, masses and spacings over 22
// links of differing heights.
void BuildFixedScene(ChainScene& scene) {
  const float angles[] = {90.0f, -35.5f, 12.25f, 170.0f};
  const float masses[] = {1.0f, 3.5f, 0.25f, 9.0f};
  for (int c = 0; c < 4; ++c) {
    scene.Anchor(120 * c - 100, 40 + 7 * c);
    ChainRecord& chain = scene.Chain(static_cast<uint32_t>(c));
    chain.angle = angles[c];
    chain.mass = masses[c];
    chain.linkSpacing = 1.5f * static_cast<float>(c);
    chain.swinging = 1;
    scene.Platform();
  }
  for (int l = 0; l < 22; ++l) scene.Link(12 + (l * 7) % 19);
}

uint64_t PlayFixedScene() {
  ChainScene scene;
  BuildFixedScene(scene);
  Fnv1a hash;
  for (int frame = 0; frame < 3000; ++frame) {
    scene.host.RunFrame();
    if (frame % 97 == 0) UpdateChainAt(scene.rd, frame % 4);
    if (frame % 250 == 0) scene.Chain(static_cast<uint32_t>(frame % 4)).speed += 0.75f;
  }
  for (uint32_t c = 0; c < scene.rd.chains->Count(); ++c) {
    const ChainRecord& r = scene.Chain(c);
    for (float value : {r.mass, r.angle, r.speed, r.linkSpacing, r.prevPlatformX, r.prevPlatformY,
                        r.platformX, r.platformY, r.acceleration}) {
      hash.Add(Bits(value));
    }
  }
  for (ObjectList* list : {scene.rd.links, scene.rd.platforms}) {
    for (uint32_t i = 0; i < list->Count(); ++i) {
      const HostObject& object = *list->At(i);
      for (int32_t value : {object.head.x, object.head.y, object.direction}) hash.Add(static_cast<uint32_t>(value));
    }
  }
  return hash.value;
}

TEST(Determinism, FixedSceneHashesToTheGoldenValueOnEveryBuild) {
  EXPECT_EQ(PlayFixedScene(), 0x32457d7314b34651ull) << std::hex << "hash 0x" << PlayFixedScene();
}

TEST(SwingLimit, WritesWhatTheLibraryWrites) {
  ChainScene library, limit;
  BuildFixedScene(library);
  BuildFixedScene(limit);
  LimitChains chains = LimitChainsOf(limit.rd);
  for (int frame = 0; frame < 200; ++frame) {
    library.host.RunFrame();
    LimitFrame(chains);
  }
  for (uint32_t c = 0; c < 4; ++c) {
    const ChainRecord& a = library.Chain(c);
    const ChainRecord& b = chains.chains[c];
    for (float ChainRecord::*field : {&ChainRecord::speed, &ChainRecord::angle, &ChainRecord::acceleration,
                                      &ChainRecord::prevPlatformX, &ChainRecord::prevPlatformY,
                                      &ChainRecord::platformX, &ChainRecord::platformY}) {
      EXPECT_EQ(Bits(a.*field), Bits(b.*field)) << "chain " << c;
    }
  }
  for (ObjectList* list : {library.rd.links, library.rd.platforms}) {
    const ObjectList* other = list == library.rd.links ? limit.rd.links : limit.rd.platforms;
    for (uint32_t i = 0; i < list->Count(); ++i) {
      EXPECT_EQ(list->At(i)->head.x, other->At(i)->head.x) << i;
      EXPECT_EQ(list->At(i)->head.y, other->At(i)->head.y) << i;
      EXPECT_EQ(list->At(i)->changed, other->At(i)->changed) << i;
    }
  }
}

}  // namespace
