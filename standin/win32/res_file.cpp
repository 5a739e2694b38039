// Reads a .res file, the resource compiler's output: the form in which the
// library's resources are embedded off Windows.
#include "module_resources.h"

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

}  // namespace

std::vector<ResourceEntry> ReadResFile(const unsigned char* bytes, std::size_t size) {
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

}  // namespace standin
