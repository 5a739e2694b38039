// The nine drawing services of the host's runtime library as the stand-in
// provides them: every call is recorded, then carried out on a canvas.
#include "editor/drawing_services.h"

#include <cstring>
#include <initializer_list>
#include <new>
#include <set>
#include <string>

#include "canvas.h"
#include "dravo2_standin.h"

// The stand-in's own layout of the host's surface class. A scratch surface
// is constructed in its caller's storage, so it is written there.
struct HostSurface {
  dravo2::Canvas* canvas = nullptr;
};

namespace {

constexpr int32_t kLargestSide = 4096;

struct EditorWindow {
  HostSurface surface;
};

EditorWindow* g_window = nullptr;
// Surfaces constructed and not yet destructed, by address: the caller's
// storage is never read to find out.
std::set<const HostSurface*> g_scratch;
std::string g_calls;
#if !defined(_WIN32)
const void* (*g_bitmapSource)(HINSTANCE, int32_t) = nullptr;
#endif

std::string WindowName(const void* window) {
  if (window == nullptr) return "null";
  return window == g_window ? "window" : "unknown";
}

bool IsEditor(const HostSurface* surface) { return g_window != nullptr && surface == &g_window->surface; }
bool IsScratch(const HostSurface* surface) { return g_scratch.count(surface) != 0; }

std::string SurfaceName(const HostSurface* surface) {
  if (IsEditor(surface)) return "editor";
  return IsScratch(surface) ? "scratch" : "invalid";
}

// The canvas of a surface that may be drawn on, or null.
dravo2::Canvas* CanvasOf(const HostSurface* surface) {
  return IsEditor(surface) || IsScratch(surface) ? surface->canvas : nullptr;
}

std::string Numbers(std::initializer_list<long long> values) {
  std::string text;
  for (const long long value : values) {
    text += ' ';
    text += std::to_string(value);
  }
  return text;
}

void Record(const std::string& line) { g_calls += line + "\n"; }

int32_t ClampSide(int32_t side) { return side < 1 ? 1 : side > kLargestSide ? kLargestSide : side; }

void ReplaceCanvas(HostSurface* surface, dravo2::Canvas* canvas) {
  dravo2::CanvasDestroy(surface->canvas);
  surface->canvas = canvas;
}

// A packed 8-bit bitmap as the resource compiler stores it: a 40-byte
// header, the palette, then the rows bottom first.
struct Bitmap {
  int32_t width = 0;
  int32_t height = 0;
  int paletteSize = 0;
  const uint8_t* palette = nullptr;
  const uint8_t* pixels = nullptr;
};

template <typename T>
T Field(const uint8_t* bytes, std::size_t offset) {
  T value;
  std::memcpy(&value, bytes + offset, sizeof value);
  return value;
}

bool ReadBitmap(const void* data, Bitmap& bitmap) {
  if (data == nullptr) return false;
  const auto* bytes = static_cast<const uint8_t*>(data);
  const auto colours = Field<uint32_t>(bytes, 32);
  bitmap.width = Field<int32_t>(bytes, 4);
  bitmap.height = Field<int32_t>(bytes, 8);
  if (Field<uint32_t>(bytes, 0) != 40 || Field<uint16_t>(bytes, 14) != 8 || Field<uint32_t>(bytes, 16) != 0 ||
      colours > 256 || bitmap.width < 1 || bitmap.width > kLargestSide || bitmap.height < 1 ||
      bitmap.height > kLargestSide) {
    return false;
  }
  bitmap.paletteSize = colours == 0 ? 256 : static_cast<int>(colours);
  bitmap.palette = bytes + 40;
  bitmap.pixels = bitmap.palette + 4 * bitmap.paletteSize;
  return true;
}

const void* FindBitmap(HINSTANCE module, int32_t id) {
#if defined(_WIN32)
  const HRSRC resource = FindResourceA(module, MAKEINTRESOURCEA(id), RT_BITMAP);
  const HGLOBAL loaded = resource == nullptr ? nullptr : LoadResource(module, resource);
  return loaded == nullptr ? nullptr : LockResource(loaded);
#else
  return g_bitmapSource == nullptr ? nullptr : g_bitmapSource(module, id);
#endif
}

}  // namespace

