#include "demo_scene.h"

#include <cstddef>

// The bytes of demo_scene.json, embedded by the build.
extern const unsigned char kDemoSceneBytes[];
extern const std::size_t kDemoSceneBytesSize;

namespace scene_player {

std::string_view DemoScene() { return {reinterpret_cast<const char*>(kDemoSceneBytes), kDemoSceneBytesSize}; }

}  // namespace scene_player
