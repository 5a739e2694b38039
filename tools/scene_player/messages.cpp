#include "messages.h"

#include <unistd.h>

#include <iostream>

namespace scene_player {

std::string Counted(long count, const char* thing) {
  return std::to_string(count) + " " + thing + (count == 1 ? "" : "s");
}

Messages::Messages(std::string sceneName)
    : sceneName_(std::move(sceneName)), progress_(isatty(STDERR_FILENO) == 1) {}

void Messages::Warn(const std::string& text) {
  EndProgressLine();
  const std::size_t split = text.find(": ");
  const std::string place = split == std::string::npos ? "" : text.substr(0, split + 2);
  std::cerr << sceneName_ << ": " << place << "warning: " << text.substr(place.size()) << '\n';
}

void Messages::Warn(const std::vector<std::string>& texts) {
  for (const std::string& text : texts) Warn(text);
}

void Messages::Progress(int frame, int frames) {
  if (!progress_ || (frame % 10 != 9 && frame + 1 != frames)) return;
  std::cerr << "\rframe " << frame + 1 << " of " << frames << std::flush;
  onProgressLine_ = true;
}

void Messages::EndProgressLine() {
  if (onProgressLine_) std::cerr << '\n';
  onProgressLine_ = false;
}

}  // namespace scene_player
