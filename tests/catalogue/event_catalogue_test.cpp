// The event catalogue as the host's event editor reads it: the words behind
// the addresses that the info routines give, the texts of the entries
// (display strings, parameter titles and expression parameter texts) with
// their exact spaces, and the event menus read back through the
// Win32 menu calls; and what a host that fails the compatibility test gets.
#include <gtest/gtest.h>

#include <cstring>
#include <utility>
#include <vector>

#include "catalogue_helpers.h"
#include "frame/exports.h"

namespace {

using catalogue_test::HostWithVersion;
using catalogue_test::GuardedBuffer;

// The words of an entry from its code word on: code, flags, count, types, titles.
std::vector<uint16_t> EntryWords(const void* infos) {
  const auto* bytes = static_cast<const unsigned char*>(infos);
  const auto word = [&](int i) { return static_cast<uint16_t>(bytes[2 * i] | (bytes[2 * i + 1] << 8)); };
  std::vector<uint16_t> words;
  for (int i = 0; i < 3 + 2 * word(2); ++i) words.push_back(word(i));
  return words;
}

// The host reads an entry from its code word on; the "Chain %0 is swinging"
// entry is checked byte for byte from its menu id.
TEST(EventTables, InfosPointAtTheCodeWordOfTheEntry) {
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
}

enum class Routine { ConditionString, ActionString, ExpressionString, ConditionTitle, ActionTitle, ExpressionTitle,
                     ExpressionParam };

// What `routine` writes for `code` and `param` into a buffer of `size` bytes.
std::string TextOf(Routine routine, int32_t code, int16_t param, int16_t size = 128,
                   EditorHost host = HostWithVersion()) {
  GuardedBuffer buffer(size);
  char* b = buffer.data();
  switch (routine) {
    case Routine::ConditionString: GetConditionString(&host, code, b, size); break;
    case Routine::ActionString: GetActionString(&host, code, b, size); break;
    case Routine::ExpressionString: GetExpressionString(&host, code, b, size); break;
    case Routine::ConditionTitle: GetConditionTitle(nullptr, code, param, b, size); break;
    case Routine::ActionTitle: GetActionTitle(nullptr, code, param, b, size); break;
    case Routine::ExpressionTitle: GetExpressionTitle(nullptr, code, b, size); break;
    case Routine::ExpressionParam: GetExpressionParam(nullptr, code, param, b, size); break;
  }
  return buffer.text();
}

// A parameter without a title of its own, such as those of "ChainNum(" and
// "ChainLinks(" that have none, gets the menu text of its entry rather than
// the next entry's words. A text is cut to the buffer; an expression's
// parameter text is one empty byte. A code that no entry carries gets nothing.
TEST(EventTexts, KeepTheirExactSpacingAreCutToTheBufferAndTitlesFallBackToTheMenuText) {
  using R = Routine;
  const struct {
    Routine routine;
    int32_t code;
    int16_t param;
    const char* text;
    int16_t size = 128;
  } cases[] = {{R::ConditionString, 0, 0, "Chain %0 is swinging"}, {R::ActionString, 1, 0, "Add Link  %0"},
               {R::ActionString, 2, 0, "Add Platform  %0"}, {R::ActionString, 7, 0, "Set Speed at index %0 to %1"},
               {R::ExpressionString, 16, 0, "LinkY("}, {R::ActionString, 0x10000 + 1, 0, "Add Link  %0"},
               {R::ConditionTitle, 1, 0, "Chain index"}, {R::ActionTitle, 10, 0, "Chain Index"},
               {R::ActionTitle, 3, 1, "X Position"}, {R::ActionTitle, 7, 1, "Speed"},
               {R::ActionTitle, 9, 0, "Start All"}, {R::ActionTitle, 3, 2, "Set Anchor X "},
               {R::ActionTitle, 3, -1, "Set Anchor X "}, {R::ExpressionTitle, 2, 0, "Get Anchor X"},
               {R::ExpressionTitle, 15, 0, "Get Link X"}, {R::ExpressionTitle, 0, 0, "Get number of chains"},
               {R::ExpressionTitle, 1, 0, "Get number of links per chain"},
               {R::ActionString, 3, 0, "Set Ancho", 10}, {R::ExpressionTitle, 13, 0, "Get C", 6},
               {R::ExpressionParam, 15, 1, "", 32},
               {R::ConditionString, 2, 0, "<untouched>"}, {R::ActionTitle, 16, 0, "<untouched>"},
               {R::ExpressionTitle, -1, 0, "<untouched>"}, {R::ExpressionParam, 17, 0, "<untouched>"}};
  for (const auto& c : cases) EXPECT_EQ(TextOf(c.routine, c.code, c.param, c.size), c.text) << c.code;
}

// The action menu has no "Set Speed"; the condition menu keeps its spelling.
TEST(EventMenus, ListItemsThenSubmenusWithTheirIdsInOrder) {
  const std::pair<HMENU(TVCALL*)(EditorHost*, void*, void*), const char*> menus[] = {
      {GetActionMenu,
       "Add Anchor=25000|Add Link=25010|Add Platform=25020|Anchor{Set Anchor X =25030|Set Anchor Y=25040}|"
       "Chain{Set Mass=25050|Set Acceleration=25150|Set Angle=25060|Set Link Spacing=25080}|"
       "Swing{Start All=25090|Start Chain=25100|Stop All=25110|Stop Chain=25120|Update All=25130|Update Chain=25140}"},
      {GetConditionMenu, "Is chain swingging?=26000|On Swing=26010"},
      {GetExpressionMenu,
       "Get number of chains=27000|Get number of links per chain=27010|"
       "Anchor{Get Anchor X=27020|Get Anchor Y=27030}|"
       "Chain{Get Platform Mass=27040|Get Chain Angle=27050|Get Chain Acceleration=27130|Get Chain Speed=27060|"
       "Get Chain Index=27100|Get DeltaX=27110|Get DeltaY=27120}|"
       "Link{Get Link Index=27140|Get Link X=27150|Get Link Y=27160|Get Link Spacing=27070}|"
       "Platform{Get Platform X=27080|Get Platform Y=27090}"}};
  for (const auto& [routine, dump] : menus) {
    EditorHost host = HostWithVersion();
    const HMENU handle = routine(&host, nullptr, nullptr);
    ASSERT_NE(handle, nullptr);
    EXPECT_EQ(catalogue_test::DumpMenu(handle), dump);
    EXPECT_TRUE(DestroyMenu(handle));
  }
}

// No menus and no display strings: the routines return null and leave the
// buffers as they were.
TEST(EventMenus, IncompatibleHostGetsNoMenusAndNoDisplayStrings) {
  const std::pair<const char*, uint32_t> hosts[] = {
      {"no version service", 0}, {"build 217", 0x02000000u | 217u},
      {"build 100 with bit 0x1000", 0x02000000u | 0x1000u | 100u}, {"version 0x0100", 0x01000000u | 300u},
      {"flag 0x8000 set", 0x02000000u | 0x8000u | 300u}};
  for (const auto& [why, version] : hosts) {
    EditorHost host = version != 0 ? HostWithVersion(version) : EditorHost{};
    for (auto menu : {GetConditionMenu, GetActionMenu, GetExpressionMenu}) {
      EXPECT_EQ(menu(&host, nullptr, nullptr), nullptr) << why;
    }
    for (Routine r : {Routine::ConditionString, Routine::ActionString, Routine::ExpressionString}) {
      EXPECT_EQ(TextOf(r, 0, 0, 64, host), "<untouched>") << why;
    }
  }
}

}  // namespace
