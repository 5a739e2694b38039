// The host's record of one object on the frame, and the run-time services
// reached from it. Only the fields the extension touches are named; the rest
// is the host's and kept as opaque bytes so every named field sits at the
// byte offset the host uses on every target.
#pragma once

#include <cstddef>
#include <cstdint>

#include "frame/abi.h"

struct HostRunContext;

// The first 184 bytes of every host object. The extension's own object is
// exactly this header, at the head of RunData.
struct HostObjectHeader {
  int16_t idLow;  // low half of the object identifier
  uint8_t reserved0[6];
  HostRunContext* context;  // run-time service slots
  uint8_t reserved1[26 - 8 - sizeof(void*)];
  uint16_t idHigh;  // high half of the object identifier
  uint8_t reserved2[76 - 28];
  int32_t x;
  uint8_t reserved3[4];
  int32_t y;  // grows downwards
  uint8_t reserved4[100 - 88];
  int32_t height;
  uint8_t reserved5[124 - 104];
  uint16_t flags;
  uint8_t reserved6[184 - 126];
};

// A whole host object as the host hands it to actions (links, anchors,
// platforms). Longer than the header: direction and changed lie past it.
struct HostObject {
  HostObjectHeader head;
  uint8_t reserved7[236 - 184];
  int32_t direction;  // 0 to 31, steps of 11.25 degrees
  uint8_t reserved8[252 - 240];
  int32_t changed;  // 1 after a move or turn: the host redraws the object
};

constexpr uint16_t kFlagDestroyed = 0x0001;    // stays readable until the frame's handle call ran
constexpr uint16_t kFlagFloatResult = 0x4000;  // the current expression result is a float

static_assert(offsetof(HostObjectHeader, idLow) == 0);
static_assert(offsetof(HostObjectHeader, context) == 8);
static_assert(offsetof(HostObjectHeader, idHigh) == 26);
static_assert(offsetof(HostObjectHeader, x) == 76);
static_assert(offsetof(HostObjectHeader, y) == 84);
static_assert(offsetof(HostObjectHeader, height) == 100);
static_assert(offsetof(HostObjectHeader, flags) == 124);
static_assert(sizeof(HostObjectHeader) == 184);
static_assert(offsetof(HostObject, direction) == 236);
static_assert(offsetof(HostObject, changed) == 252);
static_assert(sizeof(HostObject) == 256);

// The object identifier: the high half shifted left by 16 plus the low half
// sign-extended, in 32-bit arithmetic (idHigh 1, idLow -1 gives 65535).
inline int32_t ObjectIdentifier(const HostObjectHeader& object) {
  const uint32_t high = static_cast<uint32_t>(object.idHigh) << 16;
  const uint32_t low = static_cast<uint32_t>(static_cast<int32_t>(object.idLow));
  return static_cast<int32_t>(high + low);
}

inline bool IsBeingDestroyed(const HostObject& object) {
  return (object.head.flags & kFlagDestroyed) != 0;
}
