#include "trace_writer.h"

#include <nlohmann/json.hpp>

namespace scene_player {

void WriteTraceLine(std::FILE* file, int frame, const Scene& scene, const Player& player) {
  using json = nlohmann::ordered_json;
  const RunData& rd = player.extension();
  auto nameOf = [&](const HostObject* object) -> json {
    const int index = player.IndexOf(object);
    return index < 0 ? json(nullptr) : json(scene.objects[static_cast<std::size_t>(index)].name);
  };

  // Floats are written as the doubles they convert to exactly, so a reader
  // gets back the stored float bits; a value that is not finite is null.
  json chains = json::array();
  for (uint32_t i = 0; i < ChainCount(rd); ++i) {
    const ChainRecord& r = rd.chains->At(i);
    chains.push_back({{"anchor", nameOf(r.anchor)},
                      {"mass", double{r.mass}},
                      {"angle", double{r.angle}},
                      {"speed", double{r.speed}},
                      {"linkSpacing", double{r.linkSpacing}},
                      {"prevPlatformX", double{r.prevPlatformX}},
                      {"prevPlatformY", double{r.prevPlatformY}},
                      {"platformX", double{r.platformX}},
                      {"platformY", double{r.platformY}},
                      {"acceleration", double{r.acceleration}},
                      {"swinging", r.swinging}});
  }
  json objects = json::array();
  for (std::size_t i = 0; i < scene.objects.size(); ++i) {
    const HostObject* object = player.live(i);
    if (object == nullptr) continue;
    objects.push_back({{"name", scene.objects[i].name},
                       {"x", object->head.x},
                       {"y", object->head.y},
                       {"direction", object->direction}});
  }
  const json line = {{"frame", frame}, {"currentChain", rd.currentChain}, {"chains", chains}, {"objects", objects}};
  const std::string text = line.dump() + "\n";
  std::fwrite(text.data(), 1, text.size(), file);
}

}  // namespace scene_player
