#include <cmath>
#include <vector>

#include <gtest/gtest.h>

#include "chain_scene.h"

namespace {

struct DefaultChain : ChainScene {
  HostObject* anchor = Anchor(100, 50);
  HostObject* links[3] = {Link(32), Link(32), Link(32)};
  HostObject* platform = Platform();
  DefaultChain() { Chain(0).swinging = 1; }
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
  EXPECT_EQ(chain.prevPlatformY, 0.0f);
  const int expectedX[] = {68, 36, 4};
  for (int k = 0; k < 3; ++k) {
    EXPECT_EQ(scene.links[k]->head.x, expectedX[k]) << "link " << k;
    EXPECT_EQ(scene.links[k]->head.y, 50) << "link " << k;
    EXPECT_EQ(scene.links[k]->changed, 1);
  }
  EXPECT_EQ(scene.platform->head.x, -28);
  EXPECT_EQ(scene.platform->head.y, 50);
  EXPECT_EQ(scene.platform->changed, 1);
  EXPECT_EQ(scene.rd.currentChain, 0);
  EXPECT_EQ(scene.host.eventsRaised, 1);
  // The anchor is never moved or marked.
  EXPECT_EQ(scene.anchor->head.x, 100);
  EXPECT_EQ(scene.anchor->changed, 0);
}

TEST(SwingStep, SecondStepSwingsAndTruncatesTowardZero) {
  DefaultChain scene;
  scene.host.RunFrame();
  scene.host.RunFrame();
  const ChainRecord& chain = scene.Chain(0);
  EXPECT_EQ(Bits(chain.speed), Bits(-0.07664062827825546f));
  EXPECT_EQ(Bits(chain.angle), Bits(static_cast<float>(90.0 + static_cast<double>(-0.07664062827825546f))));
  EXPECT_NEAR(chain.angle, 89.92336f, 1e-5f);
  EXPECT_NEAR(chain.platformX, -27.99989f, 1e-5f);
  EXPECT_EQ(chain.prevPlatformX, -28.0f);
  EXPECT_EQ(scene.platform->head.x, -27);  // -27.99989 truncates toward zero
  EXPECT_EQ(scene.platform->head.y, 50);
  EXPECT_EQ(scene.host.eventsRaised, 2);
}

TEST(SwingStep, StoppedChainKeepsItsValuesAndObjects) {
  DefaultChain scene;
  scene.Chain(0).swinging = 0;
  scene.host.RunFrame();
  EXPECT_EQ(scene.Chain(0).angle, 90.0f);
  EXPECT_EQ(scene.Chain(0).acceleration, 0.0f);
  EXPECT_EQ(scene.platform->changed, 0);
  EXPECT_EQ(scene.host.eventsRaised, 0);
  EXPECT_EQ(scene.rd.currentChain, -1);
}

TEST(SwingStep, ChainLengthComesFromTheFirstLinkAndLinksUseTheirOwnHeights) {
  ChainScene scene;
  scene.Anchor(0, 0);
  scene.Link(32);
  HostObject* second = scene.Link(16);
  HostObject* platform = scene.Platform();
  scene.Chain(0).angle = 0.0f;
  scene.Chain(0).swinging = 1;
  scene.host.RunFrame();
  // L = (32 + 0) * (2 + 1) = 96, from the first link alone.
  // sin(90 K) is a hair below 1, but the stored float rounds back to 96.
  EXPECT_EQ(scene.Chain(0).platformY, 96.0f);
  EXPECT_EQ(platform->head.y, 96);
  // The second link stands at 2 * (16 + 0), not after the 32 of the first.
  EXPECT_EQ(second->head.y, 31);
  EXPECT_EQ(second->head.x, 0);
}

TEST(SwingStep, SevenLinksForTwoChainsLeaveTheLastOneAlone) {
  ChainScene scene;
  scene.Anchor(100, 0);
  scene.Anchor(300, 0);
  std::vector<HostObject*> links;
  for (int i = 0; i < 7; ++i) links.push_back(scene.Link(10));
  for (HostObject* link : links) link->head.x = -1;
  scene.Chain(0).swinging = 1;
  scene.Chain(1).swinging = 1;
  scene.host.RunFrame();
  for (int i = 0; i < 3; ++i) EXPECT_LT(links[i]->head.x, 100) << i;  // swung out from x 100
  for (int i = 3; i < 6; ++i) EXPECT_GT(links[i]->head.x, 200) << i;  // chain 1, about x 300
  EXPECT_EQ(links[6]->head.x, -1);
  EXPECT_EQ(links[6]->changed, 0);
}

TEST(SwingStep, MoreChainsThanLinksMovesNoLink) {
  ChainScene scene;
  scene.Anchor(0, 0);
  scene.Anchor(0, 0);
  HostObject* link = scene.Link(20);
  HostObject* platform = scene.Platform();
  scene.Chain(0).angle = 0.0f;
  scene.Chain(0).linkSpacing = 5.0f;
  scene.Chain(0).swinging = 1;
  scene.host.RunFrame();
  EXPECT_EQ(link->changed, 0);
  // L = 20 + 5, one step of length.
  EXPECT_EQ(scene.Chain(0).platformY, 25.0f);
  EXPECT_EQ(platform->head.y, 25);
}

TEST(SwingStep, ChainWithoutPlatformStillStepsAndRaisesItsEvent) {
  ChainScene scene;
  scene.Anchor(0, 0);
  scene.Anchor(50, 0);
  scene.Link(10);
  scene.Link(10);
  HostObject* platform = scene.Platform();
  scene.Chain(1).swinging = 1;
  scene.host.RunFrame();
  scene.host.RunFrame();
  EXPECT_EQ(platform->changed, 0);
  EXPECT_EQ(scene.host.eventsRaised, 2);
  EXPECT_EQ(scene.rd.currentChain, 1);
  EXPECT_NEAR(scene.Chain(1).platformX, 30.0f, 1e-2f);  // 50 - 20 at about 90 degrees
}

TEST(SwingStep, RemovesChainsWhoseAnchorsAreDestroyedAndStepsTheNext) {
  ChainScene scene;
  HostObject* first = scene.Anchor(0, 0);
  HostObject* second = scene.Anchor(0, 0);
  HostObject* third = scene.Anchor(0, 0);
  for (int i = 0; i < 3; ++i) scene.Chain(i).swinging = 1;
  scene.host.Destroy(first);
  scene.host.Destroy(second);
  std::vector<int32_t> raisedFor;
  scene.host.onEvent = [&](int32_t, int32_t) { raisedFor.push_back(scene.rd.currentChain); };
  scene.host.RunFrame();
  ASSERT_EQ(scene.rd.chains->Count(), 1u);
  EXPECT_EQ(scene.Chain(0).anchor, third);
  EXPECT_EQ(raisedFor, std::vector<int32_t>{0});
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

TEST(SwingStep, DestroyedNeighbouringLinksArePlacedThenRemoved) {
  DefaultChain scene;
  HostObject* survivor = scene.links[2];
  scene.host.Destroy(scene.links[0]);
  scene.host.Destroy(scene.links[1]);
  int placedBeforeRemoval = 0;
  scene.host.onEvent = [&](int32_t, int32_t) {
    placedBeforeRemoval = scene.links[0]->changed + scene.links[1]->changed;
  };
  scene.host.RunFrame();
  EXPECT_EQ(placedBeforeRemoval, 2);
  ASSERT_EQ(scene.rd.links->Count(), 1u);
  EXPECT_EQ(scene.rd.links->At(0), survivor);
}

TEST(SwingStep, DestroyedPlatformsLeaveTheirList) {
  DefaultChain scene;
  HostObject* second = scene.Platform();
  scene.host.Destroy(scene.platform);
  scene.host.RunFrame();
  ASSERT_EQ(scene.rd.platforms->Count(), 1u);
  EXPECT_EQ(scene.rd.platforms->At(0), second);
}

TEST(SwingStep, ChainAppendedDuringOnSwingIsSteppedLaterInTheSamePass) {
  DefaultChain scene;
  std::vector<int32_t> raisedFor;
  scene.host.onEvent = [&](int32_t code, int32_t param) {
    EXPECT_EQ(code, 1);
    EXPECT_EQ(param, 0);
    raisedFor.push_back(scene.rd.currentChain);
    if (scene.rd.chains->Count() == 1) {
      scene.Anchor(200, 50);
      scene.Chain(1).swinging = 1;
    }
  };
  scene.host.RunFrame();
  EXPECT_EQ(raisedFor, (std::vector<int32_t>{0, 1}));
  EXPECT_EQ(scene.Chain(1).angle, 90.0f);
  EXPECT_NE(scene.Chain(1).platformX, 0.0f);
}

}  // namespace
