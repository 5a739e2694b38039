// The description table entries as the host reads them: codes from menu
// ids, the words behind the addresses that the info routines give, and the
// texts of the entries (display strings, parameter titles and expression
// parameter texts) with their exact spaces, cut to short buffers, and not
// written at all without room or for codes that no entry carries.
#include <gtest/gtest.h>

#include <cstring>
#include <vector>

#include "catalogue_helpers.h"
#include "frame/exports.h"

namespace {

using catalogue_test::GuardedBuffer;

uint16_t WordAt(const unsigned char* bytes) { return static_cast<uint16_t>(bytes[0] | (bytes[1] << 8)); }

// The words of an entry from its code word on: code, flags, count, types, titles.
std::vector<uint16_t> EntryWords(const void* infos) {
  const auto* bytes = static_cast<const unsigned char*>(infos);
  std::vector<uint16_t> words;
  for (int i = 0; i < 3 + 2 * WordAt(bytes + 4); ++i) words.push_back(WordAt(bytes + 2 * i));
  return words;
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

// The host reads an entry from its code word on; the "Chain %0 is swinging"
// entry is checked byte for byte from its menu id.
TEST(EventTables, InfosPointAtTheCodeWordOfTheEntryOrAreNull) {
  const auto* code = static_cast<const unsigned char*>(GetConditionInfos(nullptr, 0));
  ASSERT_NE(code, nullptr);
  const unsigned char expected[] = {0x90, 0x65, 0x90, 0x65, 0x00, 0x00, 0x20,
                                    0x02, 0x01, 0x00, 0x16, 0x00, 0x91, 0x65};
  EXPECT_EQ(std::memcmp(code - 4, expected, sizeof expected), 0);
  EXPECT_EQ(EntryWords(GetActionInfos(nullptr, 7)), (std::vector<uint16_t>{7, 0, 2, 22, 22, 25071, 25072}));
  EXPECT_EQ(EntryWords(GetActionInfos(nullptr, 13)), (std::vector<uint16_t>{13, 0, 0}));
  EXPECT_EQ(EntryWords(GetExpressionInfos(nullptr, 5)), (std::vector<uint16_t>{5, 2, 1, 1, 0}));
  EXPECT_EQ(EntryWords(GetExpressionInfos(nullptr, 11)), (std::vector<uint16_t>{11, 0, 1, 2, 0}));
  EXPECT_EQ(EntryWords(GetExpressionInfos(nullptr, 16)), (std::vector<uint16_t>{16, 0, 2, 1, 1, 0, 0}));
  EXPECT_EQ(GetConditionInfos(nullptr, 2), nullptr);
  EXPECT_EQ(GetActionInfos(nullptr, 16), nullptr);
  EXPECT_EQ(GetExpressionInfos(nullptr, -1), nullptr);
}

// Runs a text routine on a guarded buffer and returns the text.
template <typename Call>
std::string TextOf(Call call, std::size_t size = 128) {
  GuardedBuffer buffer(size);
  call(buffer.data(), buffer.size());
  EXPECT_TRUE(buffer.guardsIntact());
  return buffer.text();
}

std::string DisplayString(void(TVCALL* routine)(EditorHost*, int32_t, char*, int16_t), int32_t code,
                          std::size_t size = 128) {
  EditorHost host = catalogue_test::CompatibleHost();
  return TextOf([&](char* b, int16_t n) { routine(&host, code, b, n); }, size);
}

std::string ActionTitle(int32_t code, int16_t param) {
  return TextOf([&](char* b, int16_t n) { GetActionTitle(nullptr, code, param, b, n); });
}

std::string ExpressionTitle(int32_t code, std::size_t size = 128) {
  return TextOf([&](char* b, int16_t n) { GetExpressionTitle(nullptr, code, b, n); }, size);
}

// A parameter without a title of its own, such as those of "ChainNum(" and
// "ChainLinks(" that have none, gets the menu text of its entry rather than
// the next entry's words.
TEST(EventTexts, TextsKeepTheirExactSpacingAndTitlesFallBackToTheMenuText) {
  EXPECT_EQ(DisplayString(GetConditionString, 0), "Chain %0 is swinging");
  EXPECT_EQ(DisplayString(GetActionString, 1), "Add Link  %0");
  EXPECT_EQ(DisplayString(GetActionString, 2), "Add Platform  %0");
  EXPECT_EQ(DisplayString(GetActionString, 7), "Set Speed at index %0 to %1");
  EXPECT_EQ(DisplayString(GetExpressionString, 16), "LinkY(");
  EXPECT_EQ(DisplayString(GetActionString, 0x10000 + 1), "Add Link  %0");  // low 16 bits compared
  EXPECT_EQ(TextOf([](char* b, int16_t n) { GetConditionTitle(nullptr, 1, 0, b, n); }), "Chain index");
  EXPECT_EQ(ActionTitle(10, 0), "Chain Index");
  EXPECT_EQ(ActionTitle(3, 1), "X Position");
  EXPECT_EQ(ActionTitle(7, 1), "Speed");
  EXPECT_EQ(ActionTitle(9, 0), "Start All");
  EXPECT_EQ(ActionTitle(3, 2), "Set Anchor X ");
  EXPECT_EQ(ActionTitle(3, -1), "Set Anchor X ");
  EXPECT_EQ(ExpressionTitle(2), "Get Anchor X");
  EXPECT_EQ(ExpressionTitle(15), "Get Link X");
  EXPECT_EQ(ExpressionTitle(0), "Get number of chains");
  EXPECT_EQ(ExpressionTitle(1), "Get number of links per chain");
}

// A text is cut to the buffer; an expression's parameter text is one empty
// byte; a buffer without room, or a code that no entry carries, gets nothing.
TEST(EventTexts, WriteNoMoreThanFitsAndNothingWithoutRoomOrEntry) {
  EXPECT_EQ(DisplayString(GetActionString, 3, 10), "Set Ancho");
  EXPECT_EQ(ExpressionTitle(13, 6), "Get C");
  GuardedBuffer param(32);
  GetExpressionParam(nullptr, 15, 1, param.data(), param.size());
  EXPECT_EQ(param.data()[0], '\0');
  EXPECT_EQ(param.data()[1], param.kSentinel);

  EditorHost host = catalogue_test::CompatibleHost();
  for (int16_t size : {int16_t{0}, int16_t{-1}, int16_t{-32768}}) {
    GuardedBuffer buffer(32);
    GetConditionString(&host, 0, buffer.data(), size);
    GetActionTitle(nullptr, 3, 1, buffer.data(), size);
    GetExpressionTitle(nullptr, 2, buffer.data(), size);
    GetExpressionParam(nullptr, 2, 0, buffer.data(), size);
    EXPECT_TRUE(buffer.untouched()) << "size " << size;
  }
  GuardedBuffer buffer(32);
  GetConditionString(&host, 2, buffer.data(), buffer.size());
  GetActionString(&host, 16, buffer.data(), buffer.size());
  GetExpressionString(&host, -1, buffer.data(), buffer.size());
  GetConditionTitle(nullptr, 2, 0, buffer.data(), buffer.size());
  GetExpressionTitle(nullptr, 17, buffer.data(), buffer.size());
  GetExpressionParam(nullptr, 17, 0, buffer.data(), buffer.size());
  EXPECT_TRUE(buffer.untouched());
}

}  // namespace
