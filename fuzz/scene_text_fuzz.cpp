// Any text given to the scene player as a scene is either read or refused
// with a SceneError, never another exception, and every message and warning
// it makes is one printable line, whatever bytes the text holds.
#include <string>
#include <string_view>
#include <vector>

#include "fuzz_input.h"
#include "scene_parser.h"

namespace {

bool OneLine(const std::string& text) {
  for (const char c : text) {
    if (static_cast<unsigned char>(c) < 0x20 || c == 0x7F) return false;
  }
  return !text.empty();
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  std::vector<std::string> warnings;
  try {
    scene_player::ParseScene(std::string_view(reinterpret_cast<const char*>(data), size), warnings);
  } catch (const scene_player::SceneError& error) {
    Check(OneLine(error.place()) && OneLine(error.what()));
  }
  for (const std::string& warning : warnings) Check(OneLine(warning));
  return 0;
}
