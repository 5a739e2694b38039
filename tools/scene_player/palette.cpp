#include "palette.h"

#include <algorithm>
#include <stdexcept>

namespace scene_player {

namespace {

// Halfway between the object's colour and the background: a trail reads as
// where the platform was, not where it is.
Colour TrailShade(Colour colour, Colour background) {
  auto mix = [](uint8_t a, uint8_t b) { return static_cast<uint8_t>((a + b) / 2); };
  return {mix(colour.r, background.r), mix(colour.g, background.g), mix(colour.b, background.b)};
}

std::vector<Colour> SceneColours(const Scene& scene) {
  std::vector<Colour> colours{scene.background};
  for (const ObjectSpec& object : scene.objects) {
    for (Colour colour : {object.colour, TrailShade(object.colour, scene.background)}) {
      if (std::find(colours.begin(), colours.end(), colour) == colours.end()) colours.push_back(colour);
    }
  }
  return colours;
}

}  // namespace

std::size_t PaletteSize(const Scene& scene) { return SceneColours(scene).size(); }

Palette::Palette(const Scene& scene) : colours_(SceneColours(scene)) {
  if (colours_.size() > kMaxPaletteColours) throw std::logic_error("the scene has more colours than a palette holds");
  for (const ObjectSpec& object : scene.objects) {
    objects_.push_back(IndexOf(object.colour));
    trails_.push_back(IndexOf(TrailShade(object.colour, scene.background)));
  }
}

uint8_t Palette::IndexOf(Colour colour) const {
  return static_cast<uint8_t>(std::find(colours_.begin(), colours_.end(), colour) - colours_.begin());
}

}  // namespace scene_player
