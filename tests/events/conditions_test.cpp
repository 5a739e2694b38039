// The two conditions, evaluated through the condition table, "On Swing" from
// inside the events the swing step raises, as the host evaluates it.
#include <limits>
#include <vector>

#include "event_scene.h"

namespace {

class ConditionTest : public EventTest {};

TEST_F(ConditionTest, ChainIsSwingingFollowsStartAndStop) {
  EXPECT_EQ(host.Condition(condition::ChainIsSwinging, 0), 0);  // no chains yet
  for (int i = 0; i < 3; ++i) AddAnchor(100 * i, 50);
  host.Action(action::StartChain, 1);
  EXPECT_EQ(host.Condition(condition::ChainIsSwinging, 0), 0);
  EXPECT_NE(host.Condition(condition::ChainIsSwinging, 1), 0);
  host.Action(action::StartAll);
  host.Action(action::StopChain, 2);
  EXPECT_NE(host.Condition(condition::ChainIsSwinging, 0), 0);
  EXPECT_EQ(host.Condition(condition::ChainIsSwinging, 2), 0);
}

TEST_F(ConditionTest, ChainIsSwingingIsFalseForAnIndexThatAddressesNoChain) {
  for (int i = 0; i < 3; ++i) AddAnchor(100 * i, 50);
  host.Action(action::StartAll);
  for (int32_t index : {-1, 3, std::numeric_limits<int32_t>::min(), std::numeric_limits<int32_t>::max()}) {
    EXPECT_EQ(host.Condition(condition::ChainIsSwinging, index), 0) << index;
  }
}

TEST_F(ConditionTest, OnSwingIsTrueOnlyForTheChainRaisingIt) {
  for (int i = 0; i < 3; ++i) {
    AddAnchor(100 * i, 50);
    AddLink(0, 0);
  }
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
}

TEST_F(ConditionTest, OnSwingOutsideTheEventComparesWithTheLastChainThatRaisedIt) {
  AddAnchor(0, 50);
  AddAnchor(100, 50);
  AddLink(0, 0);
  // Nothing has swung yet: false for every index, -1 included.
  for (intptr_t index : {0, 1, -1}) EXPECT_EQ(host.Condition(condition::OnSwing, index), 0) << index;
  host.Action(action::StartChain, 1);
  host.RunFrame();
  EXPECT_EQ(host.Condition(condition::OnSwing, 0), 0);
  EXPECT_NE(host.Condition(condition::OnSwing, 1), 0);
  host.Action(action::StopAll);
  host.RunFrame();  // nothing swings: the last answer stands
  EXPECT_NE(host.Condition(condition::OnSwing, 1), 0);
  // An update raises no event and leaves the chain of the last one.
  host.Action(action::UpdateChain, 0);
  EXPECT_EQ(host.Condition(condition::OnSwing, 0), 0);
}

}  // namespace
