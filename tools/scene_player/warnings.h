// Warnings about what the library does that may surprise an author, because
// it is how the extension works rather than a fault of the scene: said once,
// one line each, and the scene plays on.
#pragma once

#include <string>
#include <vector>

#include "player.h"
#include "scene.h"

namespace scene_player {

// Settings whose text the library does not read as the number it shows, or
// that it reads as a number no author means: "settings.gravity: the text
// ...". Called once the run-time object exists.
std::vector<std::string> SettingWarnings(const Scene& scene, const RunData& extension);

// Once the run is over: the "On Swing" rules whose chain never existed.
std::vector<std::string> RuleWarnings(const Scene& scene, const Player& player);

// What a frame has left: links that do not divide evenly among the chains,
// links of differing heights, a chain swinging with no links, a chain that
// turns more than a full turn in a frame, chain values that are no longer
// finite. Each is said when it first appears, and again only after it has
// gone away. Links that changed chains are said in the frame they change.
class FrameWarnings {
 public:
  std::vector<std::string> Check(const Scene& scene, const Player& player, int frame);

 private:
  // The links that changed chains in `frame`, or an empty text.
  std::string RegroupedLinks(const Scene& scene, const Player& player, int frame);

  bool uneven_ = false;
  bool heights_ = false;
  bool noLinks_ = false;
  bool spinning_ = false;
  bool notFinite_ = false;
  // For each scene object that has been a link of a chain, the scene object
  // of that chain's anchor at the end of the last frame it belonged to one
  // (-1: never), and that frame.
  struct Owner {
    int anchor = -1;
    int frame = -1;
  };
  std::vector<Owner> owners_;
};

}  // namespace scene_player
