// What the event tests share: the codes of the routines as the event editor
// stores them, and a host running one object with the stored defaults.
#pragma once

#include <gtest/gtest.h>

#include <cstdint>

#include "chains/chain_scene.h"

namespace action {
enum : int {
  AddAnchor = 0, AddLink, AddPlatform, SetAnchorX, SetAnchorY, SetMass, SetAngle, SetSpeed,
  SetLinkSpacing, StartAll, StartChain, StopAll, StopChain, UpdateAll, UpdateChain, SetAcceleration,
};
}  // namespace action

namespace condition {
enum : int { ChainIsSwinging = 0, OnSwing };
}  // namespace condition

namespace expression {
enum : int {
  ChainNum = 0, ChainLinks, AnchorX, AnchorY, PlatformMass, ChainAngle, ChainSpeed, LinkSpacing,
  PlatformX, PlatformY, ChainIndex, DeltaX, DeltaY, ChainAccel, LinkIndex, LinkX, LinkY,
};
}  // namespace expression

class EventTest : public ::testing::Test {
 protected:
  // An object parameter is the address of the object's host record.
  static intptr_t Ref(HostObject* object) { return reinterpret_cast<intptr_t>(object); }

  // Adds a new object through the action `code`. Unless one is given, each
  // gets an identifier of its own, so a search can only find the object it
  // is given.
  HostObject* Add(int code, int32_t x = 0, int32_t y = 0, int32_t height = 32, standin::ObjectId id = {}) {
    if (id.low == 0 && id.high == 0) id.low = static_cast<int16_t>(++lastId_);
    HostObject* object = host.AddObject(x, y, height, id);
    host.Action(code, Ref(object));
    return object;
  }
  const ChainRecord& Chain(uint32_t index) { return host.extension().chains->At(index); }

  standin::Host host{ChainScene::Defaults()};  // start angle 90, mass 1, gravity 9.81, spacing 0

 private:
  int lastId_ = 0;
};
