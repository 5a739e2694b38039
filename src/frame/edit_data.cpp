#include "frame/edit_data.h"

#include <cstring>

namespace {

void SetText(char (&field)[kSettingTextSize], const char* text) {
  std::memset(field, 0, sizeof field);
  std::strncpy(field, text, sizeof field - 1);
}

}  // namespace

void WriteEditDataDefaults(EditData& data) {
  data.reserved20 = 0;
  data.reserved22 = 0;
  data.objectWidth = 32;
  data.objectHeight = 32;
  SetText(data.startAngleText, "90");
  SetText(data.massText, "1");
  SetText(data.gravityText, "9.81");
  SetText(data.linkSpacingText, "0");
  data.anchorWidth = 32;
  data.anchorHeight = 32;
  data.platformWidth = 64;
  data.platformHeight = 32;
  data.linkWidth = 32;
  data.linkHeight = 32;
  data.linkCount = 10;
  data.viewTemplate = 0;
}
