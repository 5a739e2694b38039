// Canvases off Windows: cairo image surfaces, drawn without antialiasing so
// that every outline lands on whole pixels.
#include <cairo.h>
#include <fontconfig/fontconfig.h>

#include <algorithm>
#include <cmath>

#include "canvas.h"

namespace dravo2 {

struct Canvas {
  cairo_surface_t* image;
  double left = 0.0, top = 0.0, scale = 1.0;  // the view
};

namespace {

// Cairo keeps coordinates in 24.8 fixed point; anything drawn farther out
// than this is off every canvas anyway.
double Coordinate(long long value) { return static_cast<double>(std::clamp(value, -100000LL, 100000LL)); }

// A context that draws in the canvas's pixels; View() makes it draw in the
// coordinates of the view.
cairo_t* Draw(Canvas* canvas) {
  cairo_t* cr = cairo_create(canvas->image);
  cairo_set_antialias(cr, CAIRO_ANTIALIAS_NONE);
  return cr;
}

void View(cairo_t* cr, const Canvas* canvas) {
  cairo_scale(cr, canvas->scale, canvas->scale);
  cairo_translate(cr, -canvas->left, -canvas->top);
}

void Finish(Canvas* canvas, cairo_t* cr) {
  cairo_destroy(cr);
  cairo_surface_flush(canvas->image);
}

// Cairo and fontconfig keep fonts for the life of the process; they are let
// go when this library is unloaded, so that leak checks see nothing of ours.
__attribute__((destructor)) void ReleaseFonts() {
  cairo_debug_reset_static_data();
  FcFini();
}

}  // namespace

Canvas* CanvasCreate(int32_t width, int32_t height, bool white) {
  auto* canvas = new Canvas{cairo_image_surface_create(CAIRO_FORMAT_ARGB32, width, height)};
  if (white) {
    cairo_t* cr = Draw(canvas);
    cairo_set_source_rgb(cr, 1, 1, 1);
    cairo_paint(cr);
    Finish(canvas, cr);
  }
  return canvas;
}

void CanvasDestroy(Canvas* canvas) {
  if (canvas == nullptr) return;
  cairo_surface_destroy(canvas->image);
  delete canvas;
}

Canvas* CanvasFromBitmap(int32_t width, int32_t height, const uint8_t* palette, int paletteSize,
                         const uint8_t* pixels, int32_t stride) {
  Canvas* canvas = CanvasCreate(width, height, false);
  cairo_surface_flush(canvas->image);
  unsigned char* data = cairo_image_surface_get_data(canvas->image);
  if (data == nullptr) return canvas;  // cairo could not allocate the image
  const int rowBytes = cairo_image_surface_get_stride(canvas->image);
  for (int32_t y = 0; y < height; ++y) {
    const uint8_t* row = pixels + static_cast<std::ptrdiff_t>(height - 1 - y) * stride;
    auto* out = reinterpret_cast<uint32_t*>(data + static_cast<std::ptrdiff_t>(y) * rowBytes);
    for (int32_t x = 0; x < width; ++x) {
      // An index beyond the palette shows black, as the display would.
      const uint8_t* entry = row[x] < paletteSize ? palette + 4 * row[x] : nullptr;
      const uint32_t blue = entry ? entry[0] : 0, green = entry ? entry[1] : 0, red = entry ? entry[2] : 0;
      out[x] = 0xFF000000u | red << 16 | green << 8 | blue;
    }
  }
  cairo_surface_mark_dirty(canvas->image);
  return canvas;
}

void CanvasView(Canvas* canvas, double left, double top, double scale) {
  canvas->left = left;
  canvas->top = top;
  canvas->scale = scale;
}

void CanvasBlit(const Canvas* source, Canvas* destination, int32_t x, int32_t y) {
  cairo_t* cr = Draw(destination);
  View(cr, destination);
  cairo_set_source_surface(cr, source->image, Coordinate(x), Coordinate(y));
  cairo_paint(cr);
  Finish(destination, cr);
}

void CanvasRectangle(Canvas* canvas, int32_t x1, int32_t y1, int32_t x2, int32_t y2, uint32_t colour) {
  // In pixels, so that the outline stays one pixel wide at any scale.
  const auto pixel = [&](int32_t value, double origin) { return std::floor((Coordinate(value) - origin) * canvas->scale); };
  const double left = pixel(x1, canvas->left), top = pixel(y1, canvas->top);
  const double right = pixel(x2, canvas->left), bottom = pixel(y2, canvas->top);
  cairo_t* cr = Draw(canvas);
  cairo_set_source_rgb(cr, (colour & 0xFF) / 255.0, (colour >> 8 & 0xFF) / 255.0, (colour >> 16 & 0xFF) / 255.0);
  cairo_set_line_width(cr, 1);
  // Through the centres of the edge pixels: the outline covers columns x1 and
  // x2 - 1 and rows y1 and y2 - 1, as a one-pixel pen does on Windows.
  cairo_rectangle(cr, left + 0.5, top + 0.5, right - left - 1, bottom - top - 1);
  cairo_stroke(cr);
  Finish(canvas, cr);
}

void CanvasText(Canvas* canvas, const char* text, const RECT& rect) {
  const double left = Coordinate(rect.left), top = Coordinate(rect.top);
  const double right = Coordinate(rect.right), bottom = Coordinate(rect.bottom);
  if (right <= left || bottom <= top) return;
  cairo_t* cr = Draw(canvas);
  View(cr, canvas);
  cairo_rectangle(cr, left, top, right - left, bottom - top);
  cairo_clip(cr);
  cairo_select_font_face(cr, "sans-serif", CAIRO_FONT_SLANT_NORMAL, CAIRO_FONT_WEIGHT_NORMAL);
  cairo_set_font_size(cr, 11);
  cairo_font_extents_t font;
  cairo_font_extents(cr, &font);
  cairo_set_source_rgb(cr, 0, 0, 0);
  cairo_move_to(cr, left + 1, top + font.ascent);
  cairo_show_text(cr, text);
  Finish(canvas, cr);
}

bool CanvasWritePng(const Canvas* canvas, std::FILE* stream) {
  const auto write = [](void* closure, const unsigned char* data, unsigned int length) {
    return std::fwrite(data, 1, length, static_cast<std::FILE*>(closure)) == length ? CAIRO_STATUS_SUCCESS
                                                                                     : CAIRO_STATUS_WRITE_ERROR;
  };
  return cairo_surface_write_to_png_stream(canvas->image, write, stream) == CAIRO_STATUS_SUCCESS;
}

}  // namespace dravo2
