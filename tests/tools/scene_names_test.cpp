// A scene names the library's events by the texts the event editor shows.
// The player keeps its own table of them, so that stored scenes keep their
// meaning; this test holds that table to what the library's catalogue says
// (menu texts, display strings, parameter counts, object parameters and
// titles), so a changed text in the resources cannot pass unnoticed. The
// author's guide is held to the catalogue too, so that no event an author
// can pick goes undescribed.
#include <gtest/gtest.h>
#include <windows.h>

#include <cstring>
#include <fstream>
#include <iterator>
#include <map>
#include <regex>
#include <string>

#include "catalogue/catalogue_helpers.h"
#include "event_names.h"
#include "frame/exports.h"

namespace {

using scene_player::ParamKind;

// Menu texts by event code, from every item of a menu and its submenus.
std::map<int, std::string> MenuTexts(HMENU(TVCALL* getMenu)(EditorHost*, void*, void*),
                                     int16_t(TVCALL* codeFromMenu)(EditorHost*, int32_t)) {
  EditorHost host = catalogue_test::HostWithVersion();
  const HMENU menu = getMenu(&host, nullptr, nullptr);
  const std::string dump = catalogue_test::DumpMenu(menu);  // "text=id|popup{text=id|...}|..."
  DestroyMenu(menu);
  std::map<int, std::string> texts;
  const std::regex item(R"(([^|{}=]+)=(\d+))");
  for (std::sregex_iterator it(dump.begin(), dump.end(), item), end; it != end; ++it) {
    texts[codeFromMenu(&host, std::stoi((*it)[2]))] = (*it)[1];
  }
  return texts;
}

// Entry words from the code word on: code, flags, count, types..., titles...
uint16_t EntryWord(const void* entry, int index) {
  uint16_t word = 0;
  std::memcpy(&word, static_cast<const char*>(entry) + 2 * index, sizeof word);
  return word;
}

std::string Text(const char* text) { return text == nullptr ? "<none>" : text; }

// The author's guide describes each event an author can pick, under a
// heading of its menu text, with its display text.
void ExpectInGuide(const std::string& menu, const std::string& display) {
  static const std::string guide = [] {
    std::ifstream file(GUIDE_DOC);
    return std::string{std::istreambuf_iterator<char>(file), {}};
  }();
  EXPECT_NE(guide.find("\n#### " + menu.substr(0, menu.find_last_not_of(' ') + 1) + "\n"), std::string::npos) << menu;
  EXPECT_NE(guide.find("`" + display + "`"), std::string::npos) << display;
}

TEST(SceneNames, TablesAndGuideMatchTheCatalogue) {
  EditorHost host = catalogue_test::HostWithVersion();
  // "menu | display | parameter count" of an entry, as the catalogue and as the player's table say.
  const auto library = [&](std::map<int, std::string>& menus, int code, const void* entry,
                           void(TVCALL * display)(EditorHost*, int32_t, char*, int16_t)) {
    char text[256] = "";
    display(&host, code, text, sizeof text);
    if (menus.count(code)) ExpectInGuide(menus[code], text);
    return Text(menus.count(code) ? menus[code].c_str() : nullptr) + " | " + text + " | " +
           std::to_string(EntryWord(entry, 2));
  };
  const auto player = [](const auto& name) {
    return Text(name.menuText) + " | " + name.displayText + " | " + std::to_string(name.paramCount);
  };
  auto menus = MenuTexts(&GetActionMenu, &GetActionCodeFromMenu);
  for (int code = 0; code < scene_player::kActionNameCount; ++code) {
    const scene_player::ActionName& name = scene_player::kActionNames[code];
    const void* entry = GetActionInfos(&host, code);
    ASSERT_NE(entry, nullptr) << code;
    std::string theirs = library(menus, code, entry, &GetActionString), ours = player(name);
    for (int p = 0; p < EntryWord(entry, 2); ++p) {
      char title[256] = "";
      GetActionTitle(&host, code, static_cast<int16_t>(p), title, sizeof title);
      theirs += std::string(" ") + (EntryWord(entry, 3 + p) == 1 ? "object " : "value ") + title;
    }
    for (int p = 0; p < name.paramCount; ++p) {
      ours += std::string(" ") + (name.kinds[p] == ParamKind::Object ? "object " : "value ") + name.titles[p];
    }
    EXPECT_EQ(ours, theirs) << "action " << code;
  }
  for (const auto& [code, menu] : MenuTexts(&GetConditionMenu, &GetConditionCodeFromMenu)) {
    char display[256] = "";
    GetConditionString(&host, code, display, sizeof display);
    ExpectInGuide(menu, display);
  }
  menus = MenuTexts(&GetExpressionMenu, &GetExpressionCodeFromMenu);
  for (int code = 0; code < scene_player::kExpressionNameCount; ++code) {
    const void* entry = GetExpressionInfos(&host, code);
    ASSERT_NE(entry, nullptr) << code;
    EXPECT_EQ(player(scene_player::kExpressionNames[code]), library(menus, code, entry, &GetExpressionString))
        << "expression " << code;
  }
}

}  // namespace
