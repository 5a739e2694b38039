#include "frame/setting_text.h"

#include <bit>
#include <cstdint>

namespace {

bool IsSpace(char c) { return c == ' ' || (c >= '\t' && c <= '\r'); }
bool IsDigit(char c) { return c >= '0' && c <= '9'; }

// A field's digits make a significand below 10^19, which fits in 64 bits.
static_assert(kSettingTextSize <= 19);

// A natural number in 32-bit limbs, least significant first. Within the
// clamps of DecimalToDouble the numerator is below 10^309 and the
// denominator at most 10^342, 1137 bits; shifted 64 bits further for the
// division, 1201 bits: 38 limbs, and a shift writes one limb above.
class Natural {
 public:
  explicit Natural(uint64_t value) {
    for (; value != 0; value >>= 32) limbs_[size_++] = static_cast<uint32_t>(value);
  }

  void Multiply(uint32_t factor) {
    uint64_t carry = 0;
    for (int i = 0; i < size_; ++i) {
      carry += uint64_t{limbs_[i]} * factor;
      limbs_[i] = static_cast<uint32_t>(carry);
      carry >>= 32;
    }
    if (carry != 0) limbs_[size_++] = static_cast<uint32_t>(carry);
  }

  void ShiftLeft(int bits) {
    if (size_ == 0 || bits == 0) return;
    const int whole = bits / 32, part = bits % 32;
    limbs_[size_ + whole] = 0;
    for (int i = size_ - 1; i >= 0; --i) {
      if (part != 0) limbs_[i + whole + 1] |= limbs_[i] >> (32 - part);
      limbs_[i + whole] = limbs_[i] << part;
    }
    for (int i = 0; i < whole; ++i) limbs_[i] = 0;
    size_ += whole + 1;
    Trim();
  }

  // Subtracts `other` when it is not larger; true when it did.
  bool SubtractIfAtMost(const Natural& other) {
    if (Compare(other) < 0) return false;
    uint64_t borrow = 0;
    for (int i = 0; i < size_; ++i) {
      const uint64_t difference = uint64_t{limbs_[i]} - (i < other.size_ ? other.limbs_[i] : 0) - borrow;
      limbs_[i] = static_cast<uint32_t>(difference);
      borrow = difference >> 63;
    }
    Trim();
    return true;
  }

  int BitLength() const { return size_ == 0 ? 0 : 32 * size_ - std::countl_zero(limbs_[size_ - 1]); }
  bool IsZero() const { return size_ == 0; }

 private:
  int Compare(const Natural& other) const {
    if (size_ != other.size_) return size_ < other.size_ ? -1 : 1;
    for (int i = size_ - 1; i >= 0; --i) {
      if (limbs_[i] != other.limbs_[i]) return limbs_[i] < other.limbs_[i] ? -1 : 1;
    }
    return 0;
  }
  void Trim() {
    while (size_ > 0 && limbs_[size_ - 1] == 0) --size_;
  }

  uint32_t limbs_[40] = {};
  int size_ = 0;  // limbs in use; the top one is not 0
};

constexpr uint64_t kInfinityBits = 0x7FF0000000000000ull;

// The double nearest to significand * 10^exponent, ties to even, as the bits
// of its magnitude; computed in integers alone, so that every build and
// every C library gives the same bits.
uint64_t DecimalToDouble(uint64_t significand, int32_t exponent) {
  if (significand == 0) return 0;
  int digits = 0;
  for (uint64_t rest = significand; rest != 0; rest /= 10) ++digits;
  // At least 10^309, beyond the largest double; below 10^-324, nearer to 0
  // than to the smallest double.
  if (exponent > 309 - digits) return kInfinityBits;
  if (exponent <= -324 - digits) return 0;

  // The quotient of numerator and denominator, both scaled so that its
  // integer part q has 63 or 64 bits: value = (q + fraction) * 2^-scale.
  Natural numerator(significand), denominator(1);
  for (int32_t e = exponent; e > 0; --e) numerator.Multiply(10);
  for (int32_t e = exponent; e < 0; ++e) denominator.Multiply(10);
  const int scale = 63 - (numerator.BitLength() - denominator.BitLength());
  if (scale > 0) numerator.ShiftLeft(scale);
  if (scale < 0) denominator.ShiftLeft(-scale);
  // Long division, one bit of q a round: the remainder doubles where the
  // divisor would halve.
  denominator.ShiftLeft(63);
  uint64_t q = 0;
  for (int bit = 63; bit >= 0; --bit) {
    if (numerator.SubtractIfAtMost(denominator)) q |= uint64_t{1} << bit;
    numerator.ShiftLeft(1);
  }
  const bool inexact = !numerator.IsZero();

  // value lies in [2^top, 2^(top + 1)). A normal double keeps 53 bits of it;
  // below 2^-1022 the bits down to 2^-1074.
  const int length = 64 - std::countl_zero(q);
  int top = length - 1 - scale;
  const int kept = top >= -1022 ? 53 : top + 1075;
  if (kept < 0) return 0;  // below 2^-1075, half the smallest double
  const int dropped = length - kept;  // 10 to 64
  uint64_t mantissa = dropped < 64 ? q >> dropped : 0;
  const uint64_t rest = dropped < 64 ? q & ((uint64_t{1} << dropped) - 1) : q;
  const uint64_t half = uint64_t{1} << (dropped - 1);
  if (rest > half || (rest == half && (inexact || (mantissa & 1) != 0))) ++mantissa;
  // A subnormal's bits are its mantissa; one that rounds up to 2^52 is the
  // smallest normal double, whose bits are the same.
  if (kept < 53) return mantissa;
  if (mantissa == uint64_t{1} << 53) {
    mantissa >>= 1;
    ++top;
  }
  if (top > 1023) return kInfinityBits;
  return (static_cast<uint64_t>(top + 1023) << 52) | (mantissa & ((uint64_t{1} << 52) - 1));
}

}  // namespace

double ParseDecimalPrefix(const char (&field)[kSettingTextSize]) {
  std::size_t end = 0;
  while (end < kSettingTextSize && field[end] != '\0') ++end;

  std::size_t i = 0;
  while (i < end && IsSpace(field[i])) ++i;
  bool negative = false;
  if (i < end && (field[i] == '+' || field[i] == '-')) negative = field[i++] == '-';

  uint64_t significand = 0;
  int32_t exponent = 0;  // of ten
  std::size_t digits = 0;
  for (; i < end && IsDigit(field[i]); ++i, ++digits) significand = 10 * significand + (field[i] - '0');
  if (i < end && field[i] == '.') {
    for (++i; i < end && IsDigit(field[i]); ++i, ++digits, --exponent) {
      significand = 10 * significand + (field[i] - '0');
    }
  }
  if (digits == 0) return 0.0;

  if (i < end && (field[i] == 'e' || field[i] == 'E')) {
    std::size_t j = i + 1;
    bool negativeExponent = false;
    if (j < end && (field[j] == '+' || field[j] == '-')) negativeExponent = field[j++] == '-';
    int32_t written = 0;  // saturates far beyond any double's exponent
    for (; j < end && IsDigit(field[j]); ++j) written = written < 100000 ? 10 * written + (field[j] - '0') : written;
    exponent += negativeExponent ? -written : written;
  }
  const uint64_t sign = negative ? uint64_t{1} << 63 : 0;
  return std::bit_cast<double>(sign | DecimalToDouble(significand, exponent));
}
