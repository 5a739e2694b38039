#include "bounded_read.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstring>

#include "shown_text.h"

namespace tool_input {

std::string InputName(const std::string& path) { return path == "-" ? "standard input" : Shown(path); }

std::string ReadBounded(const std::string& path, std::size_t ceiling) {
  const bool standardInput = path == "-";
  const int fd = standardInput ? STDIN_FILENO : open(path.c_str(), O_RDONLY | O_CLOEXEC);
  const auto fail = [&](int error) {
    if (!standardInput && fd >= 0) close(fd);
    return InputError(std::strerror(error), false);
  };
  if (fd < 0) throw fail(errno);
  struct stat info {};
  if (fstat(fd, &info) != 0) throw fail(errno);
  if (S_ISDIR(info.st_mode)) throw fail(EISDIR);

  // One byte past the ceiling tells a file that is too large from one that
  // just fits.
  std::string bytes;
  std::size_t size = 0;
  while (size <= ceiling) {
    bytes.resize(std::min(ceiling + 1, size + 65536));
    const ssize_t got = read(fd, bytes.data() + size, bytes.size() - size);
    if (got < 0 && errno == EINTR) continue;
    if (got < 0) throw fail(errno);
    if (got == 0) break;
    size += static_cast<std::size_t>(got);
  }
  if (!standardInput) close(fd);
  if (size > ceiling) throw InputError("larger than " + std::to_string(ceiling) + " bytes", true);
  bytes.resize(size);
  return bytes;
}

}  // namespace tool_input
