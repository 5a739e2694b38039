// msvcrt: the C library, called directly where msvcrt's function has the
// same types and meaning, and through a wrapper where it does not: its FILE
// records, and the runtime's own start-up calls.
#include <unistd.h>

#include <cerrno>
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

FILE* StreamOf(MsvcrtFile* file) {
  if (file == &g_iob[0]) return stdin;
  if (file == &g_iob[1]) return stdout;
  if (file == &g_iob[2]) return stderr;
  errno = EBADF;
  return nullptr;
}

size_t Fwrite(const void* data, size_t size, size_t count, MsvcrtFile* file) {
  FILE* stream = StreamOf(file);
  return stream == nullptr ? 0 : std::fwrite(data, size, count, stream);
}

int Vfprintf(MsvcrtFile* file, const char* format, va_list arguments) {
  FILE* stream = StreamOf(file);
  return stream == nullptr ? -1 : std::vfprintf(stream, format, arguments);
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
      // The library's own calls: the lists' storage and plain memory copies.
      Cdecl<4>("malloc", &malloc),
      Cdecl<8>("realloc", &realloc),
      Cdecl<4>("free", &free),
      Cdecl<12>("memcpy", &memcpy),
      Cdecl<12>("memmove", &memmove),
      Cdecl<12>("memset", &memset),
      // The C runtime's sine and cosine report domain errors through these.
      Cdecl<0>("_errno", &__errno_location),
      Cdecl<4>("__setusermatherr", &SetUserMathErr),
      // Its DLL start-up: the start-up lock, initialisers and exit table.
      Cdecl<4>("_amsg_exit", &AmsgExit),
      Cdecl<8>("_initterm", &Initterm),
      Cdecl<4>("_lock", &Lock),
      Cdecl<4>("_unlock", &Unlock),
      // Its thread-local storage callback.
      Cdecl<8>("calloc", &calloc),
      // Its relocation of imported data, and the message it writes when that
      // fails.
      Data("_iob", g_iob),
      Cdecl<0>("abort", &abort),
      Cdecl<16>("fwrite", &Fwrite),
      Cdecl<12>("vfprintf", &Vfprintf),
      Cdecl<4>("strlen", &strlen),
      Cdecl<12>("strncmp", &strncmp),
  };
  return rows;
}

}  // namespace pe
