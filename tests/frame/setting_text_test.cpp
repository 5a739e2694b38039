// How a stored setting text reads as a number.
#include <algorithm>
#include <cmath>
#include <cstring>

#include <gtest/gtest.h>

#include "frame/setting_text.h"

namespace {

TEST(SettingText, ReadsTheLongestDecimalPrefixOfItsFieldAndNothingElse) {
  const struct {
    const char* text;
    double value;
  } cases[] = {
      // The setting_text fuzzer holds plain decimal texts to the C library;
      // here, what it cannot: blanks, letters and commas, and each build's
      // reading of the default and of the ends of the double range.
      {"9.81", 9.81}, {" 45abc", 45.0}, {"\t\r-2.5x", -2.5}, {"7E-x", 7.0}, {"abc", 0.0}, {"9,81", 9.0},
      {"0x10", 0.0}, {"inf", 0.0}, {"nan", 0.0}, {"-infinity", 0.0}, {"1e999", INFINITY}, {"1e-999", 0.0},
      // Exactly halfway (to even, down and up), just above halfway, around the
      // smallest double and at the largest.
      {"1e23", 0x1.52d02c7e14af6p+76}, {"7e22", 0x1.da56a4b0835cp+75}, {"5109e-5", 0x1.a2877ee4e26d5p-5},
      {"2.5e-324", 0x1p-1074}, {"2.47e-324", 0.0}, {"2.225e-308", 0x0.fffdd31a00c6dp-1022},
      {"179769e303", 0x1.ffffc57ca82aep+1023}, {"17977e304", INFINITY},
      // Ten bytes without a terminator, then what would be the next field.
      {"123456789077", 1234567890.0},
  };
  for (const auto& c : cases) {
    char field[kSettingTextSize] = {};
    std::memcpy(field, c.text, std::min(std::strlen(c.text), kSettingTextSize));
    EXPECT_EQ(ParseDecimalPrefix(field), c.value) << '"' << c.text << '"';
  }
}

}  // namespace
