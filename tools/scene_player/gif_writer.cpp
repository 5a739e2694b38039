#include "gif_writer.h"

#include <algorithm>
#include <gif_lib.h>
#include <stdexcept>
#include <string>

#include "shown_text.h"

namespace scene_player {

namespace {

int WriteToFile(GifFileType* gif, const GifByteType* bytes, int length) {
  return static_cast<int>(std::fwrite(bytes, 1, static_cast<std::size_t>(length), static_cast<std::FILE*>(gif->UserData)));
}

// A GIF colour table has a power-of-two size of at least 2.
int TableSize(std::size_t colours) {
  int size = 2;
  while (static_cast<std::size_t>(size) < colours) size *= 2;
  return size;
}

struct Box {
  int left, top, right, bottom;  // right and bottom exclusive
};

// The smallest rectangle holding every pixel that changed; an empty box when
// nothing did.
Box ChangedBox(const std::vector<uint8_t>& before, const std::vector<uint8_t>& after, int width, int height) {
  Box box{width, height, 0, 0};
  for (int y = 0; y < height; ++y) {
    const uint8_t* a = before.data() + static_cast<std::size_t>(y) * width;
    const uint8_t* b = after.data() + static_cast<std::size_t>(y) * width;
    const auto first = std::mismatch(a, a + width, b).first;
    if (first == a + width) continue;
    int last = width - 1;
    while (a[last] == b[last]) --last;
    box.left = std::min(box.left, static_cast<int>(first - a));
    box.right = std::max(box.right, last + 1);
    box.top = std::min(box.top, y);
    box.bottom = y + 1;
  }
  return box;
}

}  // namespace

GifWriter::GifWriter(std::FILE* file, std::string name, int width, int height, const std::vector<Colour>& palette,
                     int delay)
    : name_(std::move(name)), width_(width), height_(height), delay_(delay) {
  int error = 0;
  gif_.reset(EGifOpen(file, &WriteToFile, &error));
  if (gif_ == nullptr) Fail(GifErrorString(error));
  EGifSetGifVersion(gif_.get(), true);

  std::vector<GifColorType> colours(static_cast<std::size_t>(TableSize(palette.size())), GifColorType{0, 0, 0});
  for (std::size_t i = 0; i < palette.size(); ++i) colours[i] = {palette[i].r, palette[i].g, palette[i].b};
  ColorMapObject* map = GifMakeMapObject(static_cast<int>(colours.size()), colours.data());
  if (map == nullptr) Fail("out of memory");
  const int result = EGifPutScreenDesc(gif_.get(), width, height, 8, 0, map);
  GifFreeMapObject(map);
  Check(result);

  // Loop for ever.
  static const GifByteType kApplication[] = {'N', 'E', 'T', 'S', 'C', 'A', 'P', 'E', '2', '.', '0'};
  static const GifByteType kLoop[] = {1, 0, 0};
  Check(EGifPutExtensionLeader(gif_.get(), APPLICATION_EXT_FUNC_CODE));
  Check(EGifPutExtensionBlock(gif_.get(), sizeof kApplication, kApplication));
  Check(EGifPutExtensionBlock(gif_.get(), sizeof kLoop, kLoop));
  Check(EGifPutExtensionTrailer(gif_.get()));
}

// A GIF left unfinished (after a failure) is only freed.
void GifWriter::Closer::operator()(GifFileType* gif) const { EGifCloseFile(gif, nullptr); }

void GifWriter::AddFrame(const Picture& picture) {
  Box box{0, 0, width_, height_};
  if (!previous_.empty()) {
    box = ChangedBox(previous_, picture.pixels, width_, height_);
    // A frame that changes nothing still takes its time: one pixel, redrawn.
    if (box.right == 0) box = {0, 0, 1, 1};
  }

  GraphicsControlBlock control{};
  control.DisposalMode = DISPOSE_DO_NOT;
  control.UserInputFlag = false;
  control.DelayTime = delay_;
  control.TransparentColor = NO_TRANSPARENT_COLOR;
  GifByteType extension[4];
  const std::size_t length = EGifGCBToExtension(&control, extension);
  Check(EGifPutExtension(gif_.get(), GRAPHICS_EXT_FUNC_CODE, static_cast<int>(length), extension));
  const int boxWidth = box.right - box.left;
  Check(EGifPutImageDesc(gif_.get(), box.left, box.top, boxWidth, box.bottom - box.top, false, nullptr));
  std::vector<GifPixelType> row(static_cast<std::size_t>(boxWidth));
  for (int y = box.top; y < box.bottom; ++y) {
    const uint8_t* source = picture.pixels.data() + static_cast<std::size_t>(y) * width_ + box.left;
    std::copy(source, source + boxWidth, row.begin());
    Check(EGifPutLine(gif_.get(), row.data(), boxWidth));
  }
  previous_ = picture.pixels;
}

void GifWriter::Finish() {
  int error = 0;
  // EGifCloseFile frees the GIF whatever it returns.
  const int result = EGifCloseFile(gif_.release(), &error);
  if (result != GIF_OK) Fail(GifErrorString(error));
}

void GifWriter::Check(int result) {
  if (result != GIF_OK) Fail(GifErrorString(gif_->Error));
}

void GifWriter::Fail(const char* reason) const {
  throw std::runtime_error("cannot write " + tool_input::Shown(name_) + ": " + reason);
}

}  // namespace scene_player
