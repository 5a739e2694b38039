#include <cmath>

#include <gtest/gtest.h>

#include "chain_scene.h"
#include "chains/swing_step.h"

namespace {

TEST(ChainDirection, FollowsTheChainAngle) {
  const struct {
    float angle;
    int32_t direction;
  } cases[] = {{0, 8},    {10.5f, 7}, {45, 4},    {90, 0},   {100, 0},  {102, 31},
               {150, 27}, {180, 24},  {-90, 16},  {-270, 0}, {-300, 2}};
  for (const auto& c : cases) EXPECT_EQ(ChainDirection(c.angle, -1), c.direction) << c.angle;
}

TEST(ChainDirection, StaysWhenTheAngleIsNotFinite) {
  EXPECT_EQ(ChainDirection(INFINITY, 13), 13);
  EXPECT_EQ(ChainDirection(NAN, 13), 13);
  // Finite but beyond the integer range: 90 - angle saturates at INT32_MIN,
  // whose 32-step direction is -190887435 mod 32 = 21.
  EXPECT_EQ(ChainDirection(1e30f, 13), 21);
}

struct HangingChain : ChainScene {
  HostObject* anchor;
  HostObject* link = nullptr;
  HostObject* platform = nullptr;
  explicit HangingChain(int32_t anchorX) {
    anchor = Anchor(anchorX, 50);
    link = Link(20);
    platform = Platform();
    Chain(0).angle = 0.0f;
  }
};

TEST(ChainUpdate, PlacesAndTurnsAHangingChain) {
  HangingChain scene(50);
  UpdateChainAt(scene.rd, 0);
  // The link is one pixel short of 70 (truncated double), the platform is
  // not (its position is stored as a float first).
  EXPECT_EQ(scene.link->head.x, 50);
  EXPECT_EQ(scene.link->head.y, 69);
  EXPECT_EQ(scene.platform->head.x, 50);
  EXPECT_EQ(scene.platform->head.y, 90);
  EXPECT_EQ(scene.link->direction, 8);
  EXPECT_EQ(scene.platform->direction, 8);
  EXPECT_EQ(scene.link->changed, 1);
  EXPECT_EQ(scene.Chain(0).angle, 0.0f);
}

TEST(ChainUpdate, TruncatesTowardZeroLeftOfTheOrigin) {
  HangingChain scene(-50);
  UpdateChainAt(scene.rd, 0);
  EXPECT_EQ(scene.link->head.x, -49);
  EXPECT_EQ(scene.link->head.y, 69);
  EXPECT_EQ(scene.platform->head.x, -49);
  EXPECT_EQ(scene.platform->head.y, 90);
}

TEST(ChainUpdate, ThirtyDegreeChainOfThreeLinks) {
  ChainScene scene;
  scene.Anchor(100, 100);
  HostObject* links[3] = {scene.Link(10), scene.Link(10), scene.Link(10)};
  HostObject* platform = scene.Platform();
  scene.Chain(0).angle = 30.0f;
  UpdateAllChains(scene.rd);
  const int expected[3][2] = {{95, 108}, {90, 117}, {85, 125}};
  for (int k = 0; k < 3; ++k) {
    EXPECT_EQ(links[k]->head.x, expected[k][0]) << k;
    EXPECT_EQ(links[k]->head.y, expected[k][1]) << k;
    EXPECT_EQ(links[k]->direction, 5) << k;
  }
  EXPECT_EQ(platform->head.x, 80);
  EXPECT_EQ(platform->head.y, 134);
  EXPECT_EQ(platform->direction, 5);
  EXPECT_NEAR(scene.Chain(0).acceleration, -0.1226249f, 1e-7f);
}

TEST(ChainUpdate, MatchesTheSwingStepToTheLastBit) {
  ChainScene stepped;
  ChainScene updated;
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
  const ChainRecord& a = stepped.Chain(0);
  const ChainRecord& b = updated.Chain(0);
  EXPECT_EQ(Bits(a.angle), Bits(b.angle));
  EXPECT_EQ(Bits(a.speed), Bits(b.speed));
  EXPECT_EQ(Bits(a.acceleration), Bits(b.acceleration));
  EXPECT_EQ(Bits(a.platformX), Bits(b.platformX));
  EXPECT_EQ(Bits(a.platformY), Bits(b.platformY));
  EXPECT_EQ(Bits(a.prevPlatformY), Bits(b.prevPlatformY));
  for (uint32_t i = 0; i < 2; ++i) {
    EXPECT_EQ(stepped.rd.links->At(i)->head.x, updated.rd.links->At(i)->head.x);
    EXPECT_EQ(stepped.rd.links->At(i)->head.y, updated.rd.links->At(i)->head.y);
  }
  // Only the update turns objects; only the step raises events.
  EXPECT_EQ(stepped.rd.platforms->At(0)->direction, 0);
  EXPECT_NE(updated.rd.platforms->At(0)->direction, 0);
  EXPECT_EQ(updated.host.eventsRaised, 0);
  EXPECT_EQ(updated.rd.currentChain, -1);
}

TEST(ChainUpdate, UpdatesAStoppedChainAndLeavesItStopped) {
  HangingChain scene(0);
  scene.Chain(0).angle = 45.0f;
  UpdateChainAt(scene.rd, 0);
  EXPECT_EQ(scene.Chain(0).swinging, 0);
  EXPECT_NE(scene.Chain(0).acceleration, 0.0f);
  UpdateChainAt(scene.rd, 0);
  EXPECT_NE(scene.Chain(0).speed, 0.0f);
}

TEST(ChainUpdate, IndexesThatAddressNoChainChangeNothing) {
  HangingChain scene(0);
  for (int32_t index : {-1, 1, INT32_MIN, INT32_MAX}) UpdateChainAt(scene.rd, index);
  EXPECT_EQ(scene.link->changed, 0);
  EXPECT_EQ(scene.Chain(0).platformY, 0.0f);
}

TEST(ChainUpdate, NeverRemovesObjectsBeingDestroyed) {
  HangingChain scene(0);
  scene.host.Destroy(scene.anchor);
  scene.host.Destroy(scene.link);
  UpdateAllChains(scene.rd);
  EXPECT_EQ(scene.rd.chains->Count(), 1u);
  EXPECT_EQ(scene.rd.links->Count(), 1u);
  EXPECT_EQ(scene.link->head.y, 69);  // placed like any other
}

TEST(ChainUpdate, ChainBeyondThePlatformsStillTurnsItsLinks) {
  ChainScene scene;
  scene.Anchor(0, 0);
  scene.Anchor(100, 0);
  scene.Link(10);
  HostObject* link = scene.Link(10);
  scene.Platform();
  scene.rd.chains->At(1).angle = 45.0f;
  UpdateChainAt(scene.rd, 1);
  EXPECT_EQ(link->direction, 4);
  EXPECT_NE(scene.Chain(1).platformX, 0.0f);
}

}  // namespace
