// Writes the frames as one looping animated GIF, frame by frame, so that no
// more than two pictures are ever held.
#pragma once

#include <cstdio>
#include <memory>
#include <string>
#include <vector>

#include "frame_renderer.h"
#include "scene.h"

struct GifFileType;

namespace scene_player {

class GifWriter {
 public:
  // Writes the header, the palette and the loop marker. `delay` is in
  // hundredths of a second per frame; `name` names the file in messages.
  GifWriter(std::FILE* file, std::string name, int width, int height, const std::vector<Colour>& palette, int delay);
  GifWriter(const GifWriter&) = delete;
  GifWriter& operator=(const GifWriter&) = delete;

  // Adds one frame. Only the rectangle that differs from the previous frame
  // is stored; the rest of the previous frame stays in place.
  void AddFrame(const Picture& picture);
  // Ends the GIF. Throws std::runtime_error when anything failed.
  void Finish();

 private:
  void Check(int result);
  [[noreturn]] void Fail(const char* reason) const;

  struct Closer {
    void operator()(GifFileType* gif) const;
  };
  std::string name_;
  std::unique_ptr<GifFileType, Closer> gif_;
  int width_, height_, delay_;
  std::vector<uint8_t> previous_;
};

}  // namespace scene_player
