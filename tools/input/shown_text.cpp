#include "shown_text.h"

#include <cstdint>
#include <cstdio>

namespace tool_input {

namespace {

// The length of the well-formed UTF-8 sequence at the start of `text` (no
// overlong forms, no surrogates, nothing beyond U+10FFFF), or 0.
std::size_t SequenceLength(std::string_view text) {
  const auto byte = [&](std::size_t i) { return static_cast<uint8_t>(text[i]); };
  const uint8_t first = byte(0);
  std::size_t length = 0;
  uint8_t low = 0x80, high = 0xBF;  // the range of the second byte
  if (first >= 0xC2 && first <= 0xDF) {
    length = 2;
  } else if (first >= 0xE0 && first <= 0xEF) {
    length = 3;
    if (first == 0xE0) low = 0xA0;
    if (first == 0xED) high = 0x9F;
  } else if (first >= 0xF0 && first <= 0xF4) {
    length = 4;
    if (first == 0xF0) low = 0x90;
    if (first == 0xF4) high = 0x8F;
  } else {
    return 0;
  }
  if (text.size() < length || byte(1) < low || byte(1) > high) return 0;
  for (std::size_t i = 2; i < length; ++i) {
    if (byte(i) < 0x80 || byte(i) > 0xBF) return 0;
  }
  return length;
}

}  // namespace

std::string Shown(std::string_view text) {
  std::string shown;
  std::size_t at = 0;
  while (at < text.size()) {
    if (shown.size() >= kShownLength) return shown + "...";
    const auto c = static_cast<uint8_t>(text[at]);
    if (c >= 0x20 && c < 0x7F) {
      shown += static_cast<char>(c);
      ++at;
    } else if (const std::size_t length = c >= 0x80 ? SequenceLength(text.substr(at)) : 0; length > 0) {
      shown.append(text.substr(at, length));
      at += length;
    } else {
      char escaped[5];
      std::snprintf(escaped, sizeof escaped, "\\x%02X", c);
      shown += escaped;
      ++at;
    }
  }
  return shown;
}

std::string Quoted(std::string_view text) {
  // Appended rather than concatenated: GCC 12 takes "\"" + string for an
  // overlapping copy and warns.
  std::string quoted = "\"";
  quoted += Shown(text);
  quoted += '"';
  return quoted;
}

std::string ShownNumber(double value) {
  char text[32];
  std::snprintf(text, sizeof text, "%g", value);
  return text;
}

}  // namespace tool_input
