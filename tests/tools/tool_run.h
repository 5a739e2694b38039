// Runs a tool (the scene player, the editor preview) as a program, in a
// folder of its own, and keeps what it printed and the status it ended with.
#pragma once

#include <sys/wait.h>

#include <algorithm>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <initializer_list>
#include <iterator>
#include <nlohmann/json.hpp>
#include <sstream>
#include <stdexcept>
#include <string>
#include <vector>

namespace tool_test {

inline std::string ReadFile(const std::string& path) {
  std::ifstream file(path, std::ios::binary);
  return {std::istreambuf_iterator<char>(file), {}};
}

inline std::vector<std::string> Lines(const std::string& text) {
  std::vector<std::string> lines;
  std::istringstream stream(text);
  for (std::string line; std::getline(stream, line);) lines.push_back(line);
  return lines;
}

// A scene's "objects" array: each object's name, x, y, width and height.
struct SceneObject {
  const char* name;
  int x, y, width, height;
};
inline std::string Objects(std::initializer_list<SceneObject> objects) {
  nlohmann::json list = nlohmann::json::array();
  for (const SceneObject& o : objects) {
    list.push_back({{"name", o.name}, {"x", o.x}, {"y", o.y}, {"width", o.width}, {"height", o.height}});
  }
  return list.dump();
}

// A fresh temporary folder, removed with everything in it at the end.
class Folder {
 public:
  Folder() {
    std::string pattern = (std::filesystem::temp_directory_path() / "tool_test.XXXXXX").string();
    if (mkdtemp(pattern.data()) == nullptr) throw std::runtime_error("cannot make a temporary folder");
    path_ = pattern;
  }
  ~Folder() {
    std::error_code ignored;
    std::filesystem::remove_all(path_, ignored);
  }
  Folder(const Folder&) = delete;
  Folder& operator=(const Folder&) = delete;

  const std::string& path() const { return path_; }
  std::string operator/(const std::string& name) const { return path_ + "/" + name; }
  void Write(const std::string& name, const std::string& text) const {
    std::ofstream(*this / name, std::ios::binary) << text;
  }
  // The names of the files in the folder, sorted.
  std::vector<std::string> Files() const {
    std::vector<std::string> names;
    for (const auto& entry : std::filesystem::directory_iterator(path_)) names.push_back(entry.path().filename());
    std::sort(names.begin(), names.end());
    return names;
  }

 private:
  std::string path_;
};

struct ToolRun {
  int status = -1;  // exit status; -1 when it did not exit normally
  std::string out;  // standard output
  std::string err;  // standard error
};

// Runs `program` with `args` in `folder`, standard input from `input` (a
// path from `folder`) or empty. What it prints goes to a folder of its own,
// so that the files it leaves in `folder` are only its own.
inline ToolRun RunTool(const std::string& program, const std::vector<std::string>& args, const Folder& folder,
                       const std::string& input = "/dev/null") {
  const auto quoted = [](const std::string& word) { return "'" + word + "'"; };
  Folder captured;
  std::string command = "cd " + quoted(folder.path()) + " && exec " + quoted(program);
  for (const std::string& arg : args) command += " " + quoted(arg);
  command += " <" + quoted(input) + " >" + quoted(captured / "out") + " 2>" + quoted(captured / "err");
  const int status = std::system(command.c_str());
  ToolRun run;
  if (status != -1 && WIFEXITED(status)) run.status = WEXITSTATUS(status);
  run.out = ReadFile(captured / "out");
  run.err = ReadFile(captured / "err");
  return run;
}

#ifdef SCENE_PLAYER
inline ToolRun RunPlayer(const std::vector<std::string>& args, const Folder& folder,
                         const std::string& input = "/dev/null") {
  return RunTool(SCENE_PLAYER, args, folder, input);
}
#endif

}  // namespace tool_test
