// What the imports of a loaded image resolve to: for each DLL the loader
// stands in for, one row per function, with the bytes of arguments that
// Windows (or, for DRAVO2, the host) gives it, not what our own headers
// say. Each row's function is checked at compile time to take exactly those
// bytes in that convention, so a stand-in that disagrees with Windows does
// not build. The image check reads these rows too: they must be exactly the
// shipping DLL's imports, so that each new import is a conscious change (a
// row here, in the group of what needs it), and every call site in the DLL
// is held to them.
#pragma once

#include <cstdint>
#include <span>
#include <string_view>

namespace pe {

enum class Convention { Stdcall, Thiscall, Cdecl, Data };

struct ImportRow {
  const char* name;  // null for a row found by ordinal
  uint16_t ordinal;  // 0 for a row found by name
  Convention convention;
  uint32_t argumentBytes;  // pushed by the caller; removed by the callee unless Cdecl
  void* address;
};

struct ImportTable {
  const char* dll;
  std::span<const ImportRow> rows;
};

// Argument bytes of a function type: each argument takes its size rounded up
// to 4 bytes; __thiscall's object travels in ECX, not on the stack.
template <class... A>
constexpr uint32_t kStackBytes = (0 + ... + ((sizeof(A) + 3) & ~3u));
template <class F>
struct Signature;
template <class R, bool N, class... A>
struct Signature<R(__attribute__((stdcall)) *)(A...) noexcept(N)> {
  static constexpr Convention convention = Convention::Stdcall;
  static constexpr uint32_t bytes = kStackBytes<A...>;
};
template <class R, bool N, class S, class... A>
struct Signature<R(__attribute__((thiscall)) *)(S*, A...) noexcept(N)> {
  static constexpr Convention convention = Convention::Thiscall;
  static constexpr uint32_t bytes = kStackBytes<A...>;
};
template <class R, bool N, class... A>
struct Signature<R (*)(A...) noexcept(N)> {
  static constexpr Convention convention = Convention::Cdecl;
  static constexpr uint32_t bytes = kStackBytes<A...>;
};

template <Convention C, uint32_t Bytes, class F>
ImportRow Row(const char* name, uint16_t ordinal, F function) {
  static_assert(Signature<F>::convention == C, "the stand-in's calling convention is not the one Windows gives");
  static_assert(Signature<F>::bytes == Bytes, "the stand-in takes other argument bytes than Windows gives");
  return {name, ordinal, C, Bytes, reinterpret_cast<void*>(function)};
}

template <uint32_t Bytes, class F>
ImportRow Stdcall(const char* name, F function) { return Row<Convention::Stdcall, Bytes>(name, 0, function); }
template <uint32_t Bytes, class F>
ImportRow Stdcall(uint16_t ordinal, F function) { return Row<Convention::Stdcall, Bytes>(nullptr, ordinal, function); }
template <uint32_t Bytes, class F>
ImportRow Thiscall(uint16_t ordinal, F function) { return Row<Convention::Thiscall, Bytes>(nullptr, ordinal, function); }
template <uint32_t Bytes, class F>
ImportRow Cdecl(const char* name, F function) { return Row<Convention::Cdecl, Bytes>(name, 0, function); }
inline ImportRow Data(const char* name, void* object) { return {name, 0, Convention::Data, 0, object}; }

std::span<const ImportRow> Kernel32Imports();
std::span<const ImportRow> User32Imports();
std::span<const ImportRow> MsvcrtImports();
std::span<const ImportRow> Dravo2Imports();

// The table of the DLL named `dll` (compared without regard to case), or null.
const ImportTable* FindImportTable(std::string_view dll);
// The row of the function imported by `name`, or by `ordinal` when the name
// is empty; null when the table has none.
const ImportRow* FindImportRow(const ImportTable& table, std::string_view name, uint16_t ordinal);

}  // namespace pe
