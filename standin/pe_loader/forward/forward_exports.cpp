// The library's entry points, each a jump to the same export of a tavrin.dll
// that this library loads as the program starts and frees as it ends: the
// caller's arguments and return address stay as they are, and the DLL's own
// __stdcall return removes the arguments. One thread, as the loader is.
#include <unistd.h>

#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <iterator>

#include "frame/module.h"
#include "pe_loader.h"

namespace {

const char* const kNames[] = {
#define TAVRIN_ENTRY_POINT(index, name, words) #name,
#include "entry_points.inc"
#undef TAVRIN_ENTRY_POINT
};

void* g_module = nullptr;

// Windows starts the host's thread with 53-bit x87 precision, and every
// call into the DLL (entry points, routine tables, dialog procedures) runs
// under it there; so it does here from the start.
constexpr uint16_t kWindowsFpuControl = PE_WINDOWS_FPU_CONTROL;

}  // namespace

// Where each entry point jumps, in the order of the list.
extern "C" __attribute__((visibility("hidden"))) void* tavrin_forward_targets[std::size(kNames)];
void* tavrin_forward_targets[std::size(kNames)];

[[gnu::constructor]] static void LoadTavrinDll() {
  const char* path = std::getenv("TAVRIN_DLL");
  if (path == nullptr) path = TAVRIN_DLL_PATH;
  asm volatile("fldcw %0" : : "m"(kWindowsFpuControl));
  char error[512] = "";
  g_module = PeLoadLibrary(path, error, sizeof error);
  if (g_module == nullptr) {
    std::fprintf(stderr, "libtavrin: cannot load the DLL: %s\n", error);
    _exit(1);
  }
  for (std::size_t i = 0; i < std::size(kNames); ++i) {
    tavrin_forward_targets[i] = PeGetProcAddress(g_module, kNames[i]);
    if (tavrin_forward_targets[i] == nullptr) {
      std::fprintf(stderr, "libtavrin: %s does not export %s\n", path, kNames[i]);
      _exit(1);
    }
  }
}

[[gnu::destructor]] static void FreeTavrinDll() { PeFreeLibrary(g_module); }

// The module handle under which the DLL's resources are found.
[[gnu::visibility("default")]] HINSTANCE TavrinModule() { return static_cast<HINSTANCE>(g_module); }

asm(R"(
    .macro TAVRIN_FORWARD index, name
    .text
    .globl \name
    .type \name, @function
\name:
    call 1f
1:  popl %ecx
    addl $_GLOBAL_OFFSET_TABLE_+[.-1b], %ecx
    jmp *tavrin_forward_targets@GOTOFF+4*\index(%ecx)
    .size \name, .-\name
    .endm
)"
#define TAVRIN_ENTRY_POINT(index, name, words) "TAVRIN_FORWARD " #index ", " #name "\n"
#include "entry_points.inc"
#undef TAVRIN_ENTRY_POINT
);
