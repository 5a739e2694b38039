// The resources of the modules the stand-in knows, by module handle, and the
// lookup that FindResourceA and the calls that load strings, menus and
// dialogs share.
#pragma once

#include <windows.h>

#include <cstdint>
#include <vector>

#include "standin_win32.h"

namespace standin {

// The entries of a module that has been added, or null.
const std::vector<ResourceEntry>* ModuleResources(HMODULE module);

// True when `data` is where a known module's resource begins.
bool IsResourceData(const void* data);

// The entry FindResourceA finds, or null. A module that has not been added
// has no resources.
const ResourceEntry* FindModuleResource(HMODULE module, LPCSTR name, LPCSTR type);

// The entries of a .res file, as the resource compiler writes one, in file
// order. Reading stops at the first header that does not fit.
std::vector<ResourceEntry> ReadResFile(const unsigned char* bytes, std::size_t size);

// A little-endian 16-bit word at any address.
uint16_t ReadWord(const unsigned char* bytes);

// Resource texts are UTF-16; the ANSI calls see a character below 256 as
// that byte and any other as '?'.
char NarrowChar(uint16_t c);

}  // namespace standin
