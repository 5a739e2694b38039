#include "options.h"

#include "png_names.h"
#include "shown_text.h"

namespace scene_player {

const char* const kUsage =
    "usage: scene_player [SCENE.json | -] [--gif FILE] [--png FILE [--png-frame FRAMES]]...\n"
    "                    [--trace FILE] [--frames N]\n"
    "       scene_player --print-demo | --version | --help\n"
    "Plays SCENE.json (- reads it from standard input), or the embedded demo scene without\n"
    "one, and writes an animated GIF (by default SCENE.gif in the current folder, demo.gif\n"
    "for the demo, scene.gif for standard input). --png writes frames as PNG pictures:\n"
    "FRAMES is a frame (by default the last; frames count from 0), a range A-B or A-B/STEP,\n"
    "or a list of these separated by commas, and FILE holds %d, %04d or another printf\n"
    "width where the frame number goes when it names several (%% is a %). --trace writes a\n"
    "JSON line per frame, --frames N plays only the first N frames. FILE may be - for\n"
    "standard output. --print-demo prints the demo scene, a starting point for your own.\n"
    "Options take their value as --name VALUE or --name=VALUE; -- ends the options.\n"
    "The scene format, the warnings and the trace are described in docs/scene-format.md.\n"
    "Exit status: 0 played and written, 1 a failure while playing or writing (no file is\n"
    "left), 2 bad input: the command line or the scene.\n";

namespace {

using tool_input::OptionSpec;
using tool_input::Shown;
using tool_input::WholeNumber;
using Takes = OptionSpec::Takes;

constexpr OptionSpec kOptions[] = {
    {"--gif", Takes::OneValue},        {"--png", Takes::Values},     {"--png-frame", Takes::Values},
    {"--trace", Takes::OneValue},      {"--frames", Takes::OneValue}, {"--print-demo"},
    {"--version"},                     {"--help", Takes::Nothing, false, "-h"},
};

std::vector<FrameRange> ReadFrames(const std::string& text) {
  const UsageError error("--png-frame " + Shown(text) + ": expected a frame number, a range A-B or A-B/STEP, "
                         "or a list of these separated by commas");
  std::vector<FrameRange> ranges;
  std::size_t start = 0;
  while (true) {
    const std::size_t comma = text.find(',', start);
    std::string part = text.substr(start, comma == std::string::npos ? std::string::npos : comma - start);
    FrameRange range;
    if (const auto slash = part.find('/'); slash != std::string::npos) {
      const auto step = WholeNumber(part.substr(slash + 1));
      if (!step || *step < 1) throw error;
      range.step = *step;
      part.resize(slash);
    }
    const auto dash = part.find('-', 1);  // a first '-' is a sign
    const auto first = WholeNumber(part.substr(0, dash));
    const auto last = dash == std::string::npos ? first : WholeNumber(part.substr(dash + 1));
    if (!first || !last || *last < *first || (dash == std::string::npos && range.step != 1)) throw error;
    range.first = *first;
    range.last = *last;
    ranges.push_back(range);
    if (comma == std::string::npos) return ranges;
    start = comma + 1;
  }
}

std::string DefaultGif(const std::string& scene) {
  if (scene.empty()) return "demo.gif";
  if (scene == "-") return "scene.gif";
  std::string stem = scene.substr(scene.rfind('/') + 1);
  if (const auto dot = stem.rfind('.'); dot != std::string::npos && dot > 0) stem.resize(dot);
  return stem + ".gif";
}

}  // namespace

Options ReadOptions(int argc, const char* const* argv) {
  Options options;
  for (const tool_input::Argument& argument : tool_input::ReadCommandLine(argc, argv, kOptions)) {
    const std::string& option = argument.option;
    const std::string& value = argument.value;
    if (option == "--gif") {
      options.gif = value;
    } else if (option == "--png") {
      static_cast<void>(PngName(value));  // a bad pattern is said at once
      options.pngs.push_back({value, "", {}});
    } else if (option == "--trace") {
      options.trace = value;
    } else if (option == "--png-frame") {
      if (options.pngs.empty()) throw UsageError("--png-frame " + Shown(value) + ": expected after the --png FILE it is for");
      PngRequest& png = options.pngs.back();
      if (!png.frames.empty()) {
        throw UsageError("--png-frame " + Shown(value) + ": --png " + Shown(png.name) +
                         " already has its frames; expected one --png-frame for each --png");
      }
      png.framesText = value;
      png.frames = ReadFrames(value);
    } else if (option == "--frames") {
      options.frames = WholeNumber(value);
      if (!options.frames || *options.frames < 1) {
        throw UsageError("--frames " + Shown(value) + ": expected a number of frames, 1 or more");
      }
    } else if (option == "--print-demo") {
      options.printDemo = true;
    } else if (option == "--version") {
      options.version = true;
    } else if (option == "--help") {
      options.help = true;
    } else if (options.scene.empty()) {
      options.scene = value;
    } else {
      throw UsageError("one scene at a time: " + Shown(options.scene) + " and " + Shown(value));
    }
  }
  if (options.printDemo && (!options.scene.empty() || !options.gif.empty() || !options.trace.empty() ||
                            !options.pngs.empty() || options.frames)) {
    throw UsageError("--print-demo prints the demo scene and plays nothing; expected no scene, output or --frames "
                     "with it");
  }
  if (options.gif.empty()) options.gif = DefaultGif(options.scene);
  return options;
}

std::vector<PngOutput> PngOutputs(const std::vector<PngRequest>& requests, int frames) {
  std::vector<PngOutput> outputs;
  for (const PngRequest& request : requests) {
    const std::string option = "--png-frame " + Shown(request.framesText);
    std::vector<int> asked;
    std::vector<bool> seen(static_cast<std::size_t>(frames));
    for (const FrameRange& range : request.frames) {
      if (range.first < 0 || range.last >= frames) {
        throw UsageError(option + ": expected frames from 0 to " + std::to_string(frames - 1));
      }
      for (long frame = range.first;; frame += range.step) {
        if (seen[static_cast<std::size_t>(frame)]) {
          throw UsageError(option + ": frame " + std::to_string(frame) + " is listed twice");
        }
        seen[static_cast<std::size_t>(frame)] = true;
        asked.push_back(static_cast<int>(frame));
        if (range.last - frame < range.step) break;
      }
    }
    if (asked.empty()) asked.push_back(frames - 1);
    const PngName name(request.name);
    if (asked.size() > 1 && !name.numbered()) {
      throw UsageError("--png " + Shown(request.name) + ": " + std::to_string(asked.size()) +
                       " frames for one file name; expected %d or %04d in the name for the frame number");
    }
    for (int frame : asked) outputs.push_back({frame, name.For(frame)});
  }
  return outputs;
}

}  // namespace scene_player
