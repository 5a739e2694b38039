// The two conditions, evaluated through the condition table, "On Swing" from
// inside the events the swing step raises, as the host evaluates it, and a
// rule "On Swing" that carries a rider along on its platform with "DeltaX("
// and "DeltaY(" while frames run as a game runs them.
#include <algorithm>
#include <cmath>
#include <limits>
#include <vector>

#include "event_scene.h"

namespace {

class ConditionTest : public EventTest {};

TEST_F(ConditionTest, ChainIsSwingingFollowsStartAndIsFalseForBadIndexes) {
  EXPECT_EQ(host.Condition(condition::ChainIsSwinging, 0), 0);  // no chains yet
  for (int i = 0; i < 3; ++i) AddAnchor(100 * i, 50);
  host.Action(action::StartChain, 1);
  EXPECT_EQ(host.Condition(condition::ChainIsSwinging, 0), 0);
  EXPECT_NE(host.Condition(condition::ChainIsSwinging, 1), 0);
  host.Action(action::StartAll);
  for (int32_t index : {-1, 3, std::numeric_limits<int32_t>::min(), std::numeric_limits<int32_t>::max()}) {
    EXPECT_EQ(host.Condition(condition::ChainIsSwinging, index), 0) << index;
  }
}

// Inside the event, and after it until the next one: neither a frame in
// which nothing swings nor an update changes the answer.
TEST_F(ConditionTest, OnSwingIsTrueOnlyForTheChainThatLastRaisedIt) {
  for (int i = 0; i < 3; ++i) {
    AddAnchor(100 * i, 50);
    AddLink(0, 0);
  }
  // Nothing has swung yet: false for every index, -1 included.
  for (intptr_t index : {0, 1, -1}) EXPECT_EQ(host.Condition(condition::OnSwing, index), 0) << index;
  host.Action(action::StartAll);
  // Each row: the answers of "On Swing" for chains 0, 1 and 2 during one event.
  std::vector<std::vector<int32_t>> answers;
  host.onEvent = [&](int32_t code, int32_t param) {
    EXPECT_EQ(code, condition::OnSwing);
    EXPECT_EQ(param, 0);
    answers.push_back({});
    for (int32_t chain = 0; chain < 3; ++chain) {
      answers.back().push_back(host.Condition(condition::OnSwing, chain) != 0);
    }
  };
  host.RunFrame();
  const std::vector<std::vector<int32_t>> expected = {{1, 0, 0}, {0, 1, 0}, {0, 0, 1}};
  EXPECT_EQ(answers, expected);
  host.Action(action::StopAll);
  host.RunFrame();
  host.Action(action::UpdateChain, 0);
  EXPECT_EQ(host.Condition(condition::OnSwing, 0), 0);
  EXPECT_NE(host.Condition(condition::OnSwing, 2), 0);
}

TEST_F(ConditionTest, OnSwingRuleMovingARiderByTheDeltasKeepsItOnThePlatform) {
  // Two chains of four 16-pixel links, each with its platform; the rider
  // stands on the platform of chain 1.
  AddAnchor(160, 40);
  AddAnchor(480, 40);
  for (int i = 0; i < 8; ++i) AddLink(0, 0, 16);
  AddPlatform(0, 0);
  HostObject* platform = AddPlatform(0, 0);
  host.ActionWithValue(action::SetAngle, 0, -40.0f);
  host.ActionWithValue(action::SetAngle, 1, 55.0f);
  host.Action(action::StartAll);

  // The rider is a float position, as a game keeps a character's.
  float riderX = 0, riderY = 0;
  bool riding = false;
  int rulesRun = 0;
  host.onEvent = [&](int32_t code, int32_t) {
    // Rule: On Swing 1 -> move the rider by the platform's last move.
    if (code != condition::OnSwing || !host.Condition(condition::OnSwing, 1)) return;
    ++rulesRun;
    if (!riding) return;
    riderX += host.ExpressionFloat(expression::DeltaX, {1});
    riderY += host.ExpressionFloat(expression::DeltaY, {1});
  };
  // The first step's delta is measured from the record's initial 0, so the
  // rider boards after it: 12 pixels above where the platform now stands.
  host.RunFrame();
  ASSERT_EQ(rulesRun, 1);
  riderX = static_cast<float>(platform->head.x);
  riderY = static_cast<float>(platform->head.y - 12);
  riding = true;
  int32_t minX = platform->head.x, maxX = platform->head.x;
  for (int frame = 2; frame <= 600; ++frame) {
    host.RunFrame();
    ASSERT_EQ(rulesRun, frame);
    ASSERT_LE(std::fabs(static_cast<double>(riderX) - platform->head.x), 1.0) << "frame " << frame;
    ASSERT_LE(std::fabs(static_cast<double>(riderY) - platform->head.y + 12), 1.0) << "frame " << frame;
    ASSERT_EQ(host.Expression(expression::PlatformX, {1}), platform->head.x);  // where "PlatformX(" says
    minX = std::min(minX, platform->head.x);
    maxX = std::max(maxX, platform->head.x);
  }
  EXPECT_EQ(host.eventsRaised, 2 * 600);
  EXPECT_GT(maxX - minX, 100) << "the platform should have swung across a wide arc";
}

}  // namespace
