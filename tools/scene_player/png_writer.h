// Writes one frame as a PNG picture with the scene's palette.
#pragma once

#include <cstdio>
#include <string>
#include <vector>

#include "frame_renderer.h"
#include "scene.h"

namespace scene_player {

// Throws std::runtime_error, naming the file by `name`, when the picture
// cannot be written.
void WritePng(std::FILE* file, const std::string& name, const Picture& picture, const std::vector<Colour>& palette);

}  // namespace scene_player
