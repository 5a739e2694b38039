// What the event tests share: the codes of the routines as the event editor
// stores them, and a host running one object with the stored defaults.
#pragma once

#include <gtest/gtest.h>

#include <cstdint>

#include "frame/edit_data.h"
#include "host.h"

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

// The degree factor of the chains: 3.14159 / 180.
constexpr double kDegree = 3.14159 / 180.0;

inline EditData DefaultSettings() {
  EditData settings{};
  WriteEditDataDefaults(settings);  // start angle 90, mass 1, gravity 9.81, spacing 0
  return settings;
}

class EventTest : public ::testing::Test {
 protected:
  // An object parameter is the address of the object's host record.
  static intptr_t Ref(HostObject* object) { return reinterpret_cast<intptr_t>(object); }

  // Adds a new object through the action `code`. Identifiers are distinct,
  // so a search can only find the object it is given.
  HostObject* Add(int code, int32_t x, int32_t y, int32_t height = 32) {
    HostObject* object = host.AddObject(x, y, height, {static_cast<int16_t>(++lastId_), 0});
    host.Action(code, Ref(object));
    return object;
  }
  HostObject* AddAnchor(int32_t x, int32_t y) { return Add(action::AddAnchor, x, y); }
  HostObject* AddLink(int32_t x, int32_t y, int32_t height = 32) { return Add(action::AddLink, x, y, height); }
  HostObject* AddPlatform(int32_t x, int32_t y) { return Add(action::AddPlatform, x, y); }

  const ChainRecord& Chain(uint32_t index) { return host.extension().chains->At(index); }

  standin::Host host{DefaultSettings()};

 private:
  int lastId_ = 0;
};
