// The setup dialog as the author sees and works it, opened by CreateObject
// and SelectPopup, and the dialog item calls it relies on: how a typed text
// reads as a number, how a text is cut to a short buffer, what a check box
// holds, where the focus and the default button are, and what
// DialogBoxParamA answers when it cannot show a dialog. The same tests run
// against the Win32 stand-in and, in the Windows test build, against real
// USER32.
#include <gtest/gtest.h>

#include <cstdint>
#include <cstring>
#include <string>
#include <tuple>
#include <vector>

#include "catalogue/catalogue_helpers.h"
#include "dialog_author.h"
#include "frame/edit_data.h"
#include "frame/exports.h"
#include "frame/module.h"
#include "resources/resource_ids.h"

namespace {

using catalogue_test::GuardedBuffer;
using editor_test::ReadText;
using editor_test::WithAuthor;

// A record the host has just made: its own header and the fill bytes hold
// a pattern that nothing of ours may change.
EditData FreshRecord() {
  EditData edit;
  std::memset(&edit, 0xA5, sizeof edit);
  return edit;
}

void SetText(char (&field)[kSettingTextSize], const char* text) {
  std::memset(field, 0, sizeof field);
  std::memcpy(field, text, std::strlen(text));
}

// A fresh record with every default of a new object.
EditData Defaults() {
  EditData edit = FreshRecord();
  edit.reserved20 = edit.reserved22 = 0;
  edit.objectWidth = edit.objectHeight = 32;
  SetText(edit.startAngleText, "90");
  SetText(edit.massText, "1");
  SetText(edit.gravityText, "9.81");
  SetText(edit.linkSpacingText, "0");
  edit.anchorWidth = edit.anchorHeight = 32;
  edit.platformWidth = 64;
  edit.platformHeight = 32;
  edit.linkWidth = edit.linkHeight = 32;
  edit.linkCount = 10;
  edit.viewTemplate = 0;
  return edit;
}

bool SameBytes(const EditData& a, const EditData& b) { return std::memcmp(&a, &b, sizeof a) == 0; }

// Every control that shows a setting, with what it shows: "1001=90 ... box=0".
std::string Shown(HWND dialog) {
  std::string shown;
  for (int id = IDC_START_ANGLE; id <= IDC_LINK_COUNT; ++id) {
    shown += std::to_string(id) + "=" + ReadText(dialog, id) + " ";
  }
  return shown + "box=" + std::to_string(IsDlgButtonChecked(dialog, IDC_VIEW_TEMPLATE));
}
const std::string kDefaultsShown =
    "1001=90 1002=1 1003=0 1004=9.81 1005=64 1006=32 1007=32 1008=32 1009=32 1010=32 1011=10 box=0";

// A button clicked, or a key pressed in the focused control.
struct Press {
  bool key;
  int code;
};
constexpr Press kOk{false, IDOK}, kEnter{true, VK_RETURN}, kCancel{false, IDCANCEL}, kEscape{true, VK_ESCAPE},
    kHelp{false, IDC_SETUP_HELP};

// The author reads what is shown, then presses each of `presses` in turn;
// every press but the last leaves the dialog open.
editor_test::Author ReadThenPress(std::string& shown, std::vector<Press> presses) {
  return [&shown, presses](HWND dialog) {
    shown = Shown(dialog);
    for (std::size_t i = 0; i < presses.size(); ++i) {
      const Press& p = presses[i];
      if (!p.key && p.code == IDC_SETUP_HELP) {
        // The string table's help, in a box that the dialog owns and that
        // keeps it disabled until OK is pressed.
        char caption[64] = "", text[2048] = "", help[2048] = "";
        LoadStringA(TavrinModule(), IDS_SETUP_HELP_TEXT, help, sizeof help);
        editor_test::ClickIntoMessageBox(dialog, IDC_SETUP_HELP, [&](HWND box) {
          GetWindowTextA(box, caption, sizeof caption);
          GetDlgItemTextA(box, 0xFFFF, text, sizeof text);  // the static control of the text
          EXPECT_TRUE(GetWindow(box, GW_OWNER) == dialog && !IsWindowEnabled(dialog));
          editor_test::Click(box, IDOK);
        });
        EXPECT_EQ(caption + std::string(" | ") + text, "Tavrin object: help | " + std::string(help));
        EXPECT_TRUE(IsWindowEnabled(dialog));
      } else {
        p.key ? editor_test::PressKey(dialog, static_cast<WPARAM>(p.code)) : editor_test::Click(dialog, p.code);
      }
      if (i + 1 < presses.size()) {
        EXPECT_TRUE(IsWindowVisible(dialog)) << "press " << i;
      }
    }
  };
}

// Opened for a new object (command -1) or from the popup menu: every ending
// keeps the record as shown, and only the setup command opens the dialog.
TEST(SetupDialog, ShowsTheSettingsAndKeepsThemWhateverEndsIt) {
  const struct {
    int32_t command;
    std::vector<Press> presses;
    int shown;
    int32_t result;
  } cases[] = {{-1, {kCancel}, 1, -1},  {-1, {kEscape}, 1, -1},
               {-1, {kOk}, 1, 0},       {-1, {kEnter}, 1, 0},
               {-1, {kHelp, kHelp, kEnter}, 1, 0},
               {2020, {kOk}, 1, 4},     {2020, {kCancel}, 1, 0},
               {2021, {kOk}, 0, 0},     {0, {kOk}, 0, 0}};
  for (const auto& c : cases) {
    SCOPED_TRACE(testing::Message() << "command " << c.command << ", " << c.presses.size() << " presses");
    EditorHost host = catalogue_test::HostWithVersion();
    EditData edit = c.command < 0 ? FreshRecord() : Defaults();
    std::string shown;
    int32_t result = 99;
    EXPECT_EQ(WithAuthor(ReadThenPress(shown, c.presses),
                         [&] {
                           result = c.command < 0 ? CreateObject(&host, nullptr, &edit)
                                                  : SelectPopup(&host, c.command, nullptr, nullptr, &edit, nullptr,
                                                                nullptr);
                         }),
              c.shown);
    if (c.shown) {
      EXPECT_EQ(shown, kDefaultsShown);
    }
    EXPECT_EQ(result, c.result);
    EXPECT_TRUE(SameBytes(edit, Defaults()));
  }
}

// A value of its own in every field, so that two controls swapped show.
TEST(SetupDialog, OkStoresWhatWasTypedAndReopeningShowsIt) {
  EditorHost host = catalogue_test::HostWithVersion();
  EditData edit = FreshRecord();
  const auto typeAndOk = [](HWND dialog) {
    const std::pair<int, const char*> typed[] = {
        {IDC_MASS, "123456789012"}, {IDC_START_ANGLE, "45"}, {IDC_LINK_SPACING, "2.5"}, {IDC_GRAVITY, "9,81"},
        {IDC_ANCHOR_WIDTH, "abc"},  {IDC_ANCHOR_HEIGHT, "41"}, {IDC_LINK_WIDTH, "7"},    {IDC_LINK_HEIGHT, "9"},
        {IDC_PLATFORM_WIDTH, "80"}, {IDC_PLATFORM_HEIGHT, "12"}, {IDC_LINK_COUNT, "-5"}};
    for (const auto& [id, text] : typed) editor_test::Type(dialog, id, text);
    editor_test::Click(dialog, IDC_VIEW_TEMPLATE);
    editor_test::Click(dialog, IDOK);
  };
  int32_t result = 99;
  WithAuthor(typeAndOk, [&] { result = CreateObject(&host, nullptr, &edit); });
  EXPECT_EQ(result, 0);

  EditData expected = Defaults();
  SetText(expected.massText, "123456789");  // twelve digits cut to nine
  SetText(expected.startAngleText, "45");
  SetText(expected.linkSpacingText, "2.5");
  SetText(expected.gravityText, "9,81");  // stored as typed; the run-time object reads 9
  // Letters give 0.
  std::tie(expected.anchorWidth, expected.anchorHeight, expected.linkWidth, expected.linkHeight, expected.platformWidth,
           expected.platformHeight, expected.linkCount) = std::tuple{0, 41, 7, 9, 80, 12, -5};
  expected.viewTemplate = 1;
  EXPECT_TRUE(SameBytes(edit, expected));

  // A stored text that fills its ten bytes is shown as those ten, no more.
  std::memset(edit.linkSpacingText, 'y', kSettingTextSize);
  const EditData before = edit;
  std::string shown;
  EXPECT_EQ(WithAuthor(ReadThenPress(shown, {kCancel}),
                       [&] { result = SelectPopup(&host, 2020, nullptr, nullptr, &edit, nullptr, nullptr); }),
            1);
  EXPECT_EQ(shown, "1001=45 1002=123456789 1003=yyyyyyyyyy 1004=9,81 1005=80 1006=12 1007=7 1008=9 1009=0 "
                   "1010=41 1011=-5 box=1");
  EXPECT_EQ(result, 0);
  EXPECT_TRUE(SameBytes(edit, before));
}

TEST(SetupDialog, IncompatibleHostGetsNoDialogAndNothingWritten) {
  // 0: no version service at all; then build 217, version 1.FF, the 0x8000 flag.
  const uint32_t versions[] = {0, 0x02000000u | 217u, 0x01FF0000u | 218u, 0x02000000u | 0x8000u | 218u};
  for (uint32_t version : versions) {
    EditorHost host = version == 0 ? EditorHost{} : catalogue_test::HostWithVersion(version);
    EditData edit = FreshRecord();
    int32_t created = 99, selected = 99;
    const int shown = WithAuthor([](HWND dialog) { editor_test::Click(dialog, IDOK); }, [&] {
      created = CreateObject(&host, nullptr, &edit);
      selected = SelectPopup(&host, 2020, nullptr, nullptr, &edit, nullptr, nullptr);
    });
    EXPECT_EQ(shown, 0) << std::hex << version;
    EXPECT_EQ(created, -1) << std::hex << version;
    EXPECT_EQ(selected, 0) << std::hex << version;
    EXPECT_TRUE(SameBytes(edit, FreshRecord())) << std::hex << version;
  }
}

void InOpenDialog(const editor_test::Author& author) {
  EditorHost host = catalogue_test::HostWithVersion();
  EditData edit{};
  editor_test::WithAuthor(
      [&](HWND dialog) {
        author(dialog);
        editor_test::Click(dialog, IDCANCEL);
      },
      [&] { CreateObject(&host, nullptr, &edit); });
}

TEST(DialogCalls, TypedTextReadsAsASignedNumberAsUser32ReadsIt) {
  const struct {
    const char* text;
    int value;
    BOOL translated;
  } cases[] = {{"  5", 5, TRUE},          {"\t5", 5, TRUE},         {"+5", 5, TRUE},
               {"12abc", 12, TRUE},       {"5 6", 5, TRUE},         {"-0", 0, TRUE},
               {"0x10", 0, TRUE},         {"-2147483648", INT32_MIN, TRUE},
               {"18446744073709551621", 0, FALSE},  // 2^64 + 5: no wrap-around
               {"2147483648", 0, FALSE},  {"-2147483649", 0, FALSE}, {"99999999999", 0, FALSE},
               {"", 0, FALSE},            {"abc", 0, FALSE},        {"- 5", 0, FALSE},
               {"+", 0, FALSE},
               // Only the first 29 characters are read: here all zeros.
               {"000000000000000000000000000000007", 0, TRUE}};
  InOpenDialog([&](HWND dialog) {
    for (const auto& c : cases) {
      editor_test::Type(dialog, IDC_LINK_COUNT, c.text);
      BOOL translated = 7;
      EXPECT_EQ(static_cast<int>(GetDlgItemInt(dialog, IDC_LINK_COUNT, &translated, TRUE)), c.value) << c.text;
      EXPECT_EQ(translated, c.translated) << c.text;
    }
  });
}

TEST(DialogCalls, ItemsAnswerAsUser32Does) {
  InOpenDialog([](HWND dialog) {
    // The focus starts on the first tab stop; OK is the default button.
    EXPECT_EQ(GetFocus(), GetDlgItem(dialog, IDCANCEL));
    EXPECT_EQ(SendMessageA(dialog, DM_GETDEFID, 0, 0), MAKELONG(IDOK, DC_HASDEFID));

    // A short buffer gets size - 1 characters and a terminator.
    editor_test::Type(dialog, IDC_MASS, "123456789012");
    const struct {
      int id, size;
      UINT length;
      const char* text;
    } reads[] = {{IDC_MASS, 5, 4, "1234"}, {IDC_MASS, 1, 0, ""}, {999, 5, 0, ""}};
    for (const auto& r : reads) {
      GuardedBuffer buffer(static_cast<std::size_t>(r.size));
      EXPECT_EQ(GetDlgItemTextA(dialog, r.id, buffer.data(), r.size), r.length) << r.id << " " << r.size;
      EXPECT_EQ(buffer.text(), r.text);
      EXPECT_TRUE(buffer.guardsIntact());
    }
    GuardedBuffer untouched(4);
    EXPECT_EQ(GetDlgItemTextA(dialog, IDC_MASS, untouched.data(), 0), 0u);
    EXPECT_EQ(untouched.text(), "<untouched>");

    // A two-state box holds at most "checked"; anything else has no state.
    EXPECT_TRUE(CheckDlgButton(dialog, IDC_VIEW_TEMPLATE, 2));
    EXPECT_EQ(IsDlgButtonChecked(dialog, IDC_VIEW_TEMPLATE), UINT{BST_CHECKED});
    EXPECT_TRUE(CheckDlgButton(dialog, IDC_MASS, BST_CHECKED));
    EXPECT_EQ(IsDlgButtonChecked(dialog, IDC_MASS), UINT{BST_UNCHECKED});
    EXPECT_EQ(IsDlgButtonChecked(dialog, 999), UINT{BST_UNCHECKED});
  });
}

// The procedure of a dialog that must never show.
INT_PTR CALLBACK NeverShown(HWND, UINT, WPARAM, LPARAM) { return 0; }

TEST(DialogCalls, DialogThatCannotBeShownAnswersAsUser32Does) {
  EditData edit{};
  const int shown = editor_test::WithAuthor([](HWND dialog) { editor_test::Click(dialog, IDCANCEL); }, [&] {
    EXPECT_EQ(DialogBoxParamA(TavrinModule(), MAKEINTRESOURCEA(IDD_SETUP + 1), nullptr, NeverShown, 0), -1);
    // An owner that is not a window: no dialog, and 0.
    const auto stale = reinterpret_cast<HWND>(static_cast<uintptr_t>(0x7FFF0));
    EXPECT_EQ(DialogBoxParamA(TavrinModule(), MAKEINTRESOURCEA(IDD_SETUP), stale, NeverShown, 0), 0);
    // The routines do not take that 0 for OK: nothing shown, nothing stored.
    EditorHost host = catalogue_test::HostWithVersion();
    host.slot[kEditorSlotOwnerWindow] = stale;
    EXPECT_EQ(CreateObject(&host, nullptr, &edit), -1);
    EXPECT_EQ(SelectPopup(&host, 2020, nullptr, nullptr, &edit, nullptr, nullptr), 0);
  });
  EXPECT_EQ(shown, 0);
}

}  // namespace
