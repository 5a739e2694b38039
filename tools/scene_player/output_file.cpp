#include "output_file.h"

#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <stdexcept>
#include <sys/stat.h>
#include <unistd.h>
#include <vector>

namespace scene_player {

OutputFile::OutputFile(std::string path) : path_(std::move(path)) {
  const auto slash = path_.rfind('/');
  const std::string folder = slash == std::string::npos ? "" : path_.substr(0, slash + 1);
  const std::string name = slash == std::string::npos ? path_ : path_.substr(slash + 1);
  std::string pattern = folder + "." + name + ".XXXXXX";
  std::vector<char> buffer(pattern.begin(), pattern.end());
  buffer.push_back('\0');
  const int fd = mkstemp(buffer.data());
  if (fd < 0) Fail("cannot write", errno);
  temporary_ = buffer.data();
  // mkstemp makes the file private; a finished picture is an ordinary file.
  fchmod(fd, 0644);
  stream_ = fdopen(fd, "wb");
  if (stream_ == nullptr) {
    const int error = errno;
    close(fd);
    Fail("cannot write", error);
  }
}

OutputFile::~OutputFile() {
  if (stream_ != nullptr) std::fclose(stream_);
  if (!temporary_.empty()) std::remove(temporary_.c_str());
}

void OutputFile::Commit() {
  const bool written = std::fflush(stream_) == 0 && !std::ferror(stream_);
  int error = errno;
  const bool closed = std::fclose(stream_) == 0;
  if (!closed && written) error = errno;
  stream_ = nullptr;
  if (!written || !closed) Fail("cannot write", error);
  if (std::rename(temporary_.c_str(), path_.c_str()) != 0) Fail("cannot name", errno);
  temporary_.clear();
}

void OutputFile::Fail(const std::string& what, int error) {
  if (stream_ != nullptr) std::fclose(stream_);
  stream_ = nullptr;
  if (!temporary_.empty()) std::remove(temporary_.c_str());
  temporary_.clear();
  throw std::runtime_error(what + " " + path_ + ": " + std::strerror(error));
}

}  // namespace scene_player
