// Calling convention and export marking shared by every routine that crosses
// the boundary to the host.
#pragma once

#include <cstdint>

// Every 32-bit x86 target (the i686 DLL and the i386 Linux test build) uses
// the host's own layouts and calling conventions; 64-bit targets have one
// convention and the wider layouts of shared/abi.md.
#if defined(__i386__) || defined(_M_IX86)
#define TAVRIN_I686 1
#else
#define TAVRIN_I686 0
#endif

// TVCALL marks every exported routine, routine-table entry and host service:
// __stdcall on 32-bit x86 (the callee pops its arguments, so a caller that
// disagrees about the argument count or convention corrupts its stack at
// once). TVTHISCALL marks the operations of the host's drawing surface:
// __thiscall on 32-bit x86, the object in ECX. Both are empty on 64-bit.
// On Windows i686 exported names are decorated Name@N and undecorated by the
// .def file; ELF names are never decorated.
#if TAVRIN_I686
#define TVCALL __attribute__((stdcall))
#define TVTHISCALL __attribute__((thiscall))
#else
#define TVCALL
#define TVTHISCALL
#endif

#if defined(_WIN32)
#define TAVRIN_EXPORT extern "C"
#else
#define TAVRIN_EXPORT extern "C" __attribute__((visibility("default")))
#endif
