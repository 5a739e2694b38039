// Reading a menu item's text into a buffer of limited size.
#pragma once

#include <windows.h>

// Reads the text of `item` into `buffer` (`size` bytes, at least 1) and makes
// sure it ends inside the buffer. Some USER32 versions fill a buffer that is
// too short up to its last byte and leave the terminator out; the text is then
// cut one character earlier, as others cut it. Gives GetMenuStringA's result.
inline int ReadMenuText(HMENU menu, UINT item, char* buffer, int size, UINT flags) {
  const int length = GetMenuStringA(menu, item, buffer, size, flags);
  if (length > 0) buffer[length < size - 1 ? length : size - 1] = '\0';
  return length;
}
