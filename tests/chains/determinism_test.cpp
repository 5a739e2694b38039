// A fixed scene played for many frames gives the same bits on every build:
// the native library, the 32-bit one and the Windows DLLs hash to one
// golden value. A change of this value means results changed, on one build
// or on all. The scene is built and updated through the routine tables, so
// that the shipping DLL plays it too.
#include <cstdint>

#include <gtest/gtest.h>

#include "chain_scene.h"

namespace {

struct Fnv1a {
  uint64_t value = 0xCBF29CE484222325ull;
  void Add(uint32_t word) {
    for (int i = 0; i < 4; ++i) value = (value ^ ((word >> (8 * i)) & 0xFFu)) * 0x100000001B3ull;
  }
};

uint64_t PlayFixedScene() {
  ChainScene scene;
  BuildFixedScene(scene);
  Fnv1a hash;
  for (int frame = 0; frame < 3000; ++frame) {
    scene.host.RunFrame();
    if (frame % 97 == 0) scene.host.Action(14, frame % 4);  // "Update Chain at index"
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

}  // namespace
