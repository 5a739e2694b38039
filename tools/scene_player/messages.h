// What the player says on standard error while it plays: the warnings, each
// on a line of its own and named by the scene, and a progress line when
// standard error is a terminal.
#pragma once

#include <string>
#include <vector>

namespace scene_player {

// A count and its thing, plural unless one: "1 frame", "3 frames".
std::string Counted(long count, const char* thing);

class Messages {
 public:
  explicit Messages(std::string sceneName);
  // Also when a failure ends the run: its message starts on a line of its own.
  ~Messages() { EndProgressLine(); }
  Messages(const Messages&) = delete;
  Messages& operator=(const Messages&) = delete;

  // "PLACE: message" becomes "SCENE: PLACE: warning: message"; a text
  // without a place is "SCENE: warning: text".
  void Warn(const std::string& text);
  void Warn(const std::vector<std::string>& texts);
  void Progress(int frame, int frames);
  void EndProgressLine();

 private:
  std::string sceneName_;
  bool progress_;
  bool onProgressLine_ = false;
};

}  // namespace scene_player
