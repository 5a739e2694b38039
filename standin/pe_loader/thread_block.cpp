// The thread block lives in a page of its own, reached through a segment of
// the process's local descriptor table whose base is the block: %fs:0x18
// reads the block's own address, as on Windows.
#include "thread_block.h"

#include <asm/ldt.h>
#include <pthread.h>
#include <sys/mman.h>
#include <sys/syscall.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>

namespace pe {

namespace {

// Offsets in the thread block of the fields Windows code reads directly.
constexpr uint32_t kExceptionList = 0x00;
constexpr uint32_t kStackBase = 0x04;
constexpr uint32_t kStackLimit = 0x08;
constexpr uint32_t kSelf = 0x18;
constexpr uint32_t kProcessId = 0x20;
constexpr uint32_t kThreadId = 0x24;
constexpr uint32_t kTlsArray = 0x2C;
constexpr uint32_t kProcessBlock = 0x30;
constexpr uint32_t kPage = 0x1000;
constexpr uint32_t kTlsArraySlots = 64;
constexpr unsigned kLdtEntry = 0;
constexpr uint16_t kSelector = kLdtEntry << 3 | 4 | 3;  // LDT, ring 3

// The block, then a zeroed process block, then the TLS array.
uint8_t* g_block = nullptr;
pid_t g_thread = 0;  // the thread that has it

void Put(uint32_t offset, uint32_t value) { std::memcpy(g_block + offset, &value, 4); }
uint32_t AddressOf(const void* pointer) { return static_cast<uint32_t>(reinterpret_cast<uintptr_t>(pointer)); }

}  // namespace

bool EnsureThreadBlock(std::string& error) {
  const auto thread = static_cast<pid_t>(syscall(SYS_gettid));
  if (g_block != nullptr) {
    if (thread == g_thread) return true;
    error = "the loader serves one thread, the one that loaded the first DLL (" + std::to_string(g_thread) + ")";
    return false;
  }
  void* pages = mmap(nullptr, 3 * kPage, PROT_READ | PROT_WRITE, MAP_PRIVATE | MAP_ANONYMOUS, -1, 0);
  if (pages == MAP_FAILED) {
    error = std::string("cannot make the thread block: ") + std::strerror(errno);
    return false;
  }
  g_block = static_cast<uint8_t*>(pages);
  // The stack's bounds; the runtime's start-up lock takes the base as its
  // owner's token.
  pthread_attr_t attributes;
  void* stackLow = nullptr;
  size_t stackSize = 0;
  if (pthread_getattr_np(pthread_self(), &attributes) == 0) {
    pthread_attr_getstack(&attributes, &stackLow, &stackSize);
    pthread_attr_destroy(&attributes);
  }
  Put(kExceptionList, 0xFFFFFFFF);  // the end of an empty handler chain
  Put(kStackBase, AddressOf(static_cast<uint8_t*>(stackLow) + stackSize));
  Put(kStackLimit, AddressOf(stackLow));
  Put(kSelf, AddressOf(g_block));
  Put(kProcessId, static_cast<uint32_t>(getpid()));
  Put(kThreadId, static_cast<uint32_t>(thread));
  Put(kProcessBlock, AddressOf(g_block + kPage));
  Put(kTlsArray, AddressOf(g_block + 2 * kPage));

  user_desc segment{};
  segment.entry_number = kLdtEntry;
  segment.base_addr = AddressOf(g_block);
  segment.limit = kPage - 1;
  segment.seg_32bit = 1;
  segment.useable = 1;
  if (syscall(SYS_modify_ldt, 1, &segment, sizeof segment) != 0) {
    error = std::string("cannot give the thread its thread block: modify_ldt: ") + std::strerror(errno);
    munmap(pages, 3 * kPage);
    g_block = nullptr;
    return false;
  }
  asm volatile("movw %w0, %%fs" : : "q"(kSelector));
  g_thread = thread;
  return true;
}

void** ThreadStorageSlot(uint32_t index) {
  if (g_block == nullptr || index >= kTlsArraySlots) return nullptr;
  return reinterpret_cast<void**>(g_block + 2 * kPage) + index;
}

}  // namespace pe
