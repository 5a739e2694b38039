#include "png_writer.h"

#include <csetjmp>
#include <png.h>
#include <stdexcept>

#include "shown_text.h"

namespace scene_player {

namespace {

// libpng reports failures by longjmp to the setjmp below. Everything this
// function owns is made before setjmp, so the jump skips no destructor.
bool WriteRows(std::FILE* file, const Picture& picture, const std::vector<png_color>& colours,
               std::vector<png_bytep>& rows) {
  png_structp png = png_create_write_struct(PNG_LIBPNG_VER_STRING, nullptr, nullptr, nullptr);
  if (png == nullptr) return false;
  png_infop info = png_create_info_struct(png);
  if (info == nullptr || setjmp(png_jmpbuf(png))) {
    png_destroy_write_struct(&png, &info);
    return false;
  }
  png_init_io(png, file);
  png_set_IHDR(png, info, static_cast<png_uint_32>(picture.width), static_cast<png_uint_32>(picture.height), 8,
               PNG_COLOR_TYPE_PALETTE, PNG_INTERLACE_NONE, PNG_COMPRESSION_TYPE_DEFAULT, PNG_FILTER_TYPE_DEFAULT);
  png_set_PLTE(png, info, colours.data(), static_cast<int>(colours.size()));
  png_write_info(png, info);
  png_write_image(png, rows.data());
  png_write_end(png, nullptr);
  png_destroy_write_struct(&png, &info);
  return true;
}

}  // namespace

void WritePng(std::FILE* file, const std::string& name, const Picture& picture, const std::vector<Colour>& palette) {
  std::vector<png_color> colours;
  for (const Colour& colour : palette) colours.push_back({colour.r, colour.g, colour.b});
  std::vector<png_bytep> rows;
  // libpng takes non-const rows but only reads them when writing.
  auto* pixels = const_cast<uint8_t*>(picture.pixels.data());
  for (int y = 0; y < picture.height; ++y) rows.push_back(pixels + static_cast<std::size_t>(y) * picture.width);
  if (!WriteRows(file, picture, colours, rows)) {
    throw std::runtime_error("cannot write " + tool_input::Shown(name) + ": the PNG library failed");
  }
}

}  // namespace scene_player
