#include "output_paths.h"

#include <cerrno>
#include <climits>
#include <cstring>
#include <optional>
#include <stdexcept>
#include <sys/stat.h>
#include <unistd.h>

#include "shown_text.h"

namespace tool_output {

namespace {

constexpr int kMaxLinks = 40;  // as many as the system follows itself

std::string FolderOf(const std::string& path) {
  const auto slash = path.rfind('/');
  return slash == std::string::npos ? "." : (slash == 0 ? "/" : path.substr(0, slash));
}

// A file as the file system knows it: an existing file by its device and
// inode, a file still to be made by its folder's and its own name.
struct Identity {
  dev_t device = 0;
  ino_t inode = 0;
  std::string name;  // empty for an existing file
  bool shareable = false;  // a character device: writing twice is harmless

  bool operator==(const Identity& other) const {
    return device == other.device && inode == other.inode && name == other.name;
  }
};

std::optional<Identity> IdentityOf(const std::string& path) {
  struct stat info {};
  if (stat(path.c_str(), &info) == 0) return Identity{info.st_dev, info.st_ino, "", S_ISCHR(info.st_mode)};
  const std::string resolved = FollowLinks(path);
  if (stat(FolderOf(resolved).c_str(), &info) != 0) return std::nullopt;  // cannot be written anyway
  return Identity{info.st_dev, info.st_ino, resolved.substr(resolved.rfind('/') + 1), false};
}

}  // namespace

std::string FollowLinks(const std::string& path) {
  std::string current = path;
  for (int hops = 0; hops < kMaxLinks; ++hops) {
    struct stat info {};
    if (lstat(current.c_str(), &info) != 0 || !S_ISLNK(info.st_mode)) return current;
    char target[PATH_MAX];
    const ssize_t length = readlink(current.c_str(), target, sizeof target - 1);
    if (length <= 0) return current;
    const std::string text(target, static_cast<std::size_t>(length));
    current = text.front() == '/' ? text : FolderOf(current) + "/" + text;
  }
  throw std::runtime_error("cannot write " + tool_input::Shown(path) + ": " + std::strerror(ELOOP));
}

std::string OutputConflict(const std::vector<NamedPath>& inputs, const std::vector<NamedPath>& outputs) {
  std::vector<std::pair<const NamedPath*, Identity>> seen;
  for (const NamedPath& input : inputs) {
    if (const auto identity = IdentityOf(input.path)) seen.emplace_back(&input, *identity);
  }
  const std::size_t inputCount = seen.size();
  const NamedPath* standardOutput = nullptr;
  for (const NamedPath& output : outputs) {
    const std::string name = output.option + " " + tool_input::Shown(output.path);
    if (output.path == "-") {
      if (standardOutput) return name + ": standard output is already taken by " + standardOutput->option;
      standardOutput = &output;
      continue;
    }
    const auto identity = IdentityOf(output.path);
    if (!identity) continue;  // fails when it is opened, with the system's reason
    for (std::size_t i = 0; i < seen.size(); ++i) {
      if (!(seen[i].second == *identity)) continue;
      const NamedPath& other = *seen[i].first;
      if (i < inputCount) {
        return name + ": this is " + other.option + " (" + tool_input::Shown(other.path) +
               "); expected a file of its own for the output";
      }
      if (!identity->shareable) {
        return name + ": also written by " + other.option + " " + tool_input::Shown(other.path) +
               "; expected a file of its own";
      }
    }
    seen.emplace_back(&output, *identity);
  }
  return "";
}

}  // namespace tool_output
