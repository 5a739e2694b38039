// The benchmarks' limit loop is a fair yardstick only if it writes the same
// bits as the library into the chains and the host objects.
#include <gtest/gtest.h>

#include "chain_scene.h"
#include "swing_limit.h"

namespace {

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
