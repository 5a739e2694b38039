// The hidden partial files of a run, removed when SIGINT, SIGTERM, SIGHUP or
// SIGPIPE ends it, so that an interrupted run leaves nothing behind either.
#pragma once

#include <csignal>
#include <cstddef>

namespace tool_output {

// Makes room for `count` files in all and installs the signal handlers.
// Called once, before the first Add().
void WatchPartialFiles(std::size_t count);

// Registers a partial file; `path` must stay valid until Forget(). Returns
// its slot. Throws std::logic_error when more files are added than watched.
std::size_t AddPartialFile(const char* path);
// The file has been renamed or removed: a signal no longer touches it.
void ForgetPartialFile(std::size_t slot);

// Blocks the watched signals while it exists, so that a file is never made
// between a signal and its registration.
class SignalsHeld {
 public:
  SignalsHeld();
  ~SignalsHeld();
  SignalsHeld(const SignalsHeld&) = delete;
  SignalsHeld& operator=(const SignalsHeld&) = delete;

 private:
  sigset_t saved_;
};

}  // namespace tool_output
