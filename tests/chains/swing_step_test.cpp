#include <utility>
#include <vector>

#include <gtest/gtest.h>

#include "chain_scene.h"

namespace {

// The default chain: anchor at (100, 50), three 32-pixel links, a platform.
struct DefaultChain : ChainScene {
  HostObject* anchor = Anchor(100, 50, 1);
  HostObject* links[3] = {Link(32), Link(32), Link(32)};
  HostObject* platform = Platform();
  std::vector<int32_t> raisedFor;  // currentChain at each "On Swing"
  DefaultChain() {
    host.onEvent = [this](int32_t, int32_t) { raisedFor.push_back(rd.currentChain); };
  }
};

TEST(SwingStep, FirstStepOfARestingChainOnlyPlacesIt) {
  DefaultChain scene;
  scene.host.RunFrame();
  const ChainRecord& chain = scene.Chain(0);
  EXPECT_EQ(chain.speed, 0.0f);
  EXPECT_EQ(chain.angle, 90.0f);
  EXPECT_EQ(Bits(chain.acceleration), Bits(-0.07664062827825546f));
  EXPECT_EQ(chain.platformX, -28.0f);
  EXPECT_NEAR(chain.platformY, 50.00034f, 1e-5f);
  EXPECT_EQ(chain.prevPlatformX, 0.0f);
  const int expectedX[] = {68, 36, 4};
  for (int k = 0; k < 3; ++k) {
    EXPECT_EQ(scene.links[k]->head.x, expectedX[k]) << "link " << k;
    EXPECT_EQ(scene.links[k]->head.y, 50) << "link " << k;
    EXPECT_EQ(scene.links[k]->changed, 1) << "link " << k;
  }
  EXPECT_EQ(scene.platform->head.x, -28);
  EXPECT_EQ(scene.platform->head.y, 50);
  EXPECT_EQ(scene.platform->changed, 1);
  EXPECT_EQ(scene.raisedFor, std::vector<int32_t>{0});
  EXPECT_EQ(scene.anchor->head.x, 100);  // the anchor is never moved or marked
  EXPECT_EQ(scene.anchor->changed, 0);
}

TEST(SwingStep, SecondStepSwingsAndTruncatesTowardZero) {
  DefaultChain scene;
  scene.host.RunFrame();
  scene.host.RunFrame();
  const ChainRecord& chain = scene.Chain(0);
  EXPECT_EQ(Bits(chain.speed), Bits(-0.07664062827825546f));
  EXPECT_EQ(Bits(chain.angle), Bits(static_cast<float>(90.0 + static_cast<double>(-0.07664062827825546f))));
  EXPECT_NEAR(chain.platformX, -27.99989f, 1e-5f);
  EXPECT_EQ(chain.prevPlatformX, -28.0f);
  EXPECT_EQ(scene.platform->head.x, -27);  // -27.99989 truncates toward zero
  EXPECT_EQ(scene.platform->head.y, 50);
  EXPECT_EQ(scene.host.eventsRaised, 2);
}

// The length is the first link's height plus the spacing, times the links
// per chain plus one; each link stands at its own height plus the spacing
// times its place. sin(90 K) is a hair below 1: a link's coordinate is
// truncated from the double, the platform's is stored as a float first.
TEST(SwingStep, ChainLengthComesFromTheFirstLinkAndLinksUseTheirOwnHeights) {
  const struct {
    const char* what;
    std::vector<int32_t> heights;
    int chains;
    float spacing, angle;
    int32_t platformY;
    std::vector<int32_t> linkY;
  } cases[] = {{"mixed heights: (32 + 0) * 3", {32, 16}, 1, 0.0f, 0.0f, 106, {41, 41}},
               {"more chains than links: one step", {20}, 2, 5.0f, 0.0f, 35, {0}},
               {"no links: (0 + 30) * 1", {}, 1, 30.0f, 0.0f, 40, {}},
               {"no length: no acceleration", {}, 1, 0.0f, 45.0f, 10, {}}};
  for (const auto& c : cases) {
    SCOPED_TRACE(c.what);
    ChainScene scene;
    for (int i = 0; i < c.chains; ++i) scene.Anchor(10, 10, 1);
    std::vector<HostObject*> links;
    for (int32_t height : c.heights) links.push_back(scene.Link(height));
    HostObject* platform = scene.Platform();
    scene.Chain(0).angle = c.angle;
    scene.Chain(0).linkSpacing = c.spacing;
    for (int frame = 0; frame < 3; ++frame) scene.host.RunFrame();
    EXPECT_EQ(scene.Chain(0).angle, c.angle);
    EXPECT_EQ(scene.Chain(0).platformY, static_cast<float>(c.platformY));
    EXPECT_EQ(platform->head.x, 10);
    EXPECT_EQ(platform->head.y, c.platformY);
    for (std::size_t k = 0; k < links.size(); ++k) EXPECT_EQ(links[k]->head.y, c.linkY[k]) << "link " << k;
  }
}

// Three links per chain, the seventh in none; the second chain has no
// platform but steps and raises its event all the same.
TEST(SwingStep, SevenLinksAndOnePlatformForTwoChains) {
  ChainScene scene;
  scene.Anchor(100, 0, 1);
  scene.Anchor(300, 0, 1);
  HostObject* links[7];
  for (HostObject*& link : links) link = scene.Link(10);
  HostObject* platform = scene.Platform();
  scene.host.RunFrame();
  for (int i = 0; i < 3; ++i) EXPECT_LT(links[i]->head.x, 100) << i;  // swung out from x 100
  for (int i = 3; i < 6; ++i) EXPECT_GT(links[i]->head.x, 200) << i;  // chain 1, about x 300
  EXPECT_EQ(links[6]->changed, 0);
  EXPECT_EQ(platform->head.x, 60);  // chain 0's, 40 left of its anchor
  EXPECT_NEAR(scene.Chain(1).platformX, 260.0f, 1e-2f);
  EXPECT_EQ(scene.host.eventsRaised, 2);
  EXPECT_EQ(scene.rd.currentChain, 1);
}

TEST(SwingStep, RemovesChainsWhoseAnchorsAreDestroyedAndStepsTheNext) {
  DefaultChain scene;
  HostObject* second = scene.Anchor(0, 0, 1);
  HostObject* third = scene.Anchor(0, 0, 1);
  scene.host.Destroy(scene.anchor);
  scene.host.Destroy(second);
  scene.host.RunFrame();
  ASSERT_EQ(scene.rd.chains->Count(), 1u);
  EXPECT_EQ(scene.Chain(0).anchor, third);
  EXPECT_EQ(scene.raisedFor, std::vector<int32_t>{0});
}

TEST(SwingStep, DestroyedAnchorOfTheOnlyChainEndsThePass) {
  DefaultChain scene;
  scene.host.Destroy(scene.anchor);
  scene.host.RunFrame();
  EXPECT_EQ(scene.rd.chains->Count(), 0u);
  EXPECT_EQ(scene.host.eventsRaised, 0);
  EXPECT_EQ(scene.platform->changed, 0);
  // Its links and platform stay until destroyed themselves.
  EXPECT_EQ(scene.rd.links->Count(), 3u);
  EXPECT_EQ(scene.rd.platforms->Count(), 1u);
}

TEST(SwingStep, DestroyedNeighbouringLinksAndPlatformsArePlacedThenRemoved) {
  DefaultChain scene;
  HostObject* secondPlatform = scene.Platform();
  scene.host.Destroy(scene.links[0]);
  scene.host.Destroy(scene.links[1]);
  scene.host.Destroy(scene.platform);
  int placedBeforeRemoval = 0;
  scene.host.onEvent = [&](int32_t, int32_t) {
    placedBeforeRemoval = scene.links[0]->changed + scene.links[1]->changed + scene.platform->changed;
  };
  scene.host.RunFrame();
  EXPECT_EQ(placedBeforeRemoval, 3);
  ASSERT_EQ(scene.rd.links->Count(), 1u);
  EXPECT_EQ(scene.rd.links->At(0), scene.links[2]);
  ASSERT_EQ(scene.rd.platforms->Count(), 1u);
  EXPECT_EQ(scene.rd.platforms->At(0), secondPlatform);
}

TEST(SwingStep, ChainAppendedDuringOnSwingIsSteppedLaterInTheSamePass) {
  DefaultChain scene;
  scene.host.onEvent = [&](int32_t code, int32_t param) {
    EXPECT_EQ(code, 1);
    EXPECT_EQ(param, 0);
    scene.raisedFor.push_back(scene.rd.currentChain);
    if (scene.rd.chains->Count() == 1) scene.Anchor(200, 50, 1);
  };
  scene.host.RunFrame();
  EXPECT_EQ(scene.raisedFor, (std::vector<int32_t>{0, 1}));
  EXPECT_EQ(scene.Chain(1).angle, 90.0f);
  EXPECT_NE(scene.Chain(1).platformX, 0.0f);
}

// In the first frame an "On Swing" rule of chain 1 destroys objects, and may
// hand one to the chains again at once. The host frees them as soon as that
// frame's handle call has returned, so no list may hold one after it: the
// second frame would read freed memory (AddressSanitizer). A chain whose
// anchor went keeps its step and event only if the pass had reached it.
TEST(SwingStep, ObjectsDestroyedDuringOnSwingLeaveTheListsInTheSameFrame) {
  enum Object { A0, A1, A2, L0, L1, L2, P0, P1, P2, None };
  const struct {
    const char* what;
    Object destroyed, readded;
    std::vector<int32_t> events;
    std::vector<Object> anchors, links, platforms;
  } cases[] = {
      {"earlier chain's anchor", A0, None, {0, 1, 2}, {A1, A2}, {L0, L1, L2}, {P0, P1, P2}},
      {"later chain's anchor", A2, None, {0, 1}, {A0, A1}, {L0, L1, L2}, {P0, P1, P2}},
      {"own chain's anchor", A1, None, {0, 1, 2}, {A0, A2}, {L0, L1, L2}, {P0, P1, P2}},
      {"a link", L2, None, {0, 1, 2}, {A0, A1, A2}, {L0, L1}, {P0, P1, P2}},
      {"a platform", P0, None, {0, 1, 2}, {A0, A1, A2}, {L0, L1, L2}, {P1, P2}},
      {"own anchor, anchoring a new chain", A1, A1, {0, 1, 2}, {A0, A2}, {L0, L1, L2}, {P0, P1, P2}},
      {"a link, added again", L1, L1, {0, 1, 2}, {A0, A1, A2}, {L0, L2}, {P0, P1, P2}},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.what);
    ChainScene scene;
    HostObject* objects[None];
    for (int i = 0; i < 3; ++i) objects[A0 + i] = scene.Anchor(100 * i, 0, 1);
    for (int i = 0; i < 3; ++i) objects[L0 + i] = scene.Link(10);
    for (int i = 0; i < 3; ++i) objects[P0 + i] = scene.Platform();
    std::vector<int32_t> events;
    bool ruleRan = false;
    scene.host.onEvent = [&](int32_t, int32_t) {
      events.push_back(scene.rd.currentChain);
      if (scene.rd.currentChain != 1 || std::exchange(ruleRan, true)) return;
      HostObject* doomed = objects[c.destroyed];
      scene.host.Destroy(doomed);
      if (c.readded == None) return;
      if (c.readded <= A2) {
        AddChain(scene.rd, doomed);
        scene.Chain(scene.rd.chains->Count() - 1).swinging = 1;
      } else {
        scene.rd.links->Append(doomed);
      }
    };
    scene.host.RunFrame();
    EXPECT_EQ(events, c.events);
    const auto names = [&](auto count, auto at) {
      std::vector<HostObject*> list;
      for (uint32_t i = 0; i < count; ++i) list.push_back(at(i));
      return list;
    };
    const auto expected = [&](const std::vector<Object>& which) {
      std::vector<HostObject*> list;
      for (Object o : which) list.push_back(objects[o]);
      return list;
    };
    EXPECT_EQ(names(scene.rd.chains->Count(), [&](uint32_t i) { return scene.Chain(i).anchor; }), expected(c.anchors));
    EXPECT_EQ(names(scene.rd.links->Count(), [&](uint32_t i) { return scene.rd.links->At(i); }), expected(c.links));
    EXPECT_EQ(names(scene.rd.platforms->Count(), [&](uint32_t i) { return scene.rd.platforms->At(i); }),
              expected(c.platforms));
    events.clear();
    scene.host.RunFrame();
    EXPECT_EQ(events.size(), c.anchors.size());
  }
}

}  // namespace
