// scene_player: plays a scene against the library, as the host would, and
// writes what happened as an animated GIF, optionally frames as PNG pictures
// and a per-frame trace.
#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <cstring>
#include <iostream>
#include <memory>
#include <optional>
#include <string>
#include <unistd.h>
#include <vector>

#include "demo_scene.h"
#include "frame_renderer.h"
#include "gif_writer.h"
#include "options.h"
#include "output_file.h"
#include "output_paths.h"
#include "palette.h"
#include "partial_files.h"
#include "player.h"
#include "png_writer.h"
#include "scene_parser.h"
#include "trace_writer.h"
#include "warnings.h"

namespace {

using namespace scene_player;
using namespace tool_output;

// Exit statuses: 0 played and written; 1 a failure while playing or
// writing; 2 bad input (the command line or the scene).
constexpr int kFailed = 1;
constexpr int kBadInput = 2;

// False, with errno set, when the file cannot be read whole.
bool ReadFile(const std::string& path, std::string& text) {
  std::FILE* file = std::fopen(path.c_str(), "rb");
  if (file == nullptr) return false;
  char buffer[65536];
  std::size_t count;
  while ((count = std::fread(buffer, 1, sizeof buffer, file)) > 0) text.append(buffer, count);
  const bool failed = std::ferror(file) != 0;
  const int error = errno;
  std::fclose(file);
  errno = error;
  return !failed;
}

// Standard error, shared by the progress line and the warnings: a warning
// starts on a line of its own.
class Messages {
 public:
  Messages(std::string sceneName, int frames)
      : sceneName_(std::move(sceneName)), frames_(frames), progress_(isatty(STDERR_FILENO) == 1) {}
  // Also when a failure ends the run: its message starts on a line of its own.
  ~Messages() { EndProgressLine(); }
  Messages(const Messages&) = delete;
  Messages& operator=(const Messages&) = delete;

  // "PLACE: message" becomes "SCENE: PLACE: warning: message"; a text
  // without a place is "SCENE: warning: text".
  void Warn(const std::string& text) {
    EndProgressLine();
    const std::size_t split = text.find(": ");
    const std::string place = split == std::string::npos ? "" : text.substr(0, split + 2);
    std::cerr << sceneName_ << ": " << place << "warning: " << text.substr(place.size()) << '\n';
  }
  void Progress(int frame) {
    if (!progress_ || (frame % 10 != 9 && frame + 1 != frames_)) return;
    std::cerr << "\rframe " << frame + 1 << " of " << frames_ << std::flush;
    onProgressLine_ = true;
  }
  void EndProgressLine() {
    if (onProgressLine_) std::cerr << '\n';
    onProgressLine_ = false;
  }

 private:
  std::string sceneName_;
  int frames_;
  bool progress_;
  bool onProgressLine_ = false;
};

struct Run {
  const Scene& scene;
  const Options& options;
  int frames;  // to play
  std::vector<PngOutput> pngs;
  std::string sceneName;
};

// Throws std::runtime_error on any failure; the output files are then removed.
void Play(const Run& run) {
  const Scene& scene = run.scene;
  const Palette palette(scene);
  OutputFile gifFile(run.options.gif);
  std::optional<OutputFile> traceFile;
  if (!run.options.trace.empty()) traceFile.emplace(run.options.trace);
  std::vector<std::unique_ptr<OutputFile>> pngFiles;

  GifWriter gif(gifFile.stream(), scene.width, scene.height, palette.colours(), scene.frameDelay);
  Player player(scene);
  FrameRenderer renderer(scene, palette);
  Messages messages(run.sceneName, run.frames);
  for (const std::string& warning : SettingWarnings(scene, player.extension())) messages.Warn(warning);
  FrameWarnings frameWarnings;
  for (int frame = 0; frame < run.frames; ++frame) {
    player.PlayFrame(frame);
    for (const std::string& warning : frameWarnings.Check(scene, player, frame)) messages.Warn(warning);
    const Picture& picture = renderer.Render(player, frame);
    gif.AddFrame(picture);
    for (const PngOutput& png : run.pngs) {
      if (png.frame != frame) continue;
      // Written and closed at once: a run of many pictures holds no more
      // than one open, and all are named only when the run has succeeded.
      pngFiles.push_back(std::make_unique<OutputFile>(png.path));
      WritePng(pngFiles.back()->stream(), picture, palette.colours());
      pngFiles.back()->Close();
    }
    if (traceFile) WriteTraceLine(traceFile->stream(), frame, scene, player);
    messages.Progress(frame);
  }
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
  report << run.options.gif << ": " << run.frames << " frames of " << scene.width << "x" << scene.height << '\n';
  for (const PngOutput& png : run.pngs) report << png.path << ": frame " << png.frame << '\n';
  if (traceFile) report << run.options.trace << ": " << run.frames << " lines\n";
}

int Main(int argc, char** argv) {
  Options options;
  try {
    options = ReadOptions(argc, argv);
  } catch (const UsageError& error) {
    std::cerr << "scene_player: " << error.what() << "\n" << kUsage;
    return kBadInput;
  }
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

  const std::string sceneName = options.scene.empty() ? "(embedded demo)" : options.scene;
  std::string text;
  if (options.scene.empty()) {
    text = DemoScene();
  } else if (!ReadFile(options.scene, text)) {
    std::cerr << sceneName << ": cannot read: " << std::strerror(errno) << '\n';
    return kBadInput;
  }

  Scene scene;
  try {
    scene = ParseScene(text);
  } catch (const SceneError& error) {
    std::cerr << sceneName << ": " << error.place() << ": " << error.what() << '\n';
    return kBadInput;
  }

  Run run{scene, options, scene.frames, {}, sceneName};
  try {
    if (options.frames) {
      if (*options.frames > scene.frames) {
        throw UsageError("--frames " + std::to_string(*options.frames) + ": expected at most the scene's " +
                         std::to_string(scene.frames) + " frames");
      }
      run.frames = static_cast<int>(*options.frames);
    }
    run.pngs = PngOutputs(options.pngs, run.frames);
    std::vector<NamedPath> outputs = {{"--gif", options.gif}};
    if (!options.trace.empty()) outputs.push_back({"--trace", options.trace});
    for (const PngOutput& png : run.pngs) outputs.push_back({"--png", png.path});
    std::vector<NamedPath> inputs;
    if (!options.scene.empty()) inputs.push_back({"the scene", options.scene});
    if (const std::string conflict = OutputConflict(inputs, outputs); !conflict.empty()) throw UsageError(conflict);
    WatchPartialFiles(outputs.size());
  } catch (const UsageError& error) {
    std::cerr << "scene_player: " << error.what() << '\n';
    return kBadInput;
  }

  Play(run);
  return 0;
}

}  // namespace

// No exception leaves the player: a failure while playing or writing ends in
// one line and status 1, after the outputs have been removed.
int main(int argc, char** argv) {
  try {
    return Main(argc, argv);
  } catch (const std::exception& error) {
    std::cerr << "scene_player: " << error.what() << '\n';
  } catch (...) {
    std::cerr << "scene_player: stopped by an unknown failure\n";
  }
  return kFailed;
}
