// The ANSI code page conversions. Any code page is read as Latin-1, one
// byte to one UTF-16 unit: exact for ASCII, which is all the image converts;
// a unit above 255 becomes the default character.
#include "kernel32_shim.h"

namespace pe::kernel32 {

namespace {

// Units to convert: a length of -1 counts up to and with the terminator.
bool SourceLength(const void* source, int length, int& count, bool wide) {
  if (source == nullptr || length == 0 || length < -1) return false;
  if (length > 0) {
    count = length;
    return true;
  }
  count = 1;
  if (wide) {
    for (auto* unit = static_cast<const WCHAR*>(source); *unit != 0; ++unit) ++count;
  } else {
    for (auto* byte = static_cast<const char*>(source); *byte != 0; ++byte) ++count;
  }
  return true;
}

// Checks the destination; the result: the count (needed or written), or 0
// after setting the error.
template <typename Copy>
int Convert(const void* source, int length, bool wide, void* destination, int room, Copy copy) {
  int count = 0;
  if (!SourceLength(source, length, count, wide) || room < 0 || (room > 0 && destination == nullptr)) {
    SetLastError(kErrorInvalidParameter);
    return 0;
  }
  if (room == 0) return count;  // only the size is asked for
  if (room < count) {
    SetLastError(kErrorInsufficientBuffer);
    return 0;
  }
  for (int i = 0; i < count; ++i) copy(i);
  return count;
}

}  // namespace

int WINAPI MultiByteToWideChar(UINT, DWORD, LPCSTR text, int length, LPWSTR wide, int wideLength) {
  return Convert(text, length, false, wide, wideLength,
                 [&](int i) { wide[i] = static_cast<unsigned char>(text[i]); });
}

int WINAPI WideCharToMultiByte(UINT, DWORD, LPCWSTR wide, int wideLength, LPSTR text, int length,
                               LPCSTR defaultChar, BOOL* usedDefault) {
  if (usedDefault != nullptr) *usedDefault = FALSE;
  return Convert(wide, wideLength, true, text, length, [&](int i) {
    if (wide[i] < 0x100) {
      text[i] = static_cast<char>(wide[i]);
      return;
    }
    text[i] = defaultChar != nullptr ? *defaultChar : '?';
    if (usedDefault != nullptr) *usedDefault = TRUE;
  });
}

// No byte leads a double-byte character in a single-byte code page.
BOOL WINAPI IsDBCSLeadByteEx(UINT, BYTE) { return FALSE; }

}  // namespace pe::kernel32
