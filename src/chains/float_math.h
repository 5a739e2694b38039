// Conversions between doubles, stored floats and integer coordinates that are
// defined for every input. A C++ conversion of a value that is not finite or
// out of the target's range is undefined behaviour, so none is done directly.
#pragma once

#include <cmath>
#include <cstdint>
#include <limits>

// Rounds to the nearest float; a value beyond the float range becomes an
// infinity of its sign, as IEEE rounding would make it.
inline float RoundToFloat(double value) {
  // Half an ulp above FLT_MAX: from here on, rounding to nearest gives infinity.
  constexpr double kFloatOverflow = 0x1.ffffffp127;
  if (value >= kFloatOverflow) return std::numeric_limits<float>::infinity();
  if (value <= -kFloatOverflow) return -std::numeric_limits<float>::infinity();
  return static_cast<float>(value);  // NaN converts to NaN
}

// Truncates toward zero to a 32-bit integer. A value beyond the int32 range
// saturates at its end of the range; NaN, which has no integer, yields
// `ifNaN` (callers pass the coordinate the object already has, so it stays).
inline int32_t TruncateToInt(double value, int32_t ifNaN) {
  // One test for the common case: NaN fails both comparisons.
  if (value > -2147483649.0 && value < 2147483648.0) return static_cast<int32_t>(value);
  if (std::isnan(value)) return ifNaN;
  return value > 0.0 ? std::numeric_limits<int32_t>::max() : std::numeric_limits<int32_t>::min();
}
