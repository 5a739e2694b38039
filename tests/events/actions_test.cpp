// The actions, run through the action table as the host runs them.
#include <cmath>
#include <cstring>
#include <limits>
#include <vector>

#include "event_scene.h"

namespace {

// Every byte of every chain record and of its anchor, padding included, to
// show that an action changed nothing.
std::vector<unsigned char> ChainBytes(const RunData& rd) {
  std::vector<unsigned char> bytes;
  for (uint32_t i = 0; i < rd.chains->Count(); ++i) {
    const auto* record = reinterpret_cast<const unsigned char*>(&rd.chains->At(i));
    const auto* anchor = reinterpret_cast<const unsigned char*>(rd.chains->At(i).anchor);
    bytes.insert(bytes.end(), record, record + sizeof(ChainRecord));
    bytes.insert(bytes.end(), anchor, anchor + sizeof(HostObject));
  }
  return bytes;
}

class ActionTest : public EventTest {};

TEST_F(ActionTest, AnchorsLinksAndPlatformsAddedInOrderFormTheChainsButANullIsNot) {
  for (int code : {action::AddAnchor, action::AddLink, action::AddPlatform}) EXPECT_EQ(host.Action(code, 0), 0);
  HostObject* a = AddAnchor(100, 50);
  HostObject* b = AddAnchor(300, 50);
  HostObject* links[4];
  for (auto& link : links) link = AddLink(0, 0);
  HostObject* p0 = AddPlatform(0, 0);
  HostObject* p1 = AddPlatform(0, 0);
  host.Action(action::AddAnchor, Ref(a));  // the same anchor again: a third chain

  const RunData& rd = host.extension();
  ASSERT_EQ(rd.chains->Count(), 3u);
  EXPECT_EQ(rd.links->Count(), 4u);
  EXPECT_EQ(rd.platforms->Count(), 2u);
  EXPECT_EQ(Chain(0).anchor, a);
  EXPECT_EQ(Chain(1).anchor, b);
  EXPECT_EQ(Chain(2).anchor, a);
  EXPECT_EQ(Chain(2).angle, 90.0f);
  EXPECT_EQ(a->changed, 0);  // adding moves nothing
  ASSERT_EQ(LinksPerChain(rd), 1u);
  for (uint32_t c = 0; c < 3; ++c) EXPECT_EQ(LinkOfChain(rd, c, 1), links[c]) << c;
  EXPECT_EQ(PlatformOfChain(rd, 0), p0);
  EXPECT_EQ(PlatformOfChain(rd, 1), p1);
  EXPECT_EQ(PlatformOfChain(rd, 2), nullptr);
}

TEST_F(ActionTest, OnlyStartedChainsSwingAndStopChainLeavesTheOthers) {
  for (int i = 0; i < 3; ++i) AddAnchor(100 * i, 50);
  HostObject* platform = AddPlatform(7, 8);
  const auto swinging = [&] { return std::vector<int>{Chain(0).swinging, Chain(1).swinging, Chain(2).swinging}; };
  host.RunFrame();
  EXPECT_EQ(platform->changed, 0);  // new chains rest until started
  EXPECT_EQ(host.eventsRaised, 0);

  host.Action(action::StartAll);
  host.Action(action::StopChain, 0);
  EXPECT_EQ(swinging(), (std::vector<int>{0, 1, 1}));
  host.RunFrame();
  EXPECT_EQ(host.eventsRaised, 2);
  EXPECT_EQ(platform->changed, 0);  // the platform of the stopped chain 0

  host.Action(action::StopAll);
  host.Action(action::StartChain, 2);
  host.Action(action::StartChain, 2);  // starting a swinging chain changes nothing
  EXPECT_EQ(swinging(), (std::vector<int>{0, 0, 1}));
}

TEST_F(ActionTest, SetAnchorWritesTheAnchorsPositionAndNothingElse) {
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

// Every action that takes an index does nothing with one that addresses no
// chain, with no chains at all or with two; the float setters still ask for
// their value, once.
TEST_F(ActionTest, IndexThatAddressesNoChainChangesNothing) {
  constexpr int32_t kMin = std::numeric_limits<int32_t>::min(), kMax = std::numeric_limits<int32_t>::max();
  const int indexed[] = {action::SetAnchorX, action::SetAnchorY, action::SetMass, action::SetAngle,
                         action::SetSpeed, action::SetLinkSpacing, action::StartChain, action::StopChain,
                         action::UpdateChain, action::SetAcceleration};
  for (int chains = 0; chains <= 2; chains += 2) {
    for (int i = 0; i < chains; ++i) AddAnchor(100 + 200 * i, 50);
    host.Action(action::StopAll);  // commands on no chains do nothing either
    host.Action(action::UpdateAll);
    host.Action(action::StartAll);
    const std::vector<unsigned char> before = ChainBytes(host.extension());
    for (int code : indexed) {
      for (int32_t index : {-1, chains, kMin, kMax}) {
        SCOPED_TRACE(testing::Message() << "code " << code << " index " << index << " of " << chains);
        const int calls = host.floatParameterCalls;
        EXPECT_EQ(host.ActionWithValue(code, index, 12.5f), 0);
        const bool floatSetter = (code >= action::SetMass && code <= action::SetLinkSpacing) ||
                                 code == action::SetAcceleration;
        EXPECT_EQ(host.floatParameterCalls, calls + (floatSetter ? 1 : 0));
      }
    }
    EXPECT_EQ(ChainBytes(host.extension()), before);
    EXPECT_EQ(host.extension().chains->Count(), static_cast<uint32_t>(chains));
  }
}

// Where arguments are 64 bits wide, only the low half holds the index.
TEST_F(ActionTest, IndexIsTheLowHalfOfAWideArgument) {
  if constexpr (sizeof(intptr_t) < 8) GTEST_SKIP() << "arguments are 32 bits wide";
  AddAnchor(100, 50);
  host.Action(action::StartChain, static_cast<intptr_t>(0x1'0000'0000));  // low half 0: chain 0
  host.Action(action::StopChain, static_cast<intptr_t>(0x1'ffff'ffff));   // low half -1: no chain
  EXPECT_EQ(Chain(0).swinging, 1);
  host.Action(action::SetAnchorX, static_cast<intptr_t>(0x7'0000'0000), static_cast<intptr_t>(0x5'0000'0040));
  EXPECT_EQ(Chain(0).anchor->head.x, 64);
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
