// A scene with a fault: the player says, in one line, which file, where in it
// and what was expected, ends with status 2 and leaves no output file behind.
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "player_run.h"

namespace {

using namespace player_test;

struct BadScene {
  const char* name;
  std::string text;
  std::string place;    // the place the message names
  std::string message;  // a part of what it says there
};

void PrintTo(const BadScene& scene, std::ostream* os) { *os << scene.name; }

// A chain of one link; `timeline` and `extra` complete the scene.
std::string Scene(const std::string& timeline, const std::string& extra = "") {
  return R"({
  "frames": 10,
  "objects": [
    {"name": "anchor", "x": 100, "y": 40, "width": 16, "height": 16},
    {"name": "link", "x": 100, "y": 60, "width": 6, "height": 20},
    {"name": "platform", "x": 100, "y": 80, "width": 40, "height": 10}
  ],
  "timeline": )" + timeline + extra + "\n}\n";
}

std::string ManyColours() {
  std::string objects;
  for (int i = 0; i < 200; ++i) {
    char colour[8];
    std::snprintf(colour, sizeof colour, "#%02x%02x10", i, 255 - i);
    objects += std::string(i ? "," : "") + R"({"name": "o)" + std::to_string(i) +
               R"(", "x": 0, "y": 0, "width": 1, "height": 1, "colour": ")" + colour + "\"}";
  }
  return R"({"frames": 1, "objects": [)" + objects + "]}";
}

