// Calling convention and export marking shared by every routine that crosses
// the boundary to the host.
#pragma once

#include <cstdint>

#if defined(_WIN32)
// __stdcall on i686 (callee pops, names decorated Name@N and undecorated by the
// .def file); the compiler ignores it on x86_64, where there is one convention.
#define TVCALL __stdcall
#define TAVRIN_EXPORT extern "C"
#else
#define TVCALL
#define TAVRIN_EXPORT extern "C" __attribute__((visibility("default")))
#endif

// Operations of a host class called on an object (the object in ECX, callee
// pops the rest) on 32-bit x86; the platform's one convention elsewhere.
#if defined(__i386__)
#define TVTHISCALL __attribute__((thiscall))  // __thiscall, spelled so that Linux GCC knows it too
#else
#define TVTHISCALL
#endif

#if defined(_WIN32) && !defined(_WIN64)
#define TAVRIN_I686 1
#else
#define TAVRIN_I686 0
#endif
