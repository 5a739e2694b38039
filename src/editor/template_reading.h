// How the editor display reads the template of one chain from the settings.
#pragma once

#include <cstdint>

#include "chains/float_math.h"
#include "editor/wrapping_arithmetic.h"
#include "frame/edit_data.h"
#include "frame/setting_text.h"

// A setting text parsed as the run-time object parses it (decimal only), then
// truncated toward zero straight from the double, without the run-time
// object's rounding to a float. Beyond the int32 range (a text such as
// "1e999") it saturates.
inline int32_t SettingInteger(const char (&text)[kSettingTextSize]) {
  return TruncateToInt(ParseDecimalPrefix(text), 0);
}

// From the anchor's centre to each platform's: each link adds its height and
// the spacing, and there is one step more than links.
inline int32_t TemplateRadius(const EditData& edit, int32_t spacing) {
  return WrapMul(WrapAdd(edit.linkHeight, spacing), WrapAdd(edit.linkCount, 1));
}
