// Settings the editor display takes without a word although no author means
// them: negative sizes and counts, an object that comes out too small to
// select, a size too large for the record, a view the editor does not draw.
#pragma once

#include <string>
#include <vector>

#include "frame/edit_data.h"

namespace editor_preview {

// `before` is the record as given, `after` as the display left it. One text
// per warning, each said once.
std::vector<std::string> PreviewWarnings(const EditData& before, const EditData& after);

}  // namespace editor_preview
