// KERNEL32: the shim's calls, and the Win32 stand-in's local memory and
// resource calls, which read the loaded image's own resources.
#include "import_tables.h"
#include "kernel32_shim.h"

namespace pe {

std::span<const ImportRow> Kernel32Imports() {
  using namespace kernel32;
  static const ImportRow rows[] = {
      // The library's own calls: the editor's icon from its bitmap and the
      // menus' scratch buffer.
      Stdcall<12>("FindResourceA", &::FindResourceA),
      Stdcall<4>("FreeResource", &::FreeResource),
      Stdcall<8>("LoadResource", &::LoadResource),
      Stdcall<4>("LockResource", &::LockResource),
      Stdcall<8>("SizeofResource", &::SizeofResource),
      Stdcall<8>("LocalAlloc", &::LocalAlloc),
      Stdcall<4>("LocalFree", &::LocalFree),
      // The C runtime's DLL start-up lock.
      Stdcall<4>("Sleep", &Sleep),
      // Its thread-local storage callback, which runs the destructors of
      // thread keys (the library registers none).
      Stdcall<4>("DeleteCriticalSection", &DeleteCriticalSection),
      Stdcall<4>("EnterCriticalSection", &EnterCriticalSection),
      Stdcall<4>("InitializeCriticalSection", &InitializeCriticalSection),
      Stdcall<4>("LeaveCriticalSection", &LeaveCriticalSection),
      Stdcall<4>("TlsGetValue", &TlsGetValue),
      // Its relocation of data imported from other DLLs (the library imports
      // none).
      Stdcall<0>("GetLastError", &GetLastError),
      Stdcall<16>("VirtualProtect", &VirtualProtect),
      Stdcall<12>("VirtualQuery", &VirtualQuery),
      // The compiler's start-up file, which looks for a shared unwinder
      // library to register the DLL's call frames with (the library throws
      // nothing).
      Stdcall<4>("FreeLibrary", &FreeLibrary),
      Stdcall<4>("GetModuleHandleA", &GetModuleHandleA),
      Stdcall<8>("GetProcAddress", &GetProcAddress),
      Stdcall<4>("LoadLibraryA", &LoadLibraryA),
  };
  return rows;
}

}  // namespace pe
