// What the DRAVO2 stand-in offers beyond the nine drawing services: one
// editor window to draw on, the record of every service call, and off
// Windows the picture itself. The library's own code never includes this.
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

extern "C" {

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
