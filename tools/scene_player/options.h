// The scene player's command line.
#pragma once

#include <optional>
#include <string>
#include <vector>

#include "command_line.h"

namespace scene_player {

using tool_input::UsageError;

extern const char* const kUsage;

// Frames first to last (inclusive), every `step`-th.
struct FrameRange {
  long first = 0, last = 0, step = 1;
};

// One --png: a file name (a PngName pattern) and the frames it asks for, as
// given (none: the last).
struct PngRequest {
  std::string name;
  std::string framesText;
  std::vector<FrameRange> frames;
};

struct Options {
  std::string scene;  // empty: the embedded demo; "-": standard input
  std::string gif, trace;
  std::vector<PngRequest> pngs;
  std::optional<long> frames;  // --frames: play only this many
  bool printDemo = false;
  bool help = false;
  bool version = false;
};

// Throws UsageError for a command line the player cannot follow.
Options ReadOptions(int argc, const char* const* argv);

struct PngOutput {
  int frame;
  std::string path;
};

// Every PNG file the run writes, in the order of the command line, for a run
// of `frames` frames. Throws UsageError for a frame outside the run, a frame
// asked for twice, or a name that would be given to several frames.
std::vector<PngOutput> PngOutputs(const std::vector<PngRequest>& requests, int frames);

}  // namespace scene_player
