#include "library_view.h"

#include <algorithm>
#include <stdexcept>

#include "frame/exports.h"
#include "shown_text.h"

namespace editor_preview {

namespace {

// Room beyond the object's rectangle for the labels, which reach past it.
constexpr int64_t kLabelRoom = 64;

// The host's record of the placed object, which the library passes on to
// GetObjectRect without reading it.
char g_placedObject[64];

}  // namespace

RECT RunDisplay(standin::EditorWindow& window, EditData& settings, int32_t left, int32_t top) {
  RECT rect{};
  rect.left = left;
  rect.top = top;
  EditorDisplay(window.host(), nullptr, g_placedObject, &settings, &rect);
  return rect;
}

Drawing ProbeDisplay(const PreviewOptions& options) {
  Drawing drawing{options.settings, {}, {}};
  standin::EditorWindow probe(1, 1);
  drawing.rect = RunDisplay(probe, drawing.settings, options.left, options.top);
  drawing.calls = probe.TakeCalls();
  return drawing;
}

int32_t Divisor(int64_t side, int64_t limit) {
  return static_cast<int32_t>(std::max<int64_t>(1, (side + limit - 1) / limit));
}

PictureSize WriteEditorView(std::FILE* stream, const PreviewOptions& options, const RECT& rect) {
  const int64_t wanted[2] = {int64_t{rect.right} + kLabelRoom, int64_t{rect.bottom} + kLabelRoom};
  PictureSize size;
  if (options.windowWidth == 0 && options.windowHeight == 0) {
    size.divisor = Divisor(std::max(wanted[0], wanted[1]), kLargestSide);
  }
  const auto side = [&](int32_t chosen, int64_t want) {
    if (chosen != 0) return chosen;
    return static_cast<int32_t>(std::clamp<int64_t>((want + size.divisor - 1) / size.divisor, 1, kLargestSide));
  };
  size.width = side(options.windowWidth, wanted[0]);
  size.height = side(options.windowHeight, wanted[1]);
  standin::EditorWindow window(size.width, size.height);
  window.View(0, 0, 1.0 / size.divisor);
  EditData settings = options.settings;
  RunDisplay(window, settings, options.left, options.top);
  if (!window.WritePng(stream)) throw std::runtime_error("cannot write " + tool_input::Shown(options.output));
  return size;
}

}  // namespace editor_preview
