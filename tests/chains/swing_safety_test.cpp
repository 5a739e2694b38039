// The step on inputs the pendulum formula has no answer for, and events that
// grow every list while the step runs; the direction that follows the angle.
// Run under AddressSanitizer and UBSan.
#include <cmath>
#include <limits>

#include <gtest/gtest.h>

#include "chain_scene.h"
#include "chains/swing_step.h"

namespace {

constexpr int32_t kMax = std::numeric_limits<int32_t>::max();
constexpr int32_t kMin = std::numeric_limits<int32_t>::min();

TEST(SwingSafety, EventsThatGrowEveryListDoNotDisturbTheStep) {
  ChainScene scene;
  scene.Anchor(100, 100, 1);
  scene.Link(10);
  scene.Platform();
  int events = 0;
  scene.host.onEvent = [&](int32_t, int32_t) {
    ++events;
    // Enough appends to move the storage of all three lists every time.
    for (int i = 0; i < 40; ++i) {
      scene.Link(10);
      scene.Platform();
    }
    if (scene.rd.chains->Count() < 30) scene.Anchor(100 + events, 100, 1);
    scene.Chain(static_cast<uint32_t>(scene.rd.currentChain)).mass = 2.0f;
  };
  for (int frame = 0; frame < 5; ++frame) scene.host.RunFrame();
  EXPECT_EQ(scene.rd.chains->Count(), 30u);
  EXPECT_GT(events, 30);
  for (uint32_t i = 0; i < scene.rd.chains->Count(); ++i) EXPECT_TRUE(std::isfinite(scene.Chain(i).angle));
}

TEST(SwingSafety, NonFiniteValuesLeaveObjectsWhereTheyWere) {
  for (float poison : {std::numeric_limits<float>::infinity(), std::numeric_limits<float>::quiet_NaN()}) {
    ChainScene scene;
    scene.Anchor(100, 100, 1);
    HostObject* link = scene.Link(10);
    HostObject* platform = scene.Platform();
    scene.host.RunFrame();
    const int32_t linkX = link->head.x, linkY = link->head.y, platformX = platform->head.x;
    link->direction = platform->direction = 5;
    scene.Chain(0).angle = poison;
    for (int frame = 0; frame < 3; ++frame) scene.host.RunFrame();
    UpdateAllChains(scene.rd);
    EXPECT_EQ(link->head.x, linkX);
    EXPECT_EQ(link->head.y, linkY);
    EXPECT_EQ(platform->head.x, platformX);
    EXPECT_EQ(link->direction, 5);  // a non-finite angle turns nothing
    EXPECT_EQ(platform->direction, 5);
  }
  ChainScene heavy;
  heavy.Anchor(0, 0, 1);
  heavy.Link(10);
  heavy.Chain(0).mass = std::numeric_limits<float>::infinity();
  for (int frame = 0; frame < 4; ++frame) heavy.host.RunFrame();
  EXPECT_FALSE(std::isfinite(heavy.Chain(0).angle));
}

TEST(SwingSafety, CoordinatesBeyondTheIntegerRangeSaturate) {
  ChainScene scene;
  scene.Anchor(kMax, kMin);
  HostObject* link = scene.Link(1000);
  HostObject* platform = scene.Platform();
  scene.Chain(0).angle = -45.0f;  // swings towards larger x, and down
  scene.Chain(0).linkSpacing = 3e9f;
  UpdateAllChains(scene.rd);
  EXPECT_EQ(link->head.x, kMax);
  EXPECT_EQ(platform->head.x, kMax);
  scene.Chain(0).angle = 135.0f;  // up and to the left: y below the range
  UpdateAllChains(scene.rd);
  EXPECT_EQ(link->head.y, kMin);
}

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

}  // namespace