const std::vector<BadScene> kBadScenes = {
    {"NotJson", "{\n  \"frames\": 3,,\n}\n", "line 2, column 15", "not JSON: syntax error"},
    {"UnknownAction",
     Scene(R"([{"frame": 0, "do": []}, {"frame": 1, "do": []}, {"frame": 2, "do": []},
               {"frame": 3, "do": [{"action": "Start All"}, {"action": "Strat Chain", "params": [0]}]}])"),
     "timeline[3].do[1]", "unknown action \"Strat Chain\"; expected an action's menu text"},
    {"ObjectUsedBeforeItExists",
     Scene(R"([{"frame": 5, "do": [{"create": {"name": "late", "x": 0, "y": 0, "width": 4, "height": 4}}]},
               {"frame": 2, "do": [{"action": "Add Link", "params": ["late"]}]}])"),
     "timeline[1].do[0].params[0]", "object \"late\" is used before it exists; it is created at timeline[0].do[0]"},
    {"ObjectUsedAfterItWasDestroyed",
     Scene(R"([{"frame": 1, "do": [{"destroy": "link"}]}, {"frame": 4, "do": [{"move": "link", "by": [1, 1]}]}])"),
     "timeline[1].do[0].move", "object \"link\" no longer exists: timeline[0].do[0] destroyed it"},
    {"ObjectNamedNowhere", Scene(R"([{"frame": 0, "do": [{"action": "Add Anchor", "params": ["ankor"]}]}])"),
     "timeline[0].do[0].params[0]", "no object named \"ankor\""},
    {"TooFewParameters", Scene(R"([{"frame": 0, "do": [{"action": "Set Angle", "params": [0]}]}])"),
     "timeline[0].do[0].params", "\"Set Angle\" takes 2 parameters (Chain Index, Angle), found 1"},
    {"MissingParameters", Scene(R"([{"frame": 0, "do": [{"action": "Start Chain at index %0"}]}])"),
     "timeline[0].do[0]", "missing \"params\": \"Start Chain\" takes 1 parameter (Chain Index)"},
    {"TextForChainIndex", Scene(R"([{"frame": 0, "do": [{"action": "Start Chain", "params": ["first"]}]}])"),
     "timeline[0].do[0].params[0]", "expected an integer, or an expression"},
    {"FractionForChainIndex", Scene(R"([{"frame": 0, "do": [{"action": "Stop Chain", "params": [0.5]}]}])"),
     "timeline[0].do[0].params[0]", "expected an integer, a whole number from -2147483648 to 2147483647, found 0.5"},
    {"NumberForObject", Scene(R"([{"frame": 0, "do": [{"action": "Add Anchor", "params": [3]}]}])"),
     "timeline[0].do[0].params[0]", "expected an object's name, found 3"},
    {"NegativeFrameCount", R"({"frames": -5})", "frames",
     "expected the number of frames to play, a whole number from 1 to 100000, found -5"},
    {"NoFrameCount", R"({"objects": []})", "top level", "missing \"frames\""},
    {"FrameAfterTheLast", Scene(R"([{"frame": 10, "do": []}])"), "timeline[0].frame",
     "a whole number from 0 to 9, found 10"},
    {"UnknownKey", Scene("[]", R"(, "onswing": [])"), "top level", "unknown key \"onswing\"; expected one of"},
    {"UnknownExpression",
     Scene(R"([{"frame": 0, "do": [{"move": "link", "by": [{"expression": "DeltaZ(", "params": [0]}, 0]}]}])"),
     "timeline[0].do[0].by[0]", "unknown expression \"DeltaZ(\""},
    {"ExpressionParameterCount",
     Scene(R"([{"frame": 0, "do": [{"move": "link", "to": [{"expression": "LinkX(", "params": [0]}, 0]}]}])"),
     "timeline[0].do[0].to[0].params", "\"LinkX(\" takes 2 parameters, found 1"},
    {"CreateInsideARule", Scene("[]", R"(, "onSwing": [{"chain": 0, "do": [{"create": {"name": "x"}}]}])"),
     "onSwing[0].do[0]", "cannot create an object"},
    {"SettingTooLong", Scene("[]", R"(, "settings": {"gravity": "9.8100000001"})"), "settings.gravity",
     "a text of at most 9 characters"},
    {"SettingAsNumber", Scene("[]", R"(, "settings": {"mass": 2})"), "settings.mass",
     "a text of at most 9 characters, found 2"},
    {"NameTaken", Scene(R"([{"frame": 3, "do": [{"create": {"name": "link", "x": 0, "y": 0, "width": 1, "height": 1}}]}])"),
     "timeline[0].do[0].create.name", "the name \"link\" is already taken by objects[1]"},
    {"BadColour", Scene("[]", R"(, "canvas": {"background": "blue"})"), "canvas.background",
     "expected a colour written \"#rrggbb\""},
    {"TooManyColours", ManyColours(), "objects", "expected at most 256"},
};

class BadSceneTest : public ::testing::TestWithParam<BadScene> {};

TEST_P(BadSceneTest, NamesFilePlaceAndExpectationLeavingNoFile) {
  const BadScene& bad = GetParam();
  Folder folder;
  folder.Write("scene.json", bad.text);
  const PlayerRun run = RunPlayer({"scene.json", "--gif", "out.gif", "--png", "out.png", "--trace", "out.jsonl"}, folder);

  EXPECT_EQ(run.status, 2);
  const std::vector<std::string> lines = Lines(run.err);
  ASSERT_EQ(lines.size(), 1u) << run.err;
  const std::string prefix = "scene.json: " + bad.place + ": ";
  EXPECT_EQ(lines[0].substr(0, prefix.size()), prefix) << lines[0];
  EXPECT_NE(lines[0].find(bad.message), std::string::npos) << lines[0];
  EXPECT_EQ(run.out, "");
  EXPECT_EQ(folder.Files(), std::vector<std::string>{"scene.json"});
}

INSTANTIATE_TEST_SUITE_P(Scenes, BadSceneTest, ::testing::ValuesIn(kBadScenes),
                         [](const auto& info) { return std::string(info.param.name); });

TEST(SceneFileTest, MissingFileIsBadInput) {
  Folder folder;
  const PlayerRun run = RunPlayer({"absent.json"}, folder);
  EXPECT_EQ(run.status, 2);
  EXPECT_EQ(run.err, "absent.json: cannot read: No such file or directory\n");
  EXPECT_TRUE(folder.Files().empty());
}

TEST(SceneFileTest, PngFrameOutsideTheSceneIsBadInput) {
  Folder folder;
  folder.Write("scene.json", R"({"frames": 3})");
  const PlayerRun run = RunPlayer({"scene.json", "--png", "x.png", "--png-frame", "3"}, folder);
  EXPECT_EQ(run.status, 2);
  EXPECT_EQ(run.err, "scene_player: --png-frame 3: expected a frame from 0 to 2\n");
  EXPECT_EQ(folder.Files(), std::vector<std::string>{"scene.json"});
}

// The GIF is begun before the trace fails to open: it must go too.
TEST(SceneFileTest, FailedOutputRemovesTheOthers) {
  Folder folder;
  folder.Write("scene.json", R"({"frames": 3})");
  const PlayerRun run = RunPlayer({"scene.json", "--gif", "out.gif", "--trace", "missing/out.jsonl"}, folder);
  EXPECT_EQ(run.status, 1);
  EXPECT_NE(run.err.find("cannot write missing/out.jsonl"), std::string::npos) << run.err;
  EXPECT_EQ(folder.Files(), std::vector<std::string>{"scene.json"});
}

}  // namespace
