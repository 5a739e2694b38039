#include "options.h"

#include <charconv>

namespace scene_player {

const char* const kUsage =
    "usage: scene_player [SCENE.json] [--gif FILE] [--png FILE [--png-frame FRAMES]]... [--trace FILE]\n"
    "                    [--frames N]\n"
    "       scene_player --print-demo | --version | --help\n"
    "Plays SCENE.json, or the embedded demo scene without one, and writes an animated GIF\n"
    "(by default SCENE.gif in the current folder, demo.gif for the demo). --png writes\n"
    "frames as PNG pictures: FRAMES is a frame (by default the last; frames count from 0),\n"
    "a range A-B or A-B/STEP, or a list of these separated by commas, and FILE holds %d\n"
    "or %04d for the frame number when it names several. --trace writes a JSON line per\n"
    "frame, --frames N plays only the first N frames. FILE may be - for standard output.\n"
    "--print-demo prints the demo scene, a starting point for a scene of your own.\n";

namespace {

// A whole number from `text`, all of it (a '-' but no '+' or blank); nothing
// when it is not one.
std::optional<long> Number(const std::string& text) {
  long value = 0;
  const char* end = text.data() + text.size();
  const auto [stop, error] = std::from_chars(text.data(), end, value);
  if (error != std::errc() || stop != end) return std::nullopt;
  return value;
}

std::vector<FrameRange> ReadFrames(const std::string& text) {
  const UsageError error("--png-frame " + text + ": expected a frame number, a range A-B or A-B/STEP, "
                         "or a list of these separated by commas");
  std::vector<FrameRange> ranges;
  std::size_t start = 0;
  while (true) {
    const std::size_t comma = text.find(',', start);
    std::string part = text.substr(start, comma == std::string::npos ? std::string::npos : comma - start);
    FrameRange range;
    if (const auto slash = part.find('/'); slash != std::string::npos) {
      const auto step = Number(part.substr(slash + 1));
      if (!step || *step < 1) throw error;
      range.step = *step;
      part.resize(slash);
    }
    const auto dash = part.find('-', 1);  // a first '-' is a sign
    const auto first = Number(part.substr(0, dash));
    const auto last = dash == std::string::npos ? first : Number(part.substr(dash + 1));
    if (!first || !last || *last < *first || (dash == std::string::npos && range.step != 1)) throw error;
    range.first = *first;
    range.last = *last;
    ranges.push_back(range);
    if (comma == std::string::npos) return ranges;
    start = comma + 1;
  }
}

// Where the frame number goes in a --png name: "%d" or "%0Nd" (N from 1 to
// 9). The position and the length of the placeholder, and its width.
struct Placeholder {
  std::size_t at = std::string::npos, length = 0;
  int width = 0;
};

Placeholder FindPlaceholder(const std::string& name) {
  for (std::size_t at = name.find('%'); at != std::string::npos; at = name.find('%', at + 1)) {
    if (name.compare(at, 2, "%d") == 0) return {at, 2, 0};
    if (at + 3 < name.size() && name[at + 1] == '0' && name[at + 2] >= '1' && name[at + 2] <= '9' &&
        name[at + 3] == 'd') {
      return {at, 4, name[at + 2] - '0'};
    }
  }
  return {};
}

}  // namespace

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
      options.pngs.push_back({value(), {}});
    } else if (arg == "--trace") {
      options.trace = value();
    } else if (arg == "--png-frame") {
      const std::string text = value();
      if (options.pngs.empty()) throw UsageError("--png-frame " + text + ": expected after the --png FILE it is for");
      if (!options.pngs.back().frames.empty()) {
        throw UsageError("--png-frame " + text + ": --png " + options.pngs.back().name +
                         " already has its frames; expected one --png-frame for each --png");
      }
      options.pngs.back().frames = ReadFrames(text);
    } else if (arg == "--frames") {
      const std::string text = value();
      options.frames = Number(text);
      if (!options.frames || *options.frames < 1) throw UsageError("--frames " + text + ": expected a number of frames, 1 or more");
    } else if (arg == "--print-demo") {
      options.printDemo = true;
    } else if (arg == "--version") {
      options.version = true;
    } else if (arg == "--help" || arg == "-h") {
      options.help = true;
    } else if (!arg.empty() && arg[0] == '-') {
      throw UsageError("unknown option " + arg);
    } else if (options.scene.empty()) {
      options.scene = arg;
    } else {
      throw UsageError("one scene at a time: " + options.scene + " and " + arg);
    }
  }
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

std::vector<PngOutput> PngOutputs(const std::vector<PngRequest>& requests, int frames) {
  std::vector<PngOutput> outputs;
  for (const PngRequest& request : requests) {
    std::vector<int> asked;
    for (const FrameRange& range : request.frames) {
      if (range.first < 0 || range.last >= frames) {
        const std::string text = range.first == range.last ? std::to_string(range.first)
                                                            : std::to_string(range.first) + "-" + std::to_string(range.last);
        throw UsageError("--png-frame " + text + ": expected a frame from 0 to " + std::to_string(frames - 1));
      }
      for (long frame = range.first;; frame += range.step) {
        asked.push_back(static_cast<int>(frame));
        if (range.last - frame < range.step) break;
      }
    }
    if (asked.empty()) asked.push_back(frames - 1);
    const Placeholder placeholder = FindPlaceholder(request.name);
    if (asked.size() > 1 && placeholder.length == 0) {
      throw UsageError("--png " + request.name + ": " + std::to_string(asked.size()) +
                       " frames for one file name; expected %d or %04d in the name for the frame number");
    }
    for (int frame : asked) {
      std::string path = request.name;
      if (placeholder.length > 0) {
        std::string number = std::to_string(frame);
        if (number.size() < static_cast<std::size_t>(placeholder.width)) {
          number.insert(0, static_cast<std::size_t>(placeholder.width) - number.size(), '0');
        }
        path.replace(placeholder.at, placeholder.length, number);
      }
      outputs.push_back({frame, path});
    }
  }
  return outputs;
}

}  // namespace scene_player
