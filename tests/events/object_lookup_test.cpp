// "ChainIndex(" and "LinkIndex(": which chain, and which place in it, an
// object given by its identifier has.
#include <vector>

#include "event_scene.h"

namespace {

class ObjectLookupTest : public EventTest {
 protected:
  HostObject* WithId(int16_t low, uint16_t high) { return host.AddObject(0, 0, 32, {low, high}); }
  void Add(int code, HostObject* object) { host.Action(code, Ref(object)); }
  int32_t ChainIndexOf(int32_t id) { return host.Expression(expression::ChainIndex, {id}); }
  int32_t LinkIndexOf(int32_t id) { return host.Expression(expression::LinkIndex, {id}); }
};

TEST_F(ObjectLookupTest, SevenLinksOverTwoChains) {
  Add(action::AddAnchor, WithId(100, 0));
  Add(action::AddAnchor, WithId(101, 0));
  for (int16_t i = 0; i < 7; ++i) Add(action::AddLink, WithId(static_cast<int16_t>(200 + i), 0));
  EXPECT_EQ(host.Expression(expression::ChainLinks), 3);

  const int32_t chain[] = {0, 0, 0, 1, 1, 1, 2};  // the last link lies past the last chain
  const int32_t place[] = {0, 1, 2, 0, 1, 2, 0};
  for (int i = 0; i < 7; ++i) {
    EXPECT_EQ(ChainIndexOf(200 + i), chain[i]) << "link " << i;
    EXPECT_EQ(LinkIndexOf(200 + i), place[i]) << "link " << i;
    EXPECT_FALSE(host.lastResultWasFloat());
  }
  EXPECT_EQ(ChainIndexOf(101), 1);  // an anchor: its chain
  EXPECT_EQ(LinkIndexOf(101), -1);  // but no place among the links
}

TEST_F(ObjectLookupTest, PlatformsAreSearchedBeforeLinksAndLinksBeforeAnchors) {
  HostObject* a0 = WithId(100, 0);
  Add(action::AddAnchor, a0);
  Add(action::AddAnchor, WithId(101, 0));
  std::vector<HostObject*> links;
  for (int16_t i = 0; i < 6; ++i) links.push_back(WithId(static_cast<int16_t>(200 + i), 0));
  links[4] = a0;  // anchor of chain 0, and link 4 (chain 1)
  for (HostObject* link : links) Add(action::AddLink, link);
  Add(action::AddPlatform, links[5]);  // platform 0, and link 5 (chain 1)
  Add(action::AddPlatform, WithId(300, 0));
  Add(action::AddPlatform, WithId(301, 0));  // platform 2, for a chain that is not there

  EXPECT_EQ(ChainIndexOf(205), 0);
  EXPECT_EQ(ChainIndexOf(100), 1);
  EXPECT_EQ(LinkIndexOf(205), 2);  // the place comes from the links alone
  EXPECT_EQ(ChainIndexOf(301), 2);
}

TEST_F(ObjectLookupTest, IdentifierJoinsTheHalvesWithTheLowOneSignExtended) {
  Add(action::AddAnchor, WithId(0, 0));
  Add(action::AddLink, WithId(-1, 1));
  EXPECT_EQ(ChainIndexOf(65535), 0);
  EXPECT_EQ(LinkIndexOf(65535), 0);
  EXPECT_EQ(ChainIndexOf(0x1FFFF), -1);  // the halves joined without sign extension
  EXPECT_EQ(LinkIndexOf(0x1FFFF), -1);

  Add(action::AddPlatform, WithId(-2, 0));  // a negative low half alone: -2
  EXPECT_EQ(ChainIndexOf(-2), 0);
  EXPECT_EQ(ChainIndexOf(0xFFFE), -1);
}

TEST_F(ObjectLookupTest, ObjectInNoListIsNotFound) {
  EXPECT_EQ(ChainIndexOf(7), -1);  // nothing at all yet
  EXPECT_EQ(LinkIndexOf(7), -1);
  Add(action::AddAnchor, WithId(100, 0));
  Add(action::AddLink, WithId(200, 0));
  Add(action::AddPlatform, WithId(300, 0));
  EXPECT_EQ(ChainIndexOf(7), -1);
  EXPECT_EQ(LinkIndexOf(7), -1);
  EXPECT_EQ(LinkIndexOf(100), -1);
  EXPECT_EQ(LinkIndexOf(300), -1);
}

TEST_F(ObjectLookupTest, LinkIsInNoChainWhileThereAreFewerLinksThanChains) {
  Add(action::AddLink, WithId(200, 0));
  EXPECT_EQ(ChainIndexOf(200), -1);  // no chains at all
  EXPECT_EQ(LinkIndexOf(200), -1);

  HostObject* a1 = WithId(101, 0);
  Add(action::AddAnchor, WithId(100, 0));
  Add(action::AddAnchor, a1);
  EXPECT_EQ(host.Expression(expression::ChainLinks), 0);
  EXPECT_EQ(ChainIndexOf(200), -1);
  EXPECT_EQ(LinkIndexOf(200), -1);

  // A link that also anchors a chain is found as that chain's anchor.
  Add(action::AddLink, a1);
  Add(action::AddAnchor, WithId(102, 0));
  ASSERT_EQ(host.Expression(expression::ChainLinks), 0);
  EXPECT_EQ(ChainIndexOf(101), 1);
  EXPECT_EQ(LinkIndexOf(101), -1);
}

TEST_F(ObjectLookupTest, ParameterIsReadOnceOnEveryCall) {
  for (int code : {expression::ChainIndex, expression::LinkIndex}) {
    const int reads = host.expressionParameterReads;
    host.Expression(code, {5});
    EXPECT_EQ(host.expressionParameterReads, reads + 1);
  }
}

}  // namespace
