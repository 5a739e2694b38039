// What authors write to see a scene quickly: several PNG frames from one
// run, a repeating timeline entry in place of one entry per frame, rules
// switched on and off, and the warnings about what the library does. And the
// trace of a small scene: the pendulum's arithmetic is the chain tests' to
// check; here, what the player adds: a fractional angle reaches the library
// as a float, a rule moves a rider by the platform's DeltaX and DeltaY, which
// keeps the fractions of its moves, and actions are named by menu and
// display text.
#include <gtest/gtest.h>

#include <nlohmann/json.hpp>

#include "tool_run.h"

namespace {

using namespace tool_test;
using nlohmann::json;

// One swinging chain of two links, a rider carried by a rule that the
// timeline switches off at frame 3 and on again at frame 6 (the rule may name
// the rider, which the timeline destroys at frame 11), and `extra` timeline
// entries.
std::string Scene(const std::string& extra) {
  return R"({"frames": 12, "canvas": {"width": 200, "height": 120},
  "objects": )" + Objects({{"anchor", 100, 10, 8, 8}, {"link1", 0, 0, 4, 20}, {"link2", 0, 0, 4, 20},
                             {"platform", 0, 0, 30, 6}, {"rider", 0, 100, 6, 6}, {"box", 0, 50, 6, 6}}) + R"(,
  "timeline": [
    {"frame": 0, "do": [{"action": "Add Anchor", "params": ["anchor"]}, {"action": "Add Link", "params": ["link1"]},
      {"action": "Add Link", "params": ["link2"]}, {"action": "Add Platform", "params": ["platform"]},
      {"action": "Start All"}]},
    {"frame": 3, "do": [{"disable": "carry"}]},
    {"frame": 6, "do": [{"enable": "carry"}]}, {"frame": 11, "do": [{"destroy": "rider"}]})" +
         extra + R"(],
  "onSwing": [{"name": "carry", "chain": 0, "do": [{"move": "rider", "by": [1, 0]}]}]})";
}

TEST(SceneAuthoringTest, SeveralPngFramesOfOneRunMatchTheSameFramesOfSeparateRuns) {
  Folder folder;
  folder.Write("scene.json", Scene(""));
  const ToolRun run = RunPlayer({"scene.json", "--frames", "9", "--png", "f%02d.png", "--png-frame", "2,4-8/4",
                                   "--png", "last.png"},
                                  folder);
  ASSERT_EQ(run.status, 0) << run.err;
  for (const auto& [frame, name] : {std::pair{"2", "f02.png"}, {"4", "f04.png"}, {"8", "f08.png"}, {"8", "last.png"}}) {
    ASSERT_EQ(RunPlayer({"scene.json", "--gif", "alone.gif", "--png", "alone.png", "--png-frame", frame}, folder).status, 0);
    EXPECT_EQ(ReadFile(folder / name), ReadFile(folder / "alone.png")) << name;
  }
}

// The repeating entry sets the angle from the repetition and moves the box
// by the frame number: the same motion as one entry per frame.
TEST(SceneAuthoringTest, RepeatingEntryPlaysAsTheSameStepsWrittenFrameByFrame) {
  Folder folder;
  folder.Write("repeat.json", Scene(R"(, {"every": 3, "from": 1, "to": 10, "do": [
      {"action": "Set Angle", "params": [0, {"count": "repetition", "times": 5, "plus": 20}]},
      {"move": "box", "by": [{"count": "frame", "times": 0.5}, 1]}]})"));
  std::string entries;
  for (int frame = 1, repetition = 0; frame <= 10; frame += 3, ++repetition) {
    entries += R"(, {"frame": )" + std::to_string(frame) + R"(, "do": [{"action": "Set Angle", "params": [0, )" +
               std::to_string(20 + 5 * repetition) + R"(]}, {"move": "box", "by": [)" + std::to_string(frame * 0.5) +
               ", 1]}]}";
  }
  folder.Write("explicit.json", Scene(entries));
  ASSERT_EQ(RunPlayer({"repeat.json", "--trace", "repeat.jsonl"}, folder).status, 0);
  ASSERT_EQ(RunPlayer({"explicit.json", "--trace", "explicit.jsonl"}, folder).status, 0);
  const std::string trace = ReadFile(folder / "repeat.jsonl");
  EXPECT_EQ(trace, ReadFile(folder / "explicit.jsonl"));

  // The rider moves one pixel a swing, but not while the rule is off (frames 3 to 5).
  const std::vector<std::string> lines = Lines(trace);
  ASSERT_EQ(lines.size(), 12u);
  for (const auto& [frame, x] : {std::pair{2, 3}, {5, 3}, {10, 8}}) {
    EXPECT_EQ(json::parse(lines[frame])["objects"][4]["x"], x) << "frame " << frame;
  }
}

