// Display strings, parameter titles and expression parameter texts, with
// their exact spaces, and what the text routines do with short buffers and
// codes that no entry carries.
#include <gtest/gtest.h>

#include "catalogue_helpers.h"
#include "frame/exports.h"

namespace {

using catalogue_test::GuardedBuffer;
using catalogue_test::HostWithVersion;
using catalogue_test::kCompatibleVersion;

// Runs a text routine on a guarded 128-byte buffer and returns the text.
template <typename Call>
std::string TextOf(Call call) {
  GuardedBuffer<128> buffer;
  call(buffer.data(), buffer.size());
  EXPECT_TRUE(buffer.guardsIntact());
  return buffer.text();
}

std::string DisplayString(void(TVCALL* routine)(EditorHost*, int32_t, char*, int16_t), int32_t code) {
  EditorHost host = HostWithVersion(kCompatibleVersion);
  return TextOf([&](char* b, int16_t n) { routine(&host, code, b, n); });
}

std::string ActionTitle(int32_t code, int16_t param) {
  return TextOf([&](char* b, int16_t n) { GetActionTitle(nullptr, code, param, b, n); });
}

std::string ExpressionTitle(int32_t code) {
  return TextOf([&](char* b, int16_t n) { GetExpressionTitle(nullptr, code, b, n); });
}

TEST(EventTexts, DisplayStringsKeepTheirExactSpacing) {
  EXPECT_EQ(DisplayString(GetConditionString, 0), "Chain %0 is swinging");
  EXPECT_EQ(DisplayString(GetActionString, 1), "Add Link  %0");
  EXPECT_EQ(DisplayString(GetActionString, 2), "Add Platform  %0");
  EXPECT_EQ(DisplayString(GetActionString, 7), "Set Speed at index %0 to %1");
  EXPECT_EQ(DisplayString(GetExpressionString, 16), "LinkY(");
  // Codes are compared by their low 16 bits.
  EXPECT_EQ(DisplayString(GetActionString, 0x10000 + 1), "Add Link  %0");
}

TEST(EventTexts, ConditionAndActionTitlesComeFromTheStringTable) {
  EXPECT_EQ(TextOf([](char* b, int16_t n) { GetConditionTitle(nullptr, 1, 0, b, n); }), "Chain index");
  EXPECT_EQ(ActionTitle(10, 0), "Chain Index");
  EXPECT_EQ(ActionTitle(3, 1), "X Position");
  EXPECT_EQ(ActionTitle(7, 1), "Speed");
}

// "ChainNum(" and "ChainLinks(" have no parameter and so no title word: they
// get their menu text like the others, not the next entry's words.
TEST(EventTexts, ExpressionTitleIsTheMenuText) {
  EXPECT_EQ(ExpressionTitle(2), "Get Anchor X");
  EXPECT_EQ(ExpressionTitle(15), "Get Link X");
  EXPECT_EQ(ExpressionTitle(0), "Get number of chains");
  EXPECT_EQ(ExpressionTitle(1), "Get number of links per chain");
}

TEST(EventTexts, ParameterBeyondTheEntryHasNoTitleOfItsOwn) {
  EXPECT_EQ(ActionTitle(9, 0), "Start All");      // "Start All" has no parameters
  EXPECT_EQ(ActionTitle(3, 2), "Set Anchor X ");  // not the next entry's title
  EXPECT_EQ(ActionTitle(3, -1), "Set Anchor X ");
}

TEST(EventTexts, ExpressionParameterTextIsEmpty) {
  GuardedBuffer<32> buffer;
  GetExpressionParam(nullptr, 15, 1, buffer.data(), buffer.size());
  EXPECT_EQ(buffer.data()[0], '\0');
  EXPECT_EQ(static_cast<unsigned char>(buffer.data()[1]), buffer.kSentinel);  // only the first byte
}

TEST(EventTexts, LongTextIsCutToTheBufferSize) {
  EditorHost host = HostWithVersion(kCompatibleVersion);
  GuardedBuffer<10> display;
  GetActionString(&host, 3, display.data(), display.size());
  EXPECT_EQ(display.text(), "Set Ancho");
  EXPECT_TRUE(display.guardsIntact());

  GuardedBuffer<6> title;
  GetExpressionTitle(nullptr, 13, title.data(), title.size());
  EXPECT_EQ(title.text(), "Get C");
  EXPECT_TRUE(title.guardsIntact());
}

TEST(EventTexts, BufferWithoutRoomOrUnknownCodeIsNotWritten) {
  EditorHost host = HostWithVersion(kCompatibleVersion);
  for (int16_t size : {int16_t{0}, int16_t{-1}, int16_t{-32768}}) {
    GuardedBuffer<32> buffer;
    GetConditionString(&host, 0, buffer.data(), size);
    GetActionTitle(nullptr, 3, 1, buffer.data(), size);
    GetExpressionTitle(nullptr, 2, buffer.data(), size);
    GetExpressionParam(nullptr, 2, 0, buffer.data(), size);
    EXPECT_TRUE(buffer.untouched()) << "size " << size;
  }
  GuardedBuffer<32> buffer;
  GetConditionString(&host, 2, buffer.data(), buffer.size());
  GetActionString(&host, 16, buffer.data(), buffer.size());
  GetExpressionString(&host, -1, buffer.data(), buffer.size());
  GetConditionTitle(nullptr, 2, 0, buffer.data(), buffer.size());
  GetExpressionTitle(nullptr, 17, buffer.data(), buffer.size());
  GetExpressionParam(nullptr, 17, 0, buffer.data(), buffer.size());
  EXPECT_TRUE(buffer.untouched());
}

}  // namespace
