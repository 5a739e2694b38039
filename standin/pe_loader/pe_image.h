// A PE32 image for 32-bit x86 as plain data: its headers read and checked
// from a file's bytes, then laid out, relocated and read in memory. Nothing
// here maps memory or runs the image, so all of it can be fuzzed.
#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace pe {

// The largest image the loader takes. Windows allows more; a test DLL is
// far smaller, and a damaged header must not reserve the address space.
constexpr uint32_t kLargestImage = 256u << 20;

enum DirectoryIndex : int {
  kExportDirectory = 0,
  kImportDirectory = 1,
  kResourceDirectory = 2,
  kRelocationDirectory = 5,
  kTlsDirectory = 9,
  kDirectoryCount = 16,
};

struct Directory {
  uint32_t rva = 0;
  uint32_t size = 0;
};

// Section characteristics that decide the protection of its pages.
constexpr uint32_t kSectionExecute = 0x20000000;
constexpr uint32_t kSectionRead = 0x40000000;
constexpr uint32_t kSectionWrite = 0x80000000;

struct Section {
  std::string name;
  uint32_t rva = 0;
  uint32_t memorySize = 0;  // bytes it takes in the image
  uint32_t fileOffset = 0;
  uint32_t fileSize = 0;  // bytes copied from the file, at most memorySize
  uint32_t characteristics = 0;
};

struct Layout {
  uint32_t imageBase = 0;
  uint32_t sizeOfImage = 0;
  uint32_t sizeOfHeaders = 0;
  uint32_t entryPoint = 0;  // RVA; 0 for none
  bool relocationsStripped = false;
  Directory directories[kDirectoryCount];
  std::vector<Section> sections;  // in ascending RVA order
};

// Reads and checks the headers of a file: a PE32 DLL for x86 whose sections
// lie inside the image, do not overlap and have their bytes in the file.
// False, with one line saying what is wrong, for anything else.
bool ReadLayout(std::span<const uint8_t> file, Layout& layout, std::string& error);

// Lays the file out as the loader maps it: the headers and each section's
// bytes at their RVAs. `image` holds layout.sizeOfImage zeroed bytes.
void CopyImage(std::span<const uint8_t> file, const Layout& layout, std::span<uint8_t> image);

// Moves an image laid out for its preferred base to `base`: every address
// its base relocations name gets the difference added. The relocations are
// checked even when nothing moves. False when one lies outside the image or
// is of a kind x86 images do not use, or when the image must move and has
// no relocations.
bool Relocate(std::span<uint8_t> image, const Layout& layout, uint32_t base, std::string& error);

struct Import {
  std::string name;  // empty when imported by ordinal
  uint16_t ordinal = 0;
  uint32_t slotRva = 0;  // where the loader writes the address
};

struct ImportedDll {
  std::string name;
  std::vector<Import> functions;
};

// The DLLs and functions the image imports, each function with the RVA of
// its address slot. False when any part of the import tables lies outside
// the image.
bool ReadImports(std::span<const uint8_t> image, const Layout& layout, std::vector<ImportedDll>& dlls,
                 std::string& error);

// The RVA of the function exported as `name`; 0 when there is none, or it
// is forwarded to another DLL, or the export table is damaged.
uint32_t FindExport(std::span<const uint8_t> image, const Layout& layout, std::string_view name);

struct ThreadStorage {
  uint32_t dataRva = 0;  // the template of each thread's data
  uint32_t dataSize = 0;
  uint32_t zeroFill = 0;
  uint32_t indexRva = 0;  // where the loader writes the image's TLS index
  std::vector<uint32_t> callbacks;  // RVAs, in order
};

// The image's TLS directory, read from an image relocated to `base` (its
// fields are addresses). False when the image has none; also false, with an
// error, when anything it names lies outside the image.
bool ReadThreadStorage(std::span<const uint8_t> image, const Layout& layout, uint32_t base,
                       ThreadStorage& storage, std::string& error);

// A resource type or name: an id, or a text (then id is 0).
struct ResourceKey {
  uint16_t id = 0;
  std::u16string text;
};

struct Resource {
  ResourceKey type;
  ResourceKey name;
  uint16_t language = 0;
  uint32_t dataRva = 0;
  uint32_t size = 0;
};

// Every resource of the image's three-level resource directory (type, name,
// language). False when an entry or its data lies outside the image.
bool ReadResources(std::span<const uint8_t> image, const Layout& layout, std::vector<Resource>& resources,
                   std::string& error);

}  // namespace pe
