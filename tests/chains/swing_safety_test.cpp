// The step on inputs the pendulum formula has no answer for, and the
// direction that follows the angle. Run under AddressSanitizer and UBSan;
// the event-program fuzzer grows the lists from inside the step.
#include <cmath>
#include <limits>

#include <gtest/gtest.h>

#include "chain_scene.h"
#include "chains/swing_step.h"

namespace {

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
