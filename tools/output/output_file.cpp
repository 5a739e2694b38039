#include "output_file.h"

#include <cerrno>
#include <cstring>
#include <stdexcept>
#include <sys/stat.h>
#include <unistd.h>
#include <vector>

#include "output_paths.h"
#include "partial_files.h"
#include "shown_text.h"

namespace tool_output {

namespace {

// The permissions a new file gets from the user's umask.
mode_t NewFileMode() {
  const mode_t mask = umask(0);
  umask(mask);
  return 0666 & ~mask;
}

// ".NAME.XXXXXX" beside the file. A name the file system takes must stay
// writable: when the eight added characters would make the hidden name too
// long, NAME is cut to fit.
std::string TemporaryPattern(const std::string& target) {
  const auto slash = target.rfind('/');
  const std::string folder = slash == std::string::npos ? "" : target.substr(0, slash + 1);
  std::string name = slash == std::string::npos ? target : target.substr(slash + 1);
  const long longest = pathconf(folder.empty() ? "." : folder.c_str(), _PC_NAME_MAX);
  const std::size_t room = (longest > 0 ? static_cast<std::size_t>(longest) : 255) - 8;
  if (name.size() > room) name.resize(room);
  return folder + "." + name + ".XXXXXX";
}

}  // namespace

OutputFile::OutputFile(std::string path) : path_(std::move(path)) {
  if (path_ == "-") {
    stream_ = stdout;
    return;
  }
  target_ = FollowLinks(path_);
  struct stat info {};
  const bool exists = stat(target_.c_str(), &info) == 0;
  if (exists && S_ISDIR(info.st_mode)) Fail("cannot write", EISDIR);
  if (exists && !S_ISREG(info.st_mode)) {
    // A device or a FIFO: it cannot be replaced, only written to.
    stream_ = std::fopen(target_.c_str(), "wb");
    if (stream_ == nullptr) Fail("cannot write", errno);
    return;
  }

  std::string pattern = TemporaryPattern(target_);
  std::vector<char> buffer(pattern.begin(), pattern.end());
  buffer.push_back('\0');
  int fd = -1;
  {
    const SignalsHeld held;
    fd = mkstemp(buffer.data());
    if (fd < 0) Fail("cannot write", errno);
    temporary_ = buffer.data();
    slot_ = AddPartialFile(temporary_.c_str());
  }
  // mkstemp makes the file private; the finished file keeps the permissions
  // of the file it replaces, or gets those of a new file.
  fchmod(fd, exists ? (info.st_mode & 07777) : NewFileMode());
  stream_ = fdopen(fd, "wb");
  if (stream_ == nullptr) {
    const int error = errno;
    close(fd);
    Fail("cannot write", error);
  }
}

OutputFile::~OutputFile() { Discard(); }

void OutputFile::Discard() {
  if (stream_ != nullptr && stream_ != stdout) std::fclose(stream_);
  stream_ = nullptr;
  if (!temporary_.empty()) {
    std::remove(temporary_.c_str());
    ForgetPartialFile(slot_);
  }
  temporary_.clear();
}

void OutputFile::Close() {
  if (closed_) return;
  closed_ = true;
  bool written = std::fflush(stream_) == 0 && !std::ferror(stream_);
  int error = errno;
  if (stream_ != stdout) {
    const bool closed = std::fclose(stream_) == 0;
    if (!closed && written) error = errno;
    written = written && closed;
  }
  stream_ = nullptr;
  if (!written) Fail("cannot write", error);
}

void OutputFile::Commit() {
  Close();
  if (temporary_.empty()) return;
  if (std::rename(temporary_.c_str(), target_.c_str()) != 0) Fail("cannot name", errno);
  ForgetPartialFile(slot_);
  temporary_.clear();
}

void OutputFile::Fail(const std::string& what, int error) {
  Discard();
  throw std::runtime_error(what + " " + tool_input::Shown(path_) + ": " + std::strerror(error));
}

}  // namespace tool_output
