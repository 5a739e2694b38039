// The DRAVO2 stand-in: the nine drawing services as the host defines them,
// declared here and not taken from the library's header, so that a mistake
// there is not repeated here; and beyond them one editor window to draw on,
// the record of every service call, and off Windows the picture itself. The
// library's own code never includes this.
#pragma once

#include <windows.h>

#include <cstdint>
#include <cstdio>

// What this library exports off Windows (on Windows its .def file says).
#if defined(_WIN32)
#define DRAVO2_STANDIN_API
#else
#define DRAVO2_STANDIN_API __attribute__((visibility("default")))
#endif

// The surface class's operations take the object in ECX on 32-bit x86.
#if defined(__i386__)
#define DRAVO2_THISCALL __attribute__((thiscall))
#else
#define DRAVO2_THISCALL
#endif

struct HostSurface;

extern "C" {

// The plain functions, ordinals 34 and 50.
DRAVO2_STANDIN_API HostSurface* WINAPI HostGetEditorSurface(void* editorWindow, int32_t zero);
DRAVO2_STANDIN_API void WINAPI HostUpdateEditorRect(void* editorWindow, const RECT* rect);
// The surface class's operations: 264, 286, 372, 616, 344, 679 and 411.
DRAVO2_STANDIN_API void DRAVO2_THISCALL HostSurfaceConstruct(HostSurface* self);
DRAVO2_STANDIN_API void DRAVO2_THISCALL HostSurfaceDestruct(HostSurface* self);
DRAVO2_STANDIN_API void DRAVO2_THISCALL HostSurfaceCreate(HostSurface* self, int32_t width, int32_t height,
                                                          HostSurface* model);
DRAVO2_STANDIN_API void DRAVO2_THISCALL HostSurfaceLoadBitmap(HostSurface* self, HINSTANCE module, int32_t bitmapId,
                                                              int32_t ownSize);
DRAVO2_STANDIN_API void DRAVO2_THISCALL HostSurfaceBlit(HostSurface* self, HostSurface* destination, int32_t x,
                                                        int32_t y, int32_t mode, int32_t a, int32_t b, int32_t c);
DRAVO2_STANDIN_API void DRAVO2_THISCALL HostSurfaceRectangle(HostSurface* self, int32_t x1, int32_t y1, int32_t x2,
                                                             int32_t y2, int32_t colour, int32_t a, int32_t b,
                                                             int32_t thickness);
DRAVO2_STANDIN_API void DRAVO2_THISCALL HostSurfaceDrawText(HostSurface* self, const char* text, int32_t length,
                                                            RECT* rect, int32_t a, int32_t b, int32_t c, int32_t d,
                                                            int32_t e, int32_t f, int32_t g, int32_t h, int32_t i,
                                                            int32_t flags);

// Opens the editor window (there is one at a time; opening again replaces
// it) with a white surface of `width` by `height` pixels, each clamped to 1
// to 4096. The handle is what the editor-time host record holds; any other
// handle has no editor surface.
DRAVO2_STANDIN_API void* StandinOpenEditorWindow(int32_t width, int32_t height);
DRAVO2_STANDIN_API void StandinCloseEditorWindow(void);

// Every service call since the last clear, one line each, "\n"-terminated:
// the service's name, the surface it was called on ("editor", "scratch", or
// "invalid" for one not constructed), then its arguments.
DRAVO2_STANDIN_API const char* StandinDrawingCalls(void);
DRAVO2_STANDIN_API void StandinClearDrawingCalls(void);

#if !defined(_WIN32)
// Off Windows the Win32 stand-in lives inside the library, out of this
// library's reach: the program that holds the library tells the load
// service where a module's bitmaps are. `source` gives the packed bitmap
// with that id, or null when the module has none.
DRAVO2_STANDIN_API void StandinSetBitmapSource(const void* (*source)(HINSTANCE module, int32_t id));

// Makes the editor window show the editor's coordinates from (left, top)
// at `scale` pixels per unit, as a scrolled and zoomed-out editor does; a
// window opens showing (0, 0) at scale 1.
DRAVO2_STANDIN_API void StandinViewEditorWindow(int32_t left, int32_t top, double scale);

// Writes the editor window's surface as PNG; false when there is no window
// or the stream fails.
DRAVO2_STANDIN_API bool StandinWriteEditorPng(std::FILE* stream);
#endif

}  // extern "C"
