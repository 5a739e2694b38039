// The TLS directory: the template of the image's per-thread data, where the
// loader writes the image's TLS index, and the callbacks it runs before the
// entry point. Its fields are addresses, so it is read after relocation.
#include "image_bytes.h"
#include "pe_image.h"

namespace pe {

bool ReadThreadStorage(std::span<const uint8_t> image, const Layout& layout, uint32_t base,
                       ThreadStorage& storage, std::string& error) {
  const ImageBytes bytes(image);
  const Directory directory = layout.directories[kTlsDirectory];
  storage = ThreadStorage{};
  if (directory.size == 0) return false;
  if (!bytes.Has(directory.rva, 24)) {
    return Fail(error, "TLS directory (RVA 0x%x) lies outside the image", directory.rva);
  }
  // Each address as an RVA; one outside the image makes it size() or more.
  const auto rvaOf = [&](uint32_t address) { return uint64_t{address - base}; };
  const uint64_t dataStart = rvaOf(bytes.U32(directory.rva));
  const uint64_t dataEnd = rvaOf(bytes.U32(directory.rva + 4));
  const uint64_t index = rvaOf(bytes.U32(directory.rva + 8));
  const uint32_t callbacks = bytes.U32(directory.rva + 12);
  storage.zeroFill = bytes.U32(directory.rva + 16);
  const bool noData = bytes.U32(directory.rva) == 0 && bytes.U32(directory.rva + 4) == 0;
  if (!noData && (dataEnd < dataStart || !bytes.Has(dataStart, dataEnd - dataStart))) {
    return Fail(error, "the TLS data template lies outside the image");
  }
  if (!bytes.Has(index, 4)) return Fail(error, "the TLS index lies outside the image");
  storage.dataRva = noData ? 0 : static_cast<uint32_t>(dataStart);
  storage.dataSize = noData ? 0 : static_cast<uint32_t>(dataEnd - dataStart);
  storage.indexRva = static_cast<uint32_t>(index);
  for (uint64_t at = rvaOf(callbacks); callbacks != 0; at += 4) {
    if (!bytes.Has(at, 4)) return Fail(error, "the TLS callback list runs outside the image");
    const uint32_t callback = bytes.U32(at);
    if (callback == 0) break;
    if (!bytes.Has(rvaOf(callback), 1)) return Fail(error, "a TLS callback at 0x%x lies outside the image", callback);
    storage.callbacks.push_back(static_cast<uint32_t>(rvaOf(callback)));
  }
  return true;
}

}  // namespace pe
