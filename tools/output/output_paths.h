// What an output path names on disk, so that no output is written over an
// input or over another output of the same run, however the file is named.
#pragma once

#include <string>
#include <vector>

namespace tool_output {

// `path` with symbolic links in its last part followed to the file they end
// at (which need not exist yet). Throws std::runtime_error for a loop.
std::string FollowLinks(const std::string& path);

struct NamedPath {
  std::string option;  // how the command line gave it: "--gif", "the scene", ...
  std::string path;
};

// A message saying which output would overwrite an input or another output,
// or an empty text when each output is a file of its own. "-" is standard
// output; devices such as /dev/null may take several outputs.
std::string OutputConflict(const std::vector<NamedPath>& inputs, const std::vector<NamedPath>& outputs);

}  // namespace tool_output
