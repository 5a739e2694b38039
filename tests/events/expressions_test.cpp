// The expressions, run through the expression table with their parameters
// served by the host: those that read chains and the positions of their
// objects, and "ChainIndex(" and "LinkIndex(", which find the chain, and the
// place in it, of an object given by its identifier.
#include <limits>
#include <utility>

#include "event_scene.h"

namespace {

constexpr int32_t kMin = std::numeric_limits<int32_t>::min();
constexpr int32_t kMax = std::numeric_limits<int32_t>::max();

class ExpressionTest : public EventTest {
 protected:
  // Three chains, two links each (one spare link), two platforms.
  void BuildThreeChains() {
    for (int i = 0; i < 3; ++i) Add(action::AddAnchor, 100 + 100 * i, 40 + i);
    for (int i = 0; i < 7; ++i) Add(action::AddLink, 1000 + i, 2000 + i, 16);
    for (int i = 0; i < 2; ++i) Add(action::AddPlatform, 500 + i, 600 + i);
  }
  HostObject* Object(int code, int16_t low, uint16_t high = 0) { return Add(code, 0, 0, 32, {low, high}); }
  // "ChainIndex(" and "LinkIndex(" of `id`; each reads its one parameter.
  std::pair<int32_t, int32_t> Lookup(int32_t id) {
    const int reads = host.expressionParameterReads;
    const std::pair<int32_t, int32_t> found = {host.Expression(expression::ChainIndex, {id}),
                                               host.Expression(expression::LinkIndex, {id})};
    EXPECT_EQ(host.expressionParameterReads, reads + 2);
    return found;
  }
};

// The setters take their value from the float parameter, not the integer
// one, and ask for it once; the expressions read it back from the chain.
TEST_F(ExpressionTest, ReadTheAddressedChainAndItsObjects) {
  Add(action::AddLink);
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
  } fields[] = {{action::SetMass, expression::PlatformMass, 2.5f}, {action::SetAngle, expression::ChainAngle, -30.25f},
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
  // Link place k of chain c is links entry 2c + k, after the one added first.
  EXPECT_EQ(host.Expression(expression::LinkX, {0, 1}), 1000);
  EXPECT_EQ(host.Expression(expression::LinkY, {1, 1}), 2002);
  EXPECT_EQ(host.Expression(expression::LinkX, {2, 1}), 1004);
  // Out of range: 0, with both parameters read whatever they hold.
  const std::pair<int32_t, int32_t> outside[] = {{1, 2}, {1, -1}, {3, 0}, {-1, 0}, {kMin, kMin}, {kMax, kMax}};
  for (const auto& [chain, place] : outside) {
    for (int code : {expression::LinkX, expression::LinkY}) {
      const int reads = host.expressionParameterReads;
      EXPECT_EQ(host.Expression(code, {chain, place}), 0) << code << ": " << chain << ", " << place;
      EXPECT_EQ(host.expressionParameterReads, reads + 2);
    }
  }
}

// Out of range, a chain index gives 0 (of its type) and a platform index the
// extension's own position; the parameter is read all the same.
TEST_F(ExpressionTest, MotionOfASwingingChainAndZeroForAnIndexThatAddressesNone) {
  BuildThreeChains();  // two platforms for three chains
  host.Action(action::StartAll);
  // Two steps: every chain has moved, and from a place away from the origin.
  for (int frame = 0; frame < 2; ++frame) host.RunFrame();
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
      EXPECT_EQ(host.expressionParameterReads, reads + 1);
    }
  }
  // In range, how far the platform moved in the last step and the
  // acceleration; a stopped chain reports no motion, whatever its record holds.
  const ChainRecord& c = Chain(1);
  const float motion[] = {c.platformX - c.prevPlatformX, c.platformY - c.prevPlatformY, c.acceleration};
  for (int i = 0; i < 3; ++i) {
    ASSERT_NE(motion[i], 0.0f);
    EXPECT_EQ(host.ExpressionFloat(expression::DeltaX + i, {1}), motion[i]) << i;
  }
  host.Action(action::StopChain, 1);
  for (int i = 0; i < 3; ++i) EXPECT_EQ(host.Expression(expression::DeltaX + i, {1}), 0) << i;
}

