#include <utility>
#include <vector>

#include <gtest/gtest.h>

#include "chain_scene.h"

namespace {

// Anchor at (100, 50), three 32-pixel links, a platform: the first step of a
// resting chain only places it, the second swings it.
TEST(SwingStep, FirstStepPlacesARestingChainAndTheSecondSwingsIt) {
  ChainScene scene;
  HostObject* anchor = scene.Anchor(100, 50, 1);
  HostObject* links[3] = {scene.Link(32), scene.Link(32), scene.Link(32)};
  HostObject* platform = scene.Platform();
  scene.host.RunFrame();
  const ChainRecord& chain = scene.Chain(0);
  EXPECT_EQ(chain.speed, 0.0f);
  EXPECT_EQ(chain.angle, 90.0f);
  EXPECT_EQ(Bits(chain.acceleration), Bits(-0.07664062827825546f));
  EXPECT_EQ(chain.platformX, -28.0f);
  EXPECT_NEAR(chain.platformY, 50.00034f, 1e-5f);
  for (int k = 0; k < 3; ++k) {
    EXPECT_EQ(links[k]->head.x, 68 - 32 * k) << "link " << k;
    EXPECT_EQ(links[k]->head.y, 50) << "link " << k;
    EXPECT_EQ(links[k]->changed, 1) << "link " << k;
  }
  EXPECT_EQ(platform->head.y, 50);
  EXPECT_EQ(platform->changed, 1);
  EXPECT_EQ(anchor->head.x, 100);  // the anchor is never moved or marked
  EXPECT_EQ(anchor->changed, 0);

  scene.host.RunFrame();
  EXPECT_EQ(Bits(chain.speed), Bits(-0.07664062827825546f));
  EXPECT_EQ(Bits(chain.angle), Bits(static_cast<float>(90.0 + static_cast<double>(-0.07664062827825546f))));
  EXPECT_NEAR(chain.platformX, -27.99989f, 1e-5f);
  EXPECT_EQ(chain.prevPlatformX, -28.0f);
  EXPECT_EQ(platform->head.x, -27);  // -27.99989 truncates toward zero
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

// Three chains; objects destroyed before the frame, or during it by an "On
// Swing" rule of chain 1, which may hand one to the chains again at once or
// anchor a new chain. The host frees destroyed objects as soon as that
// frame's handle call has returned, so no list may hold one after it: the
// second frame would read freed memory (AddressSanitizer). Destroyed links
// and platforms are placed before they leave; a chain whose anchor went
// keeps its step and event only if the pass had reached it.
TEST(SwingStep, DestroyedObjectsLeaveTheListsInTheSameFrame) {
  enum Object { A0, A1, A2, L0, L1, L2, P0, P1, P2, New, None };
  const struct {
    const char* what;
    std::vector<Object> before;  // destroyed before the frame
    Object during, readded;
    std::vector<int32_t> events;
    std::vector<Object> anchors, links, platforms;
  } cases[] = {
      {"two anchors before", {A0, A1}, None, None, {0}, {A2}, {L0, L1, L2}, {P0, P1, P2}},
      {"the first anchor before", {A0}, None, None, {0, 1}, {A1, A2}, {L0, L1, L2}, {P0, P1, P2}},
      {"links and a platform before", {L0, L1, P0}, None, None, {0, 1, 2}, {A0, A1, A2}, {L2}, {P1, P2}},
      {"earlier chain's anchor", {}, A0, None, {0, 1, 2}, {A1, A2}, {L0, L1, L2}, {P0, P1, P2}},
      {"later chain's anchor", {}, A2, None, {0, 1}, {A0, A1}, {L0, L1, L2}, {P0, P1, P2}},
      {"own chain's anchor", {}, A1, None, {0, 1, 2}, {A0, A2}, {L0, L1, L2}, {P0, P1, P2}},
      {"a link", {}, L2, None, {0, 1, 2}, {A0, A1, A2}, {L0, L1}, {P0, P1, P2}},
      {"a platform", {}, P0, None, {0, 1, 2}, {A0, A1, A2}, {L0, L1, L2}, {P1, P2}},
      {"own anchor, anchoring a new chain", {}, A1, A1, {0, 1, 2}, {A0, A2}, {L0, L1, L2}, {P0, P1, P2}},
      {"a link, added again", {}, L1, L1, {0, 1, 2}, {A0, A1, A2}, {L0, L2}, {P0, P1, P2}},
      {"nothing; a new chain is stepped in the same pass", {}, None, New, {0, 1, 2, 3}, {A0, A1, A2, New},
       {L0, L1, L2}, {P0, P1, P2}},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.what);
    ChainScene scene;
    HostObject* objects[None];
    for (int i = 0; i < 3; ++i) objects[A0 + i] = scene.Anchor(100 * i, 0, 1);
    for (int i = 0; i < 3; ++i) objects[L0 + i] = scene.Link(10);
    for (int i = 0; i < 3; ++i) objects[P0 + i] = scene.Platform();
    objects[New] = scene.host.AddObject(500, 0, 32);
    for (Object o : c.before) scene.host.Destroy(objects[o]);
    std::vector<int32_t> events;
    std::vector<uint8_t> placed(c.before.size());  // read while the host still holds them
    bool ruleRan = false, firstFrame = true;
    scene.host.onEvent = [&](int32_t code, int32_t param) {
      EXPECT_EQ(code, 1);
      EXPECT_EQ(param, 0);
      events.push_back(scene.rd.currentChain);
      for (std::size_t i = 0; firstFrame && i < c.before.size(); ++i) placed[i] = objects[c.before[i]]->changed;
      if (scene.rd.currentChain != 1 || std::exchange(ruleRan, true)) return;
      if (c.during != None) scene.host.Destroy(objects[c.during]);
      if (c.readded == None) return;
      if (c.readded <= A2 || c.readded == New) {
        AddChain(scene.rd, objects[c.readded]);
        scene.Chain(scene.rd.chains->Count() - 1).swinging = 1;
      } else {
        scene.rd.links->Append(objects[c.readded]);
      }
    };
    scene.host.RunFrame();
    EXPECT_EQ(events, c.events);
    for (std::size_t i = 0; i < c.before.size(); ++i) EXPECT_EQ(placed[i], c.before[i] >= L0 ? 1 : 0) << i;
    const auto objectsOf = [&](const std::vector<Object>& which) {
      std::vector<HostObject*> list;
      for (Object o : which) list.push_back(objects[o]);
      return list;
    };
    const auto listed = [](uint32_t count, auto at) {
      std::vector<HostObject*> list;
      for (uint32_t i = 0; i < count; ++i) list.push_back(at(i));
      return list;
    };
    EXPECT_EQ(listed(scene.rd.chains->Count(), [&](uint32_t i) { return scene.Chain(i).anchor; }), objectsOf(c.anchors));
    EXPECT_EQ(listed(scene.rd.links->Count(), [&](uint32_t i) { return scene.rd.links->At(i); }), objectsOf(c.links));
    EXPECT_EQ(listed(scene.rd.platforms->Count(), [&](uint32_t i) { return scene.rd.platforms->At(i); }),
              objectsOf(c.platforms));
    events.clear();
    firstFrame = false;
    scene.host.RunFrame();
    EXPECT_EQ(events.size(), c.anchors.size());
  }
}

}  // namespace
