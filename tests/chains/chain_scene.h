// A run-time object in the stand-in host with chains built through the
// actions that add anchors, links and platforms, for tests of the step and
// the update.
#pragma once

#include <bit>
#include <cstdint>

#include "chains/run_data.h"
#include "frame/edit_data.h"
#include "host.h"

struct ChainScene {
  static EditData Defaults() {
    EditData edit{};
    WriteEditDataDefaults(edit);
    return edit;
  }

  standin::Host host{Defaults()};
  RunData& rd = host.extension();

  // A new chain, resting or swinging, anchored at (x, y).
  HostObject* Anchor(int32_t x, int32_t y, uint8_t swinging = 0) {
    HostObject* anchor = Add(0, x, y, 32);  // "Add Anchor"
    rd.chains->At(rd.chains->Count() - 1).swinging = swinging;
    return anchor;
  }
  HostObject* Link(int32_t height) { return Add(1, 0, 0, height); }  // "Add Link"
  HostObject* Platform() { return Add(2, 0, 0, 32); }                // "Add Platform"
  HostObject* Add(int action, int32_t x, int32_t y, int32_t height) {
    HostObject* object = host.AddObject(x, y, height);
    host.Action(action, reinterpret_cast<intptr_t>(object));
    return object;
  }
  ChainRecord& Chain(uint32_t i) { return rd.chains->At(i); }
};

inline uint32_t Bits(float value) { return std::bit_cast<uint32_t>(value); }

// Four swinging chains of differing angles, masses and spacings over 22
// links of differing heights: the golden scene.
inline void BuildFixedScene(ChainScene& scene) {
  const float angles[] = {90.0f, -35.5f, 12.25f, 170.0f};
  const float masses[] = {1.0f, 3.5f, 0.25f, 9.0f};
  for (int c = 0; c < 4; ++c) {
    scene.Anchor(120 * c - 100, 40 + 7 * c);
    ChainRecord& chain = scene.Chain(static_cast<uint32_t>(c));
    chain.angle = angles[c];
    chain.mass = masses[c];
    chain.linkSpacing = 1.5f * static_cast<float>(c);
    chain.swinging = 1;
    scene.Platform();
  }
  for (int l = 0; l < 22; ++l) scene.Link(12 + (l * 7) % 19);
}
