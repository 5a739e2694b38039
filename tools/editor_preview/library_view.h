// The library's own drawing: the editor display run for given settings in a
// window of the stand-in editor, as the frame editor calls it, and the
// picture of what it drew.
#pragma once

#include <windows.h>

#include <cstdint>
#include <cstdio>
#include <string>
#include <vector>

#include "editor_window.h"
#include "frame/edit_data.h"
#include "preview_options.h"

namespace editor_preview {

// The largest picture side the stand-in editor's window holds.
constexpr int32_t kLargestSide = 4096;

// A picture as written: its size, and 1/divisor the scale of the editor in it.
struct PictureSize {
  int32_t width = 0, height = 0;
  int32_t divisor = 1;
};

// Runs the editor display on `window` for `settings` placed at (left, top),
// as the editor does whenever it draws; the object's rectangle comes back.
RECT RunDisplay(standin::EditorWindow& window, EditData& settings, int32_t left, int32_t top);

// What a display of `settings` draws, as the stand-in recorded it, and the
// record and rectangle as the display leaves them.
struct Drawing {
  EditData settings;
  RECT rect;
  std::vector<std::string> calls;
};
Drawing ProbeDisplay(const PreviewOptions& options);

// The frame editor's view: the window from (0, 0), as large as the object
// and its labels or as given, scaled down by a whole divisor when that is
// larger than a window holds. Throws std::runtime_error when the picture
// cannot be written.
PictureSize WriteEditorView(std::FILE* stream, const PreviewOptions& options, const RECT& rect);

// The smallest whole divisor that fits `side` into `limit`.
int32_t Divisor(int64_t side, int64_t limit);

}  // namespace editor_preview
