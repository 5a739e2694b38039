// What every fuzz target shares: its input read as a stream of bytes and
// numbers, and the check that stops a run on a broken invariant.
#pragma once

#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>

// A broken invariant stops the run and names itself.
#define Check(condition) \
  ((condition) ? (void)0 : (std::fprintf(stderr, "%s:%d: %s\n", __FILE__, __LINE__, #condition), std::abort()))

// The fuzzer's bytes, read front to back; past the end every read gives 0.
class FuzzInput {
 public:
  FuzzInput(const uint8_t* data, size_t size) : data_(data), size_(size) {}

  bool done() const { return pos_ >= size_; }
  uint8_t Byte() { return pos_ < size_ ? data_[pos_++] : 0; }
  int32_t Int() {
    uint32_t value = 0;
    for (int i = 0; i < 4; ++i) value = (value << 8) | Byte();
    return static_cast<int32_t>(value);
  }
  // Mostly `base` - 2 to `base` + `spread` - 3, sometimes any 32-bit value.
  int32_t Near(int32_t base, int spread) {
    const uint8_t b = Byte();
    return b < 224 ? base + b % spread - 2 : Int();
  }

 private:
  const uint8_t* data_;
  size_t size_;
  size_t pos_ = 0;
};
