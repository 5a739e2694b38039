// How a stored setting text reads as a number.
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
      // The setting_text fuzzer holds plain decimal texts to the C library;
      // here, what it cannot: blanks, letters and commas, and each build's
      // reading of the default and of the ends of the double range.
      {"9.81", 9.81}, {" 45abc", 45.0}, {"\t\r-2.5x", -2.5}, {"7E-x", 7.0}, {"abc", 0.0}, {"9,81", 9.0},
      {"0x10", 0.0}, {"inf", 0.0}, {"nan", 0.0}, {"-infinity", 0.0}, {"1e999", INFINITY}, {"1e-999", 0.0},
      // Ten bytes without a terminator, then what would be the next field.
      {"123456789077", 1234567890.0, 10},
  };
  for (const auto& c : cases) {
    EXPECT_EQ(ParseDecimalPrefix(c.text, c.size != 0 ? c.size : std::strlen(c.text) + 1), c.value)
        << '"' << c.text << '"';
  }
}

}  // namespace
