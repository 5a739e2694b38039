// A run-time object in the stand-in host with chains built straight through
// the chain model, for tests of the step and the update.
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
    HostObject* anchor = host.AddObject(x, y, 32);
    AddChain(rd, anchor);
    rd.chains->At(rd.chains->Count() - 1).swinging = swinging;
    return anchor;
  }
  HostObject* Link(int32_t height) {
    HostObject* link = host.AddObject(0, 0, height);
    rd.links->Append(link);
    return link;
  }
  HostObject* Platform() {
    HostObject* platform = host.AddObject(0, 0, 32);
    rd.platforms->Append(platform);
    return platform;
  }
  ChainRecord& Chain(uint32_t i) { return rd.chains->At(i); }
};

inline uint32_t Bits(float value) { return std::bit_cast<uint32_t>(value); }
