// The PE loader: a damaged or foreign image is refused with one line before
// anything of it runs; freeing a DLL runs its entry point with
// DLL_PROCESS_DETACH; and every entry point of libtavrin.so reaches the
// loaded DLL's export of its name. This program's libtavrin.so loads the
// probe DLL.
#include <dlfcn.h>

#include <gtest/gtest.h>

#include <cstring>
#include <fstream>
#include <iterator>
#include <string>
#include <string_view>
#include <vector>

#include "frame/module.h"
#include "pe_loader.h"
#include "routine_call.h"

namespace {

using Bytes = std::vector<char>;

Bytes ReadFile(const char* path) {
  std::ifstream in(path, std::ios::binary);
  return Bytes(std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>());
}

uint32_t PeHeader(const Bytes& dll) {
  uint32_t offset = 0;
  std::memcpy(&offset, &dll[0x3C], 4);
  return offset;
}

void Put(Bytes& dll, std::size_t offset, uint32_t value, std::size_t size) { std::memcpy(&dll[offset], &value, size); }

void ReplaceAll(Bytes& dll, std::string_view from, std::string_view to) {
  for (auto at = dll.begin(); (at = std::search(at, dll.end(), from.begin(), from.end())) != dll.end();) {
    at = std::copy(to.begin(), to.end(), at);
  }
}

TEST(PeLoader, RefusesWhatIsNotALoadableX86DllInOneLine) {
  constexpr uint32_t kImports = 24 + 96 + 8, kRelocations = 24 + 96 + 40;  // data directory entries
  const struct {
    void (*damage)(Bytes&);
    const char* says;
  } cases[] = {
      {[](Bytes& d) { d[0] = 'X'; }, "not a PE image: no MZ header"},
      {[](Bytes& d) { Put(d, PeHeader(d) + 24, 0x20B, 2); }, "a PE32+ (64-bit) image"},
      {[](Bytes& d) { Put(d, PeHeader(d) + 4, 0x8664, 2); }, "machine 0x8664 is not x86"},
      {[](Bytes& d) { d.resize(d.size() / 2); }, "is truncated"},
      {[](Bytes& d) { Put(d, PeHeader(d) + kImports, 0x7FFFFFF0, 4); }, "import directory (RVA 0x7ffffff0) runs outside"},
      {[](Bytes& d) { Put(d, PeHeader(d) + kRelocations, 0x7FFFFFF0, 4); }, "relocation directory (RVA 0x7ffffff0"},
      {[](Bytes& d) { ReplaceAll(d, {"LoadStringA", 12}, {"LoadStringZ", 12}); }, "imports USER32.dll!LoadStringZ, which"},
      {[](Bytes& d) { ReplaceAll(d, {"\x22\0\0\x80", 4}, {"\x23\0\0\x80", 4}); }, "imports DRAVO2.dll ordinal 35, which"},
  };
  const std::string path = testing::TempDir() + "damaged.dll";
  for (const auto& c : cases) {
    Bytes dll = ReadFile(SHIPPING_DLL);
    c.damage(dll);
    std::ofstream(path, std::ios::binary).write(dll.data(), static_cast<std::streamsize>(dll.size()));
    char error[256] = "";
    EXPECT_EQ(PeLoadLibrary(path.c_str(), error, sizeof error), nullptr) << c.says;
    EXPECT_EQ(std::string(error).rfind(path + ": ", 0), 0u) << error;
    EXPECT_NE(std::string(error).find(c.says), std::string::npos) << error;
  }
}

// The probe is loaded already, so this copy is relocated: its entry point
// writes through the relocated address of its own variable.
TEST(PeLoader, FreeingRunsTheEntryPointWithProcessDetach) {
  char error[256] = "";
  void* probe = PeLoadLibrary(PROBE_DLL, error, sizeof error);
  ASSERT_NE(probe, nullptr) << error;
  ASSERT_NE(probe, TavrinModule());
  int reasons[2] = {-1, -1};
  using Record = void(__attribute__((stdcall)) *)(int*);
  reinterpret_cast<Record>(PeGetProcAddress(probe, "ProbeRecordEntryCalls"))(reasons);
  PeFreeLibrary(probe);
  EXPECT_EQ(reasons[0], 0);  // DLL_PROCESS_DETACH
  EXPECT_EQ(reasons[1], -1);
}

// Through each, the probe's export of that name gets the words pushed and
// answers with them, under Windows' x87 control word; the stack is left as
// the caller's __stdcall call expects.
TEST(Forwarding, EveryEntryPointReachesTheDllsExportOfItsName) {
  const struct {
    const char* name;
    uint32_t words;
  } exports[] = {
#define TAVRIN_ENTRY_POINT(index, name, words) {#name, words},
#include "entry_points.inc"
#undef TAVRIN_ENTRY_POINT
  };
  ASSERT_EQ(std::size(exports), 48u);
  for (uint32_t index = 0; index < std::size(exports); ++index) {
    uint32_t words[7] = {};
    uint32_t expected = index;
    for (uint32_t i = 0; i < exports[index].words; ++i) {
      words[i] = 0x9E3779B9u * (index + 1) + i;
      expected = expected * 31 + words[i];
    }
    int32_t unpopped = 0;
    const void* entry = dlsym(RTLD_DEFAULT, exports[index].name);
    ASSERT_NE(entry, nullptr) << exports[index].name;
    EXPECT_EQ(standin::StandinStdcallCall(entry, words, exports[index].words, &unpopped), expected) << exports[index].name;
    EXPECT_EQ(unpopped, 0) << exports[index].name;
  }
  using ControlWord = uint32_t(__attribute__((stdcall)) *)();
  EXPECT_EQ(reinterpret_cast<ControlWord>(PeGetProcAddress(TavrinModule(), "ProbeControlWord"))(), 0x27Fu);
}

}  // namespace
