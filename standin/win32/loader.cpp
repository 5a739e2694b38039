// Plays the system loader's part for the library off Windows: once the
// library is in memory, its entry point is called with the module handle
// under which its resources are found.
#include "standin_win32.h"

extern "C" BOOL WINAPI DllMain(HINSTANCE instance, DWORD reason, LPVOID reserved);

namespace {

// The one module this stand-in knows. Its address is the handle, so a handle
// that is not this one can be recognised as foreign.
char g_moduleTag;

struct LoadLibrary {
  LoadLibrary() { DllMain(reinterpret_cast<HINSTANCE>(&g_moduleTag), DLL_PROCESS_ATTACH, nullptr); }
} g_load;

}  // namespace

HINSTANCE StandinLibraryModule() { return reinterpret_cast<HINSTANCE>(&g_moduleTag); }
