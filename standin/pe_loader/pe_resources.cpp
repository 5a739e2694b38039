// The resource directory: three levels of tables (type, name, language) of
// 8-byte entries, ids or names, each leading to a subtable or, at the last
// level, to a data entry (the data's RVA and size). Offsets of subtables and
// names count from the start of the directory.
#include "image_bytes.h"
#include "pe_image.h"

namespace pe {

namespace {

constexpr uint32_t kHighBit = 0x80000000;
// More table entries than any DLL holds: a damaged directory whose tables
// lead back into each other stops here instead of multiplying without end.
constexpr std::size_t kMostEntries = 65536;

struct Walk {
  const ImageBytes& bytes;
  uint64_t root;
  std::vector<Resource>& resources;
  std::string& error;
  std::size_t entriesLeft = kMostEntries;
};

bool ReadKey(const Walk& walk, uint32_t field, ResourceKey& key) {
  key = ResourceKey{};
  if ((field & kHighBit) == 0) {
    key.id = static_cast<uint16_t>(field);
    return true;
  }
  const uint64_t at = walk.root + (field & ~kHighBit);
  if (!walk.bytes.Has(at, 2) || !walk.bytes.Has(at + 2, 2ull * walk.bytes.U16(at))) {
    return Fail(walk.error, "a resource name lies outside the image");
  }
  for (uint32_t c = 0; c < walk.bytes.U16(at); ++c) {
    const char16_t unit = static_cast<char16_t>(walk.bytes.U16(at + 2 + 2 * c));
    // Names are found without regard to case; the stand-in keeps them upper case.
    key.text.push_back(unit >= u'a' && unit <= u'z' ? static_cast<char16_t>(unit - u'a' + u'A') : unit);
  }
  return true;
}

// Reads the table at `offset` of level `level` (0 types, 1 names, 2 languages).
bool ReadTable(Walk& walk, uint32_t offset, int level, Resource& path) {
  const uint64_t table = walk.root + offset;
  if (!walk.bytes.Has(table, 16)) return Fail(walk.error, "a resource table lies outside the image");
  const uint32_t count = uint32_t{walk.bytes.U16(table + 12)} + walk.bytes.U16(table + 14);
  for (uint32_t i = 0; i < count; ++i) {
    const uint64_t entry = table + 16 + 8ull * i;
    if (!walk.bytes.Has(entry, 8)) return Fail(walk.error, "a resource table lies outside the image");
    if (walk.entriesLeft-- == 0) return Fail(walk.error, "the resource directory has more than %zu entries", kMostEntries);
    const uint32_t key = walk.bytes.U32(entry);
    const uint32_t target = walk.bytes.U32(entry + 4);
    if (level == 0 && !ReadKey(walk, key, path.type)) return false;
    if (level == 1 && !ReadKey(walk, key, path.name)) return false;
    if (level == 2) path.language = static_cast<uint16_t>(key);
    if (level < 2) {
      if ((target & kHighBit) == 0) return Fail(walk.error, "a resource table entry has data where a table belongs");
      if (!ReadTable(walk, target & ~kHighBit, level + 1, path)) return false;
      continue;
    }
    const uint64_t data = walk.root + target;
    if ((target & kHighBit) != 0 || !walk.bytes.Has(data, 16)) {
      return Fail(walk.error, "a resource's data entry lies outside the image");
    }
    path.dataRva = walk.bytes.U32(data);
    path.size = walk.bytes.U32(data + 4);
    if (!walk.bytes.Has(path.dataRva, path.size)) {
      return Fail(walk.error, "a resource's data (RVA 0x%x, 0x%x bytes) lies outside the image", path.dataRva, path.size);
    }
    walk.resources.push_back(path);
  }
  return true;
}

}  // namespace

bool ReadResources(std::span<const uint8_t> image, const Layout& layout, std::vector<Resource>& resources,
                   std::string& error) {
  const ImageBytes bytes(image);
  const Directory directory = layout.directories[kResourceDirectory];
  resources.clear();
  if (directory.size == 0) return true;
  Resource path;
  Walk walk{bytes, directory.rva, resources, error};
  return ReadTable(walk, 0, 0, path);
}

}  // namespace pe
