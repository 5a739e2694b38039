// Memory that cannot be had: the run-time object is refused whole, and a list
// keeps what it held when an append fails.
#include <cstdlib>
#include <random>
#include <vector>

#include <gtest/gtest.h>

#include "chains/run_data.h"
#include "frame/edit_data.h"
#include "frame/exports.h"

namespace {

int g_allocationsLeft = -1;  // -1: no end

bool NextAllocationSucceeds() {
  if (g_allocationsLeft == 0) return false;
  if (g_allocationsLeft > 0) --g_allocationsLeft;
  return true;
}

}  // namespace

// The library allocates with malloc and realloc alone. This program is linked
// with both wrapped (tests/frame/CMakeLists.txt): every call to them from its
// own objects, the library's among them, comes here first.
extern "C" void* __real_malloc(std::size_t size);
extern "C" void* __real_realloc(void* block, std::size_t size);
extern "C" void* __wrap_malloc(std::size_t size) { return NextAllocationSucceeds() ? __real_malloc(size) : nullptr; }
extern "C" void* __wrap_realloc(void* block, std::size_t size) {
  return NextAllocationSucceeds() ? __real_realloc(block, size) : nullptr;
}

namespace {

// Runs `call` with every allocation after the first `succeeding` failing.
template <typename Call>
auto FailingAfter(int succeeding, Call call) {
  struct Restore {
    ~Restore() { g_allocationsLeft = -1; }
  } restore;
  g_allocationsLeft = succeeding;
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

// Random appends, removals and lookups against a vector, a third of them made
// while memory has run out, on fresh lists that must grow: a failed append
// leaves the list as it was, and a lookup without memory for its index still
// finds the first object of the identifier.
TEST(AllocationFailure, ListsMatchAVectorWhicheverAllocationsFail) {
  std::vector<HostObject> objects(48);
  for (std::size_t i = 0; i < objects.size(); ++i) objects[i].head.idLow = static_cast<int16_t>(i % 40);
  std::mt19937 random(7);
  int failedAppends = 0;
  for (int round = 0; round < 60; ++round) {
    ObjectList list;
    std::vector<HostObject*> model;
    for (uint32_t step = 0, steps = random() % 200; step < steps; ++step) {
      const bool starved = random() % 3 == 0;
      const uint32_t pick = random() % objects.size();
      switch (random() % 4) {
        case 0:
          if (!model.empty()) {
            const uint32_t at = pick % model.size();
            list.RemoveAt(at);
            model.erase(model.begin() + at);
          }
          break;
        case 1: {
          const int32_t id = ObjectIdentifier(objects[pick].head);
          const auto found = starved ? FailingAfter(0, [&] { return list.Find(id); }) : list.Find(id);
          uint32_t first = 0;
          while (first < model.size() && ObjectIdentifier(model[first]->head) != id) ++first;
          ASSERT_EQ(found.value_or(first), first) << "round " << round << ", step " << step;
          ASSERT_EQ(found.has_value(), first < model.size());
          break;
        }
        default:
          if (starved ? !FailingAfter(0, [&] { return list.Append(&objects[pick]); }) : !list.Append(&objects[pick])) {
            ++failedAppends;
            break;
          }
          model.push_back(&objects[pick]);
      }
      ASSERT_EQ(list.Count(), model.size());
      for (uint32_t i = 0; i < list.Count(); ++i) ASSERT_EQ(list.At(i), model[i]) << "round " << round;
    }
  }
  EXPECT_GT(failedAppends, 0);
}

}  // namespace