// Every kind of warning, each once although its cause lasts or recurs: the
// repeating entry addresses a chain that is not there at every frame. Link
// l1, added again at frame 3, is in both chains from then on. The link
// created at frame 6 under a destroyed link's name is added again. Chain 2
// lives for one frame: its rule destroys its anchor.
TEST(SceneAuthoringTest, WarnsOnceInOneLineOfWhatTheLibraryDoesAndPlaysOn) {
  Folder folder;
  folder.Write("scene.json", R"({"frames": 5, "frames": 8, "settings": {"gravity": "9.8x", "startAngle": "400"},
    "objects": )" + Objects({{"a", 10, 10, 4, 4}, {"b", 50, 10, 4, 4}, {"l1", 0, 0, 4, 10}, {"l2", 0, 0, 4, 12},
                               {"l3", 0, 0, 4, 10}, {"p", 0, 0, 4, 4}}) + R"(,
    "timeline": [{"frame": 0, "do": [{"action": "Add Anchor", "params": ["a"]}, {"action": "Add Anchor", "params": ["b"]},
      {"action": "Add Link", "params": ["l1"]}, {"action": "Add Link", "params": ["l2"]},
      {"action": "Add Link", "params": ["l3"]}, {"action": "Start All"},
      {"move": "p", "by": [{"expression": "PlatformX(", "params": [0]}, 0]}]},
      {"every": 1, "from": 0, "do": [{"action": "Stop Chain", "params": [5]}]},
      {"frame": 2, "do": [{"action": "Set Angle", "params": [1, 1e39]}]},
      {"frame": 3, "do": [{"action": "Add Link", "params": ["l1"]}]},
      {"frame": 4, "do": [{"action": "Set Speed at index %0 to %1", "params": [0, 500]}]},
      {"frame": 5, "do": [{"destroy": "l1"}, {"destroy": "l2"}, {"destroy": "l3"}]},
      {"frame": 6, "do": [{"create": {"name": "l1", "x": 0, "y": 0, "width": 4, "height": 10}},
        {"action": "Add Link", "params": ["l1"]}]},
      {"frame": 7, "do": [{"action": "Add Anchor", "params": ["p"]}, {"action": "Start Chain", "params": [2]}]}],
    "onSwing": [{"chain": 2, "do": [{"destroy": "p"}]}, {"chain": 3, "do": []}]})");
  const ToolRun run = RunPlayer({"scene.json"}, folder);
  EXPECT_EQ(run.status, 0);
  const std::vector<std::string> expected = {
      "frames: warning: the key \"frames\" is given twice in one object",
      "settings.gravity: warning: the text \"9.8x\" is not a number; the library reads the number it starts with, "
      "here 9.8",
      "settings.startAngle: warning: every chain starts 400 degrees from hanging straight down",
      "timeline[0].do[6]: warning: \"PlatformX(\" asks for platform 0, but there is no platform at that moment",
      "timeline[1].do[0]: warning: \"Stop Chain\" addresses chain 5, but there are only 2 chains (0 to 1)",
      "frame 0: warning: 3 links do not divide evenly among 2 chains",
      "frame 0: warning: links of differing heights (10 and 12)",
      "frame 2: warning: chain 1 holds a value that is no longer finite (inf)",
      "frame 3: warning: link \"l2\" went from the chain of anchor \"b\" to the chain of anchor \"a\"",
      "frame 4: warning: chain 0 turns 499.798 degrees in one frame, more than a full turn",
      "frame 5: warning: a chain swings with no links at all",
      "frame 6: warning: 1 link does not divide evenly among 2 chains",
      "onSwing[1].chain: warning: the rule is for chain 3, but the scene never had more than 3 chains"};
  const std::vector<std::string> lines = Lines(run.err);
  ASSERT_EQ(lines.size(), expected.size()) << run.err;
  for (std::size_t i = 0; i < lines.size(); ++i) {
    EXPECT_EQ(lines[i].substr(0, expected[i].size() + 12), "scene.json: " + expected[i]);
  }
}

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
    const json& objects = line["objects"];  // as declared: the platform at 4, the rider at 5
    EXPECT_EQ(objects[4]["x"], static_cast<int32_t>(x));
    EXPECT_EQ(objects[5]["x"], static_cast<int32_t>(riderX));
    EXPECT_EQ(objects[5]["y"], static_cast<int32_t>(riderY));
  }
  EXPECT_LT(json::parse(lines[5])["chains"][0]["angle"], 30.5);  // it swings back towards the vertical
}

}  // namespace
