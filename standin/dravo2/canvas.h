// The pixels behind a stand-in surface: a cairo image off Windows; on
// Windows, where the stand-in only records, nothing at all.
#pragma once

#include <windows.h>

#include <cstdint>
#include <cstdio>

namespace dravo2 {

struct Canvas;

// A blank canvas: white for an editor window, transparent otherwise. Sizes
// are at least 1 and at most 4096.
Canvas* CanvasCreate(int32_t width, int32_t height, bool white);
void CanvasDestroy(Canvas* canvas);

// A canvas holding an 8-bit packed bitmap: `pixels` rows of `stride` bytes,
// bottom row first, indexing `palette` (blue, green, red, unused).
Canvas* CanvasFromBitmap(int32_t width, int32_t height, const uint8_t* palette, int paletteSize,
                         const uint8_t* pixels, int32_t stride);

// Which part of the coordinates the canvas shows, as a scrolled and zoomed
// editor does: (left, top) at its top-left corner, `scale` pixels per unit.
// A new canvas shows (0, 0) at scale 1. Drawing goes through the view.
void CanvasView(Canvas* canvas, double left, double top, double scale);

void CanvasBlit(const Canvas* source, Canvas* destination, int32_t x, int32_t y);
// A one-pixel outline from (x1, y1) to (x2 - 1, y2 - 1); `colour` is
// 0x00bbggrr.
void CanvasRectangle(Canvas* canvas, int32_t x1, int32_t y1, int32_t x2, int32_t y2, uint32_t colour);
// Black text from the rectangle's top-left corner, clipped to the rectangle.
void CanvasText(Canvas* canvas, const char* text, const RECT& rect);

bool CanvasWritePng(const Canvas* canvas, std::FILE* stream);

}  // namespace dravo2
