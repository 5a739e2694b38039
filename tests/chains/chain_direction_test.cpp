#include <cmath>

#include <gtest/gtest.h>

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

}  // namespace
