// scene_player: plays a scene against the library, as the host would, and
// writes what happened as an animated GIF, optionally frames as PNG pictures
// and a per-frame trace.
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <iostream>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "bounded_read.h"
#include "demo_scene.h"
#include "frame_renderer.h"
#include "gif_writer.h"
#include "messages.h"
#include "options.h"
#include "output_file.h"
#include "output_paths.h"
#include "palette.h"
#include "partial_files.h"
#include "player.h"
#include "png_writer.h"
#include "scene_parser.h"
#include "shown_text.h"
#include "tool_main.h"
#include "trace_writer.h"
#include "warnings.h"

namespace {

using namespace scene_player;
using namespace tool_output;
using tool_input::Shown;

// The largest scene read: its document takes several times its text in
// memory, and no scene within the format's limits needs more.
constexpr std::size_t kMaxSceneMegabytes = 16;

struct Run {
  const Scene& scene;
  const Options& options;
  int frames;  // to play
  std::vector<PngOutput> pngs;
  Messages& messages;
};

// Throws std::runtime_error on any failure; the output files are then removed.
void Play(const Run& run) {
  const Scene& scene = run.scene;
  const Palette palette(scene);
  OutputFile gifFile(run.options.gif);
  std::optional<OutputFile> traceFile;
  if (!run.options.trace.empty()) traceFile.emplace(run.options.trace);
  std::vector<std::unique_ptr<OutputFile>> pngFiles;

  GifWriter gif(gifFile.stream(), run.options.gif, scene.width, scene.height, palette.colours(), scene.frameDelay);
  Player player(scene);
  FrameRenderer renderer(scene, palette);
  Messages& messages = run.messages;
  messages.Warn(SettingWarnings(scene, player.extension()));
  FrameWarnings frameWarnings;
  // The pictures in frame order (those of one frame in the command line's),
  // so that each frame finds its own without a look at the others.
  std::vector<const PngOutput*> pngs;
  for (const PngOutput& png : run.pngs) pngs.push_back(&png);
  std::stable_sort(pngs.begin(), pngs.end(),
                   [](const PngOutput* a, const PngOutput* b) { return a->frame < b->frame; });
  auto nextPng = pngs.begin();
  for (int frame = 0; frame < run.frames; ++frame) {
    player.PlayFrame(frame);
    messages.Warn(player.TakeWarnings());
    messages.Warn(frameWarnings.Check(scene, player, frame));
    const Picture& picture = renderer.Render(player, frame);
    gif.AddFrame(picture);
    for (; nextPng != pngs.end() && (*nextPng)->frame == frame; ++nextPng) {
      const PngOutput& png = **nextPng;
      // Written and closed at once: a run of many pictures holds no more
      // than one open, and all are named only when the run has succeeded.
      pngFiles.push_back(std::make_unique<OutputFile>(png.path));
      WritePng(pngFiles.back()->stream(), png.path, picture, palette.colours());
      pngFiles.back()->Close();
    }
    if (traceFile) WriteTraceLine(traceFile->stream(), frame, scene, player);
    messages.Progress(frame, run.frames);
  }
  messages.Warn(RuleWarnings(scene, player));
  messages.EndProgressLine();
  gif.Finish();
  gifFile.Close();
  if (traceFile) traceFile->Close();
  gifFile.Commit();
  if (traceFile) traceFile->Commit();
  for (auto& png : pngFiles) png->Commit();

  // What was written; on standard error when standard output carries a file.
  const bool toStandardOutput = run.options.gif == "-" || run.options.trace == "-" ||
                                std::any_of(run.pngs.begin(), run.pngs.end(), [](const PngOutput& png) { return png.path == "-"; });
  std::ostream& report = toStandardOutput ? std::cerr : std::cout;
  report << Shown(run.options.gif) << ": " << Counted(run.frames, "frame") << " of " << scene.width << "x"
         << scene.height << '\n';
  for (const PngOutput& png : run.pngs) report << Shown(png.path) << ": frame " << png.frame << '\n';
  if (traceFile) report << Shown(run.options.trace) << ": " << Counted(run.frames, "line") << '\n';
}

// The scene's text: the demo, a file, or standard input, read no further
// than the largest scene. Nothing, after a message, when it cannot be read.
std::optional<std::string> SceneText(const Options& options, const std::string& sceneName) {
  if (options.scene.empty()) return std::string(DemoScene());
  try {
    return tool_input::ReadBounded(options.scene, kMaxSceneMegabytes << 20);
  } catch (const tool_input::InputError& error) {
    const std::string limit = std::to_string(kMaxSceneMegabytes) + " MB";
    std::cerr << sceneName << ": "
              << (error.tooLarge() ? "larger than " + limit + "; expected a scene of at most " + limit
                                   : "cannot read: " + std::string(error.what()))
              << '\n';
    return std::nullopt;
  }
}

// The scene as an input that no output may replace; standard input only
// when it is a file.
std::vector<NamedPath> SceneInputs(const std::string& scene) {
  struct stat info {};
  if (scene == "-") {
    if (fstat(STDIN_FILENO, &info) != 0 || !S_ISREG(info.st_mode)) return {};
    return {{"the scene", "/dev/stdin"}};
  }
  if (scene.empty()) return {};
  return {{"the scene", scene}};
}

int Main(int argc, char** argv) {
  const Options options = ReadOptions(argc, argv);
  if (options.help) {
    std::cout << kUsage;
    return 0;
  }
  if (options.version) {
    std::cout << "scene_player " << TAVRIN_VERSION << '\n';
    return 0;
  }
  if (options.printDemo) {
    std::cout << DemoScene();
    return 0;
  }

  const std::string sceneName = options.scene.empty() ? "(embedded demo)" : tool_input::InputName(options.scene);
  const std::optional<std::string> text = SceneText(options, sceneName);
  if (!text) return tool_input::kBadInput;
  Scene scene;
  std::vector<std::string> readingWarnings;
  try {
    scene = ParseScene(*text, readingWarnings);
  } catch (const SceneError& error) {
    std::cerr << sceneName << ": " << error.place() << ": " << error.what() << '\n';
    return tool_input::kBadInput;
  }

  Messages messages(sceneName);
  Run run{scene, options, scene.frames, {}, messages};
  if (options.frames) {
    if (*options.frames > scene.frames) {
      throw UsageError("--frames " + std::to_string(*options.frames) + ": expected at most the scene's " +
                       Counted(scene.frames, "frame"));
    }
    run.frames = static_cast<int>(*options.frames);
  }
  run.pngs = PngOutputs(options.pngs, run.frames);
  std::vector<NamedPath> outputs = {{"--gif", options.gif}};
  if (!options.trace.empty()) outputs.push_back({"--trace", options.trace});
  for (const PngOutput& png : run.pngs) outputs.push_back({"--png", png.path});
  if (const std::string conflict = OutputConflict(SceneInputs(options.scene), outputs); !conflict.empty()) {
    throw UsageError(conflict);
  }
  WatchPartialFiles(outputs.size());

  messages.Warn(readingWarnings);
  Play(run);
  return 0;
}

}  // namespace

int main(int argc, char** argv) { return tool_input::RunToolMain("scene_player", argc, argv, &Main); }
