#include <cmath>
#include <cstring>

#include <gtest/gtest.h>

#include "frame/setting_text.h"

namespace {

double Parse(const char* text) { return ParseDecimalPrefix(text, std::strlen(text) + 1); }

TEST(SettingText, ReadsTheLongestDecimalPrefix) {
  EXPECT_EQ(Parse("90"), 90.0);
  EXPECT_EQ(Parse("9.81"), 9.81);
  EXPECT_EQ(Parse(" 45abc"), 45.0);
  EXPECT_EQ(Parse("\t-2.5x"), -2.5);
  EXPECT_EQ(Parse("+3"), 3.0);
  EXPECT_EQ(Parse(".5"), 0.5);
  EXPECT_EQ(Parse("5."), 5.0);
  EXPECT_EQ(Parse("1e2"), 100.0);
  EXPECT_EQ(Parse("2.5E-1"), 0.25);
}

TEST(SettingText, StopsBeforeAnIncompleteExponent) {
  EXPECT_EQ(Parse("1e"), 1.0);
  EXPECT_EQ(Parse("1e+"), 1.0);
  EXPECT_EQ(Parse("7E-x"), 7.0);
}

TEST(SettingText, GivesZeroWhenThereIsNoNumber) {
  EXPECT_EQ(Parse(""), 0.0);
  EXPECT_EQ(Parse("abc"), 0.0);
  EXPECT_EQ(Parse("-"), 0.0);
  EXPECT_EQ(Parse("."), 0.0);
  EXPECT_EQ(Parse("e5"), 0.0);
}

TEST(SettingText, AcceptsOnlyDecimalNotationWithAPoint) {
  EXPECT_EQ(Parse("9,81"), 9.0);  // a decimal comma ends the number
  EXPECT_EQ(Parse("0x10"), 0.0);  // no hexadecimal
  EXPECT_EQ(Parse("inf"), 0.0);
  EXPECT_EQ(Parse("nan"), 0.0);
  EXPECT_EQ(Parse("-infinity"), 0.0);
}

TEST(SettingText, OverflowIsInfiniteAndUnderflowIsZero) {
  EXPECT_EQ(Parse("1e999"), INFINITY);
  EXPECT_EQ(Parse("-1e999"), -INFINITY);
  EXPECT_EQ(Parse("1e-999"), 0.0);
}

TEST(SettingText, NeverReadsPastTheFieldWhenTheTerminatorIsMissing) {
  // Ten digits and no terminator, then what would be the next field.
  const char bytes[] = {'1', '2', '3', '4', '5', '6', '7', '8', '9', '0', '7', '7', '\0'};
  EXPECT_EQ(ParseDecimalPrefix(bytes, 10), 1234567890.0);
  const char exponent[] = {' ', ' ', ' ', ' ', ' ', ' ', ' ', ' ', '1', 'e', '5', '\0'};
  EXPECT_EQ(ParseDecimalPrefix(exponent, 10), 1.0);
}

}  // namespace
