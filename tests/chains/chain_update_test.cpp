#include <cmath>

#include <gtest/gtest.h>

#include "chain_scene.h"
#include "chains/swing_step.h"

namespace {

TEST(ChainDirection, FollowsTheChainAngleAndStaysWhenItIsNotFinite) {
  const struct {
    float angle;
    int32_t direction;
  } cases[] = {{0, 8}, {10.5f, 7}, {45, 4}, {90, 0}, {100, 0}, {102, 31}, {150, 27}, {180, 24}, {-90, 16},
               {-270, 0}, {-300, 2}, {INFINITY, 13}, {NAN, 13},
               // Finite but beyond the integer range: 90 - angle saturates at
               // INT32_MIN, whose 32-step direction is -190887435 mod 32 = 21.
               {1e30f, 21}};
  for (const auto& c : cases) EXPECT_EQ(ChainDirection(c.angle, 13), c.direction) << c.angle;
}

// One 20-pixel link hanging straight down from (x, 50): the link is one
// pixel short of 70 (a truncated double), the platform is not (its position
// is stored as a float first). Left of the origin, truncation goes toward
// zero. Objects being destroyed are placed like any other: only the swing
// step removes them.
TEST(ChainUpdate, PlacesAndTurnsAHangingChainTruncatingTowardZero) {
  const struct {
    int32_t anchorX, placedX;
  } cases[] = {{50, 50}, {-50, -49}};
  for (const auto& c : cases) {
    SCOPED_TRACE(c.anchorX);
    ChainScene scene;
    scene.host.Destroy(scene.Anchor(c.anchorX, 50));
    HostObject* link = scene.Link(20);
    HostObject* platform = scene.Platform();
    scene.host.Destroy(link);
    scene.Chain(0).angle = 0.0f;
    c.anchorX > 0 ? UpdateChainAt(scene.rd, 0) : UpdateAllChains(scene.rd);  // both ways
    EXPECT_EQ(link->head.x, c.placedX);
    EXPECT_EQ(link->head.y, 69);
    EXPECT_EQ(platform->head.x, c.placedX);
    EXPECT_EQ(platform->head.y, 90);
    EXPECT_EQ(link->direction, 8);
    EXPECT_EQ(platform->direction, 8);
    EXPECT_EQ(link->changed, 1);
    EXPECT_EQ(scene.Chain(0).angle, 0.0f);
    EXPECT_EQ(scene.rd.chains->Count() + scene.rd.links->Count(), 2u);
  }
}

TEST(ChainUpdate, MatchesTheSwingStepToTheLastBitButTurnsAndRaisesNothing) {
  ChainScene stepped, updated;
  for (ChainScene* scene : {&stepped, &updated}) {
    scene->Anchor(-30, 77);
    scene->Link(17);
    scene->Link(23);
    scene->Platform();
    scene->Chain(0).angle = 61.3f;
    scene->Chain(0).linkSpacing = 1.5f;
    scene->Chain(0).mass = 2.25f;
  }
  stepped.Chain(0).swinging = 1;
  for (int frame = 0; frame < 50; ++frame) {
    stepped.host.RunFrame();
    UpdateAllChains(updated.rd);
  }
  for (float ChainRecord::*field : {&ChainRecord::angle, &ChainRecord::speed, &ChainRecord::acceleration,
                                    &ChainRecord::platformX, &ChainRecord::platformY, &ChainRecord::prevPlatformX,
                                    &ChainRecord::prevPlatformY}) {
    EXPECT_EQ(Bits(stepped.Chain(0).*field), Bits(updated.Chain(0).*field));
  }
  for (ObjectList* list : {stepped.rd.links, stepped.rd.platforms}) {
    ObjectList* other = list == stepped.rd.links ? updated.rd.links : updated.rd.platforms;
    for (uint32_t i = 0; i < list->Count(); ++i) {
      EXPECT_EQ(list->At(i)->head.x, other->At(i)->head.x);
      EXPECT_EQ(list->At(i)->head.y, other->At(i)->head.y);
      EXPECT_EQ(list->At(i)->direction, 0);  // only the update turns objects
      EXPECT_NE(other->At(i)->direction, 0);
    }
  }
  EXPECT_EQ(updated.host.eventsRaised, 0);
  EXPECT_EQ(updated.rd.currentChain, -1);
}

}  // namespace
