// The object type's icon and its texts for the host's About information.
#include <algorithm>
#include <cstring>

#include "editor/icon_bytes.h"
#include "frame/exports.h"
#include "frame/module.h"
#include "resources/resource_ids.h"

namespace {

constexpr uint32_t kInfoHeaderSize = 40;
constexpr int kObjectTextSize = 255;

uint32_t ReadLittleEndian(const unsigned char* bytes, int count) {
  uint32_t value = 0;
  for (int i = count - 1; i >= 0; --i) value = (value << 8) | bytes[i];
  return value;
}

// Header, palette and pixels as the header describes them: 16-bit
// dimensions, the palette and pixel byte counts kept to 16 bits; the count
// of colours used is not consulted.
uint32_t PackedBitmapSize(const unsigned char* header) {
  const uint32_t width = ReadLittleEndian(header + 4, 2);
  const uint32_t height = ReadLittleEndian(header + 8, 2);
  const uint32_t bitCount = ReadLittleEndian(header + 14, 2);
  const uint32_t rowBytes = ((width * bitCount + 31) & ~uint32_t{31}) / 8;
  const uint32_t pixelBytes = (rowBytes * height) & 0xFFFF;
  const uint32_t paletteBytes = bitCount <= 8 ? (uint32_t{4} << bitCount) & 0xFFFF : 0;
  return kInfoHeaderSize + paletteBytes + pixelBytes;
}

}  // namespace

uint32_t IconBytesToCopy(const unsigned char* bitmap, uint32_t available) {
  if (available < kInfoHeaderSize) return 0;
  return std::min(PackedBitmapSize(bitmap), available);
}

TAVRIN_EXPORT int32_t TVCALL MakeIcon(void*, void* buffer, void*, void*, void*) {
  const HMODULE module = TavrinModule();
  const HRSRC found = FindResourceA(module, MAKEINTRESOURCEA(IDB_ICON), RT_BITMAP);
  if (found == nullptr) return -1;
  const HGLOBAL loaded = LoadResource(module, found);
  if (loaded == nullptr) return -1;
  const auto* bitmap = static_cast<const unsigned char*>(LockResource(loaded));
  // A damaged header may ask for more than the resource holds: never more.
  const uint32_t size = bitmap == nullptr ? 0 : IconBytesToCopy(bitmap, SizeofResource(module, found));
  if (size == 0) {  // not locked, or too short to be a bitmap
    FreeResource(loaded);
    return -1;
  }
  std::memcpy(buffer, bitmap, size);
  FreeResource(loaded);
  return 0;
}

TAVRIN_EXPORT void TVCALL GetObjInfos(void*, void*, char* name, char* author, char* copyright, char* comment,
                                      char* web) {
  const HINSTANCE module = TavrinModule();
  LoadStringA(module, IDS_OBJECT_NAME, name, kObjectTextSize);
  LoadStringA(module, IDS_OBJECT_AUTHOR, author, kObjectTextSize);
  LoadStringA(module, IDS_OBJECT_COPYRIGHT, copyright, kObjectTextSize);
  LoadStringA(module, IDS_OBJECT_COMMENT, comment, kObjectTextSize);  // absent: comes back empty
  LoadStringA(module, IDS_OBJECT_WEB, web, kObjectTextSize);
}
