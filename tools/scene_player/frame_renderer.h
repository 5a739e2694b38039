// Draws the frame as the player left it: every object on the frame as its
// rectangle in its colour, centred on its position, over the trail that each
// platform leaves behind it.
#pragma once

#include <cstdint>
#include <deque>
#include <vector>

#include "palette.h"
#include "player.h"
#include "scene.h"

namespace scene_player {

// One picture of indexed colours (indexes into the scene's Palette), row by row.
struct Picture {
  int width = 0, height = 0;
  std::vector<uint8_t> pixels;
};

class FrameRenderer {
 public:
  FrameRenderer(const Scene& scene, const Palette& palette);

  // Draws frame `frame` (called once per frame, in order: the trail grows
  // from the platforms' positions seen at each call).
  const Picture& Render(const Player& player, int frame);

 private:
  struct TrailPoint {
    int frame;
    int32_t x, y;
    uint8_t colour;
  };

  void Fill(int64_t left, int64_t top, int64_t width, int64_t height, uint8_t colour);

  const Scene& scene_;
  const Palette& palette_;
  Picture picture_;
  std::deque<TrailPoint> trail_;
};

}  // namespace scene_player
