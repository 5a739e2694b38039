#include "png_names.h"

#include <cctype>
#include <cstdio>
#include <cstring>

#include "command_line.h"
#include "shown_text.h"

namespace scene_player {

namespace {

constexpr std::size_t kMaxWidth = 255;  // no file name is longer

// The digits at `at`, as a number no larger than kMaxWidth + 1.
std::size_t Digits(const std::string& text, std::size_t& at) {
  std::size_t value = 0;
  while (at < text.size() && std::isdigit(static_cast<unsigned char>(text[at]))) {
    value = std::min(value * 10 + static_cast<std::size_t>(text[at++] - '0'), kMaxWidth + 1);
  }
  return value;
}

}  // namespace

PngName::PngName(const std::string& pattern) {
  std::size_t at = 0;
  while (at < pattern.size()) {
    const std::size_t percent = pattern.find('%', at);
    if (percent != at) {
      pieces_.push_back({pattern.substr(at, percent - at)});
      if (percent == std::string::npos) break;
    }
    at = percent + 1;
    if (at < pattern.size() && pattern[at] == '%') {
      pieces_.push_back({"%"});
      ++at;
      continue;
    }
    // printf's flags, a width and a precision, then d or i.
    while (at < pattern.size() && std::strchr("-+ 0", pattern[at]) != nullptr) ++at;
    std::size_t width = Digits(pattern, at);
    if (at < pattern.size() && pattern[at] == '.') width = std::max(width, Digits(pattern, ++at));
    if (at >= pattern.size() || (pattern[at] != 'd' && pattern[at] != 'i') || width > kMaxWidth) {
      throw tool_input::UsageError("--png " + tool_input::Shown(pattern) +
                                   ": a % that is no frame number; expected %d, a width such as %05d, or %% for a %");
    }
    ++at;
    pieces_.push_back({pattern.substr(percent, at - percent), true});
    numbered_ = true;
  }
}

std::string PngName::For(int frame) const {
  std::string name;
  for (const Piece& piece : pieces_) {
    if (!piece.field) {
      name += piece.text;
      continue;
    }
    char number[kMaxWidth + 16];
    // The format is one checked field of one int: flags, width, precision, d.
    std::snprintf(number, sizeof number, piece.text.c_str(), frame);
    name += number;
  }
  return name;
}

}  // namespace scene_player
