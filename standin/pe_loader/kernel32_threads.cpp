// KERNEL32's thread calls for a process of one thread: a critical section is
// always free to enter, and no TLS slot can hold a value, as none can be
// allocated here.
#include <sys/syscall.h>
#include <unistd.h>

#include <ctime>

#include "kernel32_shim.h"

namespace pe::kernel32 {

namespace {

constexpr DWORD kTlsSlots = 64;
DWORD g_lastError = 0;

}  // namespace

DWORD WINAPI GetLastError() { return g_lastError; }
void SetLastError(DWORD error) { g_lastError = error; }

void WINAPI Sleep(DWORD milliseconds) {
  timespec pause{static_cast<time_t>(milliseconds / 1000), static_cast<long>(milliseconds % 1000) * 1000000};
  while (nanosleep(&pause, &pause) != 0) {
  }
}

void WINAPI InitializeCriticalSection(CriticalSection* section) { *section = CriticalSection{nullptr, -1, 0, nullptr, nullptr, 0}; }
void WINAPI DeleteCriticalSection(CriticalSection* section) { *section = CriticalSection{}; }

void WINAPI EnterCriticalSection(CriticalSection* section) {
  ++section->lockCount;
  ++section->recursionCount;
  section->owningThread = reinterpret_cast<HANDLE>(static_cast<uintptr_t>(syscall(SYS_gettid)));
}

void WINAPI LeaveCriticalSection(CriticalSection* section) {
  if (section->recursionCount <= 0) return;  // not entered: nothing to leave
  --section->lockCount;
  if (--section->recursionCount == 0) section->owningThread = nullptr;
}

// A slot never set holds null, and reading it succeeds.
LPVOID WINAPI TlsGetValue(DWORD index) {
  SetLastError(index < kTlsSlots ? 0 : kErrorInvalidParameter);
  return nullptr;
}

}  // namespace pe::kernel32
