#include "chain_template.h"

#include <cstdio>

#include "editor/template_reading.h"

namespace editor_preview {

ChainTemplate::ChainTemplate(const EditData& settings)
    : spacing(SettingInteger(settings.linkSpacingText)),
      angle(SettingInteger(settings.startAngleText)),
      radius((static_cast<double>(settings.linkHeight) + spacing) * (static_cast<double>(settings.linkCount) + 1)),
      width(settings.platformWidth + 2 * radius),
      height(settings.platformHeight + 2 * radius),
      drawnRadius(TemplateRadius(settings, spacing)) {}

std::string Whole(double value) {
  char text[48];
  std::snprintf(text, sizeof text, "%.0f", value);
  return text;
}

}  // namespace editor_preview
