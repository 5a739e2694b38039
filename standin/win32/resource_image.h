// The library's compiled resources (the bytes of the .res file made from
// src/resources/tavrin.rc, embedded in the library) as a list of entries.
#pragma once

#include <windows.h>

#include <cstdint>
#include <string>
#include <vector>

namespace standin {

// A resource type or name: an integer id, or a text kept in upper case as
// the resource compiler stores it.
struct ResourceKey {
  uint16_t id = 0;
  std::u16string text;  // empty for an id
};

struct ResourceEntry {
  ResourceKey type;
  ResourceKey name;
  uint16_t language = 0;
  const unsigned char* data = nullptr;
  uint32_t size = 0;
};

// The entries in file order. The embedded bytes must hold a well-formed
// .res file; reading stops at the first header that does not fit.
const std::vector<ResourceEntry>& LibraryResources();

// The entry FindResourceA finds, or null. A module other than the
// library's has no resources here.
const ResourceEntry* FindLibraryResource(HMODULE module, LPCSTR name, LPCSTR type);

// A little-endian 16-bit word at any address.
uint16_t ReadWord(const unsigned char* bytes);

// Resource texts are UTF-16; the ANSI calls see a character below 256 as
// that byte and any other as '?'.
char NarrowChar(uint16_t c);

}  // namespace standin
