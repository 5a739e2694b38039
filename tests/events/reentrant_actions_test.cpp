// Actions run from inside "On Swing" through the routine tables, as a host's
// event rules run them: they append to every list (moving its storage),
// start the chains they add and update chains while the step is under way.
// Run under AddressSanitizer, a reference held across the event shows.
#include <vector>

#include <gtest/gtest.h>

#include "frame/edit_data.h"
#include "host.h"

namespace {

constexpr int kAddAnchor = 0, kAddLink = 1, kAddPlatform = 2, kSetAngle = 6, kStartChain = 10,
              kUpdateAll = 13;
constexpr int kOnSwing = 1, kChainNum = 0;

TEST(ReentrantActions, RulesThatGrowTheListsInsideOnSwingAreSafeAndSeenInTheSamePass) {
  EditData edit{};
  WriteEditDataDefaults(edit);
  standin::Host host(edit);
  const auto ref = [](HostObject* object) { return reinterpret_cast<intptr_t>(object); };

  host.Action(kAddAnchor, ref(host.AddObject(100, 50, 32)));
  host.Action(kAddLink, ref(host.AddObject(0, 0, 16)));
  host.Action(kAddPlatform, ref(host.AddObject(0, 0, 16)));
  host.Action(kStartChain, 0);

  std::vector<int32_t> steppedThisFrame;
  host.onEvent = [&](int32_t code, int32_t) {
    ASSERT_EQ(code, kOnSwing);
    const int32_t chains = host.Expression(kChainNum);
    for (int32_t c = 0; c < chains; ++c) {
      if (host.Condition(kOnSwing, c)) steppedThisFrame.push_back(c);
    }
    if (chains >= 12) return;
    // Enough objects to move the storage of the links and platforms lists.
    for (int i = 0; i < 17; ++i) host.Action(kAddLink, ref(host.AddObject(0, 0, 16)));
    host.Action(kAddPlatform, ref(host.AddObject(0, 0, 16)));
    host.Action(kAddAnchor, ref(host.AddObject(100 + 40 * chains, 50, 32)));
    host.Action(kStartChain, chains);
    host.ActionWithValue(kSetAngle, chains - 1, 45.0f);
    host.Action(kUpdateAll);
  };

  host.RunFrame();
  // Every chain added during the frame's events was started there and was
  // stepped later in the same pass: 0, then 1 added by 0's rule, and so on.
  std::vector<int32_t> expected;
  for (int32_t c = 0; c < 12; ++c) expected.push_back(c);
  EXPECT_EQ(steppedThisFrame, expected);

  steppedThisFrame.clear();
  host.RunFrame();
  EXPECT_EQ(steppedThisFrame, expected);
  EXPECT_EQ(host.extension().links->Count(), 1u + 11u * 17u);
}

}  // namespace
