// The description tables as the host reads them: codes from menu ids, and
// the words behind the addresses that the info routines give.
#include <gtest/gtest.h>

#include <cstring>
#include <vector>

#include "catalogue_helpers.h"
#include "frame/exports.h"

namespace {

using InfosRoutine = const void*(TVCALL*)(EditorHost*, int32_t);

uint16_t WordAt(const unsigned char* bytes) { return static_cast<uint16_t>(bytes[0] | (bytes[1] << 8)); }

// The words of an entry from its code word on: code, flags, count, types, titles.
std::vector<uint16_t> EntryWords(const void* infos) {
  const auto* bytes = static_cast<const unsigned char*>(infos);
  std::vector<uint16_t> words;
  for (int i = 0; i < 3 + 2 * WordAt(bytes + 4); ++i) words.push_back(WordAt(bytes + 2 * i));
  return words;
}

// The table's bytes before its 0 word, walked as the host walks it from the
// first entry, whose menu id lies four bytes before its code word.
std::size_t TableBytes(InfosRoutine infos) {
  const auto* table = static_cast<const unsigned char*>(infos(nullptr, 0)) - 4;
  std::size_t at = 0;
  while (WordAt(table + at) != 0) at += 10 + 4 * WordAt(table + at + 8);
  return at;
}

TEST(EventTables, CodeFromMenuFollowsTheTableNotTheMenu) {
  EXPECT_EQ(GetConditionCodeFromMenu(nullptr, 26010), 1);
  EXPECT_EQ(GetConditionCodeFromMenu(nullptr, 27000), -1);
  EXPECT_EQ(GetActionCodeFromMenu(nullptr, 25070), 7);  // no menu item carries it
  EXPECT_EQ(GetActionCodeFromMenu(nullptr, 25150), 15);
  EXPECT_EQ(GetExpressionCodeFromMenu(nullptr, 27130), 13);
  EXPECT_EQ(GetExpressionCodeFromMenu(nullptr, 27001), -1);
  EXPECT_EQ(GetConditionCodeFromMenu(nullptr, 0x10000 + 26010), 1);  // low 16 bits compared
}

TEST(EventTables, SwingingConditionEntryHasItsExactBytes) {
  const auto* code = static_cast<const unsigned char*>(GetConditionInfos(nullptr, 0));
  ASSERT_NE(code, nullptr);
  const unsigned char expected[] = {0x90, 0x65, 0x90, 0x65, 0x00, 0x00, 0x20,
                                    0x02, 0x01, 0x00, 0x16, 0x00, 0x91, 0x65};
  EXPECT_EQ(std::memcmp(code - 4, expected, sizeof expected), 0);
}

TEST(EventTables, InfosPointAtTheCodeWordOfTheEntry) {
  EXPECT_EQ(EntryWords(GetConditionInfos(nullptr, 0)), (std::vector<uint16_t>{0, 0x0220, 1, 22, 26001}));
  EXPECT_EQ(EntryWords(GetActionInfos(nullptr, 7)), (std::vector<uint16_t>{7, 0, 2, 22, 22, 25071, 25072}));
  EXPECT_EQ(EntryWords(GetActionInfos(nullptr, 13)), (std::vector<uint16_t>{13, 0, 0}));
  EXPECT_EQ(EntryWords(GetExpressionInfos(nullptr, 5)), (std::vector<uint16_t>{5, 2, 1, 1, 0}));
  EXPECT_EQ(EntryWords(GetExpressionInfos(nullptr, 11)), (std::vector<uint16_t>{11, 0, 1, 2, 0}));
  EXPECT_EQ(EntryWords(GetExpressionInfos(nullptr, 16)), (std::vector<uint16_t>{16, 0, 2, 1, 1, 0, 0}));
}

TEST(EventTables, TablesHaveTheSizesTheHostWalks) {
  EXPECT_EQ(TableBytes(GetConditionInfos), 28u);
  EXPECT_EQ(TableBytes(GetActionInfos), 240u);
  EXPECT_EQ(TableBytes(GetExpressionInfos), 238u);
}

TEST(EventTables, CodeThatNoEntryCarriesHasNoInfos) {
  EXPECT_EQ(GetConditionInfos(nullptr, 2), nullptr);
  EXPECT_EQ(GetActionInfos(nullptr, 16), nullptr);
  EXPECT_EQ(GetExpressionInfos(nullptr, -1), nullptr);
}

}  // namespace
