// The scene player's command line.
#pragma once

#include <optional>
#include <stdexcept>
#include <string>
#include <vector>

namespace scene_player {

extern const char* const kUsage;

class UsageError : public std::runtime_error {
  using std::runtime_error::runtime_error;
};

// Frames first to last (inclusive), every `step`-th.
struct FrameRange {
  long first = 0, last = 0, step = 1;
};

// One --png: a file name, with "%d" or "%0Nd" standing for the frame number
// when it names several files, and the frames it asks for (none: the last).
struct PngRequest {
  std::string name;
  std::vector<FrameRange> frames;
};

struct Options {
  std::string scene;  // empty: the embedded demo
  std::string gif, trace;
  std::vector<PngRequest> pngs;
  std::optional<long> frames;  // --frames: play only this many
  bool printDemo = false;
  bool help = false;
  bool version = false;
};

// Throws UsageError for a command line the player cannot follow.
Options ReadOptions(int argc, char** argv);

struct PngOutput {
  int frame;
  std::string path;
};

// Every PNG file the run writes, in the order of the command line, for a run
// of `frames` frames. Throws UsageError for a frame outside the run or a name
// that would be given to several frames.
std::vector<PngOutput> PngOutputs(const std::vector<PngRequest>& requests, int frames);

}  // namespace scene_player
