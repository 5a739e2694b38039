// The per-frame trace: one JSON line per frame with every chain's record and
// every object's position and direction, as the frame left them.
#pragma once

#include <cstdio>

#include "player.h"
#include "scene.h"

namespace scene_player {

void WriteTraceLine(std::FILE* file, int frame, const Scene& scene, const Player& player);

}  // namespace scene_player
