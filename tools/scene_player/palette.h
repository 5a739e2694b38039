// The colours a scene can show. A GIF frame holds at most 256, so the palette
// is fixed when the scene is read: the background, then for each object its
// colour and the shade in which its trail is drawn if it serves as a platform.
#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "scene.h"

namespace scene_player {

constexpr std::size_t kMaxPaletteColours = 256;

class Palette {
 public:
  explicit Palette(const Scene& scene);
  const std::vector<Colour>& colours() const { return colours_; }
  uint8_t background() const { return 0; }
  uint8_t object(std::size_t objectIndex) const { return objects_[objectIndex]; }
  uint8_t trail(std::size_t objectIndex) const { return trails_[objectIndex]; }

 private:
  uint8_t IndexOf(Colour colour) const;

  std::vector<Colour> colours_;
  std::vector<uint8_t> objects_;
  std::vector<uint8_t> trails_;
};

// The number of distinct colours `Palette` would need for the scene.
std::size_t PaletteSize(const Scene& scene);

}  // namespace scene_player
