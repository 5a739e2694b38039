// How the host calls the routines of the library's tables. On 32-bit x86 it
// calls them as the real host does, whatever the library's own types say:
// __stdcall, one word pushed per argument, and the routine pops exactly those
// words. A routine of another convention or argument count would corrupt the
// real host's stack, often silently; here the program stops and says so.
#pragma once

#include <cstdint>
#include <type_traits>

namespace standin {

#if defined(__i386__)
// Calls `routine` with the `count` words pushed, the first one last, and
// returns EAX. `unpopped` receives the bytes the routine left on the stack
// (negative: it popped more than was pushed).
extern "C" uint32_t StandinStdcallCall(const void* routine, const uint32_t* words, uint32_t count,
                                       int32_t* unpopped);
[[noreturn]] void ReportUnbalancedCall(int32_t unpopped, uint32_t count);

template <class T>
uint32_t Word(T value) {
  if constexpr (std::is_pointer_v<T>) {
    return static_cast<uint32_t>(reinterpret_cast<uintptr_t>(value));
  } else {
    return static_cast<uint32_t>(value);
  }
}
#endif

template <class Routine, class... Args>
auto CallRoutine(Routine routine, Args... args) {
#if defined(__i386__)
  using Result = std::invoke_result_t<Routine, Args...>;
  const uint32_t words[] = {Word(args)...};
  int32_t unpopped = 0;
  const uint32_t eax =
      StandinStdcallCall(reinterpret_cast<const void*>(routine), words, sizeof...(Args), &unpopped);
  if (unpopped != 0) ReportUnbalancedCall(unpopped, sizeof...(Args));
  return static_cast<Result>(eax);
#else
  return routine(args...);
#endif
}

}  // namespace standin
