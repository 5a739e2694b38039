// The trace of a small scene against the pendulum worked out here, step by
// step, from the rules of the chains: degree factor 3.14159 / 180, every
// intermediate a double, every record value stored as a float, every
// coordinate truncated toward zero.
#include <gtest/gtest.h>

#include <cmath>
#include <map>
#include <nlohmann/json.hpp>

#include "player_run.h"

namespace {

using namespace player_test;
using nlohmann::json;

constexpr double kDegree = 0.017453277777777776;

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

struct Expected {
  float angle = 30.5f, speed = 0.0f, acceleration = 0.0f;
  float platformX = 0.0f, platformY = 0.0f, prevPlatformX = 0.0f, prevPlatformY = 0.0f;
  double riderX = 7.0, riderY = -3.0;
  std::map<std::string, std::pair<int32_t, int32_t>> objects;  // where each object stands
};

// One swing step of the scene's chain.
void Step(Expected& e) {
  const int links = 3;
  const double anchorX = 100.0, anchorY = 50.0, height = 32.0, spacing = 0.0, mass = 1.0;
  const double gravity = static_cast<double>(9.81f);  // the setting is stored as a float

  const double speed = static_cast<double>(e.speed) + static_cast<double>(e.acceleration);
  e.speed = static_cast<float>(speed);
  const double angle = speed + static_cast<double>(e.angle);
  e.angle = static_cast<float>(angle);
  const int32_t length = static_cast<int32_t>(std::trunc((height + spacing) * (links + 1)));
  e.acceleration = static_cast<float>(std::sin(angle * kDegree) * (-(gravity * mass) / length));
  e.prevPlatformX = e.platformX;
  e.prevPlatformY = e.platformY;
  const double theta = (static_cast<double>(e.angle) + 90.0) * kDegree;
  e.platformX = static_cast<float>(std::cos(theta) * length + anchorX);
  e.platformY = static_cast<float>(std::sin(theta) * length + anchorY);
  for (int k = 1; k <= links; ++k) {
    const double distance = (height + spacing) * static_cast<double>(static_cast<float>(k));
    e.objects["link" + std::to_string(k)] = {static_cast<int32_t>(std::cos(theta) * distance + anchorX),
                                             static_cast<int32_t>(std::sin(theta) * distance + anchorY)};
  }
  // The rule adds the platform's move, a float difference of floats. The
  // rider keeps the fractions of its moves: it is where the sum of the deltas
  // puts it, truncated once.
  e.riderX += static_cast<float>(static_cast<double>(e.platformX) - e.prevPlatformX);
  e.riderY += static_cast<float>(static_cast<double>(e.platformY) - e.prevPlatformY);
  e.objects["anchor"] = {100, 50};
  const auto at = [](double x, double y) { return std::make_pair(static_cast<int32_t>(x), static_cast<int32_t>(y)); };
  e.objects["platform"] = at(e.platformX, e.platformY);  // truncated toward zero
  e.objects["rider"] = at(e.riderX, e.riderY);
}

TEST(SceneTraceTest, ChainAndRiderFollowThePendulumFrameByFrame) {
  Folder folder;
  folder.Write("pendulum.json", kScene);
  const PlayerRun run = RunPlayer({"pendulum.json", "--trace", "pendulum.jsonl"}, folder);
  ASSERT_EQ(run.status, 0) << run.err;
  EXPECT_EQ(run.err, "");  // no progress when standard error is not a terminal

  const std::vector<std::string> lines = Lines(ReadFile(folder / "pendulum.jsonl"));
  ASSERT_EQ(lines.size(), 6u);
  Expected e;
  for (int frame = 0; frame < 6; ++frame) {
    SCOPED_TRACE("frame " + std::to_string(frame));
    Step(e);
    const json line = json::parse(lines[static_cast<std::size_t>(frame)]);
    EXPECT_EQ(line["frame"], frame);
    EXPECT_EQ(line["currentChain"], 0);
    ASSERT_EQ(line["chains"].size(), 1u);
    const json& chain = line["chains"][0];
    EXPECT_EQ(chain["anchor"], "anchor");
    EXPECT_EQ(chain["swinging"], 1);
    // Exact: the trace holds the float values themselves.
    const std::pair<const char*, float> values[] = {
        {"mass", 1.0f}, {"linkSpacing", 0.0f}, {"angle", e.angle}, {"speed", e.speed},
        {"acceleration", e.acceleration}, {"platformX", e.platformX}, {"platformY", e.platformY},
        {"prevPlatformX", e.prevPlatformX}, {"prevPlatformY", e.prevPlatformY}};
    for (const auto& [name, value] : values) EXPECT_EQ(chain[name].get<double>(), value) << name;
    ASSERT_EQ(line["objects"].size(), e.objects.size());
    for (const json& object : line["objects"]) {
      const auto position = std::make_pair(object["x"].get<int32_t>(), object["y"].get<int32_t>());
      EXPECT_EQ(position, e.objects.at(object["name"].get<std::string>())) << object["name"];
    }
  }
  EXPECT_LT(e.angle, 30.5f);  // the chain swings back towards the vertical
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
  const PlayerRun run = RunPlayer({"actions.json", "--trace", "actions.jsonl"}, folder);
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
