#include <cmath>
#include <cstring>

#include <gtest/gtest.h>

#include "frame/setting_text.h"

namespace {

TEST(SettingText, ReadsTheLongestDecimalPrefixOfItsFieldAndNothingElse) {
  const struct {
    const char* text;
    double value;
    std::size_t size = 0;  // the field's size; 0: the text and its terminator
  } cases[] = {
      {"90", 90.0}, {"9.81", 9.81}, {" 45abc", 45.0}, {"\t\r-2.5x", -2.5}, {"+3", 3.0}, {".5", 0.5},
      {"5.", 5.0}, {"1e+2", 100.0}, {"2.5E-1", 0.25},
      // An incomplete exponent is not part of the number.
      {"1e", 1.0}, {"1e+", 1.0}, {"7E-x", 7.0},
      // No number at all.
      {"", 0.0}, {"   ", 0.0}, {"abc", 0.0}, {"-", 0.0}, {".", 0.0}, {"e5", 0.0},
      // Decimal notation with a point only: a comma ends the number.
      {"9,81", 9.0}, {"0x10", 0.0}, {"inf", 0.0}, {"nan", 0.0}, {"-infinity", 0.0},
      {"1e999", INFINITY}, {"-1e999", -INFINITY}, {"1e-999", 0.0},
      // Ten bytes without a terminator, then what would be the next field.
      {"123456789077", 1234567890.0, 10}, {"        1e5", 1.0, 10},
  };
  for (const auto& c : cases) {
    EXPECT_EQ(ParseDecimalPrefix(c.text, c.size != 0 ? c.size : std::strlen(c.text) + 1), c.value)
        << '"' << c.text << '"';
  }
}

}  // namespace
