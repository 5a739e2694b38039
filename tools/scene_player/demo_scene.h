// The demo scene, demo_scene.json, built into the program.
#pragma once

#include <string_view>

namespace scene_player {

std::string_view DemoScene();

}  // namespace scene_player
