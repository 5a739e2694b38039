// A file that appears under its name only when it is complete: it is written
// to a temporary name in the same folder and renamed by Commit(). Until then,
// and if anything fails, no file of that name is left behind.
#pragma once

#include <cstdio>
#include <string>

namespace scene_player {

class OutputFile {
 public:
  // Throws std::runtime_error when the temporary file cannot be made.
  explicit OutputFile(std::string path);
  ~OutputFile();
  OutputFile(const OutputFile&) = delete;
  OutputFile& operator=(const OutputFile&) = delete;

  std::FILE* stream() { return stream_; }
  const std::string& path() const { return path_; }

  // Closes the file and gives it its name. Throws std::runtime_error when
  // anything written failed; the temporary is then removed.
  void Commit();

 private:
  [[noreturn]] void Fail(const std::string& what, int error);

  std::string path_;
  std::string temporary_;
  std::FILE* stream_ = nullptr;
};

}  // namespace scene_player
