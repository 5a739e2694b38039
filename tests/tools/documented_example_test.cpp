// The complete example of docs/scene-format.md plays as the text says.
#include <gtest/gtest.h>

#include <nlohmann/json.hpp>

#include "player_run.h"

namespace {

using namespace player_test;
using nlohmann::json;

std::string DocumentedExample() {
  const std::string doc = ReadFile(SCENE_FORMAT_DOC);
  const auto section = doc.find("## A complete example");
  const auto start = doc.find("```json\n", section);
  if (section == std::string::npos || start == std::string::npos) return {};
  const auto end = doc.find("```", start + 8);
  return doc.substr(start + 8, end - start - 8);
}

TEST(DocumentedExampleTest, PlaysAndStopsWhenItsAnchorIsDestroyed) {
  Folder folder;
  folder.Write("example.json", DocumentedExample());
  const PlayerRun run = RunPlayer({"example.json", "--trace", "example.jsonl"}, folder);
  ASSERT_EQ(run.status, 0) << run.err;
  EXPECT_EQ(folder.Files(), (std::vector<std::string>{"example.gif", "example.json", "example.jsonl"}));

  const std::vector<std::string> lines = Lines(ReadFile(folder / "example.jsonl"));
  ASSERT_EQ(lines.size(), 200u);
  EXPECT_EQ(json::parse(lines[159])["chains"].size(), 1u);
  // Destroyed at frame 160: the chain leaves with its anchor, and nothing moves after.
  const json atDestruction = json::parse(lines[160]);
  EXPECT_TRUE(atDestruction["chains"].empty());
  EXPECT_EQ(atDestruction["objects"].size(), 5u);
  EXPECT_EQ(json::parse(lines[199])["objects"], atDestruction["objects"]);
}

}  // namespace
