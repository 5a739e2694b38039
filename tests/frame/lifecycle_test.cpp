// The entry points the host calls over the object's life, and the records
// it shares with them: sizes and offsets are asserted at compile time in the
// headers, these check what the host sees at run time, and how a stored
// setting text reads as a number.
#include <algorithm>
#include <cmath>
#include <cstring>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "chains/run_data.h"
#include "frame/edit_data.h"
#include "frame/exports.h"
#include "frame/run_info.h"
#include "frame/setting_text.h"
#include "host.h"

namespace {

// The tables themselves, null-terminated, are checked at compile time.
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
  EXPECT_TRUE(info.conditionRoutines == kConditionRoutines && info.actionRoutines == kActionRoutines &&
              info.expressionRoutines == kExpressionRoutines);
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
    ASSERT_TRUE(AddChain(host.extension(), host.AddObject(0, 0, 32)));
    const ChainRecord& chain = rd.chains->At(0);
    EXPECT_EQ((std::vector<float>{chain.angle, chain.mass, chain.linkSpacing, chain.speed, chain.acceleration}),
              (std::vector<float>{c.values[0], c.values[1], c.values[3], 0.0f, 0.0f}));
    EXPECT_EQ(chain.swinging, 0);
  }
}

TEST(SettingText, ReadsTheLongestDecimalPrefixOfItsFieldAndNothingElse) {
  const struct {
    const char* text;
    double value;
  } cases[] = {
      // The setting_text fuzzer holds plain decimal texts to the C library;
      // here, what it cannot: blanks, letters and commas, and each build's
      // reading of the default and of the ends of the double range.
      {"9.81", 9.81}, {" 45abc", 45.0}, {"\t\r-2.5x", -2.5}, {"7E-x", 7.0}, {"abc", 0.0}, {"9,81", 9.0},
      {"0x10", 0.0}, {"inf", 0.0}, {"nan", 0.0}, {"-infinity", 0.0}, {"1e999", INFINITY}, {"1e-999", 0.0},
      // Exactly halfway (to even, down and up), just above halfway, around the
      // smallest double and at the largest.
      {"1e23", 0x1.52d02c7e14af6p+76}, {"7e22", 0x1.da56a4b0835cp+75}, {"5109e-5", 0x1.a2877ee4e26d5p-5},
      {"2.5e-324", 0x1p-1074}, {"2.47e-324", 0.0}, {"2.225e-308", 0x0.fffdd31a00c6dp-1022},
      {"179769e303", 0x1.ffffc57ca82aep+1023}, {"17977e304", INFINITY},
      // Ten bytes without a terminator, then what would be the next field.
      {"123456789077", 1234567890.0},
  };
  for (const auto& c : cases) {
    char field[kSettingTextSize] = {};
    std::memcpy(field, c.text, std::min(std::strlen(c.text), kSettingTextSize));
    EXPECT_EQ(ParseDecimalPrefix(field), c.value) << '"' << c.text << '"';
  }
}

}  // namespace
