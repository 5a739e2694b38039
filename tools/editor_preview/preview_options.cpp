#include "preview_options.h"

#include <cstring>
#include <limits>

#include "bounded_read.h"
#include "shown_text.h"

namespace editor_preview {

const char* const kUsage =
    "usage: editor_preview [OPTIONS] OUTPUT.png\n"
    "       editor_preview [OPTIONS] --save-settings FILE [OUTPUT.png]\n"
    "Runs the library's editor display for the given settings, as the frame editor\n"
    "calls it, and writes what the editor shows as a PNG: the object's picture, or with\n"
    "--view-template 1 the preview of one chain built from the template sizes. With\n"
    "--explain the tool frames that drawing with what it means. OUTPUT.png may be - for\n"
    "standard output.\n"
    "Settings start from those of a new object; a settings file replaces them, and each\n"
    "option below replaces one field, in the setup dialog's names:\n"
    "  --settings FILE          a saved 100-byte settings record (- reads standard input)\n"
    "  --starting-angle TEXT    starting angle in degrees, as typed (at most 9 characters)\n"
    "  --mass TEXT              mass (not drawn; stored as typed)\n"
    "  --link-spacing TEXT      spacing between links in pixels, as typed\n"
    "  --gravity TEXT           gravity (not drawn; stored as typed)\n"
    "  --anchor-width N         anchor width in pixels\n"
    "  --anchor-height N        anchor height in pixels\n"
    "  --link-width N           link width (not drawn by the editor)\n"
    "  --link-height N          link height: each link adds it to the chain's length\n"
    "  --platform-width N       platform width in pixels\n"
    "  --platform-height N      platform height in pixels\n"
    "  --number-of-links N      number of links\n"
    "  --view-template N        1: the template preview; 0: the object's picture;\n"
    "                           any other value up to 255 draws nothing\n"
    "  --save-settings FILE     also writes the settings record, as the editor leaves it\n"
    "Placement and picture:\n"
    "  --left N, --top N        the object's top-left corner in the editor (default 0 0)\n"
    "  --window-width N, --window-height N\n"
    "                           the picture's size, 1 to 4096 (default: the object's\n"
    "                           rectangle and 64 pixels beyond it, for the labels; an\n"
    "                           object larger than 4096 pixels is drawn scaled down)\n"
    "  --explain                the view explained: the object's rectangle, the arc, the\n"
    "                           links as the run-time step places them, and a caption\n"
    "  --version, --help        the version, this text\n"
    "Options take their value as --name VALUE or --name=VALUE; -- ends the options.\n"
    "Numbers are whole decimal numbers. The picture replaces OUTPUT.png only once it is\n"
    "complete. Exit status: 0 done, 1 the picture could not be written, 2 bad input.\n";

namespace {

using tool_input::OptionSpec;
using tool_input::Shown;
using Takes = OptionSpec::Takes;

constexpr OptionSpec kOptions[] = {
    {"--settings", Takes::OneValue},         {"--starting-angle", Takes::OneValue, true},
    {"--mass", Takes::OneValue, true},       {"--link-spacing", Takes::OneValue, true},
    {"--gravity", Takes::OneValue, true},    {"--anchor-width", Takes::OneValue},
    {"--anchor-height", Takes::OneValue},    {"--link-width", Takes::OneValue},
    {"--link-height", Takes::OneValue},      {"--platform-width", Takes::OneValue},
    {"--platform-height", Takes::OneValue},  {"--number-of-links", Takes::OneValue},
    {"--view-template", Takes::OneValue},    {"--save-settings", Takes::OneValue},
    {"--left", Takes::OneValue},             {"--top", Takes::OneValue},
    {"--window-width", Takes::OneValue},     {"--window-height", Takes::OneValue},
    {"--explain"},                           {"--version"},
    {"--help", Takes::Nothing, false, "-h"},
};

int64_t ReadNumber(const std::string& option, const std::string& text, int64_t low, int64_t high) {
  const std::optional<int64_t> value = tool_input::WholeNumber(text);
  if (!value) throw UsageError(option + " " + Shown(text) + ": not a whole number");
  if (*value < low || *value > high) {
    throw UsageError(option + " " + Shown(text) + ": out of range " + std::to_string(low) + " to " +
                     std::to_string(high));
  }
  return *value;
}

int32_t ReadInt(const std::string& option, const std::string& text) {
  return static_cast<int32_t>(
      ReadNumber(option, text, std::numeric_limits<int32_t>::min(), std::numeric_limits<int32_t>::max()));
}

void ReadText(const std::string& option, const std::string& text, char (&field)[kSettingTextSize]) {
  if (text.size() >= kSettingTextSize || text.find('\0') != std::string::npos) {
    throw UsageError(option + " " + Shown(text) + ": at most " + std::to_string(kSettingTextSize - 1) + " characters");
  }
  std::memset(field, 0, sizeof field);
  std::memcpy(field, text.data(), text.size());
}

// A settings record is read no further than one byte past its 100.
void ReadSettingsFile(const std::string& path, EditData& settings) {
  const std::string name = "settings file " + tool_input::InputName(path);
  std::string bytes;
  try {
    bytes = tool_input::ReadBounded(path, sizeof(EditData));
  } catch (const tool_input::InputError& error) {
    if (!error.tooLarge()) throw UsageError("cannot read " + name + ": " + error.what());
    throw UsageError(name + " holds more than " + std::to_string(sizeof(EditData)) + " bytes; expected a " +
                     std::to_string(sizeof(EditData)) + "-byte settings record");
  }
  if (bytes.size() != sizeof(EditData)) {
    throw UsageError(name + " holds " + std::to_string(bytes.size()) + " bytes, not " +
                     std::to_string(sizeof(EditData)));
  }
  std::memcpy(&settings, bytes.data(), sizeof settings);
}

}  // namespace

PreviewOptions ReadPreviewOptions(int argc, const char* const* argv) {
  const std::vector<tool_input::Argument> arguments = tool_input::ReadCommandLine(argc, argv, kOptions);
  PreviewOptions options;
  WriteEditDataDefaults(options.settings);
  // The file is read first, so that the options given beside it win
  // wherever they stand.
  for (const tool_input::Argument& argument : arguments) {
    if (argument.option == "--help") options.help = true;
    if (argument.option == "--version") options.version = true;
    if (argument.option == "--settings") options.settingsFile = argument.value;
  }
  if (options.help || options.version) return options;
  if (!options.settingsFile.empty()) ReadSettingsFile(options.settingsFile, options.settings);

  EditData& s = options.settings;
  for (const auto& [option, value] : arguments) {
    if (option.empty() && !options.output.empty()) {
      throw UsageError("one output at a time: " + Shown(options.output) + " and " + Shown(value));
    }
    if (option.empty()) options.output = value;
    else if (option == "--starting-angle") ReadText(option, value, s.startAngleText);
    else if (option == "--mass") ReadText(option, value, s.massText);
    else if (option == "--link-spacing") ReadText(option, value, s.linkSpacingText);
    else if (option == "--gravity") ReadText(option, value, s.gravityText);
    else if (option == "--anchor-width") s.anchorWidth = ReadInt(option, value);
    else if (option == "--anchor-height") s.anchorHeight = ReadInt(option, value);
    else if (option == "--link-width") s.linkWidth = ReadInt(option, value);
    else if (option == "--link-height") s.linkHeight = ReadInt(option, value);
    else if (option == "--platform-width") s.platformWidth = ReadInt(option, value);
    else if (option == "--platform-height") s.platformHeight = ReadInt(option, value);
    else if (option == "--number-of-links") s.linkCount = ReadInt(option, value);
    else if (option == "--view-template") s.viewTemplate = static_cast<uint8_t>(ReadNumber(option, value, 0, 255));
    else if (option == "--save-settings") options.saveSettings = value;
    else if (option == "--left") options.left = ReadInt(option, value);
    else if (option == "--top") options.top = ReadInt(option, value);
    else if (option == "--window-width") options.windowWidth = static_cast<int32_t>(ReadNumber(option, value, 1, 4096));
    else if (option == "--window-height") options.windowHeight = static_cast<int32_t>(ReadNumber(option, value, 1, 4096));
    else if (option == "--explain") options.explain = true;
  }
  if (options.output.empty() && options.saveSettings.empty()) {
    throw UsageError("no output file given; expected OUTPUT.png or --save-settings FILE (editor_preview --help)");
  }
  if (options.output.empty() && options.explain) throw UsageError("--explain draws a picture; expected OUTPUT.png");
  if (options.explain && (options.windowWidth != 0 || options.windowHeight != 0)) {
    throw UsageError("--explain sizes its picture to what it shows; expected no --window-width or --window-height");
  }
  return options;
}

}  // namespace editor_preview
