// The frame editor's side of the editor display: a window of the DRAVO2
// stand-in to draw in, the editor-time host record that names it, and the
// service calls the library made. For programs that hold the library's own
// objects (tests, the editor preview).
#pragma once

#include <cstdint>
#include <cstdio>
#include <string>
#include <vector>

#include "frame/host_services.h"

namespace standin {

class EditorWindow {
 public:
  // A white window of `width` by `height` pixels (1 to 4096 each).
  EditorWindow(int32_t width, int32_t height);
  ~EditorWindow();
  EditorWindow(const EditorWindow&) = delete;
  EditorWindow& operator=(const EditorWindow&) = delete;

  // The editor-time host record whose editorWindow is this window.
  EditorHost* host() { return &host_; }

  // The drawing service calls since the last take, one line each.
  std::vector<std::string> TakeCalls();

#if !defined(_WIN32)
  // Shows the editor from (left, top) at `scale` pixels per unit, as a
  // scrolled and zoomed-out editor does: for what a window cannot hold.
  void View(int32_t left, int32_t top, double scale);
  // The window's picture as PNG; false when the stream fails.
  bool WritePng(std::FILE* stream) const;
#endif

 private:
  EditorHost host_{};
};

}  // namespace standin
