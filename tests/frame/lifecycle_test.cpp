#include <cmath>
#include <cstring>

#include <gtest/gtest.h>

#include "chains/run_data.h"
#include "frame/edit_data.h"
#include "frame/exports.h"
#include "frame/run_info.h"
#include "host.h"

namespace {

EditData Defaults() {
  EditData edit{};
  WriteEditDataDefaults(edit);
  return edit;
}

void SetField(char (&field)[kSettingTextSize], const char* text) {
  std::memset(field, 0, sizeof field);
  std::memcpy(field, text, std::strlen(text));
}

TEST(GetInfos, AnswersTheInterfaceQueries) {
  EXPECT_EQ(GetInfos(0), 0x300u);
  EXPECT_EQ(GetInfos(2), 0x100u);
  EXPECT_EQ(GetInfos(1), 0u);
  EXPECT_EQ(GetInfos(3), 0u);
  EXPECT_EQ(GetInfos(-1), 0u);
}

TEST(RunInfoRecord, DescribesTheExtension) {
  RunInfo info;
  std::memset(&info, 0xAB, sizeof info);
  EXPECT_EQ(GetRunObjectInfos(nullptr, &info), 1);
  EXPECT_EQ(info.conditionCount, 2);
  EXPECT_EQ(info.actionCount, 16);
  EXPECT_EQ(info.expressionCount, 17);
  EXPECT_EQ(info.editDataSize, 100);
  EXPECT_EQ(info.objectFlags, 0);
  EXPECT_EQ(info.priority, 100);
  EXPECT_EQ(info.editorOptions, 0);
  EXPECT_EQ(info.identifier, 0x5456524Eu);
  EXPECT_EQ(info.version, 1);
  EXPECT_EQ(info.conditionRoutines[info.conditionCount], nullptr);
  EXPECT_EQ(info.actionRoutines[info.actionCount], nullptr);
  EXPECT_EQ(info.expressionRoutines[info.expressionCount], nullptr);
}

TEST(CreateRunObject, ConvertsTheDefaultSettings) {
  standin::Host host(Defaults());
  ASSERT_TRUE(host.created());
  RunData& rd = host.extension();
  EXPECT_EQ(rd.startAngle, 90.0f);
  EXPECT_EQ(rd.defaultMass, 1.0f);
  EXPECT_EQ(rd.gravity, 9.81f);
  EXPECT_EQ(rd.defaultLinkSpacing, 0.0f);
  ASSERT_NE(rd.links, nullptr);
  ASSERT_NE(rd.platforms, nullptr);
  ASSERT_NE(rd.chains, nullptr);
  EXPECT_EQ(rd.links->Count(), 0u);
  EXPECT_EQ(rd.platforms->Count(), 0u);
  EXPECT_EQ(rd.chains->Count(), 0u);
}

TEST(CreateRunObject, ReadsEachTextIntoItsOwnSetting) {
  EditData edit = Defaults();
  SetField(edit.startAngleText, " 45abc");
  SetField(edit.massText, "1e2");
  SetField(edit.gravityText, "9,81");
  SetField(edit.linkSpacingText, "-2.5");
  standin::Host host(edit);
  RunData& rd = host.extension();
  EXPECT_EQ(rd.startAngle, 45.0f);
  EXPECT_EQ(rd.defaultMass, 100.0f);
  EXPECT_EQ(rd.gravity, 9.0f);
  EXPECT_EQ(rd.defaultLinkSpacing, -2.5f);
}

TEST(CreateRunObject, ReadsAnUnterminatedTextNoFurtherThanItsField) {
  EditData edit = Defaults();
  std::memcpy(edit.startAngleText, "1234567890", 10);  // no terminator
  SetField(edit.massText, "5");
  standin::Host host(edit);
  EXPECT_EQ(host.extension().startAngle, 1234567890.0f);
  EXPECT_EQ(host.extension().defaultMass, 5.0f);
}

TEST(CreateRunObject, AnOverflowingGravityIsInfinite) {
  EditData edit = Defaults();
  SetField(edit.gravityText, "1e999");
  SetField(edit.massText, "9e99");  // beyond float: rounds to infinity
  standin::Host host(edit);
  EXPECT_EQ(host.extension().gravity, INFINITY);
  EXPECT_EQ(host.extension().defaultMass, INFINITY);
}

TEST(CreateRunObject, NoChainHasSwungYet) {
  standin::Host host(Defaults());
  EXPECT_EQ(host.extension().currentChain, -1);
}

TEST(DestroyRunObject, ReleasesEmptyListsAndToleratesMissingOnes) {
  EditData edit = Defaults();
  alignas(8) unsigned char storage[sizeof(RunData)] = {};
  auto* rd = reinterpret_cast<RunData*>(storage);
  ASSERT_EQ(CreateRunObject(rd, &edit, nullptr), 0);
  EXPECT_EQ(DestroyRunObject(rd, 0), 0);
  EXPECT_EQ(rd->links, nullptr);
  EXPECT_EQ(rd->platforms, nullptr);
  EXPECT_EQ(rd->chains, nullptr);
  // A second destruction finds no list and does nothing.
  EXPECT_EQ(DestroyRunObject(rd, 0), 0);
  // A frame on an object without lists changes nothing.
  EXPECT_EQ(HandleRunObject(rd), 0);
}

TEST(RunTimeRoutines, DoNothingButAnswerZero) {
  standin::Host host(Defaults());
  RunData* rd = &host.extension();
  EXPECT_EQ(DisplayRunObject(rd), 0);
  EXPECT_EQ(PauseRunObject(rd), 0);
  EXPECT_EQ(ContinueRunObject(rd), 0);
  EXPECT_EQ(HandleRunObject(rd), 0);
  EXPECT_EQ(Initialize(nullptr, 0), 0);
  EXPECT_EQ(Free(nullptr), 0);
  EXPECT_EQ(LoadObject(nullptr, nullptr, nullptr, 0), 0);
  EXPECT_EQ(UpdateEditStructure(nullptr, nullptr), 0);
  EXPECT_EQ(UsesFile(nullptr, nullptr), 0);
}

}  // namespace
