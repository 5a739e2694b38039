// The expressions, run through the expression table with their parameters
// served by the host: those that read chains and the positions of their
// objects, and "ChainIndex(" and "LinkIndex(", which find the chain, and the
// place in it, of an object given by its identifier.
#include <cmath>
#include <limits>
#include <utility>
#include <vector>

#include "event_scene.h"

namespace {

constexpr int32_t kMin = std::numeric_limits<int32_t>::min();
constexpr int32_t kMax = std::numeric_limits<int32_t>::max();

bool IsFloatExpression(int code) {
  return (code >= expression::PlatformMass && code <= expression::LinkSpacing) ||
         (code >= expression::DeltaX && code <= expression::ChainAccel);
}

class ChainExpressionTest : public EventTest {
 protected:
  // Three chains, two links each (one spare link), two platforms.
  void BuildThreeChains() {
    for (int i = 0; i < 3; ++i) AddAnchor(100 + 100 * i, 40 + i);
    for (int i = 0; i < 7; ++i) AddLink(1000 + i, 2000 + i, 16);
    for (int i = 0; i < 2; ++i) AddPlatform(500 + i, 600 + i);
  }
};

// The setters take their value from the float parameter, not the integer
// one, and ask for it once; the expressions read it back from the chain.
TEST_F(ChainExpressionTest, ReadTheAddressedChainAsSetAndMarkOnlyFloatsAsFloats) {
  AddLink(0, 0);
  EXPECT_EQ(host.Expression(expression::ChainNum), 0);
  EXPECT_EQ(host.Expression(expression::ChainLinks), 0);  // no chains: no link belongs to one
  EXPECT_EQ(host.Expression(expression::LinkX, {0, 0}), 0);
  BuildThreeChains();
  EXPECT_EQ(host.Expression(expression::ChainNum), 3);
  EXPECT_EQ(host.Expression(expression::ChainLinks), 2);  // 8 links over 3 chains, rounded down
  host.Action(action::StartChain, 1);  // "ChainAccel(" reads only a swinging chain
  const struct {
    int setter, expression;
    float value;
  } fields[] = {{action::SetMass, expression::PlatformMass, 2.5f},
                {action::SetAngle, expression::ChainAngle, -30.25f},
                {action::SetSpeed, expression::ChainSpeed, 0.125f},
                {action::SetLinkSpacing, expression::LinkSpacing, 3.75f},
                {action::SetAcceleration, expression::ChainAccel, -2.75f}};
  for (const auto& field : fields) {
    SCOPED_TRACE(field.setter);
    const int calls = host.floatParameterCalls;
    host.Action(field.setter, 1, 77, field.value);
    EXPECT_EQ(host.floatParameterCalls, calls + 1);
    EXPECT_EQ(host.ExpressionFloat(field.expression, {1}), field.value);
    EXPECT_NE(host.ExpressionFloat(field.expression, {0}), field.value);
  }
  EXPECT_EQ(host.Expression(expression::AnchorX, {1}), 200);
  EXPECT_EQ(host.Expression(expression::AnchorY, {2}), 42);
  EXPECT_EQ(host.Expression(expression::PlatformX, {1}), 501);
  EXPECT_EQ(host.Expression(expression::PlatformY, {0}), 600);
  for (int code = 0; code < kExpressionCount; ++code) {
    host.Expression(code, {0, 0});
    EXPECT_EQ(host.lastResultWasFloat(), IsFloatExpression(code)) << "expression " << code;
  }
}

// A bad chain index gives 0 (of its type); a bad platform index the
// extension's own position. The parameter is read all the same.
TEST_F(ChainExpressionTest, IndexThatAddressesNoChainYieldsZeroAndStillReadsTheParameter) {
  BuildThreeChains();  // two platforms for three chains
  host.Action(action::StartAll);
  host.RunFrame();  // every chain has moved: its deltas and acceleration are not 0
  host.extension().head.x = 321;
  host.extension().head.y = -654;
  for (int code = expression::AnchorX; code <= expression::ChainAccel; ++code) {
    if (code == expression::ChainIndex) continue;
    const bool platform = code == expression::PlatformX || code == expression::PlatformY;
    for (int32_t index : {-1, platform ? 2 : 3, kMin, kMax}) {
      SCOPED_TRACE(testing::Message() << "expression " << code << " index " << index);
      const int reads = host.expressionParameterReads;
      // A float 0.0 and an integer 0 have the same bits: +0.0, not -0.0.
      const int32_t expected = !platform ? 0 : code == expression::PlatformX ? 321 : -654;
      EXPECT_EQ(host.Expression(code, {index}), expected);
      EXPECT_EQ(host.lastResultWasFloat(), IsFloatExpression(code));
      EXPECT_EQ(host.expressionParameterReads, reads + 1);
    }
  }
}

// One link of 5 pixels makes a chain 10 long. At an angle whose cosine is 0
// the platform hangs at the anchor's x; at one whose cosine is -1/4 it stands
// 2.5 pixels to the left. Near x 100 a float resolves 2^-17, far finer than
// how close the nearest float angles come, so both positions are exact.
// A stopped chain reports no motion, whatever its record still holds.
TEST_F(ChainExpressionTest, DeltasAreHowFarThePlatformMovedInTheLastStepOfASwingingChain) {
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
  const ChainRecord& c = Chain(0);
  EXPECT_EQ(c.angle, angle);
  EXPECT_EQ(host.ExpressionFloat(expression::DeltaX, {0}), -2.5f);
  EXPECT_TRUE(host.lastResultWasFloat());
  ASSERT_NE(c.platformY - c.prevPlatformY, 0.0f);
  EXPECT_EQ(host.ExpressionFloat(expression::DeltaY, {0}), c.platformY - c.prevPlatformY);
  ASSERT_NE(c.acceleration, 0.0f);
  EXPECT_EQ(host.ExpressionFloat(expression::ChainAccel, {0}), c.acceleration);

  host.Action(action::StopChain, 0);
  for (int code : {expression::DeltaX, expression::DeltaY, expression::ChainAccel}) {
    EXPECT_EQ(host.Expression(code, {0}), 0) << code;
    EXPECT_TRUE(host.lastResultWasFloat());
  }
  EXPECT_EQ(host.ExpressionFloat(expression::ChainAngle, {0}), angle);
}

TEST_F(ChainExpressionTest, LinkPositionByChainAndPlaceWithinBoundsOnly) {
  AddAnchor(0, 0);
  AddAnchor(0, 0);
  for (int i = 0; i < 7; ++i) AddLink(10 + i, 20 + i);  // three per chain; the seventh in none
  EXPECT_EQ(host.Expression(expression::LinkX, {1, 2}), 15);  // links entry 5
  EXPECT_EQ(host.Expression(expression::LinkY, {1, 2}), 25);
  EXPECT_EQ(host.Expression(expression::LinkX, {0, 0}), 10);
  const std::pair<int32_t, int32_t> outside[] = {{1, 3},    {1, -1},   {2, 0},    {-1, 0},     {kMin, 0},
                                                 {kMax, 0}, {0, kMax}, {0, kMin}, {kMax, kMax}, {kMin, kMin}};
  for (const auto& [chain, place] : outside) {
    for (int code : {expression::LinkX, expression::LinkY}) {
      SCOPED_TRACE(testing::Message() << "expression " << code << " chain " << chain << " place " << place);
      const int reads = host.expressionParameterReads;
      EXPECT_EQ(host.Expression(code, {chain, place}), 0);
      EXPECT_EQ(host.expressionParameterReads, reads + 2);
    }
  }
}

class ObjectLookupTest : public EventTest {
 protected:
  HostObject* Add(int code, int16_t low, uint16_t high = 0) {
    HostObject* object = host.AddObject(0, 0, 32, {low, high});
    host.Action(code, Ref(object));
    return object;
  }
  int32_t ChainIndexOf(int32_t id) { return host.Expression(expression::ChainIndex, {id}); }
  int32_t LinkIndexOf(int32_t id) { return host.Expression(expression::LinkIndex, {id}); }
};

TEST_F(ObjectLookupTest, SevenLinksOverTwoChainsAndObjectsInNoList) {
  EXPECT_EQ(ChainIndexOf(7), -1);  // nothing at all yet
  EXPECT_EQ(LinkIndexOf(7), -1);
  Add(action::AddAnchor, 100);
  Add(action::AddAnchor, 101);
  for (int16_t i = 0; i < 7; ++i) Add(action::AddLink, static_cast<int16_t>(200 + i));
  EXPECT_EQ(host.Expression(expression::ChainLinks), 3);

  const int32_t chain[] = {0, 0, 0, 1, 1, 1, 2};  // the last link lies past the last chain
  const int32_t place[] = {0, 1, 2, 0, 1, 2, 0};
  for (int i = 0; i < 7; ++i) {
    const int reads = host.expressionParameterReads;
    EXPECT_EQ(ChainIndexOf(200 + i), chain[i]) << "link " << i;
    EXPECT_EQ(LinkIndexOf(200 + i), place[i]) << "link " << i;
    EXPECT_EQ(host.expressionParameterReads, reads + 2);
    EXPECT_FALSE(host.lastResultWasFloat());
  }
  EXPECT_EQ(ChainIndexOf(101), 1);  // an anchor: its chain
  EXPECT_EQ(LinkIndexOf(101), -1);  // but no place among the links
  EXPECT_EQ(ChainIndexOf(7), -1);
  EXPECT_EQ(LinkIndexOf(7), -1);
}

TEST_F(ObjectLookupTest, PlatformsAreSearchedBeforeLinksAndLinksBeforeAnchors) {
  HostObject* a0 = Add(action::AddAnchor, 100);
  Add(action::AddAnchor, 101);
  for (int16_t i = 0; i < 4; ++i) Add(action::AddLink, static_cast<int16_t>(200 + i));
  host.Action(action::AddLink, Ref(a0));           // anchor of chain 0, and link 4 (chain 1)
  HostObject* p0 = Add(action::AddLink, 205);      // link 5 (chain 1), and platform 0
  host.Action(action::AddPlatform, Ref(p0));
  Add(action::AddPlatform, 300);
  Add(action::AddPlatform, 301);  // platform 2, for a chain that is not there

  EXPECT_EQ(ChainIndexOf(205), 0);
  EXPECT_EQ(ChainIndexOf(100), 1);
  EXPECT_EQ(LinkIndexOf(205), 2);  // the place comes from the links alone
  EXPECT_EQ(ChainIndexOf(301), 2);
}

TEST_F(ObjectLookupTest, IdentifierJoinsTheHalvesWithTheLowOneSignExtended) {
  Add(action::AddAnchor, 0);
  Add(action::AddLink, -1, 1);
  EXPECT_EQ(ChainIndexOf(65535), 0);
  EXPECT_EQ(LinkIndexOf(65535), 0);
  EXPECT_EQ(ChainIndexOf(0x1FFFF), -1);  // the halves joined without sign extension
  EXPECT_EQ(LinkIndexOf(0x1FFFF), -1);

  Add(action::AddPlatform, -2);  // a negative low half alone: -2
  EXPECT_EQ(ChainIndexOf(-2), 0);
  EXPECT_EQ(ChainIndexOf(0xFFFE), -1);
}

TEST_F(ObjectLookupTest, LinkIsInNoChainWhileThereAreFewerLinksThanChains) {
  Add(action::AddLink, 200);
  EXPECT_EQ(ChainIndexOf(200), -1);  // no chains at all
  EXPECT_EQ(LinkIndexOf(200), -1);

  Add(action::AddAnchor, 100);
  HostObject* a1 = Add(action::AddAnchor, 101);
  ASSERT_EQ(host.Expression(expression::ChainLinks), 0);
  EXPECT_EQ(ChainIndexOf(200), -1);
  EXPECT_EQ(LinkIndexOf(200), -1);

  // A link that also anchors a chain is found as that chain's anchor.
  host.Action(action::AddLink, Ref(a1));
  Add(action::AddAnchor, 102);
  ASSERT_EQ(host.Expression(expression::ChainLinks), 0);
  EXPECT_EQ(ChainIndexOf(101), 1);
  EXPECT_EQ(LinkIndexOf(101), -1);
}

// The lists keep an index for these two lookups. Whatever changes the lists
// (appends from inside "On Swing", objects destroyed and pruned, in the pass
// or after it, an identifier in several lists or several times in one), the
// answers must stay those of walking the lists from the start.
TEST_F(ObjectLookupTest, AnswersAreThoseOfWalkingTheListsWhateverChangesThem) {
  RunData& rd = host.extension();
  const auto walk = [](ObjectList* list, int32_t id) -> int32_t {
    for (uint32_t i = 0; i < list->Count(); ++i) {
      if (ObjectIdentifier(list->At(i)->head) == id) return static_cast<int32_t>(i);
    }
    return -1;
  };
  const auto check = [&] {
    const uint32_t perChain = LinksPerChain(rd);
    for (int32_t id = 0; id < 8; ++id) {
      int32_t chain = walk(rd.platforms, id);
      const int32_t link = walk(rd.links, id);
      if (chain < 0 && link >= 0 && perChain > 0) chain = link / static_cast<int32_t>(perChain);
      for (uint32_t i = 0; chain < 0 && i < rd.chains->Count(); ++i) {
        if (ObjectIdentifier(rd.chains->At(i).anchor->head) == id) chain = static_cast<int32_t>(i);
      }
      ASSERT_EQ(ChainIndexOf(id), chain) << "identifier " << id;
      ASSERT_EQ(LinkIndexOf(id), link >= 0 && perChain > 0 ? link % static_cast<int32_t>(perChain) : -1);
    }
  };
  uint32_t seed = 1;
  const auto random = [&](uint32_t below) {
    seed = seed * 1664525u + 1013904223u;
    return (seed >> 8) % below;
  };
  std::vector<HostObject*> live;
  const auto change = [&] {
    const uint32_t what = random(6);
    if (what < 3) {  // a new object, or one already in some list, into one of the three
      HostObject* object = nullptr;
      if (live.empty() || random(2) == 0) {
        object = live.emplace_back(host.AddObject(0, 0, 32, {static_cast<int16_t>(random(8)), 0}));
      } else {
        object = live[random(static_cast<uint32_t>(live.size()))];
      }
      host.Action(static_cast<int>(what), Ref(object));  // AddAnchor, AddLink or AddPlatform
    } else if (what == 3 && !live.empty()) {
      const uint32_t doomed = random(static_cast<uint32_t>(live.size()));
      host.Destroy(live[doomed]);
      live.erase(live.begin() + doomed);
    }
  };
  host.onEvent = [&](int32_t, int32_t) {
    check();
    for (int i = 0; i < 2; ++i) change();
    check();
  };
  for (int frame = 0; frame < 40; ++frame) {
    for (int i = 0; i < 4; ++i) change();
    check();
    host.Action(action::StartAll);
    host.RunFrame();
    check();
  }
}

}  // namespace
