// KERNEL32 as the loaded image's C and C++ runtime uses it, on one thread:
// last error, critical sections, semaphores, TLS slots, modules, page
// protection and the ANSI code page. Declared here with Windows' own types;
// the local memory and resource calls come from the Win32 stand-in.
#pragma once

#include <windows.h>

#include <cstdint>

namespace pe::kernel32 {

using HANDLE = void*;
using WCHAR = uint16_t;
using LPCWSTR = const WCHAR*;
using LPWSTR = WCHAR*;
using FARPROC = void*;

constexpr DWORD kErrorInvalidHandle = 6;
constexpr DWORD kErrorNotEnoughMemory = 8;
constexpr DWORD kErrorInvalidParameter = 87;
constexpr DWORD kErrorInsufficientBuffer = 122;
constexpr DWORD kErrorModNotFound = 126;
constexpr DWORD kErrorProcNotFound = 127;
constexpr DWORD kErrorTooManyPosts = 298;
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

// Threads and synchronisation (kernel32_threads.cpp).
DWORD WINAPI GetLastError();
void WINAPI SetLastError(DWORD error);
DWORD WINAPI GetCurrentThreadId();
void WINAPI Sleep(DWORD milliseconds);
void WINAPI InitializeCriticalSection(CriticalSection* section);
void WINAPI DeleteCriticalSection(CriticalSection* section);
void WINAPI EnterCriticalSection(CriticalSection* section);
void WINAPI LeaveCriticalSection(CriticalSection* section);
HANDLE WINAPI CreateSemaphoreW(void* attributes, LONG initial, LONG maximum, LPCWSTR name);
BOOL WINAPI ReleaseSemaphore(HANDLE semaphore, LONG count, LONG* previous);
DWORD WINAPI WaitForSingleObject(HANDLE handle, DWORD milliseconds);
BOOL WINAPI CloseHandle(HANDLE handle);
DWORD WINAPI TlsAlloc();
BOOL WINAPI TlsFree(DWORD index);
LPVOID WINAPI TlsGetValue(DWORD index);
BOOL WINAPI TlsSetValue(DWORD index, LPVOID value);

// Modules and pages (kernel32_modules.cpp).
HMODULE WINAPI GetModuleHandleA(LPCSTR name);
HMODULE WINAPI GetModuleHandleW(LPCWSTR name);
HMODULE WINAPI LoadLibraryA(LPCSTR name);
HMODULE WINAPI LoadLibraryW(LPCWSTR name);
BOOL WINAPI FreeLibrary(HMODULE module);
FARPROC WINAPI GetProcAddress(HMODULE module, LPCSTR name);
SIZE_T WINAPI VirtualQuery(const void* address, MemoryBasicInformation* information, SIZE_T size);
BOOL WINAPI VirtualProtect(void* address, SIZE_T size, DWORD protection, DWORD* previous);

// The ANSI code page, read as Latin-1: ASCII converts exactly (kernel32_code_pages.cpp).
int WINAPI MultiByteToWideChar(UINT codePage, DWORD flags, LPCSTR text, int length, LPWSTR wide, int wideLength);
int WINAPI WideCharToMultiByte(UINT codePage, DWORD flags, LPCWSTR wide, int wideLength, LPSTR text, int length,
                               LPCSTR defaultChar, BOOL* usedDefault);
BOOL WINAPI IsDBCSLeadByteEx(UINT codePage, BYTE byte);

}  // namespace pe::kernel32
