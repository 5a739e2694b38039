// The trace of a small scene against the pendulum worked out here, step by
// step, from the rules of the chains: degree factor 3.14159 / 180, every
// intermediate a double, every record value stored as a float, every
// coordinate truncated toward zero.
#include <gtest/gtest.h>

#include <cmath>
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
    {"name": "rider", "x": 7, "y": -3, "width": 10, "height": 20}
  ],
  "timeline": [
    {"frame": 0, "do": [
      {"action": "Add Anchor", "params": ["anchor"]},
      {"action": "Add Link", "params": ["link1"]},
      {"action": "Add Link  %0", "params": ["link2"]},
      {"action": "Add Link", "params": ["link3"]},
      {"action": "Add Platform", "params": ["platform"]},
      {"action": "Set Angle", "params": [0, 30.5]},
      {"action": "Start Chain", "params": [0]}
    ]}
  ],
  "onSwing": [
    {"chain": 0, "do": [{"move": "rider", "by": [
      {"expression": "DeltaX(", "params": [0]}, {"expression": "DeltaY(", "params": [0]}]}]}
  ]
})";

struct Expected {
  float angle = 30.5f, speed = 0.0f, acceleration = 0.0f;
  float platformX = 0.0f, platformY = 0.0f, prevPlatformX = 0.0f, prevPlatformY = 0.0f;
  int32_t linkX[3] = {}, linkY[3] = {};
  double riderX = 7.0, riderY = -3.0;
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
    e.linkX[k - 1] = static_cast<int32_t>(std::trunc(std::cos(theta) * distance + anchorX));
    e.linkY[k - 1] = static_cast<int32_t>(std::trunc(std::sin(theta) * distance + anchorY));
  }
  // The rule adds the platform's move, a float difference of floats.
  e.riderX += static_cast<float>(static_cast<double>(e.platformX) - e.prevPlatformX);
  e.riderY += static_cast<float>(static_cast<double>(e.platformY) - e.prevPlatformY);
}

const json& ObjectNamed(const json& line, const std::string& name) {
  for (const json& object : line["objects"]) {
    if (object["name"] == name) return object;
  }
  throw std::runtime_error("no object " + name + " in the trace");
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
    EXPECT_EQ(chain["mass"].get<double>(), 1.0);
    EXPECT_EQ(chain["linkSpacing"].get<double>(), 0.0);
    // Exact: the trace holds the float values themselves.
    EXPECT_EQ(chain["angle"].get<double>(), e.angle);
    EXPECT_EQ(chain["speed"].get<double>(), e.speed);
    EXPECT_EQ(chain["acceleration"].get<double>(), e.acceleration);
    EXPECT_EQ(chain["platformX"].get<double>(), e.platformX);
    EXPECT_EQ(chain["platformY"].get<double>(), e.platformY);
    EXPECT_EQ(chain["prevPlatformX"].get<double>(), e.prevPlatformX);
    EXPECT_EQ(chain["prevPlatformY"].get<double>(), e.prevPlatformY);
    for (int k = 0; k < 3; ++k) {
      const json& link = ObjectNamed(line, "link" + std::to_string(k + 1));
      EXPECT_EQ(link["x"], e.linkX[k]) << "link " << k + 1;
      EXPECT_EQ(link["y"], e.linkY[k]) << "link " << k + 1;
    }
    const json& platform = ObjectNamed(line, "platform");
    EXPECT_EQ(platform["x"], static_cast<int32_t>(std::trunc(e.platformX)));
    EXPECT_EQ(platform["y"], static_cast<int32_t>(std::trunc(e.platformY)));
    // The rider keeps the fractions of its moves: it is where the sum of the
    // deltas puts it, truncated once.
    const json& rider = ObjectNamed(line, "rider");
    EXPECT_EQ(rider["x"], static_cast<int32_t>(std::trunc(e.riderX)));
    EXPECT_EQ(rider["y"], static_cast<int32_t>(std::trunc(e.riderY)));
    EXPECT_EQ(ObjectNamed(line, "anchor")["x"], 100);
  }
  // The chain swings back from 30.5 degrees towards the vertical.
  EXPECT_LT(e.angle, 30.5f);
}

// The swing step does not turn objects; an update does, by the chain's angle.
TEST(SceneTraceTest, UpdateChainTurnsLinksAndPlatform) {
  Folder folder;
  folder.Write("update.json", R"({
    "frames": 1,
    "objects": [
      {"name": "anchor", "x": 100, "y": 100, "width": 16, "height": 16},
      {"name": "link", "x": 0, "y": 0, "width": 8, "height": 10},
      {"name": "platform", "x": 0, "y": 0, "width": 40, "height": 10}
    ],
    "timeline": [{"frame": 0, "do": [
      {"action": "Add Anchor", "params": ["anchor"]},
      {"action": "Add Link", "params": ["link"]},
      {"action": "Add Platform", "params": ["platform"]},
      {"action": "Set Angle at index %0 to %1", "params": [0, 45]},
      {"action": "Update Chain", "params": [0]}
    ]}]
  })");
  const PlayerRun run = RunPlayer({"update.json", "--trace", "update.jsonl"}, folder);
  ASSERT_EQ(run.status, 0) << run.err;
  const json line = json::parse(Lines(ReadFile(folder / "update.jsonl")).at(0));
  // 90 - 45 = 45 degrees; 45 * 32 / 360 = 4 direction steps.
  EXPECT_EQ(ObjectNamed(line, "link")["direction"], 4);
  EXPECT_EQ(ObjectNamed(line, "platform")["direction"], 4);
  EXPECT_EQ(ObjectNamed(line, "anchor")["direction"], 0);
  EXPECT_EQ(line["chains"][0]["swinging"], 0);
  EXPECT_EQ(line["currentChain"], -1);  // an update raises no "On Swing"
}

}  // namespace
