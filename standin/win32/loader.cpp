// Plays the system loader's part for the library off Windows: once the
// library is in memory, its embedded resources are made its module's, and
// its entry point is called with that module's handle.
#include "module_resources.h"

extern "C" BOOL WINAPI DllMain(HINSTANCE instance, DWORD reason, LPVOID reserved);

// Generated at build time from the library's .res file.
extern const unsigned char kLibraryResources[];
extern const std::size_t kLibraryResourcesSize;

namespace {

// The library's module: its address is the handle, unlike any other.
char g_moduleTag;

struct LoadLibrary {
  LoadLibrary() {
    const HMODULE module = reinterpret_cast<HINSTANCE>(&g_moduleTag);
    StandinAddModule(module, standin::ReadResFile(kLibraryResources, kLibraryResourcesSize));
    DllMain(module, DLL_PROCESS_ATTACH, nullptr);
  }
} g_load;

}  // namespace
