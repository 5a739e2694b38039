// The editor preview's command line: the settings record to show, where the
// object is placed, and where the picture goes.
#pragma once

#include <cstdint>
#include <stdexcept>
#include <string>

#include "frame/edit_data.h"

namespace editor_preview {

// A command line that cannot be followed; what() names the problem.
class UsageError : public std::runtime_error {
  using std::runtime_error::runtime_error;
};

struct PreviewOptions {
  EditData settings{};  // the defaults of a new object, then the file, then the options
  int32_t left = 0;
  int32_t top = 0;
  int32_t windowWidth = 0;  // 0: fit the object's rectangle and its labels
  int32_t windowHeight = 0;
  std::string settingsFile;  // empty when no --settings was given
  std::string output;
  bool help = false;
};

extern const char* const kUsage;

// Throws UsageError for an unknown option, a missing value, a value that is
// not a number (or too long a text), and a settings file that cannot be
// read or is not a 100-byte record.
PreviewOptions ReadPreviewOptions(int argc, const char* const* argv);

}  // namespace editor_preview
