// msvcrt: the C library, called directly where msvcrt's function has the
// same types and meaning, and through a wrapper where it does not: its FILE
// records, wide characters, locale categories and record layouts, and the
// runtime's own start-up calls.
#include <unistd.h>

#include <cerrno>
#include <climits>
#include <cstdarg>
#include <cstdio>
#include <cstdlib>
#include <cstring>

#include "import_tables.h"

namespace pe {

namespace {

// msvcrt's FILE record is 32 bytes; the image only ever names the standard
// streams, as &_iob[0] to &_iob[2], and never looks inside.
struct MsvcrtFile {
  unsigned char opaque[32];
};
MsvcrtFile g_iob[3];
int g_mbCurMax = 1;  // a single-byte code page

FILE* StreamOf(MsvcrtFile* file) {
  if (file == &g_iob[0]) return stdin;
  if (file == &g_iob[1]) return stdout;
  if (file == &g_iob[2]) return stderr;
  errno = EBADF;
  return nullptr;
}

int Fputc(int c, MsvcrtFile* file) {
  FILE* stream = StreamOf(file);
  return stream == nullptr ? EOF : std::fputc(c, stream);
}

int Fputs(const char* text, MsvcrtFile* file) {
  FILE* stream = StreamOf(file);
  return stream == nullptr ? EOF : std::fputs(text, stream);
}

size_t Fwrite(const void* data, size_t size, size_t count, MsvcrtFile* file) {
  FILE* stream = StreamOf(file);
  return stream == nullptr ? 0 : std::fwrite(data, size, count, stream);
}

int Vfprintf(MsvcrtFile* file, const char* format, va_list arguments) {
  FILE* stream = StreamOf(file);
  return stream == nullptr ? -1 : std::vfprintf(stream, format, arguments);
}

// msvcrt's wchar_t is 16 bits.
size_t Wcslen(const uint16_t* text) {
  size_t length = 0;
  while (text[length] != 0) ++length;
  return length;
}

// msvcrt's struct lconv: ten texts, then eight characters. The image's
// locale is "C" whatever the process's is.
struct MsvcrtLconv {
  const char* texts[10];
  char values[8];
};

MsvcrtLconv* Localeconv() {
  static MsvcrtLconv c = {{".", "", "", "", "", "", "", "", "", ""},
                          {CHAR_MAX, CHAR_MAX, CHAR_MAX, CHAR_MAX, CHAR_MAX, CHAR_MAX, CHAR_MAX, CHAR_MAX}};
  return &c;
}

// msvcrt's categories are LC_ALL 0 to LC_TIME 5. The image may ask, and may
// choose "C", but never changes the locale of the process that hosts it.
char* Setlocale(int category, const char* locale) {
  static char c[] = "C";
  if (category < 0 || category > 5) return nullptr;
  if (locale == nullptr || std::strcmp(locale, "C") == 0) return c;
  return nullptr;
}

// The runtime's start-up: runs each initializer of a table, skipping gaps.
using Initializer = void (*)();
void Initterm(Initializer* first, Initializer* last) {
  for (; first < last; ++first) {
    if (*first != nullptr) (*first)();
  }
}

// A runtime error the image cannot go on from: msvcrt says so and exits.
void AmsgExit(int code) {
  std::fprintf(stderr, "runtime error R60%02d\n", code);
  _exit(255);
}

void SetUserMathErr(void*) {}  // matherr handlers are never called here
void Lock(int) {}              // one thread: nothing to lock
void Unlock(int) {}

}  // namespace

std::span<const ImportRow> MsvcrtImports() {
  static const ImportRow rows[] = {
      Data("__mb_cur_max", &g_mbCurMax),
      Cdecl<4>("__setusermatherr", &SetUserMathErr),
      Cdecl<4>("_amsg_exit", &AmsgExit),
      Cdecl<0>("_errno", &__errno_location),
      Cdecl<8>("_initterm", &Initterm),
      Data("_iob", g_iob),
      Cdecl<4>("_lock", &Lock),
      Cdecl<4>("_unlock", &Unlock),
      Cdecl<0>("abort", &abort),
      Cdecl<4>("atoi", &atoi),
      Cdecl<8>("calloc", &calloc),
      Cdecl<8>("fputc", &Fputc),
      Cdecl<8>("fputs", &Fputs),
      Cdecl<4>("free", &free),
      Cdecl<16>("fwrite", &Fwrite),
      Cdecl<0>("localeconv", &Localeconv),
      Cdecl<4>("malloc", &malloc),
      Cdecl<12>("memchr", static_cast<const void* (*)(const void*, int, size_t)>(&memchr)),
      Cdecl<12>("memcmp", &memcmp),
      Cdecl<12>("memcpy", &memcpy),
      Cdecl<12>("memmove", &memmove),
      Cdecl<12>("memset", &memset),
      Cdecl<8>("realloc", &realloc),
      Cdecl<8>("setlocale", &Setlocale),
      Cdecl<8>("strchr", static_cast<const char* (*)(const char*, int)>(&strchr)),
      Cdecl<8>("strcmp", &strcmp),
      Cdecl<4>("strerror", &strerror),
      Cdecl<4>("strlen", &strlen),
      Cdecl<12>("strncmp", &strncmp),
      Cdecl<12>("vfprintf", &Vfprintf),
      Cdecl<4>("wcslen", &Wcslen),
      Cdecl<12>("_read", &read),
      Cdecl<4>("_close", &close),
  };
  return rows;
}

}  // namespace pe
