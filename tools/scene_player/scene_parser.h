// Reads a scene from its JSON text and checks all of it before anything is
// played or written.
#pragma once

#include <stdexcept>
#include <string>
#include <string_view>

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

// Throws SceneError for the first fault found.
Scene ParseScene(std::string_view text);

}  // namespace scene_player
