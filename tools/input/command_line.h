// The command-line grammar of every tool, as in GNU tools: "--name value" or
// "--name=value"; "--" ends the options, so that what follows is an operand
// even if it starts with "-"; "-" alone is an operand (standard input or
// output). An option that takes one value may be given once.
#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <stdexcept>
#include <string>
#include <string_view>
#include <vector>

namespace tool_input {

// A command line that cannot be followed; what() names the problem in one
// line, without the tool's name.
class UsageError : public std::runtime_error {
  using std::runtime_error::runtime_error;
};

struct OptionSpec {
  enum class Takes { Nothing, OneValue, Values };  // Values: may be given several times
  const char* name;             // "--gif"
  Takes takes = Takes::Nothing;
  bool emptyValue = false;      // "" is a value (a setting's text may be empty; a file name may not)
  const char* alias = nullptr;  // a second name ("-h")
};

// One word of the command line as read: an option with its value (empty for
// an option that takes none), or an operand, whose option is empty.
struct Argument {
  std::string option;
  std::string value;
};

// The arguments in order. A value is the next word unless that looks like an
// option ("--x"): then the option has none, and "--name=--x" gives it.
// Throws UsageError for an unknown option, a missing or empty value, a value
// given to an option that takes none, and a one-value option given twice.
std::vector<Argument> ReadCommandLine(int argc, const char* const* argv, std::span<const OptionSpec> options);

// A whole decimal number that is all of `text` (a '-' but no '+' or blank),
// or nothing.
std::optional<int64_t> WholeNumber(std::string_view text);

}  // namespace tool_input
