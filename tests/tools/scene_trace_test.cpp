// The trace of a small scene. The pendulum's arithmetic is the chain tests'
// to check; here, what the player adds: a fractional angle reaches the
// library as a float, a rule moves a rider by the platform's DeltaX and
// DeltaY, which keeps the fractions of its moves, the links are added by
// menu and display text, and every object is traced where it stands.
#include <gtest/gtest.h>

#include <cmath>
#include <map>
#include <nlohmann/json.hpp>

#include "tool_run.h"

namespace {

using namespace tool_test;
using nlohmann::json;

// One anchor at (100, 50), three links 32 high, one platform, a rider that an
// "On Swing" rule moves by the platform's DeltaX and DeltaY. The angle is set
// to a fraction, so it only survives if it reaches the library as a float.
constexpr const char* kScene = R"({
  "settings": {"startAngle": "90", "mass": "1", "gravity": "9.81", "linkSpacing": "0"},
  "frames": 6,
  "objects": [
    {"name": "anchor", "x": 100, "y": 50, "width": 16, "height": 16},
    {"name": "link1", "x": 0, "y": 0, "width": 8, "height": 32},
    {"name": "link2", "x": 0, "y": 0, "width": 8, "height": 32},
    {"name": "link3", "x": 0, "y": 0, "width": 8, "height": 32},
    {"name": "platform", "x": 0, "y": 0, "width": 40, "height": 10},
    {"name": "rider", "x": 7, "y": -3, "width": 10, "height": 20}],
  "timeline": [{"frame": 0, "do": [
    {"action": "Add Anchor", "params": ["anchor"]}, {"action": "Add Link", "params": ["link1"]},
    {"action": "Add Link  %0", "params": ["link2"]}, {"action": "Add Link", "params": ["link3"]},
    {"action": "Add Platform", "params": ["platform"]}, {"action": "Set Angle", "params": [0, 30.5]},
    {"action": "Start Chain", "params": [0]}]}],
  "onSwing": [{"chain": 0, "do": [{"move": "rider", "by": [
    {"expression": "DeltaX(", "params": [0]}, {"expression": "DeltaY(", "params": [0]}]}]}]
})";

TEST(SceneTraceTest, RiderFollowsThePlatformOfAChainOfThreeLinks) {
  Folder folder;
  folder.Write("pendulum.json", kScene);
  const ToolRun run = RunPlayer({"pendulum.json", "--trace", "pendulum.jsonl"}, folder);
  ASSERT_EQ(run.status, 0) << run.err;
  EXPECT_EQ(run.err, "");  // no progress when standard error is not a terminal

  const std::vector<std::string> lines = Lines(ReadFile(folder / "pendulum.jsonl"));
  ASSERT_EQ(lines.size(), 6u);
  EXPECT_EQ(json::parse(lines[0])["chains"][0]["angle"], 30.5);  // a resting chain's first step keeps it
  double riderX = 7.0, riderY = -3.0;
  float previousX = 0.0f, previousY = 0.0f;
  for (int frame = 0; frame < 6; ++frame) {
    SCOPED_TRACE("frame " + std::to_string(frame));
    const json line = json::parse(lines[static_cast<std::size_t>(frame)]);
    EXPECT_EQ(line["frame"], frame);
    EXPECT_EQ(line["currentChain"], 0);
    ASSERT_EQ(line["chains"].size(), 1u);
    const json& chain = line["chains"][0];
    EXPECT_EQ(chain["anchor"], "anchor");
    EXPECT_EQ(chain["swinging"], 1);
    EXPECT_EQ(chain["prevPlatformX"].get<float>(), previousX);
    EXPECT_EQ(chain["prevPlatformY"].get<float>(), previousY);
    const float x = chain["platformX"].get<float>(), y = chain["platformY"].get<float>();
    EXPECT_NEAR(std::hypot(x - 100.0, y - 50.0), 32.0 * 4, 1e-3);  // three links and one step more
    // The rule adds the platform's move, a float difference of floats.
    riderX += static_cast<float>(static_cast<double>(x) - previousX);
    riderY += static_cast<float>(static_cast<double>(y) - previousY);
    previousX = x;
    previousY = y;
    const std::map<std::string, std::pair<int32_t, int32_t>> expected = {
        {"anchor", {100, 50}},
        {"platform", {static_cast<int32_t>(x), static_cast<int32_t>(y)}},
        {"rider", {static_cast<int32_t>(riderX), static_cast<int32_t>(riderY)}}};
    for (const json& object : line["objects"]) {
      const auto it = expected.find(object["name"].get<std::string>());
      if (it == expected.end()) continue;
      EXPECT_EQ(std::make_pair(object["x"].get<int32_t>(), object["y"].get<int32_t>()), it->second) << it->first;
    }
  }
  EXPECT_LT(json::parse(lines[5])["chains"][0]["angle"], 30.5);  // it swings back towards the vertical
}

