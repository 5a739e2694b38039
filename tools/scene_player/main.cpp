// scene_player: plays a scene against the library, as the host would, and
// writes what happened as an animated GIF, optionally one frame as a PNG and
// a per-frame trace.
#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <cstdio>
#include <iostream>
#include <optional>
#include <string>
#include <unistd.h>

#include "demo_scene.h"
#include "frame_renderer.h"
#include "gif_writer.h"
#include "output_file.h"
#include "palette.h"
#include "player.h"
#include "png_writer.h"
#include "scene_parser.h"
#include "trace_writer.h"

namespace {

using namespace scene_player;

constexpr int kBadInput = 2;
constexpr int kFailed = 1;

constexpr const char* kUsage =
    "usage: scene_player [SCENE.json] [--gif FILE] [--png FILE [--png-frame N]] [--trace FILE]\n"
    "       scene_player --print-demo\n"
    "Plays SCENE.json, or the embedded demo scene without one, and writes an animated GIF\n"
    "(by default SCENE.gif in the current folder, demo.gif for the demo). --png writes one\n"
    "frame (by default the last; frames count from 0), --trace a JSON line per frame.\n"
    "--print-demo prints the demo scene, a starting point for a scene of your own.\n";

struct Options {
  std::string scene;  // empty: the embedded demo
  std::string gif, png, trace;
  std::optional<long> pngFrame;
  bool printDemo = false;
};

class UsageError : public std::runtime_error {
  using std::runtime_error::runtime_error;
};

Options ReadOptions(int argc, char** argv) {
  Options options;
  for (int i = 1; i < argc; ++i) {
    const std::string arg = argv[i];
    auto value = [&]() -> std::string {
      if (i + 1 >= argc) throw UsageError(arg + " needs a value");
      return argv[++i];
    };
    if (arg == "--gif") {
      options.gif = value();
    } else if (arg == "--png") {
      options.png = value();
    } else if (arg == "--trace") {
      options.trace = value();
    } else if (arg == "--png-frame") {
      const std::string text = value();
      char* end = nullptr;
      errno = 0;
      const long frame = std::strtol(text.c_str(), &end, 10);
      if (text.empty() || *end != '\0' || errno != 0) throw UsageError("--png-frame " + text + ": expected a frame number");
      options.pngFrame = frame;
    } else if (arg == "--print-demo") {
      options.printDemo = true;
    } else if (arg == "--help" || arg == "-h") {
      std::cout << kUsage;
      std::exit(0);
    } else if (!arg.empty() && arg[0] == '-') {
      throw UsageError("unknown option " + arg);
    } else if (options.scene.empty()) {
      options.scene = arg;
    } else {
      throw UsageError("one scene at a time: " + options.scene + " and " + arg);
    }
  }
  if (options.pngFrame && options.png.empty()) throw UsageError("--png-frame needs --png FILE");
  if (options.gif.empty()) {
    std::string stem = "demo";
    if (!options.scene.empty()) {
      stem = options.scene.substr(options.scene.rfind('/') + 1);
      if (const auto dot = stem.rfind('.'); dot != std::string::npos && dot > 0) stem.resize(dot);
    }
    options.gif = stem + ".gif";
  }
  return options;
}

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

// Throws std::runtime_error on any failure; the output files are then removed.
void Play(const Scene& scene, const Options& options) {
  const Palette palette(scene);
  OutputFile gifFile(options.gif);
  std::optional<OutputFile> pngFile, traceFile;
  if (!options.png.empty()) pngFile.emplace(options.png);
  if (!options.trace.empty()) traceFile.emplace(options.trace);
  const int pngFrame = options.pngFrame ? static_cast<int>(*options.pngFrame) : scene.frames - 1;

  GifWriter gif(gifFile.stream(), scene.width, scene.height, palette.colours(), scene.frameDelay);
  Player player(scene);
  FrameRenderer renderer(scene, palette);
  const bool showProgress = isatty(STDERR_FILENO) == 1;
  for (int frame = 0; frame < scene.frames; ++frame) {
    player.PlayFrame(frame);
    const Picture& picture = renderer.Render(player, frame);
    gif.AddFrame(picture);
    if (pngFile && frame == pngFrame) WritePng(pngFile->stream(), picture, palette.colours());
    if (traceFile) WriteTraceLine(traceFile->stream(), frame, scene, player);
    if (showProgress && (frame % 10 == 9 || frame + 1 == scene.frames)) {
      std::cerr << "\rframe " << frame + 1 << " of " << scene.frames << std::flush;
    }
  }
  if (showProgress) std::cerr << '\n';
  gif.Finish();
  gifFile.Commit();
  std::cout << options.gif << ": " << scene.frames << " frames of " << scene.width << "x" << scene.height << '\n';
  if (pngFile) {
    pngFile->Commit();
    std::cout << options.png << ": frame " << pngFrame << '\n';
  }
  if (traceFile) {
    traceFile->Commit();
    std::cout << options.trace << ": " << scene.frames << " lines\n";
  }
}

}  // namespace

int main(int argc, char** argv) {
  Options options;
  try {
    options = ReadOptions(argc, argv);
  } catch (const UsageError& error) {
    std::cerr << "scene_player: " << error.what() << "\n" << kUsage;
    return kBadInput;
  }
  if (options.printDemo) {
    std::cout << DemoScene();
    return 0;
  }

  const std::string sceneName = options.scene.empty() ? "(embedded demo)" : options.scene;
  std::string text;
  if (options.scene.empty()) {
    text = DemoScene();
  } else {
    if (!ReadFile(options.scene, text)) {
      std::cerr << sceneName << ": cannot read: " << std::strerror(errno) << '\n';
      return kBadInput;
    }
  }

  Scene scene;
  try {
    scene = ParseScene(text);
  } catch (const SceneError& error) {
    std::cerr << sceneName << ": " << error.place() << ": " << error.what() << '\n';
    return kBadInput;
  }
  if (options.pngFrame && (*options.pngFrame < 0 || *options.pngFrame >= scene.frames)) {
    std::cerr << "scene_player: --png-frame " << *options.pngFrame << ": expected a frame from 0 to "
              << scene.frames - 1 << '\n';
    return kBadInput;
  }

  try {
    Play(scene, options);
  } catch (const std::exception& error) {
    // After the progress line, start the message on a line of its own.
    std::cerr << (isatty(STDERR_FILENO) == 1 ? "\n" : "") << "scene_player: " << error.what() << '\n';
    return kFailed;
  }
  return 0;
}
