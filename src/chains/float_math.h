// Conversions between doubles, stored floats and integer coordinates that are
// defined for every input. A C++ conversion of a value that is not finite or
// out of the target's range is undefined behaviour, so none is done directly.
#pragma once

#include <emmintrin.h>  // every target is x86 with SSE2

#include <cmath>
#include <cstdint>
#include <limits>

// 3.14159 / 180: the degree factor the chains have always used. It is a
// little short of pi / 180, so angle 0 does not hang exactly below the
// anchor. The editor's preview uses it too, so that it puts the platform
// where a chain with the same settings hangs.
constexpr double kDegree = 0.017453277777777776;

// Rounds to the nearest float; a value beyond the float range becomes an
// infinity of its sign, as IEEE rounding would make it.
inline float RoundToFloat(double value) {
  // Half an ulp above FLT_MAX: from here on, rounding to nearest gives infinity.
  constexpr double kFloatOverflow = 0x1.ffffffp127;
  if (std::fabs(value) < kFloatOverflow) [[likely]] return static_cast<float>(value);
  if (value >= kFloatOverflow) return std::numeric_limits<float>::infinity();
  if (value <= -kFloatOverflow) return -std::numeric_limits<float>::infinity();
  return static_cast<float>(value);  // NaN converts to NaN
}

// Truncates `value` toward zero into `result` with the processor's own
// conversion, which turns every double that has no int32 (NaN, beyond the
// range) into INT32_MIN. True when the result is anything else, which is
// then exact; on false, TruncateToInt gives the right answer.
inline bool TruncatesToInt(double value, int32_t& result) {
  result = _mm_cvttsd_si32(_mm_set_sd(value));
  return result != std::numeric_limits<int32_t>::min();
}

// Truncates toward zero to a 32-bit integer. A value beyond the int32 range
// saturates at its end of the range (from -2^31 down, truncation gives
// INT32_MIN exactly or would go below it); NaN, which has no integer, yields
// `ifNaN` (callers pass the coordinate the object already has, so it stays).
inline int32_t TruncateToInt(double value, int32_t ifNaN) {
  if (int32_t result; TruncatesToInt(value, result)) [[likely]] return result;
  if (std::isnan(value)) return ifNaN;
  return value > 0.0 ? std::numeric_limits<int32_t>::max() : std::numeric_limits<int32_t>::min();
}
