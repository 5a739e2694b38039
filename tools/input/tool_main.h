// How every tool ends: no exception leaves it. A command line or an input
// it cannot follow (UsageError) ends in one line and status 2; any other
// failure (while playing, drawing or writing) in one line and status 1.
#pragma once

namespace tool_input {

constexpr int kFailed = 1;
constexpr int kBadInput = 2;

// Runs `body` and returns its status, or says what stopped it on standard
// error, after "PROGRAM: ", and returns the status above.
int RunToolMain(const char* program, int argc, char** argv, int (*body)(int, char**));

}  // namespace tool_input