// Actions named by menu or display text reach the routines they name: each
// value lands where its action puts it, the second chain alone swings, and
// only chain 0's objects are turned by "Update Chain" (to 90 - 45.75 degrees:
// 3 of 32 steps; chain 1's, at angle 0, would face 8).
TEST(SceneTraceTest, ActionsReachTheRoutinesTheyName) {
  Folder folder;
  folder.Write("actions.json", R"({"frames": 1, "objects": [
    {"name": "anchor", "x": 0, "y": 0, "width": 16, "height": 16},
    {"name": "anchor2", "x": 300, "y": 0, "width": 16, "height": 16},
    {"name": "link", "x": 0, "y": 0, "width": 8, "height": 10},
    {"name": "link2", "x": 0, "y": 0, "width": 8, "height": 10},
    {"name": "platform", "x": 0, "y": 0, "width": 40, "height": 10}],
  "timeline": [{"frame": 0, "do": [
    {"action": "Add Anchor", "params": ["anchor"]}, {"action": "Add Anchor", "params": ["anchor2"]},
    {"action": "Add Link", "params": ["link"]}, {"action": "Add Link", "params": ["link2"]},
    {"action": "Add Platform", "params": ["platform"]}, {"action": "Set Anchor X", "params": [0, 150]},
    {"action": "Set Anchor Y", "params": [0, 120]}, {"action": "Set Mass", "params": [0, 2.5]},
    {"action": "Set Speed at index %0 to %1", "params": [0, 0.5]}, {"action": "Set Link Spacing", "params": [0, 1.5]},
    {"action": "Set Acceleration", "params": [0, 0.25]}, {"action": "Set Angle at index %0 to %1", "params": [0, 45]},
    {"action": "Set Angle", "params": [1, 0]}, {"action": "Start All"},
    {"action": "Stop Chain", "params": [0]}, {"action": "Update Chain", "params": [0]}]}]})");
  const ToolRun run = RunPlayer({"actions.json", "--trace", "actions.jsonl"}, folder);
  ASSERT_EQ(run.status, 0) << run.err;
  const json line = json::parse(ReadFile(folder / "actions.jsonl"));
  EXPECT_EQ(line["currentChain"], 1);
  const json& chain = line["chains"].at(0);
  EXPECT_EQ(chain["swinging"], 0);
  EXPECT_EQ(line["chains"].at(1)["swinging"], 1);
  const std::pair<const char*, double> values[] = {
      {"mass", 2.5}, {"linkSpacing", 1.5}, {"speed", 0.75}, {"angle", 45.75}};
  for (const auto& [name, value] : values) EXPECT_EQ(chain[name].get<double>(), value) << name;
  const json& objects = line["objects"];  // anchor, anchor2, link, link2, platform
  EXPECT_EQ(objects.at(0)["x"], 150);
  EXPECT_EQ(objects.at(0)["y"], 120);
  const int directions[] = {0, 0, 3, 0, 3};
  for (int i = 0; i < 5; ++i) EXPECT_EQ(objects.at(i)["direction"], directions[i]) << objects.at(i)["name"];
}

}  // namespace
