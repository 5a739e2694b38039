// LocalAlloc and LocalFree for fixed blocks, the only kind the library asks
// for. Every live block is known, so freeing a foreign or already freed
// pointer fails instead of corrupting the heap.
#include <cstdlib>
#include <new>
#include <unordered_set>

#include "call_faults.h"
#include "standin_win32.h"

namespace {

std::unordered_set<void*>& LiveBlocks() {
  // Never destroyed: a loaded DLL shutting down at exit still calls in.
  static auto& blocks = *new std::unordered_set<void*>;
  return blocks;
}

standin::CallFaults g_allocFaults;

}  // namespace

HLOCAL WINAPI LocalAlloc(UINT uFlags, SIZE_T uBytes) {
  // Moveable blocks hand out handles rather than addresses; nothing here
  // asks for them.
  if ((uFlags & ~UINT{LMEM_ZEROINIT}) != LMEM_FIXED) return nullptr;
  if (g_allocFaults.NextCallFails()) return nullptr;
  // A zero-byte fixed block is still a distinct, freeable block.
  const SIZE_T size = uBytes == 0 ? 1 : uBytes;
  void* block = (uFlags & LMEM_ZEROINIT) != 0 ? std::calloc(1, size) : std::malloc(size);
  if (block == nullptr) return nullptr;
  try {
    LiveBlocks().insert(block);
  } catch (const std::bad_alloc&) {
    std::free(block);
    return nullptr;
  }
  return block;
}

HLOCAL WINAPI LocalFree(HLOCAL hMem) {
  if (hMem == nullptr) return nullptr;
  if (LiveBlocks().erase(hMem) == 0) return hMem;  // failure: the handle comes back
  std::free(hMem);
  return nullptr;
}

void StandinFailLocalAlloc(int successes, int failures) { g_allocFaults.Arm(successes, failures); }

std::size_t StandinLiveLocalBlockCount() { return LiveBlocks().size(); }
