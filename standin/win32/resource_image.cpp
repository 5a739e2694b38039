#include "resource_image.h"

#include <cstddef>

#include "standin_win32.h"

// Generated at build time from the library's .res file.
extern const unsigned char kLibraryResources[];
extern const std::size_t kLibraryResourcesSize;

namespace standin {

namespace {

uint32_t ReadDword(const unsigned char* bytes) {
  return uint32_t{ReadWord(bytes)} | (uint32_t{ReadWord(bytes + 2)} << 16);
}

std::size_t AlignToDword(std::size_t offset) { return (offset + 3) & ~std::size_t{3}; }

// Reads a type or name field of a resource header at `offset`, which must
// lie before `end`: 0xFFFF and an id, or a zero-terminated UTF-16 text.
bool ReadKey(const unsigned char* bytes, std::size_t& offset, std::size_t end, ResourceKey& key) {
  if (offset + 4 > end) return false;
  if (ReadWord(bytes + offset) == 0xFFFF) {
    key.id = ReadWord(bytes + offset + 2);
    offset += 4;
    return true;
  }
  for (; offset + 2 <= end; offset += 2) {
    const uint16_t c = ReadWord(bytes + offset);
    if (c == 0) {
      offset += 2;
      return true;
    }
    key.text.push_back(static_cast<char16_t>(c));
  }
  return false;
}

std::vector<ResourceEntry> ParseResources(const unsigned char* bytes, std::size_t size) {
  // Each entry: data size, header size, type, name, (align), data version,
  // memory flags, language, version, characteristics, then the data,
  // padded to a multiple of four bytes.
  std::vector<ResourceEntry> entries;
  std::size_t offset = 0;
  while (offset + 8 <= size) {
    const uint32_t dataSize = ReadDword(bytes + offset);
    const uint32_t headerSize = ReadDword(bytes + offset + 4);
    const std::size_t headerEnd = offset + headerSize;
    if (headerSize < 16 || headerEnd > size || dataSize > size - headerEnd) break;

    ResourceEntry entry;
    std::size_t field = offset + 8;
    if (!ReadKey(bytes, field, headerEnd, entry.type) || !ReadKey(bytes, field, headerEnd, entry.name)) break;
    field = AlignToDword(field);
    if (field + 8 > headerEnd) break;
    entry.language = ReadWord(bytes + field + 6);
    entry.data = bytes + headerEnd;
    entry.size = dataSize;
    // The file opens with an empty entry of type 0 that only marks the format.
    if (entry.type.id != 0 || !entry.type.text.empty()) entries.push_back(entry);
    offset = AlignToDword(headerEnd + dataSize);
  }
  return entries;
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

const std::vector<ResourceEntry>& LibraryResources() {
  static const std::vector<ResourceEntry> entries = ParseResources(kLibraryResources, kLibraryResourcesSize);
  return entries;
}

const ResourceEntry* FindLibraryResource(HMODULE module, LPCSTR name, LPCSTR type) {
  if (module != StandinLibraryModule() || name == nullptr || type == nullptr) return nullptr;
  // Every resource exists in one language only, so the first match is the
  // one the system's language preference would pick too.
  for (const ResourceEntry& entry : LibraryResources()) {
    if (KeyMatches(entry.type, type) && KeyMatches(entry.name, name)) return &entry;
  }
  return nullptr;
}

}  // namespace standin
