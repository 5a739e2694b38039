// Reads a scene from its JSON text and checks all of it before anything is
// played or written.
#pragma once

#include <stdexcept>
#include <string>
#include <string_view>
#include <vector>

#include "scene.h"

namespace scene_player {

// What is wrong with a scene: the place in the file (a JSON path such as
// `timeline[3].do[1]`, or a line and column for text that is not JSON) and
// what was expected there.
class SceneError : public std::runtime_error {
 public:
  SceneError(std::string place, const std::string& message)
      : std::runtime_error(message), place_(std::move(place)) {}
  const std::string& place() const { return place_; }

 private:
  std::string place_;
};

// Throws SceneError for the first fault found. What is not a fault but
// likely a slip (a key given twice in one object) is added to `warnings`,
// each "PLACE: message".
Scene ParseScene(std::string_view text, std::vector<std::string>& warnings);

}  // namespace scene_player
