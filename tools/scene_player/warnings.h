// Warnings about what the library does that may surprise an author, because
// it is how the extension works rather than a fault of the scene: said once,
// one line each, and the scene plays on.
#pragma once

#include <string>
#include <vector>

#include "player.h"
#include "scene.h"

namespace scene_player {

// Settings whose text the library does not read as the number it shows:
// "settings.gravity: the text ...". Called once the run-time object exists.
std::vector<std::string> SettingWarnings(const Scene& scene, const RunData& extension);

// What a frame has left: links that do not divide evenly among the chains,
// links of differing heights, chain values that are no longer finite. Each
// is said when it first appears, and again only after it has gone away.
class FrameWarnings {
 public:
  std::vector<std::string> Check(const Scene& scene, const Player& player, int frame);

 private:
  bool uneven_ = false;
  bool heights_ = false;
  bool notFinite_ = false;
};

}  // namespace scene_player
