// The benchmarks' limit loop is a fair yardstick only if it does the
// library's work: played side by side on two identical scenes, both must
// write the same bits into the chains and the host objects.
#include <gtest/gtest.h>

#include "chain_scene.h"
#include "swing_limit.h"

namespace {

void Build(ChainScene& scene) {
  for (uint32_t c = 0; c < 3; ++c) {
    scene.Anchor(90 * static_cast<int32_t>(c) - 50, 20 + static_cast<int32_t>(c), 1);
    scene.Chain(c).angle = 30.0f * static_cast<float>(c) - 20.5f;
    scene.Chain(c).mass = 1.0f + static_cast<float>(c);
    scene.Chain(c).linkSpacing = 0.75f * static_cast<float>(c);
    scene.Platform();
  }
  for (int l = 0; l < 12; ++l) scene.Link(6 + (l * 5) % 11);
}

TEST(SwingLimit, WritesWhatTheLibraryWrites) {
  ChainScene library, limit;
  Build(library);
  Build(limit);
  LimitChains chains = LimitChainsOf(limit.rd);
  for (int frame = 0; frame < 200; ++frame) {
    library.host.RunFrame();
    LimitFrame(chains);
  }
  for (uint32_t c = 0; c < 3; ++c) {
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
