// editor_preview: runs the library's editor display for given settings, as
// the frame editor calls it, and writes what the editor shows as a PNG.
#include <algorithm>
#include <cstdint>
#include <iostream>
#include <stdexcept>

#include "editor_window.h"
#include "frame/exports.h"
#include "output_file.h"
#include "output_paths.h"
#include "partial_files.h"
#include "preview_options.h"

namespace {

using editor_preview::PreviewOptions;

constexpr int kFailed = 1;
constexpr int kBadInput = 2;
// Room beyond the object's rectangle for the labels, which reach past it.
constexpr int64_t kLabelRoom = 64;

int32_t WindowSide(int32_t chosen, int64_t end) {
  if (chosen != 0) return chosen;
  return static_cast<int32_t>(std::clamp<int64_t>(end + kLabelRoom, 1, 4096));
}

RECT Place(const PreviewOptions& options) {
  RECT rect{};
  rect.left = options.left;
  rect.top = options.top;
  return rect;
}

// The host's record of the placed object, which the library passes on to
// GetObjectRect without reading it.
char g_placedObject[64];

}  // namespace

int main(int argc, char** argv) {
  PreviewOptions options;
  try {
    options = editor_preview::ReadPreviewOptions(argc, argv);
  } catch (const editor_preview::UsageError& error) {
    std::cerr << "editor_preview: " << error.what() << "\n";
    return kBadInput;
  }
  if (options.help) {
    std::cout << editor_preview::kUsage;
    return 0;
  }
  // The picture never replaces the settings file it was made from.
  if (!options.settingsFile.empty()) {
    const std::string conflict = tool_output::OutputConflict({{"--settings", options.settingsFile}},
                                                             {{"output", options.output}});
    if (!conflict.empty()) {
      std::cerr << "editor_preview: " << conflict << "\n";
      return kBadInput;
    }
  }
  tool_output::WatchPartialFiles(1);

  // A first display, as the editor makes whenever it draws, gives the
  // object's rectangle and so the size of the picture.
  EditData settings = options.settings;
  RECT rect = Place(options);
  {
    standin::EditorWindow probe(1, 1);
    EditorDisplay(probe.host(), nullptr, g_placedObject, &settings, &rect);
  }
  standin::EditorWindow window(WindowSide(options.windowWidth, rect.right),
                               WindowSide(options.windowHeight, rect.bottom));
  rect = Place(options);
  EditorDisplay(window.host(), nullptr, g_placedObject, &settings, &rect);

  try {
    tool_output::OutputFile output(options.output);
    if (!window.WritePng(output.stream())) throw std::runtime_error("cannot write " + options.output);
    output.Commit();
  } catch (const std::runtime_error& error) {
    std::cerr << "editor_preview: " << error.what() << "\n";
    return kFailed;
  }
  return 0;
}
