// The actions and conditions, run through their tables as the host runs them:
// "On Swing" also from inside the events the swing step raises.
#include <cstring>
#include <vector>

#include "event_scene.h"

namespace {

class ActionTest : public EventTest {};

TEST_F(ActionTest, AnchorsLinksAndPlatformsAddedInOrderFormTheChainsButANullIsNot) {
  for (int code : {action::AddAnchor, action::AddLink, action::AddPlatform}) EXPECT_EQ(host.Action(code, 0), 0);
  HostObject* a = Add(action::AddAnchor, 100, 50);
  HostObject* b = Add(action::AddAnchor, 300, 50);
  HostObject* links[4];
  for (auto& link : links) link = Add(action::AddLink);
  HostObject* p0 = Add(action::AddPlatform);
  HostObject* p1 = Add(action::AddPlatform);
  host.Action(action::AddAnchor, Ref(a));  // the same anchor again: a third chain

  const RunData& rd = host.extension();
  ASSERT_EQ(rd.chains->Count(), 3u);
  ASSERT_EQ(LinksPerChain(rd), 1u);  // 4 links over 3 chains
  EXPECT_EQ(rd.platforms->Count(), 2u);
  std::vector<HostObject*> chains;  // anchor, link and platform of each chain
  for (uint32_t c = 0; c < 3; ++c) {
    chains.insert(chains.end(), {Chain(c).anchor, LinkOfChain(rd, c, 1), PlatformOfChain(rd, c)});
  }
  EXPECT_EQ(chains, (std::vector<HostObject*>{a, links[0], p0, b, links[1], p1, a, links[2], nullptr}));
  EXPECT_EQ(a->changed, 0);  // adding moves nothing
}

// Only started chains swing. "On Swing" is true inside the event for the
// chain just moved, and after it until the next one: neither a frame in
// which nothing swings nor an update changes the answer.
TEST_F(ActionTest, OnlyStartedChainsSwingAndOnSwingNamesTheLastThatDid) {
  for (int i = 0; i < 3; ++i) {
    Add(action::AddAnchor, 100 * i, 50);
    Add(action::AddLink);
  }
  HostObject* p0 = Add(action::AddPlatform, 7, 8);
  HostObject* p1 = Add(action::AddPlatform, 7, 8);
  const auto answers = [&](int code) {  // of the condition for chains 0, 1 and 2
    std::vector<int32_t> row;
    for (int32_t chain = 0; chain < 3; ++chain) row.push_back(host.Condition(code, chain) != 0);
    return row;
  };
  host.RunFrame();  // new chains rest until started, and nothing has swung yet
  EXPECT_EQ(p0->changed, 0);
  EXPECT_EQ(host.Condition(condition::OnSwing, -1), 0);
  EXPECT_EQ(answers(condition::OnSwing), (std::vector<int32_t>{0, 0, 0}));

  host.Action(action::StartAll);
  host.Action(action::StopChain, 1);
  EXPECT_EQ(answers(condition::ChainIsSwinging), (std::vector<int32_t>{1, 0, 1}));
  std::vector<std::vector<int32_t>> during;
  host.onEvent = [&](int32_t code, int32_t param) {
    EXPECT_TRUE(code == condition::OnSwing && param == 0);
    during.push_back(answers(condition::OnSwing));
  };
  host.RunFrame();
  EXPECT_EQ(during, (std::vector<std::vector<int32_t>>{{1, 0, 0}, {0, 0, 1}}));
  EXPECT_TRUE(p0->changed != 0 && p1->changed == 0);

  host.Action(action::StopAll);
  host.RunFrame();
  host.Action(action::UpdateChain, 0);
  EXPECT_EQ(answers(condition::OnSwing), (std::vector<int32_t>{0, 0, 1}));
  host.Action(action::StartChain, 2);
  host.Action(action::StartChain, 2);  // starting a swinging chain changes nothing
  EXPECT_EQ(answers(condition::ChainIsSwinging), (std::vector<int32_t>{0, 0, 1}));
}

// Where arguments are 64 bits wide, only their low half holds the index and
// the position.
TEST_F(ActionTest, SetAnchorWritesTheAnchorsPositionAndNothingElse) {
  HostObject* anchor = Add(action::AddAnchor, 100, 50);
  // Sentinel bytes everywhere but in the host's own pointer to its services.
  HostObject expected;
  std::memset(&expected, 0xA5, sizeof expected);
  expected.head.context = anchor->head.context;
  std::memcpy(anchor, &expected, sizeof expected);

  const auto high = static_cast<intptr_t>(int64_t{5} << 32);  // 0 where arguments are 32 bits wide
  host.Action(action::SetAnchorX, high, high + 0x01020304);
  host.Action(action::SetAnchorY, 0, -2);
  host.Action(action::SetAnchorY, high - 1, 77);  // low half -1: no chain
  expected.head.x = 0x01020304;
  expected.head.y = -2;
  expected.changed = 1;
  EXPECT_EQ(std::memcmp(anchor, &expected, sizeof expected), 0);
}

}  // namespace
