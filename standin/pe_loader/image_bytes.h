// Little-endian reads from an image or file that never go past its end, and
// the one-line failures of the PE readers.
#pragma once

#include <cstdarg>
#include <cstdint>
#include <cstdio>
#include <cstring>
#include <span>
#include <string>

namespace pe {

class ImageBytes {
 public:
  explicit ImageBytes(std::span<const uint8_t> bytes) : bytes_(bytes) {}

  uint64_t size() const { return bytes_.size(); }
  // True when `count` bytes from `offset` lie inside.
  bool Has(uint64_t offset, uint64_t count) const { return offset <= size() && count <= size() - offset; }
  // Reads of bytes the caller has checked with Has.
  uint8_t U8(uint64_t offset) const { return bytes_[offset]; }
  uint16_t U16(uint64_t offset) const { return static_cast<uint16_t>(bytes_[offset] | bytes_[offset + 1] << 8); }
  uint32_t U32(uint64_t offset) const { return uint32_t{U16(offset)} | uint32_t{U16(offset + 2)} << 16; }
  // The zero-terminated text at `offset`; false when it has no terminator
  // before the end.
  bool Text(uint64_t offset, std::string& text) const {
    if (offset >= size()) return false;
    const void* end = std::memchr(bytes_.data() + offset, 0, size() - offset);
    if (end == nullptr) return false;
    const auto* start = reinterpret_cast<const char*>(bytes_.data() + offset);
    text.assign(start, static_cast<const char*>(end));
    return true;
  }

 private:
  std::span<const uint8_t> bytes_;
};

// Sets `error` to the formatted line and returns false.
[[gnu::format(printf, 2, 3)]] inline bool Fail(std::string& error, const char* format, ...) {
  char line[256];
  va_list arguments;
  va_start(arguments, format);
  std::vsnprintf(line, sizeof line, format, arguments);
  va_end(arguments);
  error = line;
  return false;
}

}  // namespace pe
