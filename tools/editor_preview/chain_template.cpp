#include "chain_template.h"

#include <cstdio>

#include "chains/float_math.h"
#include "editor/wrapping_arithmetic.h"
#include "frame/setting_text.h"

namespace editor_preview {

namespace {

// As the editor display reads a setting text: its number, truncated.
int32_t SettingInteger(const char (&text)[kSettingTextSize]) {
  return TruncateToInt(ParseDecimalPrefix(text), 0);
}

}  // namespace

ChainTemplate::ChainTemplate(const EditData& settings)
    : spacing(SettingInteger(settings.linkSpacingText)),
      angle(SettingInteger(settings.startAngleText)),
      radius((static_cast<double>(settings.linkHeight) + spacing) * (static_cast<double>(settings.linkCount) + 1)),
      width(settings.platformWidth + 2 * radius),
      height(settings.platformHeight + 2 * radius),
      drawnRadius(WrapMul(WrapAdd(settings.linkHeight, spacing), WrapAdd(settings.linkCount, 1))) {}

std::string Whole(double value) {
  char text[48];
  std::snprintf(text, sizeof text, "%.0f", value);
  return text;
}

}  // namespace editor_preview
