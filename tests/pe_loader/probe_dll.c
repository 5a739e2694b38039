/* A DLL without a C runtime for the loader's tests: every entry point of the
 * library under its name and with its argument bytes, answering which one it
 * is and what it was given; and an entry point that records each reason it
 * is called with. */
#define PROBE_API __declspec(dllexport)

static int* g_reasons;
static unsigned short g_controlWord;

PROBE_API void __stdcall ProbeRecordEntryCalls(int* reasons) { g_reasons = reasons; }
PROBE_API unsigned __stdcall ProbeControlWord(void) { return g_controlWord; }

int __stdcall DllMain(void* module, unsigned reason, void* reserved) {
  (void)module, (void)reserved;
  if (g_reasons) *g_reasons++ = (int)reason;
  return 1;
}

/* The answer of entry point `index` to `count` argument words; the test
 * computes the same. */
static unsigned Answer(unsigned index, unsigned count, const unsigned* words) {
  unsigned answer = index;
  __asm__("fnstcw %0" : "=m"(g_controlWord));
  for (unsigned i = 0; i < count; ++i) answer = answer * 31 + words[i];
  return answer;
}

#define WORDS_1 unsigned a
#define WORDS_2 WORDS_1, unsigned b
#define WORDS_3 WORDS_2, unsigned c
#define WORDS_4 WORDS_3, unsigned d
#define WORDS_5 WORDS_4, unsigned e
#define WORDS_6 WORDS_5, unsigned f
#define WORDS_7 WORDS_6, unsigned g
#define VALUES_1 a
#define VALUES_2 VALUES_1, b
#define VALUES_3 VALUES_2, c
#define VALUES_4 VALUES_3, d
#define VALUES_5 VALUES_4, e
#define VALUES_6 VALUES_5, f
#define VALUES_7 VALUES_6, g
#define TAVRIN_ENTRY_POINT(index, name, words)            \
  PROBE_API unsigned __stdcall name(WORDS_##words) {      \
    const unsigned given[] = {VALUES_##words};            \
    return Answer(index, words, given);                   \
  }
#include "entry_points.inc"
