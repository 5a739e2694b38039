// One output of a run. A regular file, or a name where there is none yet, is
// written under a hidden temporary name (.NAME.XXXXXX, NAME cut short when
// the whole would be longer than the folder takes) in its folder and
// renamed over the name by Commit(), so that it appears only when complete
// and a failed or interrupted run leaves neither it nor a partial file. A
// symbolic link is followed: the file it points at is replaced and the link
// stays. Anything else (standard output for "-", a device, a FIFO) cannot be
// replaced and is written directly.
#pragma once

#include <cstddef>
#include <cstdio>
#include <string>

namespace tool_output {

class OutputFile {
 public:
  // Throws std::runtime_error when the file cannot be made or opened, or
  // when the path names a folder.
  explicit OutputFile(std::string path);
  ~OutputFile();
  OutputFile(const OutputFile&) = delete;
  OutputFile& operator=(const OutputFile&) = delete;

  std::FILE* stream() { return stream_; }
  const std::string& path() const { return path_; }

  // Ends the writing. Throws std::runtime_error when anything written
  // failed; a temporary is then removed.
  void Close();
  // Close(), then gives a temporary its name.
  void Commit();

 private:
  // Closes the stream and removes a temporary.
  void Discard();
  [[noreturn]] void Fail(const std::string& what, int error);

  std::string path_;
  std::string target_;     // where the bytes go: path_ with its links followed
  std::string temporary_;  // empty when written directly
  std::size_t slot_ = 0;   // the temporary's place among the partial files
  std::FILE* stream_ = nullptr;
  bool closed_ = false;
};

}  // namespace tool_output
