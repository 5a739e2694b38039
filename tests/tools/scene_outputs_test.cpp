// Where the player's files go: an output never replaces what stands at its
// path unless that is a regular file (a link is written through, a device or
// a FIFO written to), never lands on the scene or on another output, and
// neither a failure nor a signal leaves a partial file.
#include <gtest/gtest.h>

#include <fcntl.h>
#include <signal.h>
#include <sys/stat.h>
#include <sys/sysmacros.h>
#include <unistd.h>

#include <chrono>
#include <filesystem>
#include <functional>
#include <thread>

#include "tool_run.h"

namespace {

using namespace tool_test;
namespace fs = std::filesystem;

constexpr const char* kScene = R"({"frames": 3, "objects": [{"name": "box", "x": 5, "y": 5, "width": 4, "height": 4}]})";

struct OutputCase {
  const char* name;
  // Prepares the folder; returns a descriptor to read the output from, or -1.
  std::function<int(const Folder&)> setup;
  std::vector<std::string> args;  // after the scene
  int status;
  const char* says;  // a part of standard error
  std::function<void(const Folder&, const ToolRun&, int fd)> check;
};

void PrintTo(const OutputCase& c, std::ostream* os) { *os << c.name; }

const OutputCase kOutputCases[] = {
    {"SceneUnderAnotherName", [](const Folder& f) { fs::create_hard_link(f / "scene.json", f / "other.json"); return -1; },
     {"--trace", "other.json"}, 2, "--trace other.json: this is the scene (scene.json)", nullptr},
    {"LinkToTheScene", [](const Folder& f) { fs::create_symlink("scene.json", f / "link.gif"); return -1; },
     {"--gif", "link.gif"}, 2, "this is the scene", nullptr},
    {"TwoOutputsOnOneFile", nullptr, {"--gif", "x", "--trace", "./x"}, 2, "--trace ./x: also written by --gif x", nullptr},
    // A relative link is read from the link's own folder.
    {"SymbolicLinkWrittenThrough",
     [](const Folder& f) { fs::create_directory(f / "real"); fs::create_symlink("x.jsonl", f / "real/t.jsonl"); return -1; },
     {"--trace", "real/t.jsonl"}, 0, "",
     [](const Folder& f, const ToolRun&, int) {
       EXPECT_TRUE(fs::is_symlink(f / "real/t.jsonl"));
       EXPECT_EQ(Lines(ReadFile(f / "real/x.jsonl")).size(), 3u);
     }},
    {"Fifo",
     [](const Folder& f) {
       mkfifo((f / "fifo").c_str(), 0600);
       return open((f / "fifo").c_str(), O_RDONLY | O_NONBLOCK);  // a reader, so the player's open returns
     },
     {"--trace", "fifo"}, 0, "",
     [](const Folder& f, const ToolRun&, int fd) {
       char text[4096];
       const ssize_t length = read(fd, text, sizeof text);
       EXPECT_EQ(Lines(std::string(text, length > 0 ? static_cast<std::size_t>(length) : 0)).size(), 3u);
       EXPECT_TRUE(fs::is_fifo(f / "fifo"));
     }},
    // A device made here, never the system's own: a fault could replace it.
    // Unlike a file, it may take several outputs.
    {"Device",
     [](const Folder& f) { return mknod((f / "null").c_str(), S_IFCHR | 0666, makedev(1, 3)) == 0 ? -1 : -2; },
     {"--gif", "null", "--trace", "null"}, 0, "",
     [](const Folder& f, const ToolRun&, int) { EXPECT_TRUE(fs::is_character_file(f / "null")); }},
    {"StandardOutputTwice", nullptr, {"--gif", "-", "--trace", "-"}, 2, "--trace -: standard output is already taken by --gif", nullptr},
    {"StandardOutput", nullptr, {"--trace", "-"}, 0, "-: 3 lines",
     [](const Folder&, const ToolRun& run, int) { EXPECT_EQ(Lines(run.out).size(), 3u); }},
    // The hidden temporary name must fit too.
    {"LongestName", nullptr, {"--trace", std::string(249, 'n') + ".jsonl"}, 0, "",
     [](const Folder& f, const ToolRun&, int) { EXPECT_TRUE(fs::exists(f / (std::string(249, 'n') + ".jsonl"))); }},
    // As root no permission keeps a folder from being written: a folder
    // that is a regular file does.
    {"UnwritableFolder", nullptr, {"--gif", "g.gif", "--trace", "scene.json/t.jsonl"}, 1,
     "cannot write scene.json/t.jsonl: Not a directory", nullptr},
};

class OutputPathTest : public ::testing::TestWithParam<OutputCase> {};

TEST_P(OutputPathTest, WritesWhereThePathLeadsAndLeavesNoPartialFile) {
  const OutputCase& c = GetParam();
  Folder folder;
  folder.Write("scene.json", kScene);
  const int fd = c.setup ? c.setup(folder) : -1;
  if (fd == -2) GTEST_SKIP() << "cannot make a device here";
  std::vector<std::string> args = {"scene.json"};
  args.insert(args.end(), c.args.begin(), c.args.end());
  const ToolRun run = RunPlayer(args, folder);
  EXPECT_EQ(run.status, c.status) << run.err;
  EXPECT_NE(run.err.find(c.says), std::string::npos) << run.err;
  if (c.status != 0) {
    EXPECT_EQ(Lines(run.err).size(), 1u) << run.err;
  }
  for (const std::string& name : folder.Files()) EXPECT_NE(name[0], '.') << name;
  EXPECT_EQ(ReadFile(folder / "scene.json"), kScene);
  if (c.check) c.check(folder, run, fd);
  if (fd >= 0) close(fd);
}

INSTANTIATE_TEST_SUITE_P(Paths, OutputPathTest, ::testing::ValuesIn(kOutputCases),
                         [](const auto& info) { return std::string(info.param.name); });

// The grammar's forms that are easy to get wrong: values after "=", "--"
// before an operand that starts with "-", the scene from standard input,
// and PNG names with "%%" and a width.
TEST(CommandLineTest, FollowsTheGnuForms) {
  const struct {
    std::vector<std::string> args;
    std::vector<std::string> files;  // besides the scene
  } cases[] = {
      {{"-", "--gif=in.gif", "--trace=t.jsonl"}, {"in.gif", "t.jsonl"}},
      {{"--gif", "g.gif", "--", "-s.json"}, {"-s.json", "g.gif"}},
      {{"scene.json", "--png", "f%%%3d.png", "--png-frame", "1,2"}, {"f%  1.png", "f%  2.png", "scene.gif"}},
  };
  for (const auto& c : cases) {
    Folder folder;
    folder.Write("scene.json", kScene);
    folder.Write("-s.json", kScene);
    const ToolRun run = RunPlayer(c.args, folder, "scene.json");
    EXPECT_EQ(run.status, 0) << run.err;
    std::vector<std::string> files = c.files;
    files.insert(files.end(), {"-s.json", "scene.json"});
    std::sort(files.begin(), files.end());
    files.erase(std::unique(files.begin(), files.end()), files.end());
    EXPECT_EQ(folder.Files(), files) << c.args[0];
  }
}

class InterruptedRunTest : public ::testing::TestWithParam<int> {};

TEST_P(InterruptedRunTest, LeavesNothingBehind) {
  Folder folder;
  folder.Write("long.json", R"({"frames": 100000, "canvas": {"width": 2000, "height": 2000}})");
  const pid_t pid = fork();
  if (pid == 0) {
    signal(GetParam(), SIG_DFL);  // even where the test was started with it ignored
    if (chdir(folder.path().c_str()) == 0) {
      const int null = open("/dev/null", O_WRONLY);
      dup2(null, 1);
      dup2(null, 2);
      execl(SCENE_PLAYER, SCENE_PLAYER, "long.json", "--png", "p.png", "--png-frame", "0", "--trace", "t.jsonl", nullptr);
    }
    _exit(127);
  }
  ASSERT_GT(pid, 0);
  // Interrupted once its partial files exist.
  for (int i = 0; i < 500 && folder.Files().size() < 4; ++i) std::this_thread::sleep_for(std::chrono::milliseconds(20));
  EXPECT_EQ(folder.Files().size(), 4u);  // the scene, the hidden GIF, PNG and trace
  kill(pid, GetParam());
  int status = 0;
  pid_t ended = 0;
  for (int i = 0; i < 500 && ended == 0; ++i, std::this_thread::sleep_for(std::chrono::milliseconds(20))) {
    ended = waitpid(pid, &status, WNOHANG);
  }
  if (ended == 0) kill(pid, SIGKILL);  // it ignored the signal: a failure, but no hang
  ASSERT_EQ(ended == 0 ? waitpid(pid, &status, 0) : ended, pid);
  EXPECT_TRUE(WIFSIGNALED(status) && WTERMSIG(status) == GetParam()) << status;
  EXPECT_EQ(folder.Files(), std::vector<std::string>{"long.json"});
}

INSTANTIATE_TEST_SUITE_P(Signals, InterruptedRunTest, ::testing::Values(SIGINT, SIGTERM),
                         [](const auto& info) { return std::string(info.param == SIGINT ? "Int" : "Term"); });

}  // namespace
