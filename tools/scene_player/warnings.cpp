#include "warnings.h"

#include <charconv>
#include <cmath>
#include <cstdio>
#include <optional>
#include <utility>

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

// Whether a condition holds now but did not at the last check; remembers it.
bool Appears(bool now, bool& before) {
  const bool appeared = now && !before;
  before = now;
  return appeared;
}

}  // namespace

std::vector<std::string> SettingWarnings(const Scene& scene, const RunData& rd) {
  struct Setting {
    const char* key;
    const std::string& text;  // as the scene gives it
    float stored;             // as the library read it
  };
  const Setting settings[] = {{"startAngle", scene.settings.startAngle, rd.startAngle},
                              {"mass", scene.settings.mass, rd.defaultMass},
                              {"gravity", scene.settings.gravity, rd.gravity},
                              {"linkSpacing", scene.settings.linkSpacing, rd.defaultLinkSpacing}};
  std::vector<std::string> warnings;
  for (const auto& [key, text, stored] : settings) {
    const std::string start = std::string("settings.") + key + ": the text \"" + text + "\" ";
    if (!IsNumber(text)) {
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
  if (Appears(chains > 0 && links % chains != 0, uneven_)) {
    warnings.push_back(at + std::to_string(links) + " links do not divide evenly among " + std::to_string(chains) +
                       " chains: each chain takes " + std::to_string(links / chains) +
                       " in the order they were added, and the last " + std::to_string(links % chains) +
                       " belong to no chain");
  }

  // Heights from the scene: the objects in the list are those of the scene,
  // and what the library knows of them never changes.
  auto heightOf = [&](uint32_t j) {
    const int index = player.IndexOf(rd.links->At(j));
    return index < 0 ? -1 : scene.objects[static_cast<std::size_t>(index)].height;
  };
  uint32_t other = 1;  // the first link whose height differs from the first's
  while (other < links && heightOf(other) == heightOf(0)) ++other;
  if (Appears(other < links, heights_)) {
    warnings.push_back(at + "links of differing heights (" + std::to_string(heightOf(0)) + " and " +
                       std::to_string(heightOf(other)) + "): every chain's length comes from the height of the "
                       "first link added; each link is placed by its own height");
  }

  std::optional<std::pair<uint32_t, float>> notFinite;  // the first chain and its value
  for (uint32_t i = 0; i < chains && !notFinite; ++i) {
    const ChainRecord& r = rd.chains->At(i);
    for (float value : {r.mass, r.angle, r.speed, r.linkSpacing, r.acceleration, r.platformX, r.platformY}) {
      if (!std::isfinite(value)) {
        notFinite = {i, value};
        break;
      }
    }
  }
  if (Appears(notFinite.has_value(), notFinite_)) {
    warnings.push_back(at + "chain " + std::to_string(notFinite->first) +
                       " holds a value that is no longer finite (" + Number(notFinite->second) +
                       "): what follows from it is not finite either");
  }
  return warnings;
}

}  // namespace scene_player
