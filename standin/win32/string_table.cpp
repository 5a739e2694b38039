// LoadStringA over the library's string table. Strings are stored in blocks
// of sixteen: string id N is entry N % 16 of the RT_STRING resource named
// N / 16 + 1, each entry a length word followed by that many UTF-16
// characters (length 0 for an id that has no string).
#include <algorithm>

#include "module_resources.h"

int WINAPI LoadStringA(HINSTANCE hInstance, UINT uID, LPSTR lpBuffer, int cchBufferMax) {
  // A size of 0 asks Windows for a pointer to the resource text rather
  // than a copy; the library never asks for that, so nothing is written.
  if (lpBuffer == nullptr || cchBufferMax <= 0) return 0;
  lpBuffer[0] = '\0';

  const standin::ResourceEntry* block = standin::FindModuleResource(
      hInstance, MAKEINTRESOURCEA((LOWORD(uID) >> 4) + 1), RT_STRING);
  if (block == nullptr) return 0;

  std::size_t offset = 0;
  for (UINT skip = uID & 0xF; skip > 0; --skip) {
    if (offset + 2 > block->size) return 0;
    offset += 2 + 2 * std::size_t{standin::ReadWord(block->data + offset)};
  }
  if (offset + 2 > block->size) return 0;
  std::size_t length = standin::ReadWord(block->data + offset);
  offset += 2;
  length = std::min(length, (block->size - offset) / 2);

  // At most cchBufferMax - 1 characters, then the terminator.
  const std::size_t copied = std::min(length, static_cast<std::size_t>(cchBufferMax) - 1);
  for (std::size_t i = 0; i < copied; ++i) {
    lpBuffer[i] = standin::NarrowChar(standin::ReadWord(block->data + offset + 2 * i));
  }
  lpBuffer[copied] = '\0';
  return static_cast<int>(copied);
}
