// Runs the scene player as a program, in a folder of its own, and keeps what
// it printed and the status it ended with.
#pragma once

#include <string>
#include <vector>

namespace player_test {

struct PlayerRun {
  int status = -1;  // exit status; -1 when it did not exit normally
  std::string out;  // standard output
  std::string err;  // standard error
};

// A fresh temporary folder, removed with everything in it at the end.
class Folder {
 public:
  Folder();
  ~Folder();
  Folder(const Folder&) = delete;
  Folder& operator=(const Folder&) = delete;

  const std::string& path() const { return path_; }
  std::string operator/(const std::string& name) const { return path_ + "/" + name; }
  // Writes `text` to the file `name` in the folder and gives its path.
  std::string Write(const std::string& name, const std::string& text) const;
  // The names of the files in the folder, sorted.
  std::vector<std::string> Files() const;

 private:
  std::string path_;
};

// Runs the player with `args`, its working folder being `folder`.
PlayerRun RunPlayer(const std::vector<std::string>& args, const Folder& folder);

std::string ReadFile(const std::string& path);
std::vector<std::string> Lines(const std::string& text);

}  // namespace player_test
