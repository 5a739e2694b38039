// Memory that cannot be had: the run-time object is refused whole, and a list
// keeps what it held when an append fails.
#include <cstdlib>
#include <new>

#include <gtest/gtest.h>

#include "chains/run_data.h"
#include "frame/edit_data.h"
#include "frame/exports.h"

namespace {

int g_allocationsBeforeFailure = -1;  // -1: never fail

}  // namespace

void* operator new(std::size_t size) {
  if (g_allocationsBeforeFailure == 0) throw std::bad_alloc();
  if (g_allocationsBeforeFailure > 0) --g_allocationsBeforeFailure;
  if (void* p = std::malloc(size == 0 ? 1 : size)) return p;
  throw std::bad_alloc();
}
void* operator new(std::size_t size, const std::nothrow_t&) noexcept {
  try {
    return operator new(size);
  } catch (...) {
    return nullptr;
  }
}
void operator delete(void* p) noexcept { std::free(p); }
void operator delete(void* p, std::size_t) noexcept { std::free(p); }

namespace {

// Runs `call` with every allocation after the first `succeeding` failing.
template <typename Call>
auto FailingAfter(int succeeding, Call call) {
  struct Restore {
    ~Restore() { g_allocationsBeforeFailure = -1; }
  } restore;
  g_allocationsBeforeFailure = succeeding;
  return call();
}

// Three lists make the object. The later routines tolerate an object without
// them, and destruction releases them, also twice over.
TEST(AllocationFailure, CreationIsRefusedWholeWhenAnyListCannotBeMade) {
  EditData edit{};
  WriteEditDataDefaults(edit);
  for (int succeeding = 0; succeeding <= 3; ++succeeding) {
    SCOPED_TRACE(succeeding);
    alignas(8) unsigned char storage[sizeof(RunData)] = {};
    auto* rd = reinterpret_cast<RunData*>(storage);
    const auto lists = [rd] { return (rd->links != nullptr) + (rd->platforms != nullptr) + (rd->chains != nullptr); };
    EXPECT_EQ(FailingAfter(succeeding, [&] { return CreateRunObject(rd, &edit, nullptr); }), succeeding < 3 ? -1 : 0);
    EXPECT_EQ(lists(), succeeding < 3 ? 0 : 3);
    EXPECT_EQ(HandleRunObject(rd), 0);
    for (int destroy = 0; destroy < 2; ++destroy) EXPECT_EQ(DestroyRunObject(rd, 0), 0);
    EXPECT_EQ(lists(), 0);
  }
}

TEST(AllocationFailure, AFailedAppendLeavesTheListAsItWas) {
  ObjectList list;
  HostObject a{}, b{}, c{};
  ASSERT_TRUE(list.Append(&a) && list.Append(&b));
  // Two elements fill a vector's storage of two, so the third must grow it.
  EXPECT_FALSE(FailingAfter(0, [&] { return list.Append(&c); }));
  ASSERT_EQ(list.Count(), 2u);
  EXPECT_TRUE(list.At(0) == &a && list.At(1) == &b);
  ChainList chains;
  EXPECT_FALSE(FailingAfter(0, [&] { return chains.Append(ChainRecord{}); }));
  EXPECT_EQ(chains.Count(), 0u);
}

}  // namespace
