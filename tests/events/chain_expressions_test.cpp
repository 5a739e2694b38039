// The expressions that read chains and the positions of their objects, run
// through the expression table with their parameters served by the host.
#include <bit>
#include <cmath>
#include <cstring>
#include <limits>
#include <vector>

#include "event_scene.h"

namespace {

constexpr int32_t kMin = std::numeric_limits<int32_t>::min();
constexpr int32_t kMax = std::numeric_limits<int32_t>::max();

constexpr int kChainExpressions[] = {expression::AnchorX,    expression::AnchorY,      expression::PlatformMass,
                                     expression::ChainAngle, expression::ChainSpeed,   expression::LinkSpacing,
                                     expression::DeltaX,     expression::DeltaY,       expression::ChainAccel};

bool IsFloatExpression(int code) {
  return (code >= expression::PlatformMass && code <= expression::LinkSpacing) ||
         (code >= expression::DeltaX && code <= expression::ChainAccel);
}

class ChainExpressionTest : public EventTest {
 protected:
  // Three chains, two links each (one spare link), two platforms.
  void BuildThreeChains() {
    for (int i = 0; i < 3; ++i) anchors.push_back(AddAnchor(100 + 100 * i, 40 + i));
    for (int i = 0; i < 7; ++i) links.push_back(AddLink(1000 + i, 2000 + i, 16));
    for (int i = 0; i < 2; ++i) platforms.push_back(AddPlatform(500 + i, 600 + i));
  }

