// The entry points the host calls over the object's life, and the records
// it shares with them: sizes and offsets are asserted at compile time in the
// headers, these check what the host sees at run time.
#include <cmath>
#include <cstring>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "chains/run_data.h"
#include "frame/edit_data.h"
#include "frame/exports.h"
#include "frame/run_info.h"
#include "host.h"

namespace {

TEST(Description, AnswersTheInterfaceQueriesAndDescribesTheExtension) {
  const std::pair<int32_t, uint32_t> answers[] = {{0, 0x300u}, {2, 0x100u}, {1, 0u}, {3, 0u}, {-1, 0u}};
  for (const auto& [query, answer] : answers) EXPECT_EQ(GetInfos(query), answer) << query;
  EXPECT_EQ(GetRunObjectDataSize(nullptr, nullptr), sizeof(void*) == 8 ? 232u : 216u);
  RunInfo info;
  std::memset(&info, 0xAB, sizeof info);
  EXPECT_EQ(GetRunObjectInfos(nullptr, &info), 1);
  // Conditions, actions, expressions, edit data size, flags, priority, editor options, version.
  EXPECT_EQ((std::vector<int>{info.conditionCount, info.actionCount, info.expressionCount, info.editDataSize,
                              info.objectFlags, info.priority, info.editorOptions, info.version}),
            (std::vector<int>{2, 16, 17, 100, 0, 100, 0, 1}));
  // The identifier's bytes hold its characters last to first.
  EXPECT_EQ(std::string(reinterpret_cast<const char*>(&info.identifier), 4), "NRVT");
  // Each routine table holds its count of routines and then a null entry.
  EXPECT_TRUE(info.conditionRoutines[1] != nullptr && info.conditionRoutines[2] == nullptr);
  EXPECT_TRUE(info.actionRoutines[15] != nullptr && info.actionRoutines[16] == nullptr);
  EXPECT_TRUE(info.expressionRoutines[16] != nullptr && info.expressionRoutines[17] == nullptr);
}

// Each text goes into its own setting: an unterminated one is read to the end
// of its field only, and a value beyond the float range is infinite.
TEST(CreateRunObject, ConvertsEachSettingTextForTheChainsToCome) {
  const struct {
    const char* texts[4];  // start angle, mass, gravity, link spacing; null: the default
    float values[4];
  } cases[] = {{{nullptr, nullptr, nullptr, nullptr}, {90.0f, 1.0f, 9.81f, 0.0f}},
               {{"1234567890", "9e99", "1e999", "   "}, {1234567890.0f, INFINITY, INFINITY, 0.0f}}};
  for (const auto& c : cases) {
    SCOPED_TRACE(c.values[0]);
    EditData edit{};
    WriteEditDataDefaults(edit);
    char* fields[] = {edit.startAngleText, edit.massText, edit.gravityText, edit.linkSpacingText};
    for (int i = 0; i < 4; ++i) {
      // Ten characters fill a field without a terminator.
      if (c.texts[i] != nullptr) std::strncpy(fields[i], c.texts[i], kSettingTextSize);
    }
    standin::Host host(edit);
    ASSERT_TRUE(host.created());
    const RunData& rd = host.extension();
    EXPECT_EQ((std::vector<float>{rd.startAngle, rd.defaultMass, rd.gravity, rd.defaultLinkSpacing}),
              (std::vector<float>(c.values, c.values + 4)));
    EXPECT_EQ(rd.currentChain, -1);  // no chain has swung yet
    EXPECT_EQ(rd.links->Count() + rd.platforms->Count() + rd.chains->Count(), 0u);
    // A new chain starts from the settings, at rest.
    host.Action(0, reinterpret_cast<intptr_t>(host.AddObject(0, 0, 32)));  // "Add Anchor"
    ASSERT_EQ(rd.chains->Count(), 1u);
    const ChainRecord& chain = rd.chains->At(0);
    EXPECT_EQ((std::vector<float>{chain.angle, chain.mass, chain.linkSpacing, chain.speed, chain.acceleration}),
              (std::vector<float>{c.values[0], c.values[1], c.values[3], 0.0f, 0.0f}));
    EXPECT_EQ(chain.swinging, 0);
  }
}

}  // namespace
