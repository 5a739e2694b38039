// Reads an input file whole, but never more than a valid input can hold: a
// device that never ends (/dev/zero) or a huge file is refused after the
// ceiling, not read into memory.
#pragma once

#include <cstddef>
#include <stdexcept>
#include <string>

namespace tool_input {

// Why an input was not read: what() is the system's reason ("No such file or
// directory", "Is a directory"), or "larger than N bytes" when tooLarge.
class InputError : public std::runtime_error {
 public:
  InputError(const std::string& reason, bool tooLarge) : std::runtime_error(reason), tooLarge_(tooLarge) {}
  bool tooLarge() const { return tooLarge_; }

 private:
  bool tooLarge_;
};

// The bytes of `path` ("-" is standard input), at most `ceiling` of them:
// it reads no more than one byte past the ceiling. Throws InputError when
// the file cannot be opened or read (a folder among them), or holds more.
std::string ReadBounded(const std::string& path, std::size_t ceiling);

// The name under which a message shows an input: "standard input" for "-".
std::string InputName(const std::string& path);

}  // namespace tool_input
