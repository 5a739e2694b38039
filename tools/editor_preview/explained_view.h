// The editor's view explained, drawn by the tool around the library's own
// drawing: the object's rectangle (what the editor selects), the arc the
// platform travels between its two outer positions, the links and platform
// where the run-time step places them at the starting angle, and a caption
// that says where the radius comes from and which side the positive angles
// swing to. It shows the whole drawing, scaled down when that is larger than
// a picture holds.
#pragma once

#include <cstdio>

#include "library_view.h"
#include "preview_options.h"

namespace editor_preview {

// Throws std::runtime_error when the picture cannot be made or written.
PictureSize WriteExplainedView(std::FILE* stream, const PreviewOptions& options, const Drawing& drawing);

}  // namespace editor_preview
