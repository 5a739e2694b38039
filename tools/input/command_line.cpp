#include "command_line.h"

#include <algorithm>
#include <charconv>
#include <cstring>

#include "shown_text.h"

namespace tool_input {

namespace {

bool LooksLikeOption(const std::string& word) { return word.size() > 2 && word.compare(0, 2, "--") == 0; }

std::string ProgramName(const char* path) {
  const char* slash = std::strrchr(path, '/');
  return slash == nullptr ? path : slash + 1;
}

}  // namespace

std::vector<Argument> ReadCommandLine(int argc, const char* const* argv, std::span<const OptionSpec> options) {
  const std::string program = argc > 0 ? ProgramName(argv[0]) : "the tool";
  std::vector<Argument> arguments;
  bool optionsEnded = false;
  for (int i = 1; i < argc; ++i) {
    const std::string word = argv[i];
    if (optionsEnded || word == "-" || word.empty() || word[0] != '-') {
      arguments.push_back({"", word});
      continue;
    }
    if (word == "--") {
      optionsEnded = true;
      continue;
    }
    const std::size_t equals = word.compare(0, 2, "--") == 0 ? word.find('=') : std::string::npos;
    const std::string name = word.substr(0, equals);
    const auto spec = std::find_if(options.begin(), options.end(), [&](const OptionSpec& o) {
      return name == o.name || (o.alias != nullptr && name == o.alias);
    });
    if (spec == options.end()) {
      throw UsageError("unknown option " + Shown(name) + " (" + program + " --help lists the options)");
    }
    Argument argument{spec->name, ""};
    if (spec->takes == OptionSpec::Takes::Nothing) {
      if (equals != std::string::npos) throw UsageError(argument.option + " takes no value, found " + Shown(word));
      arguments.push_back(argument);
      continue;
    }
    if (equals != std::string::npos) {
      argument.value = word.substr(equals + 1);
    } else if (i + 1 < argc && !LooksLikeOption(argv[i + 1])) {
      argument.value = argv[++i];
    } else {
      throw UsageError(argument.option + " needs a value");
    }
    if (argument.value.empty() && !spec->emptyValue) {
      throw UsageError(argument.option + " needs a value, found an empty text");
    }
    if (spec->takes == OptionSpec::Takes::OneValue) {
      for (const Argument& earlier : arguments) {
        if (earlier.option == argument.option) {
          throw UsageError(argument.option + " given twice (" + Shown(earlier.value) + ", then " +
                           Shown(argument.value) + "); expected it once");
        }
      }
    }
    arguments.push_back(std::move(argument));
  }
  return arguments;
}

std::optional<int64_t> WholeNumber(std::string_view text) {
  int64_t value = 0;
  const char* end = text.data() + text.size();
  const auto [stop, error] = std::from_chars(text.data(), end, value);
  if (error != std::errc() || stop != end) return std::nullopt;
  return value;
}

}  // namespace tool_input
