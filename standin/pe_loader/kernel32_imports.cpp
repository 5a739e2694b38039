// KERNEL32: the shim's calls, and the Win32 stand-in's local memory and
// resource calls, which read the loaded image's own resources.
#include "import_tables.h"
#include "kernel32_shim.h"

namespace pe {

std::span<const ImportRow> Kernel32Imports() {
  using namespace kernel32;
  static const ImportRow rows[] = {
      Stdcall<4>("DeleteCriticalSection", &DeleteCriticalSection),
      Stdcall<4>("EnterCriticalSection", &EnterCriticalSection),
      Stdcall<12>("FindResourceA", &::FindResourceA),
      Stdcall<4>("FreeLibrary", &FreeLibrary),
      Stdcall<4>("FreeResource", &::FreeResource),
      Stdcall<0>("GetLastError", &GetLastError),
      Stdcall<4>("GetModuleHandleA", &GetModuleHandleA),
      Stdcall<8>("GetProcAddress", &GetProcAddress),
      Stdcall<4>("InitializeCriticalSection", &InitializeCriticalSection),
      Stdcall<4>("LeaveCriticalSection", &LeaveCriticalSection),
      Stdcall<4>("LoadLibraryA", &LoadLibraryA),
      Stdcall<8>("LoadResource", &::LoadResource),
      Stdcall<8>("LocalAlloc", &::LocalAlloc),
      Stdcall<4>("LocalFree", &::LocalFree),
      Stdcall<4>("LockResource", &::LockResource),
      Stdcall<8>("SizeofResource", &::SizeofResource),
      Stdcall<4>("Sleep", &Sleep),
      Stdcall<4>("TlsGetValue", &TlsGetValue),
      Stdcall<16>("VirtualProtect", &VirtualProtect),
      Stdcall<12>("VirtualQuery", &VirtualQuery),
  };
  return rows;
}

}  // namespace pe
