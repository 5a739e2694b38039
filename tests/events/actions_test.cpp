// The actions, run through the action table as the host runs them.
#include <cmath>
#include <cstring>
#include <limits>
#include <vector>

#include "event_scene.h"

namespace {

constexpr int32_t kBadIndexes[] = {-1, 2, std::numeric_limits<int32_t>::min(),
                                   std::numeric_limits<int32_t>::max()};

// Every byte of every chain record, padding included, to show that an action
// changed nothing.
std::vector<unsigned char> ChainBytes(const RunData& rd) {
  std::vector<unsigned char> bytes(rd.chains->Count() * sizeof(ChainRecord));
  for (uint32_t i = 0; i < rd.chains->Count(); ++i) {
    std::memcpy(bytes.data() + i * sizeof(ChainRecord), &rd.chains->At(i), sizeof(ChainRecord));
  }
  return bytes;
}

class ActionTest : public EventTest {};

TEST_F(ActionTest, AnchorsLinksAndPlatformsAddedInOrderFormTheChains) {
  HostObject* a = AddAnchor(100, 50);
  HostObject* b = AddAnchor(300, 50);
  HostObject* links[4];
  for (auto& link : links) link = AddLink(0, 0);
  HostObject* p0 = AddPlatform(0, 0);
  HostObject* p1 = AddPlatform(0, 0);

  const RunData& rd = host.extension();
  ASSERT_EQ(rd.chains->Count(), 2u);
  EXPECT_EQ(Chain(0).anchor, a);
  EXPECT_EQ(Chain(1).anchor, b);
  ASSERT_EQ(LinksPerChain(rd), 2u);
  EXPECT_EQ(LinkOfChain(rd, 0, 1), links[0]);
  EXPECT_EQ(LinkOfChain(rd, 0, 2), links[1]);
  EXPECT_EQ(LinkOfChain(rd, 1, 1), links[2]);
  EXPECT_EQ(LinkOfChain(rd, 1, 2), links[3]);
  EXPECT_EQ(PlatformOfChain(rd, 0), p0);
  EXPECT_EQ(PlatformOfChain(rd, 1), p1);
}

TEST_F(ActionTest, SameAnchorTwiceGivesTwoChainsWithTheDefaults) {
  HostObject* anchor = AddAnchor(10, 20);
  host.Action(action::AddAnchor, Ref(anchor));
  ASSERT_EQ(host.extension().chains->Count(), 2u);
  for (uint32_t i = 0; i < 2; ++i) {
    EXPECT_EQ(Chain(i).anchor, anchor);
    EXPECT_EQ(Chain(i).angle, 90.0f);
    EXPECT_EQ(Chain(i).mass, 1.0f);
    EXPECT_EQ(Chain(i).swinging, 0);
  }
  EXPECT_EQ(anchor->changed, 0);  // adding moves nothing
}

TEST_F(ActionTest, OneObjectMayBeAnchorLinkAndPlatformAtOnce) {
  HostObject* object = Object(100, 50, 20);
  for (int code : {action::AddAnchor, action::AddLink, action::AddPlatform, action::AddLink}) {
    EXPECT_EQ(host.Action(code, Ref(object)), 0);
  }
  const RunData& rd = host.extension();
  EXPECT_EQ(rd.chains->Count(), 1u);
  EXPECT_EQ(rd.links->Count(), 2u);
  EXPECT_EQ(rd.platforms->Count(), 1u);
  host.Action(action::StartChain, 0);
  host.RunFrame();  // moves the object as each link and as the platform
  EXPECT_EQ(host.eventsRaised, 1);
}

TEST_F(ActionTest, NullObjectIsNotAdded) {
  for (int code : {action::AddAnchor, action::AddLink, action::AddPlatform}) {
    EXPECT_EQ(host.Action(code, 0), 0);
  }
  const RunData& rd = host.extension();
  EXPECT_EQ(rd.chains->Count(), 0u);
  EXPECT_EQ(rd.links->Count(), 0u);
  EXPECT_EQ(rd.platforms->Count(), 0u);
  host.Action(action::StartAll);
  host.RunFrame();  // a null anchor would be dereferenced here
  EXPECT_EQ(host.eventsRaised, 0);
}

TEST_F(ActionTest, NewChainMovesOnlyOnceStarted) {
  AddAnchor(100, 50);
  AddLink(0, 0);
  HostObject* platform = AddPlatform(7, 8);
  host.RunFrame();
  EXPECT_EQ(platform->head.x, 7);
  EXPECT_EQ(platform->changed, 0);
  EXPECT_EQ(host.eventsRaised, 0);

  host.Action(action::StartChain, 0);
  host.RunFrame();
  EXPECT_EQ(platform->changed, 1);
  EXPECT_EQ(host.eventsRaised, 1);
}

TEST_F(ActionTest, SetAnchorMovesTheAnchorAtOnceAndTheChainFollowsAtItsNextStep) {
  HostObject* anchor = AddAnchor(100, 50);
  HostObject* link = AddLink(0, 0);
  host.Action(action::StartChain, 0);
  host.RunFrame();
  const int32_t linkX = link->head.x;
  const int32_t linkY = link->head.y;

  host.Action(action::SetAnchorX, 0, 200);
  host.Action(action::SetAnchorY, 0, 170);
  EXPECT_EQ(anchor->head.x, 200);
  EXPECT_EQ(anchor->head.y, 170);
  EXPECT_EQ(anchor->changed, 1);
  EXPECT_EQ(link->head.x, linkX);
  EXPECT_EQ(link->head.y, linkY);

  host.RunFrame();
  EXPECT_EQ(link->head.x - linkX, 100);  // still at angle 90: only the anchor moved it
  EXPECT_EQ(link->head.y - linkY, 120);
}

TEST_F(ActionTest, SetAnchorWritesNothingElseOfTheObject) {
  HostObject* anchor = AddAnchor(100, 50);
  // Sentinel bytes everywhere but in the host's own pointer to its services.
  std::vector<unsigned char> expected(sizeof(HostObject), 0xA5);
  std::memcpy(expected.data() + offsetof(HostObjectHeader, context), &anchor->head.context, sizeof(void*));
  std::memcpy(anchor, expected.data(), sizeof(HostObject));

  host.Action(action::SetAnchorX, 0, 0x01020304);
  host.Action(action::SetAnchorY, 0, -2);
  const int32_t x = 0x01020304, y = -2, changed = 1;
  std::memcpy(expected.data() + offsetof(HostObjectHeader, x), &x, 4);
  std::memcpy(expected.data() + offsetof(HostObjectHeader, y), &y, 4);
  std::memcpy(expected.data() + offsetof(HostObject, changed), &changed, 4);
  EXPECT_EQ(std::memcmp(anchor, expected.data(), sizeof(HostObject)), 0);
}

TEST_F(ActionTest, AnchorSettersIgnoreAnIndexThatAddressesNoChain) {
  HostObject* a = AddAnchor(100, 50);
  HostObject* b = AddAnchor(300, 50);
  for (int32_t index : kBadIndexes) {
    host.Action(action::SetAnchorX, index, 1);
    host.Action(action::SetAnchorY, index, 1);
  }
  for (HostObject* anchor : {a, b}) {
    EXPECT_EQ(anchor->head.y, 50);
    EXPECT_EQ(anchor->changed, 0);
  }
  EXPECT_EQ(a->head.x, 100);
  EXPECT_EQ(b->head.x, 300);
}

TEST_F(ActionTest, FloatSettersStoreTheFloatParameterNotTheIntegerOne) {
  AddAnchor(100, 50);
  AddAnchor(300, 50);
  const struct {
    int code;
    float ChainRecord::*field;
  } setters[] = {{action::SetMass, &ChainRecord::mass},
                 {action::SetAngle, &ChainRecord::angle},
                 {action::SetSpeed, &ChainRecord::speed},
                 {action::SetLinkSpacing, &ChainRecord::linkSpacing},
                 {action::SetAcceleration, &ChainRecord::acceleration}};
  for (const auto& setter : setters) {
    SCOPED_TRACE(setter.code);
    host.Action(setter.code, 1, 77, -2.75f);
    EXPECT_EQ(Chain(1).*setter.field, -2.75f);
    EXPECT_NE(Chain(0).*setter.field, -2.75f);
  }
}

TEST_F(ActionTest, FloatSettersAskForTheirValueOnceEvenForABadIndex) {
  AddAnchor(100, 50);
  AddAnchor(300, 50);
  const std::vector<unsigned char> before = ChainBytes(host.extension());
  for (int code : {action::SetMass, action::SetAngle, action::SetSpeed, action::SetLinkSpacing,
                   action::SetAcceleration}) {
    for (int32_t index : kBadIndexes) {
      SCOPED_TRACE(testing::Message() << "code " << code << " index " << index);
      const int calls = host.floatParameterCalls;
      EXPECT_EQ(host.ActionWithValue(code, index, 12.5f), 0);
      EXPECT_EQ(host.floatParameterCalls, calls + 1);
    }
  }
  EXPECT_EQ(ChainBytes(host.extension()), before);
  host.ActionWithValue(action::SetMass, 0, 12.5f);
  EXPECT_EQ(host.floatParameterCalls, 5 * 4 + 1);
}

TEST_F(ActionTest, IndexIsTheLowHalfOfAWideArgument) {
  if constexpr (sizeof(intptr_t) < 8) GTEST_SKIP() << "arguments are 32 bits wide";
  AddAnchor(100, 50);
  const auto wide = [](uint64_t value) { return static_cast<intptr_t>(value); };
  host.Action(action::StartChain, wide(0x1'0000'0000));  // low half 0: chain 0
  EXPECT_EQ(Chain(0).swinging, 1);
  host.Action(action::StopChain, wide(0x0000'0001'ffff'ffff));  // low half -1: no chain
  EXPECT_EQ(Chain(0).swinging, 1);
  host.Action(action::SetAnchorX, wide(0x7'0000'0000), wide(0x5'0000'0040));
  EXPECT_EQ(Chain(0).anchor->head.x, 64);
}

TEST_F(ActionTest, StartAndStopChainTouchOnlyTheirChain) {
  for (int i = 0; i < 3; ++i) AddAnchor(100 * i, 50);
  host.Action(action::StartAll);
  host.Action(action::StopChain, 0);
  EXPECT_EQ(Chain(0).swinging, 0);
  EXPECT_EQ(Chain(1).swinging, 1);
  EXPECT_EQ(Chain(2).swinging, 1);

  host.Action(action::StopAll);
  host.Action(action::StartChain, 2);
  host.Action(action::StartChain, 2);  // starting a swinging chain changes nothing
  EXPECT_EQ(Chain(0).swinging, 0);
  EXPECT_EQ(Chain(1).swinging, 0);
  EXPECT_EQ(Chain(2).swinging, 1);

  const std::vector<unsigned char> before = ChainBytes(host.extension());
  for (int32_t index : {-1, 3, std::numeric_limits<int32_t>::min(), std::numeric_limits<int32_t>::max()}) {
    host.Action(action::StartChain, index);
    host.Action(action::StopChain, index);
    host.Action(action::UpdateChain, index);
  }
  EXPECT_EQ(ChainBytes(host.extension()), before);
}

TEST_F(ActionTest, CommandsOnNoChainsDoNothing) {
  for (int code : {action::StartAll, action::StopAll, action::UpdateAll, action::StartChain,
                   action::StopChain, action::UpdateChain, action::SetAnchorX}) {
    EXPECT_EQ(host.Action(code, 0, 5), 0);
  }
  EXPECT_EQ(host.extension().chains->Count(), 0u);
}

TEST_F(ActionTest, SetAccelerationIsAddedToTheSpeedByTheNextUpdateOnly) {
  HostObject* anchor = AddAnchor(100, 50);
  AddLink(0, 0, 32);
  HostObject* platform = AddPlatform(0, 0);
  host.ActionWithValue(action::SetAcceleration, 0, 5.0f);
  host.Action(action::UpdateChain, 0);

  // One link of 32 pixels: the chain is 64 long; at rest at 90 degrees, the
  // update adds the 5 to the speed and the speed to the angle.
  const ChainRecord& c = Chain(0);
  EXPECT_EQ(c.speed, 5.0f);
  EXPECT_EQ(c.angle, 95.0f);
  const double gravity = static_cast<double>(9.81f);
  EXPECT_EQ(c.acceleration, static_cast<float>(std::sin(95.0 * kDegree) * (-(gravity * 1.0) / 64)));
  const double theta = (95.0 + 90.0) * kDegree;
  EXPECT_EQ(c.platformX, static_cast<float>(std::cos(theta) * 64 + anchor->head.x));
  EXPECT_EQ(platform->head.x, static_cast<int32_t>(c.platformX));
  EXPECT_EQ(c.swinging, 0);  // an update does not start the chain
  EXPECT_EQ(host.eventsRaised, 0);
}

}  // namespace
