// The name of a --png file, with printf's integer fields for the frame
// number: "%d", "%5d", "%05d" and the like. Every field gets the frame
// number, and "%%" is a "%".
#pragma once

#include <string>
#include <vector>

namespace scene_player {

class PngName {
 public:
  // Throws tool_input::UsageError for a "%" that is neither a field nor "%%".
  explicit PngName(const std::string& pattern);

  // Whether the name holds a field, and so names each frame differently.
  bool numbered() const { return numbered_; }
  std::string For(int frame) const;

 private:
  // Literal text, or a field: a printf format of one int ("%05d").
  struct Piece {
    std::string text;
    bool field = false;
  };
  std::vector<Piece> pieces_;
  bool numbered_ = false;
};

}  // namespace scene_player
