// Canvases where the stand-in only records the calls for the tests (on
// Windows, and in the 32-bit x86 build): nothing is drawn.
#include "canvas.h"

namespace dravo2 {

struct Canvas {};

Canvas* CanvasCreate(int32_t, int32_t, bool) { return new Canvas; }
void CanvasDestroy(Canvas* canvas) { delete canvas; }
Canvas* CanvasFromBitmap(int32_t, int32_t, const uint8_t*, int, const uint8_t*, int32_t) { return new Canvas; }
void CanvasView(Canvas*, double, double, double) {}
void CanvasBlit(const Canvas*, Canvas*, int32_t, int32_t) {}
void CanvasRectangle(Canvas*, int32_t, int32_t, int32_t, int32_t, uint32_t) {}
void CanvasText(Canvas*, const char*, const RECT&) {}
bool CanvasWritePng(const Canvas*, std::FILE*) { return false; }

}  // namespace dravo2
