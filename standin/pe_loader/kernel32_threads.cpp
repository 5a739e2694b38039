// KERNEL32's thread calls for a process of one thread: a critical section is
// always free to enter, a semaphore only counts, and a wait that nothing
// could ever end stops the program with a message instead of hanging.
#include <sys/syscall.h>
#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <ctime>
#include <map>
#include <memory>
#include <new>

#include "kernel32_shim.h"

namespace pe::kernel32 {

namespace {

constexpr DWORD kWaitObject0 = 0;
constexpr DWORD kWaitTimeout = 0x102;
constexpr DWORD kWaitFailed = 0xFFFFFFFF;
constexpr DWORD kInfinite = 0xFFFFFFFF;
constexpr DWORD kTlsOutOfIndexes = 0xFFFFFFFF;
constexpr DWORD kTlsSlots = 64;

DWORD g_lastError = 0;

struct Semaphore {
  LONG count;
  LONG maximum;
};
std::map<HANDLE, std::unique_ptr<Semaphore>>& Semaphores() {
  // Never destroyed: a loaded DLL shutting down at exit still calls in.
  static auto& semaphores = *new std::map<HANDLE, std::unique_ptr<Semaphore>>;
  return semaphores;
}

Semaphore* SemaphoreOf(HANDLE handle) {
  const auto found = Semaphores().find(handle);
  return found == Semaphores().end() ? nullptr : found->second.get();
}

bool g_tlsUsed[kTlsSlots] = {};
LPVOID g_tlsValues[kTlsSlots] = {};

}  // namespace

DWORD WINAPI GetLastError() { return g_lastError; }
void WINAPI SetLastError(DWORD error) { g_lastError = error; }
DWORD WINAPI GetCurrentThreadId() { return static_cast<DWORD>(syscall(SYS_gettid)); }

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
  section->owningThread = reinterpret_cast<HANDLE>(static_cast<uintptr_t>(GetCurrentThreadId()));
}

void WINAPI LeaveCriticalSection(CriticalSection* section) {
  if (section->recursionCount <= 0) return;  // not entered: nothing to leave
  --section->lockCount;
  if (--section->recursionCount == 0) section->owningThread = nullptr;
}

HANDLE WINAPI CreateSemaphoreW(void*, LONG initial, LONG maximum, LPCWSTR) {
  if (maximum <= 0 || initial < 0 || initial > maximum) {
    SetLastError(kErrorInvalidParameter);
    return nullptr;
  }
  try {
    auto semaphore = std::make_unique<Semaphore>(Semaphore{initial, maximum});
    const HANDLE handle = semaphore.get();
    Semaphores()[handle] = std::move(semaphore);
    return handle;
  } catch (const std::bad_alloc&) {
    SetLastError(kErrorNotEnoughMemory);
    return nullptr;
  }
}

BOOL WINAPI ReleaseSemaphore(HANDLE handle, LONG count, LONG* previous) {
  Semaphore* semaphore = SemaphoreOf(handle);
  if (semaphore == nullptr) {
    SetLastError(kErrorInvalidHandle);
    return FALSE;
  }
  if (count <= 0 || count > semaphore->maximum - semaphore->count) {
    SetLastError(count <= 0 ? kErrorInvalidParameter : kErrorTooManyPosts);
    return FALSE;
  }
  if (previous != nullptr) *previous = semaphore->count;
  semaphore->count += count;
  return TRUE;
}

DWORD WINAPI WaitForSingleObject(HANDLE handle, DWORD milliseconds) {
  Semaphore* semaphore = SemaphoreOf(handle);
  if (semaphore == nullptr) {
    SetLastError(kErrorInvalidHandle);
    return kWaitFailed;
  }
  if (semaphore->count > 0) {
    --semaphore->count;
    return kWaitObject0;
  }
  if (milliseconds == kInfinite) {
    // With one thread nothing can release it: Windows would hang here.
    std::fprintf(stderr, "pe_loader: the image waits forever on a semaphore no other thread can release\n");
    std::abort();
  }
  Sleep(milliseconds);
  return kWaitTimeout;
}

BOOL WINAPI CloseHandle(HANDLE handle) {
  if (Semaphores().erase(handle) == 0) {
    SetLastError(kErrorInvalidHandle);
    return FALSE;
  }
  return TRUE;
}

DWORD WINAPI TlsAlloc() {
  for (DWORD i = 0; i < kTlsSlots; ++i) {
    if (!g_tlsUsed[i]) {
      g_tlsUsed[i] = true;
      g_tlsValues[i] = nullptr;
      return i;
    }
  }
  return kTlsOutOfIndexes;
}

BOOL WINAPI TlsFree(DWORD index) {
  if (index >= kTlsSlots || !g_tlsUsed[index]) {
    SetLastError(kErrorInvalidParameter);
    return FALSE;
  }
  g_tlsUsed[index] = false;
  return TRUE;
}

LPVOID WINAPI TlsGetValue(DWORD index) {
  if (index >= kTlsSlots || !g_tlsUsed[index]) {
    SetLastError(kErrorInvalidParameter);
    return nullptr;
  }
  SetLastError(0);  // a null value is then told from a failure
  return g_tlsValues[index];
}

BOOL WINAPI TlsSetValue(DWORD index, LPVOID value) {
  if (index >= kTlsSlots || !g_tlsUsed[index]) {
    SetLastError(kErrorInvalidParameter);
    return FALSE;
  }
  g_tlsValues[index] = value;
  return TRUE;
}

}  // namespace pe::kernel32
