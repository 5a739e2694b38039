// FindResourceA, LoadResource, LockResource, SizeofResource and FreeResource
// over the library's embedded resources. An HRSRC is the entry's position
// plus one and a loaded resource is the address of its data, as on Windows,
// where LockResource only hands that address back.
#include "resource_image.h"
#include "standin_win32.h"

namespace {

const standin::ResourceEntry* EntryOf(HRSRC handle) {
  const auto& entries = standin::LibraryResources();
  const uintptr_t position = reinterpret_cast<uintptr_t>(handle);
  if (position == 0 || position > entries.size()) return nullptr;
  return &entries[position - 1];
}

}  // namespace

HRSRC WINAPI FindResourceA(HMODULE hModule, LPCSTR lpName, LPCSTR lpType) {
  const standin::ResourceEntry* entry = standin::FindLibraryResource(hModule, lpName, lpType);
  if (entry == nullptr) return nullptr;
  return reinterpret_cast<HRSRC>(static_cast<uintptr_t>(entry - standin::LibraryResources().data()) + 1);
}

HGLOBAL WINAPI LoadResource(HMODULE hModule, HRSRC hResInfo) {
  const standin::ResourceEntry* entry = EntryOf(hResInfo);
  if (hModule != StandinLibraryModule() || entry == nullptr) return nullptr;
  return const_cast<unsigned char*>(entry->data);
}

LPVOID WINAPI LockResource(HGLOBAL hResData) {
  if (hResData == nullptr) return nullptr;
  for (const standin::ResourceEntry& entry : standin::LibraryResources()) {
    if (entry.data == hResData) return hResData;
  }
  return nullptr;
}

DWORD WINAPI SizeofResource(HMODULE hModule, HRSRC hResInfo) {
  const standin::ResourceEntry* entry = EntryOf(hResInfo);
  return hModule != StandinLibraryModule() || entry == nullptr ? 0 : entry->size;
}

// Resources stay mapped with their module; releasing one is a no-op that
// reports FALSE, as it does on Windows.
BOOL WINAPI FreeResource(HGLOBAL) { return FALSE; }
