// editor_preview: runs the library's editor display for given settings, as
// the frame editor calls it, and writes what the editor shows as a PNG, or
// that view explained; it can also write the settings record.
#include <iostream>
#include <optional>
#include <stdexcept>

#include "explained_view.h"
#include "library_view.h"
#include "output_file.h"
#include "output_paths.h"
#include "partial_files.h"
#include "preview_options.h"
#include "preview_warnings.h"
#include "shown_text.h"
#include "tool_main.h"

namespace {

using namespace editor_preview;
using tool_input::Shown;

std::string ViewName(const EditData& settings, bool explained) {
  const std::string view = settings.viewTemplate == 1   ? "the template view"
                           : settings.viewTemplate == 0 ? "the object's picture"
                                                        : "an empty view";
  return explained ? view + ", explained" : view;
}

int Main(int argc, char** argv) {
  const PreviewOptions options = ReadPreviewOptions(argc, argv);
  if (options.help) {
    std::cout << kUsage;
    return 0;
  }
  if (options.version) {
    std::cout << "editor_preview " << TAVRIN_VERSION << '\n';
    return 0;
  }
  // Neither the picture nor the record replaces the settings file they were
  // made from, or each other.
  std::vector<tool_output::NamedPath> inputs, outputs;
  if (!options.settingsFile.empty() && options.settingsFile != "-") inputs.push_back({"--settings", options.settingsFile});
  if (!options.output.empty()) outputs.push_back({"the output", options.output});
  if (!options.saveSettings.empty()) outputs.push_back({"--save-settings", options.saveSettings});
  if (const std::string conflict = tool_output::OutputConflict(inputs, outputs); !conflict.empty()) {
    throw UsageError(conflict);
  }
  tool_output::WatchPartialFiles(outputs.size());

  // A first display, as the editor makes whenever it draws, gives the
  // object's rectangle and what is drawn where.
  const Drawing drawing = ProbeDisplay(options);
  for (const std::string& warning : PreviewWarnings(options.settings, drawing.settings)) {
    std::cerr << "editor_preview: warning: " << warning << '\n';
  }

  std::optional<tool_output::OutputFile> picture, record;
  PictureSize size;
  if (!options.output.empty()) {
    picture.emplace(options.output);
    size = options.explain ? WriteExplainedView(picture->stream(), options, drawing)
                           : WriteEditorView(picture->stream(), options, drawing.rect);
    picture->Close();
  }
  if (!options.saveSettings.empty()) {
    // The record as the editor leaves it after drawing, which is what the
    // host stores.
    record.emplace(options.saveSettings);
    std::fwrite(&drawing.settings, sizeof drawing.settings, 1, record->stream());
    record->Close();
  }
  if (picture) picture->Commit();
  if (record) record->Commit();

  std::ostream& report = options.output == "-" || options.saveSettings == "-" ? std::cerr : std::cout;
  if (picture) {
    report << Shown(options.output) << ": " << size.width << "x" << size.height << " picture of "
           << ViewName(drawing.settings, options.explain);
    if (size.divisor > 1) report << ", drawn at 1/" << size.divisor << " of its size to fit";
    report << '\n';
  }
  if (record) report << Shown(options.saveSettings) << ": the " << sizeof(EditData) << "-byte settings record\n";
  return 0;
}

}  // namespace

int main(int argc, char** argv) { return tool_input::RunToolMain("editor_preview", argc, argv, &Main); }
