#include "frame_renderer.h"

#include <algorithm>

namespace scene_player {

namespace {

constexpr int64_t kTrailDot = 3;  // pixels across one trail point

}  // namespace

FrameRenderer::FrameRenderer(const Scene& scene, const Palette& palette) : scene_(scene), palette_(palette) {
  picture_.width = scene.width;
  picture_.height = scene.height;
  picture_.pixels.resize(static_cast<std::size_t>(scene.width) * static_cast<std::size_t>(scene.height));
}

const Picture& FrameRenderer::Render(const Player& player, int frame) {
  const RunData& rd = player.extension();
  for (uint32_t j = 0; j < PlatformCount(rd); ++j) {
    const HostObject* platform = rd.platforms->At(j);
    const int index = player.IndexOf(platform);
    if (index < 0 || player.live(static_cast<std::size_t>(index)) == nullptr) continue;
    trail_.push_back({frame, platform->head.x, platform->head.y, palette_.trail(static_cast<std::size_t>(index))});
  }
  while (!trail_.empty() && trail_.front().frame <= frame - scene_.trail) trail_.pop_front();

  std::fill(picture_.pixels.begin(), picture_.pixels.end(), palette_.background());
  for (const TrailPoint& point : trail_) {
    Fill(int64_t{point.x} - kTrailDot / 2, int64_t{point.y} - kTrailDot / 2, kTrailDot, kTrailDot, point.colour);
  }
  for (std::size_t i = 0; i < scene_.objects.size(); ++i) {
    const HostObject* object = player.live(i);
    if (object == nullptr) continue;
    const ObjectSpec& spec = scene_.objects[i];
    const int64_t left = int64_t{object->head.x} - spec.width / 2;
    const int64_t top = int64_t{object->head.y} - spec.height / 2;
    Fill(left, top, spec.width, spec.height, palette_.background());
    // A one-pixel edge in the background colour keeps touching objects (the
    // links of a chain hang end to end) apart.
    if (spec.width > 2 && spec.height > 2) {
      Fill(left + 1, top + 1, spec.width - 2, spec.height - 2, palette_.object(i));
    } else {
      Fill(left, top, spec.width, spec.height, palette_.object(i));
    }
  }
  return picture_;
}

void FrameRenderer::Fill(int64_t left, int64_t top, int64_t width, int64_t height, uint8_t colour) {
  const int64_t x0 = std::max<int64_t>(left, 0), x1 = std::min<int64_t>(left + width, picture_.width);
  const int64_t y0 = std::max<int64_t>(top, 0), y1 = std::min<int64_t>(top + height, picture_.height);
  if (x0 >= x1) return;
  for (int64_t y = y0; y < y1; ++y) {
    uint8_t* row = picture_.pixels.data() + y * picture_.width;
    std::fill(row + x0, row + x1, colour);
  }
}

}  // namespace scene_player
