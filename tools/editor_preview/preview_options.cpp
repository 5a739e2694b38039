#include "preview_options.h"

#include <charconv>
#include <cstring>
#include <fstream>
#include <iterator>
#include <limits>
#include <vector>

namespace editor_preview {

const char* const kUsage =
    "usage: editor_preview [OPTIONS] OUTPUT.png\n"
    "Runs the library's editor display for the given settings, as the frame editor\n"
    "calls it, and writes what the editor shows as a PNG: the object's picture, or with\n"
    "--view-template 1 the preview of one chain built from the template sizes.\n"
    "Settings start from those of a new object; a settings file replaces them, and each\n"
    "option below replaces one field, in the setup dialog's names:\n"
    "  --settings FILE          a saved 100-byte settings record\n"
    "  --starting-angle TEXT    starting angle in degrees, as typed (at most 9 characters)\n"
    "  --mass TEXT              mass (not drawn; stored as typed)\n"
    "  --link-spacing TEXT      spacing between links in pixels, as typed\n"
    "  --gravity TEXT           gravity (not drawn; stored as typed)\n"
    "  --anchor-width N         anchor width in pixels\n"
    "  --anchor-height N        anchor height in pixels\n"
    "  --link-width N           link width (not drawn)\n"
    "  --link-height N          link height: each link adds it to the chain's length\n"
    "  --platform-width N       platform width in pixels\n"
    "  --platform-height N      platform height in pixels\n"
    "  --number-of-links N      number of links\n"
    "  --view-template N        1: the template preview; 0: the object's picture;\n"
    "                           any other value up to 255 draws nothing\n"
    "Placement and picture:\n"
    "  --left N, --top N        the object's top-left corner in the editor (default 0 0)\n"
    "  --window-width N, --window-height N\n"
    "                           the picture's size, 1 to 4096 (default: the object's\n"
    "                           rectangle and 64 pixels beyond it, for the labels)\n"
    "  --help                   this text\n"
    "Numbers are whole decimal numbers. The picture replaces OUTPUT.png only once it is\n"
    "complete. Exit status: 0 done, 1 the picture could not be written, 2 bad input.\n";

namespace {

int64_t ReadNumber(const std::string& option, const std::string& text, int64_t low, int64_t high) {
  int64_t value = 0;
  const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), value);
  if (text.empty() || error != std::errc() || end != text.data() + text.size()) {
    throw UsageError(option + " " + text + ": not a whole number");
  }
  if (value < low || value > high) {
    throw UsageError(option + " " + text + ": out of range " + std::to_string(low) + " to " + std::to_string(high));
  }
  return value;
}

int32_t ReadInt(const std::string& option, const std::string& text) {
  return static_cast<int32_t>(
      ReadNumber(option, text, std::numeric_limits<int32_t>::min(), std::numeric_limits<int32_t>::max()));
}

void ReadText(const std::string& option, const std::string& text, char (&field)[kSettingTextSize]) {
  if (text.size() >= kSettingTextSize) {
    throw UsageError(option + " " + text + ": at most " + std::to_string(kSettingTextSize - 1) + " characters");
  }
  std::memset(field, 0, sizeof field);
  std::memcpy(field, text.data(), text.size());
}

void ReadSettingsFile(const std::string& path, EditData& settings) {
  std::ifstream file(path, std::ios::binary);
  if (!file) throw UsageError("cannot read settings file " + path);
  const std::vector<char> bytes((std::istreambuf_iterator<char>(file)), std::istreambuf_iterator<char>());
  if (file.bad()) throw UsageError("cannot read settings file " + path);
  if (bytes.size() != sizeof(EditData)) {
    throw UsageError("settings file " + path + " holds " + std::to_string(bytes.size()) + " bytes, not " +
                     std::to_string(sizeof(EditData)));
  }
  std::memcpy(&settings, bytes.data(), sizeof settings);
}

}  // namespace

PreviewOptions ReadPreviewOptions(int argc, const char* const* argv) {
  PreviewOptions options;
  WriteEditDataDefaults(options.settings);
  // The file is read first, so that the options given beside it win
  // wherever they stand.
  for (int i = 1; i + 1 < argc; ++i) {
    if (std::strcmp(argv[i], "--settings") == 0) {
      ReadSettingsFile(argv[i + 1], options.settings);
      options.settingsFile = argv[i + 1];
    }
  }

  EditData& s = options.settings;
  for (int i = 1; i < argc; ++i) {
    const std::string arg = argv[i];
    if (arg == "--help" || arg == "-h") {
      options.help = true;
      return options;
    }
    if (arg.empty() || arg[0] != '-') {
      if (!options.output.empty()) throw UsageError("one output at a time: " + options.output + " and " + arg);
      options.output = arg;
      continue;
    }
    if (i + 1 >= argc) throw UsageError(arg + " needs a value");
    const std::string value = argv[++i];
    if (arg == "--settings") continue;  // read above
    else if (arg == "--starting-angle") ReadText(arg, value, s.startAngleText);
    else if (arg == "--mass") ReadText(arg, value, s.massText);
    else if (arg == "--link-spacing") ReadText(arg, value, s.linkSpacingText);
    else if (arg == "--gravity") ReadText(arg, value, s.gravityText);
    else if (arg == "--anchor-width") s.anchorWidth = ReadInt(arg, value);
    else if (arg == "--anchor-height") s.anchorHeight = ReadInt(arg, value);
    else if (arg == "--link-width") s.linkWidth = ReadInt(arg, value);
    else if (arg == "--link-height") s.linkHeight = ReadInt(arg, value);
    else if (arg == "--platform-width") s.platformWidth = ReadInt(arg, value);
    else if (arg == "--platform-height") s.platformHeight = ReadInt(arg, value);
    else if (arg == "--number-of-links") s.linkCount = ReadInt(arg, value);
    else if (arg == "--view-template") s.viewTemplate = static_cast<uint8_t>(ReadNumber(arg, value, 0, 255));
    else if (arg == "--left") options.left = ReadInt(arg, value);
    else if (arg == "--top") options.top = ReadInt(arg, value);
    else if (arg == "--window-width") options.windowWidth = static_cast<int32_t>(ReadNumber(arg, value, 1, 4096));
    else if (arg == "--window-height") options.windowHeight = static_cast<int32_t>(ReadNumber(arg, value, 1, 4096));
    else throw UsageError("unknown option " + arg);
  }
  if (options.output.empty()) throw UsageError("no output file given (editor_preview --help)");
  return options;
}

}  // namespace editor_preview
