// FindResourceA, LoadResource, LockResource, SizeofResource and FreeResource
// over the resources of the modules the stand-in knows. An HRSRC is the
// address of the module's entry and a loaded resource is the address of its
// data, as on Windows, where LockResource only hands that address back.
#include "module_resources.h"

namespace {

// The entry `handle` names among `module`'s, or null.
const standin::ResourceEntry* EntryOf(HMODULE module, HRSRC handle) {
  const std::vector<standin::ResourceEntry>* entries = standin::ModuleResources(module);
  if (entries == nullptr) return nullptr;
  for (const standin::ResourceEntry& entry : *entries) {
    if (reinterpret_cast<HRSRC>(const_cast<standin::ResourceEntry*>(&entry)) == handle) return &entry;
  }
  return nullptr;
}

}  // namespace

HRSRC WINAPI FindResourceA(HMODULE hModule, LPCSTR lpName, LPCSTR lpType) {
  const standin::ResourceEntry* entry = standin::FindModuleResource(hModule, lpName, lpType);
  return reinterpret_cast<HRSRC>(const_cast<standin::ResourceEntry*>(entry));
}

HGLOBAL WINAPI LoadResource(HMODULE hModule, HRSRC hResInfo) {
  const standin::ResourceEntry* entry = EntryOf(hModule, hResInfo);
  return entry == nullptr ? nullptr : const_cast<unsigned char*>(entry->data);
}

LPVOID WINAPI LockResource(HGLOBAL hResData) {
  if (hResData == nullptr) return nullptr;
  return standin::IsResourceData(hResData) ? hResData : nullptr;
}

DWORD WINAPI SizeofResource(HMODULE hModule, HRSRC hResInfo) {
  const standin::ResourceEntry* entry = EntryOf(hModule, hResInfo);
  return entry == nullptr ? 0 : entry->size;
}

// Resources stay mapped with their module; releasing one is a no-op that
// reports FALSE, as it does on Windows.
BOOL WINAPI FreeResource(HGLOBAL) { return FALSE; }
