// The editor preview's command line: the settings record to show, where the
// object is placed, which view to draw and where the picture goes.
#pragma once

#include <cstdint>
#include <string>

#include "command_line.h"
#include "frame/edit_data.h"

namespace editor_preview {

using tool_input::UsageError;

struct PreviewOptions {
  EditData settings{};  // the defaults of a new object, then the file, then the options
  int32_t left = 0;
  int32_t top = 0;
  int32_t windowWidth = 0;  // 0: fit the object's rectangle and its labels
  int32_t windowHeight = 0;
  std::string settingsFile;  // empty when no --settings was given; "-": standard input
  std::string saveSettings;  // where to write the settings record, or empty
  std::string output;        // the picture; may be empty when the record is saved
  bool explain = false;
  bool help = false;
  bool version = false;
};

extern const char* const kUsage;

// Throws UsageError for a command line that cannot be followed: an unknown
// option, a missing or repeated value, a value that is not a number (or too
// long a text), a settings file that cannot be read or is not a 100-byte
// record.
PreviewOptions ReadPreviewOptions(int argc, const char* const* argv);

}  // namespace editor_preview