// Platforms are searched before links and links before anchors; the place
// comes from the links alone. An identifier is the high half shifted left by
// 16 plus the low half sign-extended.
TEST_F(ExpressionTest, FirstListThatHoldsTheObjectGivesItsChain) {
  HostObject* a0 = Object(action::AddAnchor, 100);
  Object(action::AddAnchor, 101);
  for (int16_t i = 0; i < 4; ++i) Object(action::AddLink, static_cast<int16_t>(200 + i));
  host.Action(action::AddLink, Ref(a0));          // anchor of chain 0, and link 4 (chain 1)
  HostObject* p0 = Object(action::AddLink, 205);  // link 5 (chain 1), and platform 0
  host.Action(action::AddPlatform, Ref(p0));
  Object(action::AddLink, -1, 1);  // link 6, past the last chain; identifier 65535
  Object(action::AddPlatform, 300);
  Object(action::AddPlatform, 301);  // platform 2, for a chain that is not there
  Object(action::AddPlatform, -32768, 0xFFFF);  // identifier 0xFFFF0000 - 32768 in 32 bits: -98304
  ASSERT_EQ(host.Expression(expression::ChainLinks), 3);

  const struct {
    int32_t id, chain, place;
  } cases[] = {{200, 0, 0}, {202, 0, 2}, {203, 1, 0}, {100, 1, 1}, {205, 0, 2}, {101, 1, -1}, {300, 1, -1},
               {301, 2, -1}, {65535, 2, 0}, {-98304, 3, -1},
               // The halves joined without sign extension; an object in no list.
               {0x1FFFF, -1, -1}, {7, -1, -1}};
  for (const auto& c : cases) EXPECT_EQ(Lookup(c.id), std::make_pair(c.chain, c.place)) << c.id;
}

// The lists keep an index for these two lookups. Whatever changes the lists
// (appends from inside "On Swing", objects destroyed and pruned, in the pass
// or after it, an identifier in several lists or several times in one, fewer
// links than chains), the answers must stay those of walking the lists from
// the start.
TEST_F(ExpressionTest, LookupsAreThoseOfWalkingTheListsWhateverChangesThem) {
  RunData& rd = host.extension();
  const auto walk = [](ObjectList* list, int32_t id) -> int32_t {
    for (uint32_t i = 0; i < list->Count(); ++i) {
      if (ObjectIdentifier(list->At(i)->head) == id) return static_cast<int32_t>(i);
    }
    return -1;
  };
  const auto check = [&] {
    const auto perChain = static_cast<int32_t>(LinksPerChain(rd));
    for (int32_t id = 0; id < 8; ++id) {
      int32_t chain = walk(rd.platforms, id);
      const int32_t link = perChain > 0 ? walk(rd.links, id) : -1;
      if (chain < 0 && link >= 0) chain = link / perChain;
      for (uint32_t i = 0; chain < 0 && i < rd.chains->Count(); ++i) {
        if (ObjectIdentifier(rd.chains->At(i).anchor->head) == id) chain = static_cast<int32_t>(i);
      }
      ASSERT_EQ(Lookup(id), std::make_pair(chain, link >= 0 ? link % perChain : -1)) << "identifier " << id;
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
      const bool fresh = live.empty() || random(2) == 0;
      HostObject* object = fresh ? live.emplace_back(host.AddObject(0, 0, 32, {static_cast<int16_t>(random(8)), 0}))
                                 : live[random(static_cast<uint32_t>(live.size()))];
      host.Action(static_cast<int>(what), Ref(object));  // AddAnchor, AddLink or AddPlatform
    } else if (what == 3 && !live.empty()) {
      const auto doomed = live.begin() + random(static_cast<uint32_t>(live.size()));
      host.Destroy(*doomed);
      live.erase(doomed);
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