  std::vector<HostObject*> anchors, links, platforms;
};

TEST_F(ChainExpressionTest, CountsWithNoChains) {
  AddLink(0, 0);
  EXPECT_EQ(host.Expression(expression::ChainNum), 0);
  EXPECT_EQ(host.Expression(expression::ChainLinks), 0);  // no quotient: no link belongs to a chain
  EXPECT_EQ(host.Expression(expression::LinkX, {0, 0}), 0);
}

TEST_F(ChainExpressionTest, ReadsTheAddressedChain) {
  BuildThreeChains();
  EXPECT_EQ(host.Expression(expression::ChainNum), 3);
  EXPECT_EQ(host.Expression(expression::ChainLinks), 2);  // 7 links over 3 chains, rounded down
  host.ActionWithValue(action::SetMass, 1, 2.5f);
  host.ActionWithValue(action::SetAngle, 1, -30.25f);
  host.ActionWithValue(action::SetSpeed, 1, 0.125f);
  host.ActionWithValue(action::SetLinkSpacing, 1, 3.75f);
  EXPECT_EQ(host.Expression(expression::AnchorX, {1}), 200);
  EXPECT_EQ(host.Expression(expression::AnchorY, {2}), 42);
  EXPECT_EQ(host.ExpressionFloat(expression::PlatformMass, {1}), 2.5f);
  EXPECT_EQ(host.ExpressionFloat(expression::ChainAngle, {1}), -30.25f);
  EXPECT_EQ(host.ExpressionFloat(expression::ChainSpeed, {1}), 0.125f);
  EXPECT_EQ(host.ExpressionFloat(expression::LinkSpacing, {1}), 3.75f);
  EXPECT_EQ(host.ExpressionFloat(expression::PlatformMass, {0}), 1.0f);
  EXPECT_EQ(host.Expression(expression::PlatformX, {1}), 501);
  EXPECT_EQ(host.Expression(expression::PlatformY, {0}), 600);
}

TEST_F(ChainExpressionTest, OnlyTheFloatExpressionsMarkAFloatResult) {
  BuildThreeChains();
  for (int code = 0; code < kExpressionCount; ++code) {
    host.Expression(code, {0, 0});
    EXPECT_EQ(host.lastResultWasFloat(), IsFloatExpression(code)) << "expression " << code;
  }
}

TEST_F(ChainExpressionTest, BadChainIndexYieldsZeroAndStillReadsTheParameter) {
  BuildThreeChains();
  host.Action(action::StartAll);
  host.RunFrame();  // every chain has moved: its deltas and acceleration are not 0
  for (int code : kChainExpressions) {
    for (int32_t index : {-1, 3, kMin, kMax}) {
      SCOPED_TRACE(testing::Message() << "expression " << code << " index " << index);
      const int reads = host.expressionParameterReads;
      // A float 0.0 and an integer 0 have the same bits: +0.0, not -0.0.
      EXPECT_EQ(host.Expression(code, {index}), 0);
      EXPECT_EQ(host.lastResultWasFloat(), IsFloatExpression(code));
      EXPECT_EQ(host.expressionParameterReads, reads + 1);
    }
  }
}

TEST_F(ChainExpressionTest, BadPlatformIndexYieldsTheExtensionsOwnPosition) {
  BuildThreeChains();  // two platforms for three chains
  host.extension().head.x = 321;
  host.extension().head.y = -654;
  for (int32_t index : {-1, 2, kMin, kMax}) {
    EXPECT_EQ(host.Expression(expression::PlatformX, {index}), 321) << index;
    EXPECT_EQ(host.Expression(expression::PlatformY, {index}), -654) << index;
  }
}

TEST_F(ChainExpressionTest, StoppedChainReportsNoMotionButKeepsItsValues) {
  BuildThreeChains();
  host.Action(action::StartChain, 0);
  host.RunFrame();
  host.RunFrame();
  const ChainRecord& c = Chain(0);
  ASSERT_NE(c.platformX - c.prevPlatformX, 0.0f);
  ASSERT_NE(c.platformY - c.prevPlatformY, 0.0f);
  ASSERT_NE(c.acceleration, 0.0f);
  EXPECT_EQ(host.ExpressionFloat(expression::DeltaX, {0}), c.platformX - c.prevPlatformX);
  EXPECT_EQ(host.ExpressionFloat(expression::ChainAccel, {0}), c.acceleration);

  host.Action(action::StopChain, 0);
  for (int code : {expression::DeltaX, expression::DeltaY, expression::ChainAccel}) {
    EXPECT_EQ(host.Expression(code, {0}), 0) << code;
    EXPECT_TRUE(host.lastResultWasFloat());
  }
  EXPECT_EQ(host.ExpressionFloat(expression::ChainSpeed, {0}), c.speed);
  EXPECT_EQ(host.ExpressionFloat(expression::ChainAngle, {0}), c.angle);
  EXPECT_NE(host.ExpressionFloat(expression::ChainSpeed, {0}), 0.0f);
}

// One link of 5 pixels makes a chain 10 long. At an angle whose cosine is 0
// the platform hangs at the anchor's x; at one whose cosine is -1/4 it stands
// 2.5 pixels to the left. Near x 100 a float resolves 2^-17, far finer than
// how close the nearest float angles come, so both positions are exact.
TEST_F(ChainExpressionTest, DeltaXIsHowFarThePlatformMovedInTheLastStep) {
  const auto angleWithCosine = [](double cosine) {
    return static_cast<float>(std::acos(cosine) / kDegree - 90.0);
  };
  AddAnchor(100, 50);
  AddLink(0, 0, 5);
  AddPlatform(0, 0);
  host.ActionWithValue(action::SetAngle, 0, angleWithCosine(0.0));
  host.Action(action::StartChain, 0);
  host.RunFrame();
  ASSERT_EQ(Chain(0).platformX, 100.0f);
  // The first step is measured from the record's initial 0.
  EXPECT_EQ(host.ExpressionFloat(expression::DeltaX, {0}), 100.0f);

  const float angle = angleWithCosine(-0.25);
  host.ActionWithValue(action::SetAngle, 0, angle);
  host.ActionWithValue(action::SetAcceleration, 0, 0.0f);  // keep the angle where it was set
  host.RunFrame();
  EXPECT_EQ(Chain(0).angle, angle);
  EXPECT_EQ(host.ExpressionFloat(expression::DeltaX, {0}), -2.5f);
  EXPECT_TRUE(host.lastResultWasFloat());

  const double theta = (static_cast<double>(angle) + 90.0) * kDegree;
  const float y0 = static_cast<float>(std::sin((static_cast<double>(angleWithCosine(0.0)) + 90.0) * kDegree) * 10 + 50);
  const float y1 = static_cast<float>(std::sin(theta) * 10 + 50);
  EXPECT_EQ(host.ExpressionFloat(expression::DeltaY, {0}), y1 - y0);
}

TEST_F(ChainExpressionTest, LinkPositionByChainAndPlaceWithinBoundsOnly) {
  AddAnchor(0, 0);
  AddAnchor(0, 0);
  for (int i = 0; i < 7; ++i) AddLink(10 + i, 20 + i);  // three per chain; the seventh in none
  EXPECT_EQ(host.Expression(expression::LinkX, {1, 2}), 15);  // links entry 5
  EXPECT_EQ(host.Expression(expression::LinkY, {1, 2}), 25);
  EXPECT_EQ(host.Expression(expression::LinkX, {0, 0}), 10);
  const std::vector<std::pair<int32_t, int32_t>> outside = {
      {1, 3}, {1, -1}, {2, 0}, {-1, 0}, {kMin, 0}, {kMax, 0}, {0, kMax}, {0, kMin}, {kMax, kMax}, {kMin, kMin}};
  for (const auto& [chain, place] : outside) {
    for (int code : {expression::LinkX, expression::LinkY}) {
      SCOPED_TRACE(testing::Message() << "expression " << code << " chain " << chain << " place " << place);
      const int reads = host.expressionParameterReads;
      EXPECT_EQ(host.Expression(code, {chain, place}), 0);
      EXPECT_EQ(host.expressionParameterReads, reads + 2);
    }
  }
}

TEST_F(ChainExpressionTest, ExpressionsChangeNothingButTheFloatFlag) {
  BuildThreeChains();
  host.Action(action::StartAll);
  host.RunFrame();
  const RunData& rd = host.extension();
  std::vector<unsigned char> chains(rd.chains->Count() * sizeof(ChainRecord));
  std::memcpy(chains.data(), &rd.chains->At(0), chains.size());
  std::vector<unsigned char> own(sizeof(RunData));
  std::memcpy(own.data(), &rd, sizeof(RunData));

  for (int code = 0; code < kExpressionCount; ++code) {
    for (int32_t p : {-1, 0, 1, 2, 3, 6}) host.Expression(code, {p, p});
  }
  host.extension().head.flags &= static_cast<uint16_t>(~kFlagFloatResult);
  EXPECT_EQ(std::memcmp(chains.data(), &rd.chains->At(0), chains.size()), 0);
  EXPECT_EQ(std::memcmp(own.data(), &rd, sizeof(RunData)), 0);
  EXPECT_EQ(rd.links->Count(), 7u);
  EXPECT_EQ(rd.platforms->Count(), 2u);
}

}  // namespace
