#include "warnings.h"

#include <charconv>
#include <cmath>
#include <cstdio>

namespace scene_player {

namespace {

std::string Number(double value) {
  char text[32];
  std::snprintf(text, sizeof text, "%g", value);
  return text;
}

// Whether the text, all of it but blanks around it, is a decimal number.
bool IsNumber(const std::string& text) {
  const auto first = text.find_first_not_of(" \t\n\v\f\r");
  const auto last = text.find_last_not_of(" \t\n\v\f\r");
  if (first == std::string::npos) return false;
  const char* begin = text.data() + first + (text[first] == '+' ? 1 : 0);
  const char* end = text.data() + last + 1;
  double value = 0.0;
  const auto result = std::from_chars(begin, end, value, std::chars_format::general);
  return result.ptr == end && (result.ec == std::errc() || result.ec == std::errc::result_out_of_range) &&
         !std::isnan(value) && !std::isinf(value);
}

}  // namespace

std::vector<std::string> SettingWarnings(const Scene& scene, const RunData& rd) {
  const std::pair<const char*, std::pair<const std::string*, float>> settings[] = {
      {"startAngle", {&scene.settings.startAngle, rd.startAngle}},
      {"mass", {&scene.settings.mass, rd.defaultMass}},
      {"gravity", {&scene.settings.gravity, rd.gravity}},
      {"linkSpacing", {&scene.settings.linkSpacing, rd.defaultLinkSpacing}}};
  std::vector<std::string> warnings;
  for (const auto& [key, setting] : settings) {
    const auto& [text, stored] = setting;
    const std::string start = std::string("settings.") + key + ": the text \"" + *text + "\" ";
    if (!IsNumber(*text)) {
      warnings.push_back(start + "is not a number; the library reads the number it starts with, here " +
                         Number(stored));
    } else if (!std::isfinite(stored)) {
      warnings.push_back(start + "is beyond the range of a float; the library reads it as " + Number(stored));
    }
  }
  return warnings;
}

std::vector<std::string> FrameWarnings::Check(const Scene& scene, const Player& player, int frame) {
  const RunData& rd = player.extension();
  const std::string at = "frame " + std::to_string(frame) + ": ";
  std::vector<std::string> warnings;

  const uint32_t links = LinkCount(rd), chains = ChainCount(rd);
  const bool uneven = chains > 0 && links % chains != 0;
  if (uneven && !uneven_) {
    warnings.push_back(at + std::to_string(links) + " links do not divide evenly among " + std::to_string(chains) +
                       " chains: each chain takes " + std::to_string(links / chains) +
                       " in the order they were added, and the last " + std::to_string(links % chains) +
                       " belong to no chain");
  }
  uneven_ = uneven;

  // Heights from the scene: the objects in the list are those of the scene,
  // and what the library knows of them never changes.
  auto heightOf = [&](uint32_t j) {
    const int index = player.IndexOf(rd.links->At(j));
    return index < 0 ? -1 : scene.objects[static_cast<std::size_t>(index)].height;
  };
  bool differing = false;
  for (uint32_t j = 1; j < links && !differing; ++j) {
    if (heightOf(j) != heightOf(0)) {
      differing = true;
      if (!heights_) {
        warnings.push_back(at + "links of differing heights (" + std::to_string(heightOf(0)) + " and " +
                           std::to_string(heightOf(j)) + "): every chain's length comes from the height of the "
                           "first link added; each link is placed by its own height");
      }
    }
  }
  heights_ = differing;

  bool notFinite = false;
  for (uint32_t i = 0; i < chains && !notFinite; ++i) {
    const ChainRecord& r = rd.chains->At(i);
    for (float value : {r.mass, r.angle, r.speed, r.linkSpacing, r.acceleration, r.platformX, r.platformY}) {
      if (std::isfinite(value)) continue;
      notFinite = true;
      if (!notFinite_) {
        warnings.push_back(at + "chain " + std::to_string(i) + " holds a value that is no longer finite (" +
                           Number(value) + "): what follows from it is not finite either");
      }
      break;
    }
  }
  notFinite_ = notFinite;
  return warnings;
}

}  // namespace scene_player
