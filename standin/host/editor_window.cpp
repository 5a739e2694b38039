#include "editor_window.h"

#include <windows.h>

#include <sstream>

#include "dravo2_standin.h"

namespace standin {

namespace {

#if !defined(_WIN32)
// The Win32 stand-in that holds the library's resources is part of this
// program; the DRAVO2 stand-in reaches a module's bitmaps through it.
const void* ModuleBitmap(HINSTANCE module, int32_t id) {
  const HRSRC resource = FindResourceA(module, MAKEINTRESOURCEA(id), RT_BITMAP);
  const HGLOBAL loaded = resource == nullptr ? nullptr : LoadResource(module, resource);
  return loaded == nullptr ? nullptr : LockResource(loaded);
}
#endif

}  // namespace

EditorWindow::EditorWindow(int32_t width, int32_t height) {
#if !defined(_WIN32)
  StandinSetBitmapSource(&ModuleBitmap);
#endif
  host_.slot[kEditorSlotEditorWindow] = StandinOpenEditorWindow(width, height);
  StandinClearDrawingCalls();
}

EditorWindow::~EditorWindow() { StandinCloseEditorWindow(); }

std::vector<std::string> EditorWindow::TakeCalls() {
  std::vector<std::string> calls;
  std::istringstream lines(StandinDrawingCalls());
  for (std::string line; std::getline(lines, line);) calls.push_back(line);
  StandinClearDrawingCalls();
  return calls;
}

#if !defined(_WIN32)
void EditorWindow::View(int32_t left, int32_t top, double scale) { StandinViewEditorWindow(left, top, scale); }

bool EditorWindow::WritePng(std::FILE* stream) const { return StandinWriteEditorPng(stream); }
#endif

}  // namespace standin
