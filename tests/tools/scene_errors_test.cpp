// Bad input: the player says, in one line, which file, where in it and what
// was expected, ends with status 2 (1 when an output cannot be written) and
// leaves no output file behind.
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "tool_run.h"

namespace {

using namespace tool_test;

struct BadInput {
  const char* name;
  std::string scene;  // written to scene.json unless empty
  std::string start;  // what the one line starts with, after "scene.json: " for a scene
  std::string part;   // a part of what it says
  std::vector<std::string> args = {"scene.json", "--gif", "out.gif", "--png", "out.png", "--trace", "out.jsonl"};
  int status = 2;
};

void PrintTo(const BadInput& input, std::ostream* os) { *os << input.name; }

// A chain of one link; `timeline` and `extra` complete the scene.
std::string Scene(const std::string& timeline, const std::string& extra = "") {
  return R"({"frames": 10, "objects": )" + Objects({{"anchor", 100, 40, 16, 16}, {"link", 100, 60, 6, 20}}) +
         R"(, "timeline": )" + timeline + extra + "}";
}
std::string Do(const std::string& actions) { return Scene(R"([{"frame": 0, "do": [)" + actions + "]}]"); }

const BadInput kBadInputs[] = {
    {"NotJson", "{\n  \"frames\": 3,,\n}\n", "line 2, column 15", "not JSON: syntax error"},
    {"UnknownAction", Scene(R"([{"frame": 0, "do": []}, {"frame": 3, "do": [{"action": "Start All"},
                                {"action": "Strat Chain", "params": [0]}]}])"),
     "timeline[1].do[1]", "unknown action \"Strat Chain\"; expected an action's menu text"},
    {"ObjectUsedAfterItWasDestroyed",
     Scene(R"([{"frame": 1, "do": [{"destroy": "link"}]}, {"frame": 4, "do": [{"move": "link", "by": [1, 1]}]}])"),
     "timeline[1].do[0].move", "object \"link\" no longer exists: timeline[0].do[0] destroyed it"},
    {"TooFewParameters", Do(R"({"action": "Set Angle", "params": [0]})"), "timeline[0].do[0].params",
     "\"Set Angle\" takes 2 parameters (Chain Index, Angle), found 1"},
    {"FractionForChainIndex", Do(R"({"action": "Stop Chain", "params": [0.5]})"), "timeline[0].do[0].params[0]",
     "expected an integer, a whole number from -2147483648 to 2147483647, found 0.5"},
    {"FrameAfterTheLast", Scene(R"([{"frame": 10, "do": []}])"), "timeline[0].frame", "from 0 to 9, found 10"},
    {"SettingTooLong", Scene("[]", R"(, "settings": {"gravity": "9.8100000001"})"), "settings.gravity",
     "a text of at most 9 characters"},
    {"NameTaken", Do(R"({"create": {"name": "link", "x": 0, "y": 0, "width": 1, "height": 1}})"),
     "timeline[0].do[0].create.name", "the name \"link\" is already taken by objects[1]"},
    {"MissingFile", "", "absent.json: cannot read: No such file or directory", "", {"absent.json"}},
    {"NumberBeyondADouble", "{\"frames\": 1e400}", "line 1, column 12", "the number 1e400 is out of range"},
    {"RepeatingEntryCreates", Scene(R"([{"every": 2, "from": 0, "do": [{"create": {"name": "x"}}]}])"),
     "timeline[0].do[0]", "a repeating entry runs many times, so it cannot create an object"},
    {"FrameAndEveryInOneEntry", Scene(R"([{"frame": 1, "every": 2, "do": []}])"), "timeline[0]",
     "expected either \"frame\" for steps that run once, or \"every\""},
    {"SeveralFramesForOneName", R"({"frames": 3})", "scene_player: --png a.png: 2 frames for one file name", "",
     {"scene.json", "--png", "a.png", "--png-frame", "0,2"}},
    {"MoreFramesThanTheScene", R"({"frames": 3})", "scene_player: --frames 4: expected at most", "",
     {"scene.json", "--frames", "4"}},
    // The command line: one line naming the problem, never the usage.
    {"UnknownOption", R"({"frames": 3})", "scene_player: unknown option --colour (scene_player --help", "",
     {"scene.json", "--colour=red"}},
    {"RepeatedOption", R"({"frames": 3})", "scene_player: --gif given twice (a.gif, then b.gif)", "",
     {"scene.json", "--gif", "a.gif", "--gif=b.gif"}},
    {"EmptyFileName", R"({"frames": 3})", "scene_player: --gif needs a value, found an empty text", "",
     {"scene.json", "--gif", ""}},
    {"OptionTakenForAValue", R"({"frames": 3})", "scene_player: --trace needs a value", "",
     {"scene.json", "--trace", "--frames", "2"}},
    {"ValueForAFlag", "", "scene_player: --print-demo takes no value", "", {"--print-demo=yes"}},
    {"PrintDemoWithAnOutput", "", "scene_player: --print-demo prints the demo scene and plays nothing", "",
     {"--print-demo", "--gif", "x.gif"}},
    {"FrameListedTwice", R"({"frames": 9})", "scene_player: --png-frame 0-4/2,4: frame 4 is listed twice", "",
     {"scene.json", "--png", "f%d.png", "--png-frame", "0-4/2,4"}},
    {"PercentThatIsNoField", R"({"frames": 3})", "scene_player: --png 100%.png: a % that is no frame number", "",
     {"scene.json", "--png", "100%.png"}},
    {"BadBytesShownEscaped", "", "scene_player: unknown option --\\xFF\\x01", "", {"--\xff\x01"}},
    {"DeviceThatNeverEnds", "", "/dev/zero: larger than 16 MB", "", {"/dev/zero"}},
    {"Folder", "", ".: cannot read: Is a directory", "", {"."}},
    // The GIF is begun before the trace fails to open: it must go too.
    {"OutputCannotBeWritten", R"({"frames": 3})", "scene_player: ", "cannot write missing/out.jsonl",
     {"scene.json", "--gif", "out.gif", "--trace", "missing/out.jsonl"}, 1},
};

class BadInputTest : public ::testing::TestWithParam<BadInput> {};

TEST_P(BadInputTest, SaysWhereAndWhatInOneLineAndLeavesNoFile) {
  const BadInput& bad = GetParam();
  Folder folder;
  if (!bad.scene.empty()) folder.Write("scene.json", bad.scene);
  const ToolRun run = RunPlayer(bad.args, folder);

  EXPECT_EQ(run.status, bad.status);
  const std::vector<std::string> lines = Lines(run.err);
  ASSERT_EQ(lines.size(), 1u) << run.err;
  const bool scene = bad.start.find(": ") == std::string::npos;
  const std::string start = scene ? "scene.json: " + bad.start + ": " : bad.start;
  EXPECT_EQ(lines[0].substr(0, start.size()), start) << lines[0];
  EXPECT_NE(lines[0].find(bad.part), std::string::npos) << lines[0];
  EXPECT_EQ(run.out, "");
  EXPECT_EQ(folder.Files(), bad.scene.empty() ? std::vector<std::string>{} : std::vector<std::string>{"scene.json"});
}

INSTANTIATE_TEST_SUITE_P(Inputs, BadInputTest, ::testing::ValuesIn(kBadInputs),
                         [](const auto& info) { return std::string(info.param.name); });

}  // namespace
