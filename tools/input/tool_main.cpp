#include "tool_main.h"

#include <exception>
#include <iostream>

#include "command_line.h"

namespace tool_input {

int RunToolMain(const char* program, int argc, char** argv, int (*body)(int, char**)) {
  try {
    return body(argc, argv);
  } catch (const UsageError& error) {
    std::cerr << program << ": " << error.what() << '\n';
    return kBadInput;
  } catch (const std::exception& error) {
    std::cerr << program << ": " << error.what() << '\n';
  } catch (...) {
    std::cerr << program << ": stopped by an unknown failure\n";
  }
  return kFailed;
}

}  // namespace tool_input
