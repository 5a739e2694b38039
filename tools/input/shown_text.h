// User text (a file name, an option's value, an object's name) as a message
// echoes it: cut to a length that fits a line, with control characters and
// bytes that are not UTF-8 shown as \xNN, so that a message is always one
// readable line whatever it was given.
#pragma once

#include <string>
#include <string_view>

namespace tool_input {

constexpr std::size_t kShownLength = 120;  // bytes of text kept before "..."

std::string Shown(std::string_view text);

// The text shown as above, in double quotes: "name".
std::string Quoted(std::string_view text);

// A number as a message shows it, as printf's "%g" does: 9.8, 499.798,
// 1e+39, inf.
std::string ShownNumber(double value);

}  // namespace tool_input
