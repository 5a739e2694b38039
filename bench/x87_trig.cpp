// What the shipping DLL's sines and cosines are on a real processor. Its
// maths library computes sin with the x87 FSIN and sin and cos of one angle
// with FSINCOS, each on the double loaded exactly and stored back rounded to
// a double; qemu computes those instructions with the C library instead.
//
// Preloaded into a program (LD_PRELOAD), this library takes that program's
// sin, cos and sincos, answers each call as those instructions do on the
// processor it runs on, and at exit tells on standard error how many calls
// gave other bits than the C library's. A test program preloaded with it
// runs with the shipping DLL's sines; under qemu-i386 (a 32-bit build), the
// emulated instructions give the C library's bits.
#include <dlfcn.h>

#include <cmath>
#include <cstdint>
#include <cstdio>
#include <cstring>

namespace {

struct Tally {
  uint64_t calls = 0;
  uint64_t differing = 0;
  uint64_t largestUlps = 0;
  ~Tally() {
    std::fprintf(stderr, "x87_trig: %llu sines and cosines, %llu differ from the C library's (by at most %llu ulp)\n",
                 static_cast<unsigned long long>(calls), static_cast<unsigned long long>(differing),
                 static_cast<unsigned long long>(largestUlps));
  }
} g_tally;

int64_t Bits(double value) {
  int64_t bits;
  std::memcpy(&bits, &value, sizeof bits);
  return bits;
}

void Compare(double x87, double library) {
  ++g_tally.calls;
  const int64_t ulps = Bits(x87) > Bits(library) ? Bits(x87) - Bits(library) : Bits(library) - Bits(x87);
  if (ulps == 0) return;
  ++g_tally.differing;
  if (static_cast<uint64_t>(ulps) > g_tally.largestUlps) g_tally.largestUlps = static_cast<uint64_t>(ulps);
}

template <typename F>
F Library(const char* name) {
  return reinterpret_cast<F>(dlsym(RTLD_NEXT, name));
}

// FSIN and FSINCOS leave an operand beyond 2^63 alone and say so in C2; the
// maths library then reduces it by 2 pi with FPREM1 and tries again, as here.
#define X87_TRIG(instruction)    \
  "fldl %[x]\n\t"                \
  instruction "\n\t"             \
  "fnstsw %%ax\n\t"              \
  "testl $0x400, %%eax\n\t"      \
  "jz 2f\n\t"                    \
  "fldpi\n\t"                    \
  "fadd %%st(0), %%st\n\t"       \
  "fxch %%st(1)\n"                \
  "1:\n\t"                       \
  "fprem1\n\t"                   \
  "fnstsw %%ax\n\t"              \
  "testl $0x400, %%eax\n\t"      \
  "jnz 1b\n\t"                   \
  "fstp %%st(1)\n\t"             \
  instruction "\n"                \
  "2:\n\t"

double Fsin(double x) {
  double result;
  asm(X87_TRIG("fsin") "fstpl %[sine]" : [sine] "=m"(result) : [x] "m"(x) : "eax", "st");
  return result;
}

void Fsincos(double x, double* s, double* c) {
  asm(X87_TRIG("fsincos") "fstpl %[cosine]\n\tfstpl %[sine]"
      : [sine] "=m"(*s), [cosine] "=m"(*c)
      : [x] "m"(x)
      : "eax", "st", "st(1)");
}

}  // namespace

extern "C" __attribute__((visibility("default"))) double sin(double x) {
  static const auto library = Library<double (*)(double)>("sin");
  const double result = Fsin(x);
  Compare(result, library(x));
  return result;
}

extern "C" __attribute__((visibility("default"))) double cos(double x) {
  static const auto library = Library<double (*)(double)>("cos");
  double s, c;
  Fsincos(x, &s, &c);
  Compare(c, library(x));
  return c;
}

extern "C" __attribute__((visibility("default"))) void sincos(double x, double* s, double* c) {
  static const auto library = Library<void (*)(double, double*, double*)>("sincos");
  double librarySin, libraryCos;
  library(x, &librarySin, &libraryCos);
  Fsincos(x, s, c);
  Compare(*s, librarySin);
  Compare(*c, libraryCos);
}