extern "C" {

DRAVO2_STANDIN_API HostSurface* TVCALL HostGetEditorSurface(void* editorWindow, int32_t zero) {
  Record("GetEditorSurface " + WindowName(editorWindow) + Numbers({zero}));
  return editorWindow != nullptr && editorWindow == g_window ? &g_window->surface : nullptr;
}

DRAVO2_STANDIN_API void TVCALL HostUpdateEditorRect(void* editorWindow, const RECT* rect) {
  Record("UpdateEditorRect " + WindowName(editorWindow) + Numbers({rect->left, rect->top, rect->right, rect->bottom}));
}

DRAVO2_STANDIN_API void TVTHISCALL HostSurfaceConstruct(HostSurface* self) {
  new (self) HostSurface;
  g_scratch.insert(self);
  Record("Construct scratch");
}

DRAVO2_STANDIN_API void TVTHISCALL HostSurfaceDestruct(HostSurface* self) {
  Record("Destruct " + SurfaceName(self));
  if (g_scratch.erase(self) == 0) return;
  ReplaceCanvas(self, nullptr);
  self->~HostSurface();
}

DRAVO2_STANDIN_API void TVTHISCALL HostSurfaceCreate(HostSurface* self, int32_t width, int32_t height, HostSurface* model) {
  Record("Create " + SurfaceName(self) + Numbers({width, height}) + " " + SurfaceName(model));
  if (!IsScratch(self)) return;
  const bool fits = width >= 1 && width <= kLargestSide && height >= 1 && height <= kLargestSide;
  ReplaceCanvas(self, fits ? dravo2::CanvasCreate(width, height, false) : nullptr);
}

DRAVO2_STANDIN_API void TVTHISCALL HostSurfaceLoadBitmap(HostSurface* self, HINSTANCE module, int32_t bitmapId, int32_t ownSize) {
  Bitmap bitmap;
  const bool found = ReadBitmap(FindBitmap(module, bitmapId), bitmap);
  std::string result = " -> failed";
  if (found) result = " -> " + std::to_string(bitmap.width) + "x" + std::to_string(bitmap.height);
  Record("LoadBitmap " + SurfaceName(self) + Numbers({bitmapId, ownSize}) + result);
  if (!found || !IsScratch(self)) return;
  dravo2::Canvas* loaded = dravo2::CanvasFromBitmap(bitmap.width, bitmap.height, bitmap.palette,
                                                    bitmap.paletteSize, bitmap.pixels, (bitmap.width + 3) & ~3);
  if (ownSize == 1 || self->canvas == nullptr) {
    ReplaceCanvas(self, loaded);  // the surface takes the bitmap's own size
  } else {
    dravo2::CanvasBlit(loaded, self->canvas, 0, 0);  // the surface keeps its size
    dravo2::CanvasDestroy(loaded);
  }
}

DRAVO2_STANDIN_API void TVTHISCALL HostSurfaceBlit(HostSurface* self, HostSurface* destination, int32_t x, int32_t y, int32_t mode,
                                int32_t a, int32_t b, int32_t c) {
  Record("Blit " + SurfaceName(self) + " " + SurfaceName(destination) + Numbers({x, y, mode, a, b, c}));
  dravo2::Canvas* source = CanvasOf(self);
  dravo2::Canvas* target = CanvasOf(destination);
  if (source != nullptr && target != nullptr) dravo2::CanvasBlit(source, target, x, y);
}

DRAVO2_STANDIN_API void TVTHISCALL HostSurfaceRectangle(HostSurface* self, int32_t x1, int32_t y1, int32_t x2, int32_t y2,
                                     int32_t colour, int32_t a, int32_t b, int32_t thickness) {
  Record("Rectangle " + SurfaceName(self) + Numbers({x1, y1, x2, y2, colour, a, b, thickness}));
  if (dravo2::Canvas* canvas = CanvasOf(self)) {
    dravo2::CanvasRectangle(canvas, x1, y1, x2, y2, static_cast<uint32_t>(colour));
  }
}

DRAVO2_STANDIN_API void TVTHISCALL HostSurfaceDrawText(HostSurface* self, const char* text, int32_t length, RECT* rect, int32_t a,
                                    int32_t b, int32_t c, int32_t d, int32_t e, int32_t f, int32_t g, int32_t h,
                                    int32_t i, int32_t flags) {
  // A length of -1 means up to the terminating zero.
  const std::string shown = length < 0 ? std::string(text) : std::string(text, static_cast<std::size_t>(length));
  Record("DrawText " + SurfaceName(self) + " \"" + shown + "\"" +
         Numbers({length, rect->left, rect->top, rect->right, rect->bottom, a, b, c, d, e, f, g, h, i, flags}));
  if (dravo2::Canvas* canvas = CanvasOf(self)) dravo2::CanvasText(canvas, shown.c_str(), *rect);
}

void* StandinOpenEditorWindow(int32_t width, int32_t height) {
  StandinCloseEditorWindow();
  g_window = new EditorWindow;
  g_window->surface.canvas = dravo2::CanvasCreate(ClampSide(width), ClampSide(height), true);
  return g_window;
}

void StandinCloseEditorWindow(void) {
  if (g_window == nullptr) return;
  ReplaceCanvas(&g_window->surface, nullptr);
  delete g_window;
  g_window = nullptr;
}

const char* StandinDrawingCalls(void) { return g_calls.c_str(); }
void StandinClearDrawingCalls(void) { g_calls.clear(); }

#if !defined(_WIN32)
void StandinSetBitmapSource(const void* (*source)(HINSTANCE module, int32_t id)) { g_bitmapSource = source; }

void StandinViewEditorWindow(int32_t left, int32_t top, double scale) {
  if (g_window != nullptr && scale > 0.0) dravo2::CanvasView(g_window->surface.canvas, left, top, scale);
}

bool StandinWriteEditorPng(std::FILE* stream) {
  return g_window != nullptr && dravo2::CanvasWritePng(g_window->surface.canvas, stream);
}
#endif

}  // extern "C"
