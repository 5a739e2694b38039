// KERNEL32: the shim's calls, and the Win32 stand-in's local memory and
// resource calls, which read the loaded image's own resources.
#include "import_tables.h"
#include "kernel32_shim.h"

namespace pe {

std::span<const ImportRow> Kernel32Imports() {
  using namespace kernel32;
  static const ImportRow rows[] = {
      Stdcall<4>("CloseHandle", &CloseHandle),
      Stdcall<16>("CreateSemaphoreW", &CreateSemaphoreW),
      Stdcall<4>("DeleteCriticalSection", &DeleteCriticalSection),
      Stdcall<4>("EnterCriticalSection", &EnterCriticalSection),
      Stdcall<12>("FindResourceA", &::FindResourceA),
      Stdcall<4>("FreeLibrary", &FreeLibrary),
      Stdcall<4>("FreeResource", &::FreeResource),
      Stdcall<0>("GetCurrentThreadId", &GetCurrentThreadId),
      Stdcall<0>("GetLastError", &GetLastError),
      Stdcall<4>("GetModuleHandleA", &GetModuleHandleA),
      Stdcall<4>("GetModuleHandleW", &GetModuleHandleW),
      Stdcall<8>("GetProcAddress", &GetProcAddress),
      Stdcall<4>("InitializeCriticalSection", &InitializeCriticalSection),
      Stdcall<8>("IsDBCSLeadByteEx", &IsDBCSLeadByteEx),
      Stdcall<4>("LeaveCriticalSection", &LeaveCriticalSection),
      Stdcall<4>("LoadLibraryA", &LoadLibraryA),
      Stdcall<4>("LoadLibraryW", &LoadLibraryW),
      Stdcall<8>("LoadResource", &::LoadResource),
      Stdcall<8>("LocalAlloc", &::LocalAlloc),
      Stdcall<4>("LocalFree", &::LocalFree),
      Stdcall<4>("LockResource", &::LockResource),
      Stdcall<24>("MultiByteToWideChar", &MultiByteToWideChar),
      Stdcall<12>("ReleaseSemaphore", &ReleaseSemaphore),
      Stdcall<4>("SetLastError", &SetLastError),
      Stdcall<8>("SizeofResource", &::SizeofResource),
      Stdcall<4>("Sleep", &Sleep),
      Stdcall<0>("TlsAlloc", &TlsAlloc),
      Stdcall<4>("TlsFree", &TlsFree),
      Stdcall<4>("TlsGetValue", &TlsGetValue),
      Stdcall<8>("TlsSetValue", &TlsSetValue),
      Stdcall<16>("VirtualProtect", &VirtualProtect),
      Stdcall<12>("VirtualQuery", &VirtualQuery),
      Stdcall<8>("WaitForSingleObject", &WaitForSingleObject),
      Stdcall<32>("WideCharToMultiByte", &WideCharToMultiByte),
  };
  return rows;
}

}  // namespace pe
