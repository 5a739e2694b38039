// The modules the stand-in knows and their resources, found by type and name
// as FindResourceA finds them.
#include "module_resources.h"

#include <cstddef>
#include <map>
#include <new>
#include <utility>

namespace standin {

namespace {

std::map<HMODULE, std::vector<ResourceEntry>>& Modules() {
  // Never destroyed: a loaded DLL shutting down at exit still calls in.
  static auto& modules = *new std::map<HMODULE, std::vector<ResourceEntry>>;
  return modules;
}

char16_t UpperAscii(char c) {
  return static_cast<char16_t>(c >= 'a' && c <= 'z' ? c - 'a' + 'A' : static_cast<unsigned char>(c));
}

// A name or type as the A calls take it: an integer id, "#" and a decimal
// id, or a text compared without regard to case.
bool KeyMatches(const ResourceKey& key, LPCSTR wanted) {
  if (IS_INTRESOURCE(wanted)) return key.text.empty() && key.id == LOWORD(wanted);
  if (wanted[0] == '#') {
    uint32_t id = 0;
    const char* c = wanted + 1;
    for (; *c >= '0' && *c <= '9' && id <= 0xFFFF; ++c) id = id * 10 + static_cast<uint32_t>(*c - '0');
    return *c == '\0' && c != wanted + 1 && id <= 0xFFFF && key.text.empty() && key.id == id;
  }
  std::size_t i = 0;
  for (; wanted[i] != '\0'; ++i) {
    if (i >= key.text.size() || key.text[i] != UpperAscii(wanted[i])) return false;
  }
  return i == key.text.size() && i > 0;
}

}  // namespace

uint16_t ReadWord(const unsigned char* bytes) {
  return static_cast<uint16_t>(bytes[0] | (bytes[1] << 8));
}

char NarrowChar(uint16_t c) { return c < 0x100 ? static_cast<char>(c) : '?'; }

const std::vector<ResourceEntry>* ModuleResources(HMODULE module) {
  const auto found = Modules().find(module);
  return found == Modules().end() ? nullptr : &found->second;
}

bool IsResourceData(const void* data) {
  for (const auto& [module, entries] : Modules()) {
    for (const ResourceEntry& entry : entries) {
      if (entry.data == data) return true;
    }
  }
  return false;
}

const ResourceEntry* FindModuleResource(HMODULE module, LPCSTR name, LPCSTR type) {
  const std::vector<ResourceEntry>* entries = ModuleResources(module);
  if (entries == nullptr || name == nullptr || type == nullptr) return nullptr;
  // Every resource exists in one language only, so the first match is the
  // one the system's language preference would pick too.
  for (const ResourceEntry& entry : *entries) {
    if (KeyMatches(entry.type, type) && KeyMatches(entry.name, name)) return &entry;
  }
  return nullptr;
}

}  // namespace standin

bool StandinAddModule(HMODULE module, std::vector<standin::ResourceEntry> resources) {
  try {
    standin::Modules()[module] = std::move(resources);
  } catch (const std::bad_alloc&) {
    return false;
  }
  return true;
}

void StandinRemoveModule(HMODULE module) { standin::Modules().erase(module); }
