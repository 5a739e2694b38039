#include <gtest/gtest.h>

#include "chain_scene.h"

namespace {

TEST(ChainModel, RemovalKeepsTheOrderOfTheRest) {
  ObjectList list;
  HostObject objects[5] = {};
  for (HostObject& object : objects) list.Append(&object);
  list.RemoveAt(1);
  list.RemoveAt(2);  // was element 3
  ASSERT_EQ(list.Count(), 3u);
  EXPECT_EQ(list.At(0), &objects[0]);
  EXPECT_EQ(list.At(1), &objects[2]);
  EXPECT_EQ(list.At(2), &objects[4]);
  list.RemoveAt(2);
  list.Append(&objects[1]);
  EXPECT_EQ(list.At(2), &objects[1]);
}

TEST(ChainModel, LinksAreRegroupedWhenChainsComeAndGo) {
  ChainScene scene;
  HostObject* links[10];
  for (HostObject*& link : links) link = scene.Link(32);
  EXPECT_EQ(LinksPerChain(scene.rd), 0u);  // no chain: no link belongs anywhere

  for (int i = 0; i < 3; ++i) scene.Anchor(0, 0);
  ASSERT_EQ(LinksPerChain(scene.rd), 3u);
  EXPECT_EQ(LinkOfChain(scene.rd, 0, 1), links[0]);
  EXPECT_EQ(LinkOfChain(scene.rd, 1, 1), links[3]);
  EXPECT_EQ(LinkOfChain(scene.rd, 2, 3), links[8]);  // link 9 belongs to no chain

  scene.rd.chains->RemoveAt(0);
  ASSERT_EQ(LinksPerChain(scene.rd), 5u);
  EXPECT_EQ(LinkOfChain(scene.rd, 1, 1), links[5]);
  EXPECT_EQ(LinkOfChain(scene.rd, 1, 5), links[9]);

  for (int i = 0; i < 9; ++i) scene.Anchor(0, 0);
  EXPECT_EQ(LinksPerChain(scene.rd), 0u);  // eleven chains, ten links
}

}  // namespace
