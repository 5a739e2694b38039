// The settings record of one object, stored by the host with the game. The
// same 100-byte layout on every target (it holds no pointer).
#pragma once

#include <cstddef>
#include <cstdint>

constexpr std::size_t kSettingTextSize = 10;  // at most 9 characters and a terminator

struct EditData {
  uint8_t hostHeader[20];  // the host's own; never read or written here
  uint16_t reserved20;
  uint16_t reserved22;
  int16_t objectWidth;
  int16_t objectHeight;
  char startAngleText[kSettingTextSize];
  char massText[kSettingTextSize];
  char gravityText[kSettingTextSize];
  char linkSpacingText[kSettingTextSize];
  int32_t anchorWidth;
  int32_t anchorHeight;
  int32_t platformWidth;
  int32_t platformHeight;
  int32_t linkWidth;
  int32_t linkHeight;
  int32_t linkCount;
  uint8_t viewTemplate;  // 1: the editor draws the template preview
  uint8_t fill[3];
};

static_assert(offsetof(EditData, reserved20) == 20);
static_assert(offsetof(EditData, objectWidth) == 24);
static_assert(offsetof(EditData, objectHeight) == 26);
static_assert(offsetof(EditData, startAngleText) == 28);
static_assert(offsetof(EditData, massText) == 38);
static_assert(offsetof(EditData, gravityText) == 48);
static_assert(offsetof(EditData, linkSpacingText) == 58);
static_assert(offsetof(EditData, anchorWidth) == 68);
static_assert(offsetof(EditData, anchorHeight) == 72);
static_assert(offsetof(EditData, platformWidth) == 76);
static_assert(offsetof(EditData, platformHeight) == 80);
static_assert(offsetof(EditData, linkWidth) == 84);
static_assert(offsetof(EditData, linkHeight) == 88);
static_assert(offsetof(EditData, linkCount) == 92);
static_assert(offsetof(EditData, viewTemplate) == 96);
static_assert(sizeof(EditData) == 100);

// Writes the defaults of a new object into every field from offset 20 on;
// the host's header and the three fill bytes are left as they are.
void WriteEditDataDefaults(EditData& data);
