#include "warnings.h"

#include <charconv>
#include <cmath>
#include <optional>
#include <tuple>
#include <utility>

#include "messages.h"
#include "shown_text.h"

namespace scene_player {

namespace {

using tool_input::ShownNumber;

constexpr double kFullTurn = 360.0;

std::string Quoted(const Scene& scene, int object) {
  return tool_input::Quoted(scene.objects[static_cast<std::size_t>(object)].name);
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

std::string At(int frame) { return "frame " + std::to_string(frame) + ": "; }

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
    const std::string start = std::string("settings.") + key + ": the text " + tool_input::Quoted(text) + " ";
    if (!IsNumber(text)) {
      warnings.push_back(start + "is not a number; the library reads the number it starts with, here " +
                         ShownNumber(stored));
    } else if (!std::isfinite(stored)) {
      warnings.push_back(start + "is beyond the range of a float; the library reads it as " + ShownNumber(stored));
    }
  }
  if (std::isfinite(rd.startAngle) && std::fabs(rd.startAngle) > kFullTurn) {
    warnings.push_back("settings.startAngle: every chain starts " + ShownNumber(rd.startAngle) +
                       " degrees from hanging straight down, more than a full turn (360)");
  }
  return warnings;
}

std::vector<std::string> FrameWarnings::Check(const Scene& scene, const Player& player, int frame) {
  const RunData& rd = player.extension();
  std::vector<std::string> warnings;

  const uint32_t links = LinkCount(rd), chains = ChainCount(rd);
  if (Appears(chains > 0 && links % chains != 0, uneven_)) {
    warnings.push_back(At(frame) + std::to_string(links) + (links == 1 ? " link does" : " links do") +
                       " not divide evenly among " + std::to_string(chains) + " chains: each chain takes " +
                       std::to_string(links / chains) + " in the order they were added, and the last " +
                       std::to_string(links % chains) + " belong to no chain");
  }

  // Every object in the lists is on the frame: the library dropped the
  // destroyed ones before the host freed them.
  const auto heightOf = [&](uint32_t j) { return rd.links->At(j)->head.height; };
  uint32_t other = 1;  // the first link whose height differs from the first's
  while (other < links && heightOf(other) == heightOf(0)) ++other;
  if (Appears(other < links, heights_)) {
    warnings.push_back(At(frame) + "links of differing heights (" + std::to_string(heightOf(0)) + " and " +
                       std::to_string(heightOf(other)) + "): every chain's length comes from the height of the "
                       "first link added; each link is placed by its own height");
  }

  bool swings = false;
  std::optional<std::pair<uint32_t, float>> spinning, notFinite;  // the first chain and its value
  for (uint32_t i = 0; i < chains; ++i) {
    const ChainRecord& r = rd.chains->At(i);
    swings = swings || r.swinging == 1;
    if (!spinning && std::isfinite(r.speed) && std::fabs(r.speed) > kFullTurn) spinning = {i, r.speed};
    for (float value : {r.mass, r.angle, r.speed, r.linkSpacing, r.acceleration, r.platformX, r.platformY}) {
      if (!notFinite && !std::isfinite(value)) notFinite = {i, value};
    }
  }
  if (Appears(swings && links == 0, noLinks_)) {
    warnings.push_back(At(frame) + "a chain swings with no links at all (none were added, or all were destroyed): "
                       "its length is then only its link spacing, and its platform hangs that close to its anchor");
  }
  if (Appears(spinning.has_value(), spinning_)) {
    warnings.push_back(At(frame) + "chain " + std::to_string(spinning->first) + " turns " +
                       ShownNumber(spinning->second) + " degrees in one frame, more than a full turn: its gravity "
                       "x mass is far too large for its length, or its speed was set so");
  }
  if (std::string regrouped = RegroupedLinks(scene, player, frame); !regrouped.empty()) {
    warnings.push_back(std::move(regrouped));
  }
  if (Appears(notFinite.has_value(), notFinite_)) {
    warnings.push_back(At(frame) + "chain " + std::to_string(notFinite->first) +
                       " holds a value that is no longer finite (" + ShownNumber(notFinite->second) +
                       "): what follows from it is not finite either");
  }
  return warnings;
}

std::string FrameWarnings::RegroupedLinks(const Scene& scene, const Player& player, int frame) {
  const RunData& rd = player.extension();
  owners_.resize(scene.objects.size());
  int moved = -1, from = -1, to = -1, count = 0;
  const uint32_t perChain = LinksPerChain(rd);
  for (uint32_t i = 0; i < ChainCount(rd); ++i) {
    const int anchor = player.IndexOf(rd.chains->At(i).anchor);
    for (uint32_t k = 0; k < perChain; ++k) {
      const int link = player.IndexOf(rd.links->At(perChain * i + k));
      if (link < 0 || anchor < 0) continue;
      // A link added twice is in two places: the first is its chain.
      Owner& owner = owners_[static_cast<std::size_t>(link)];
      if (owner.frame == frame) continue;
      if (owner.anchor >= 0 && owner.anchor != anchor) {
        if (count++ == 0) std::tie(moved, from, to) = std::tuple(link, owner.anchor, anchor);
      }
      // A link keeps the chain it last belonged to while it belongs to none.
      owner = {anchor, frame};
    }
  }
  if (count == 0) return {};
  return At(frame) + "link " + Quoted(scene, moved) + " went from the chain of anchor " + Quoted(scene, from) +
         " to the chain of anchor " + Quoted(scene, to) +
         (count > 1 ? " (" + std::to_string(count) + " links changed chains)" : "") +
         ": the library shares the links out among the chains in the order they were added, so adding or removing a "
         "chain or a link regroups them";
}

std::vector<std::string> RuleWarnings(const Scene& scene, const Player& player) {
  const uint32_t mostChains = player.mostChains();
  std::vector<std::string> warnings;
  for (std::size_t i = 0; i < scene.rules.size(); ++i) {
    const int32_t chain = scene.rules[i].chain;
    if (chain >= 0 && static_cast<uint32_t>(chain) < mostChains) continue;
    warnings.push_back("onSwing[" + std::to_string(i) + "].chain: the rule is for chain " + std::to_string(chain) +
                       (chain < 0 ? ", but chain numbers count from 0"
                                  : ", but the scene never had more than " + Counted(mostChains, "chain")) +
                       ": it never ran");
  }
  return warnings;
}

}  // namespace scene_player
