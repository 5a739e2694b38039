// A host that fails the compatibility test gets no menus and no display
// strings: the routines return null and leave the buffers as they were.
#include <gtest/gtest.h>

#include "catalogue_helpers.h"
#include "frame/exports.h"

namespace {

using catalogue_test::GuardedBuffer;
using catalogue_test::HostWithVersion;

struct IncompatibleHost {
  const char* why;
  bool hasVersionService;
  uint32_t version;
};

const IncompatibleHost kIncompatibleHosts[] = {
    {"no version service", false, 0},
    {"build 217", true, 0x02000000u | 217u},
    {"version 0x0100", true, 0x01000000u | 300u},
    {"flag 0x8000 set", true, 0x02000000u | 0x8000u | 300u},
};

TEST(IncompatibleHost, GetsNoMenusAndNoDisplayStrings) {
  for (const IncompatibleHost& kind : kIncompatibleHosts) {
    EditorHost host = kind.hasVersionService ? HostWithVersion(kind.version) : EditorHost{};
    EXPECT_EQ(GetConditionMenu(&host, nullptr, nullptr), nullptr) << kind.why;
    EXPECT_EQ(GetActionMenu(&host, nullptr, nullptr), nullptr) << kind.why;
    EXPECT_EQ(GetExpressionMenu(&host, nullptr, nullptr), nullptr) << kind.why;
    GuardedBuffer<64> text;
    GetConditionString(&host, 0, text.data(), text.size());
    GetActionString(&host, 0, text.data(), text.size());
    GetExpressionString(&host, 0, text.data(), text.size());
    EXPECT_TRUE(text.untouched()) << kind.why;
  }
}

}  // namespace
