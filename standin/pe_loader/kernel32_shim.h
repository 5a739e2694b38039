// KERNEL32 as the loaded image's C runtime uses it, on one thread: last
// error, critical sections, a TLS slot, modules and page protection.
// Declared here with Windows' own types; the local memory and resource calls
// come from the Win32 stand-in.
#pragma once

#include <windows.h>

#include <cstdint>

namespace pe::kernel32 {

using HANDLE = void*;
using FARPROC = void*;

constexpr DWORD kErrorInvalidParameter = 87;
constexpr DWORD kErrorModNotFound = 126;
constexpr DWORD kErrorProcNotFound = 127;
constexpr DWORD kErrorInvalidAddress = 487;

struct CriticalSection {
  void* debugInfo;
  LONG lockCount;
  LONG recursionCount;
  HANDLE owningThread;
  HANDLE lockSemaphore;
  ULONG_PTR spinCount;
};
static_assert(sizeof(CriticalSection) == 24);

struct MemoryBasicInformation {
  void* baseAddress;
  void* allocationBase;
  DWORD allocationProtect;
  SIZE_T regionSize;
  DWORD state;
  DWORD protect;
  DWORD type;
};
static_assert(sizeof(MemoryBasicInformation) == 28);

// Threads (kernel32_threads.cpp). The last error is also set by the shim's
// other calls.
DWORD WINAPI GetLastError();
void SetLastError(DWORD error);
void WINAPI Sleep(DWORD milliseconds);
void WINAPI InitializeCriticalSection(CriticalSection* section);
void WINAPI DeleteCriticalSection(CriticalSection* section);
void WINAPI EnterCriticalSection(CriticalSection* section);
void WINAPI LeaveCriticalSection(CriticalSection* section);
LPVOID WINAPI TlsGetValue(DWORD index);

// Modules and pages (kernel32_modules.cpp).
HMODULE WINAPI GetModuleHandleA(LPCSTR name);
HMODULE WINAPI LoadLibraryA(LPCSTR name);
BOOL WINAPI FreeLibrary(HMODULE module);
FARPROC WINAPI GetProcAddress(HMODULE module, LPCSTR name);
SIZE_T WINAPI VirtualQuery(const void* address, MemoryBasicInformation* information, SIZE_T size);
BOOL WINAPI VirtualProtect(void* address, SIZE_T size, DWORD protection, DWORD* previous);

}  // namespace pe::kernel32
