#include "frame/setting_text.h"

#include <charconv>
#include <limits>
#include <string>

namespace {

bool IsSpace(char c) { return c == ' ' || (c >= '\t' && c <= '\r'); }
bool IsDigit(char c) { return c >= '0' && c <= '9'; }

}  // namespace

double ParseDecimalPrefix(const char* text, std::size_t size) {
  std::size_t end = 0;
  while (end < size && text[end] != '\0') ++end;

  std::size_t i = 0;
  while (i < end && IsSpace(text[i])) ++i;
  bool negative = false;
  if (i < end && (text[i] == '+' || text[i] == '-')) negative = text[i++] == '-';

  const std::size_t start = i;
  std::size_t digits = 0;
  while (i < end && IsDigit(text[i])) ++i, ++digits;
  if (i < end && text[i] == '.') {
    ++i;
    while (i < end && IsDigit(text[i])) ++i, ++digits;
  }
  if (digits == 0) return 0.0;

  bool positiveExponent = true;
  std::size_t numberEnd = i;
  if (i < end && (text[i] == 'e' || text[i] == 'E')) {
    std::size_t j = i + 1;
    if (j < end && (text[j] == '+' || text[j] == '-')) positiveExponent = text[j++] == '+';
    if (j < end && IsDigit(text[j])) {
      while (j < end && IsDigit(text[j])) ++j;
      numberEnd = j;
    }
  }

  const std::string number(text + start, numberEnd - start);
  double value = 0.0;
  const auto result = std::from_chars(number.data(), number.data() + number.size(), value,
                                      std::chars_format::general);
  if (result.ec == std::errc::result_out_of_range) {
    // Nine characters hold too few digits to move the magnitude far, so
    // only the exponent's sign decides between overflow and underflow.
    value = positiveExponent ? std::numeric_limits<double>::infinity() : 0.0;
  }
  return negative ? -value : value;
}
