// The trace of a small scene. The pendulum's arithmetic is the chain tests'
// to check; here, what the player adds: a fractional angle reaches the
// library as a float, a rule moves a rider by the platform's DeltaX and
// DeltaY, which keeps the fractions of its moves, actions are named by menu
// and display text, and every object is traced where it stands.
#include <gtest/gtest.h>

#include <map>
#include <nlohmann/json.hpp>

#include "tool_run.h"

namespace {

using namespace tool_test;
using nlohmann::json;

// One anchor at (100, 50), three links 32 high, one platform, a rider that an
// "On Swing" rule moves by the platform's DeltaX and DeltaY. The angle is set
// to a fraction, so it only survives if it reaches the library as a float.
const std::string kScene = R"({
  "settings": {"startAngle": "90", "mass": "1", "gravity": "9.81", "linkSpacing": "0"},
  "frames": 6,
  "objects": )" + Objects({{"anchor", 100, 50, 16, 16}, {"link1", 0, 0, 8, 32}, {"link2", 0, 0, 8, 32},
                             {"link3", 0, 0, 8, 32}, {"platform", 0, 0, 40, 10}, {"rider", 7, -3, 10, 20}}) + R"(,
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
    const json& chain = line["chains"].at(0);
    const float x = chain["platformX"].get<float>(), y = chain["platformY"].get<float>();
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

}  // namespace
