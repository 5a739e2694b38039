// The import tables (one descriptor per DLL, naming its lookup table and its
// address table) and the export table's names.
#include "image_bytes.h"
#include "pe_image.h"

namespace pe {

namespace {

constexpr uint32_t kDescriptorSize = 20;
constexpr uint32_t kImportByOrdinal = 0x80000000;

bool ReadDllImports(const ImageBytes& bytes, uint64_t descriptor, ImportedDll& dll, std::string& error) {
  const uint32_t lookup = bytes.U32(descriptor) != 0 ? bytes.U32(descriptor) : bytes.U32(descriptor + 16);
  const uint32_t slots = bytes.U32(descriptor + 16);
  if (!bytes.Text(bytes.U32(descriptor + 12), dll.name)) {
    return Fail(error, "an imported DLL's name (RVA 0x%x) lies outside the image", bytes.U32(descriptor + 12));
  }
  if (slots == 0) return Fail(error, "the imports of %s have no address table", dll.name.c_str());
  for (uint64_t i = 0;; ++i) {
    const uint64_t entry = lookup + 4 * i;
    const uint64_t slot = slots + 4 * i;
    if (!bytes.Has(entry, 4) || !bytes.Has(slot, 4)) {
      return Fail(error, "the import table of %s (RVA 0x%x) runs outside the image", dll.name.c_str(), lookup);
    }
    const uint32_t value = bytes.U32(entry);
    if (value == 0) return true;
    Import import;
    import.slotRva = static_cast<uint32_t>(slot);
    if ((value & kImportByOrdinal) != 0) {
      import.ordinal = static_cast<uint16_t>(value);
    } else if (!bytes.Has(value, 2) || !bytes.Text(uint64_t{value} + 2, import.name)) {
      return Fail(error, "the name of a function imported from %s (RVA 0x%x) lies outside the image",
                  dll.name.c_str(), value);
    }
    dll.functions.push_back(std::move(import));
  }
}

}  // namespace

bool ReadImports(std::span<const uint8_t> image, const Layout& layout, std::vector<ImportedDll>& dlls,
                 std::string& error) {
  const ImageBytes bytes(image);
  const Directory directory = layout.directories[kImportDirectory];
  dlls.clear();
  if (directory.size == 0) return true;
  // The descriptors end with an empty one, whatever the directory's size says.
  for (uint64_t descriptor = directory.rva;; descriptor += kDescriptorSize) {
    if (!bytes.Has(descriptor, kDescriptorSize)) {
      return Fail(error, "import directory (RVA 0x%x) runs outside the image", directory.rva);
    }
    if (bytes.U32(descriptor + 12) == 0 && bytes.U32(descriptor + 16) == 0) return true;
    ImportedDll dll;
    if (!ReadDllImports(bytes, descriptor, dll, error)) return false;
    dlls.push_back(std::move(dll));
  }
}

uint32_t FindExport(std::span<const uint8_t> image, const Layout& layout, std::string_view name) {
  const ImageBytes bytes(image);
  const Directory directory = layout.directories[kExportDirectory];
  if (directory.size == 0 || !bytes.Has(directory.rva, 40)) return 0;
  const uint32_t functionCount = bytes.U32(directory.rva + 20);
  const uint32_t nameCount = bytes.U32(directory.rva + 24);
  const uint32_t functions = bytes.U32(directory.rva + 28);
  const uint32_t names = bytes.U32(directory.rva + 32);
  const uint32_t ordinals = bytes.U32(directory.rva + 36);
  std::string exported;
  for (uint64_t i = 0; i < nameCount; ++i) {
    if (!bytes.Has(names + 4 * i, 4) || !bytes.Has(ordinals + 2 * i, 2)) return 0;
    if (!bytes.Text(bytes.U32(names + 4 * i), exported) || exported != name) continue;
    const uint16_t index = bytes.U16(ordinals + 2 * i);
    if (index >= functionCount || !bytes.Has(functions + 4ull * index, 4)) return 0;
    const uint32_t rva = bytes.U32(functions + 4ull * index);
    // An address inside the export directory is a forwarder's text.
    const bool forwarded = rva >= directory.rva && rva - directory.rva < directory.size;
    return forwarded || rva >= layout.sizeOfImage ? 0 : rva;
  }
  return 0;
}

}  // namespace pe
