// Drawing services of the host's runtime library DRAVO2, which the editor
// display alone calls. On Windows they are imported by ordinal (dravo2.def
// makes the import library); elsewhere they are plain C symbols of a shared
// library that stands in for DRAVO2.
#pragma once

#include <windows.h>

#include <cstddef>
#include <cstdint>

#include "frame/abi.h"

// A surface of the host's drawing class. Only pointers to it are handled:
// its layout is the host's.
struct HostSurface;

// Bytes reserved in the caller's storage for a scratch surface. The host's
// class size is not published, so the block is far larger than any surface
// object needs (a few handles, sizes and a palette pointer) and aligned for
// any member the host's class may have.
constexpr std::size_t kScratchSurfaceBytes = 1024;
constexpr std::size_t kScratchSurfaceAlign = 16;

extern "C" {

// The two plain functions.
HostSurface* TVCALL HostGetEditorSurface(void* editorWindow, int32_t zero);
void TVCALL HostUpdateEditorRect(void* editorWindow, const RECT* rect);

// Operations of the surface class, called on `self`.
void TVTHISCALL HostSurfaceConstruct(HostSurface* self);
void TVTHISCALL HostSurfaceDestruct(HostSurface* self);
void TVTHISCALL HostSurfaceCreate(HostSurface* self, int32_t width, int32_t height, HostSurface* model);
void TVTHISCALL HostSurfaceLoadBitmap(HostSurface* self, HINSTANCE module, int32_t bitmapId, int32_t ownSize);
void TVTHISCALL HostSurfaceBlit(HostSurface* self, HostSurface* destination, int32_t x, int32_t y, int32_t mode,
                                int32_t a, int32_t b, int32_t c);
void TVTHISCALL HostSurfaceRectangle(HostSurface* self, int32_t x1, int32_t y1, int32_t x2, int32_t y2,
                                     int32_t colour, int32_t a, int32_t b, int32_t thickness);
void TVTHISCALL HostSurfaceDrawText(HostSurface* self, const char* text, int32_t length, RECT* rect,
                                    int32_t a, int32_t b, int32_t c, int32_t d, int32_t e, int32_t f,
                                    int32_t g, int32_t h, int32_t i, int32_t flags);

}  // extern "C"
