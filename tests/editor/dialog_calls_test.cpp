// The dialog item calls the setup dialog relies on, exercised in the open
// dialog: how a typed text reads as a number, how a text is cut to a short
// buffer, what a check box holds, where the focus and the default button
// are, and what DialogBoxParamA answers when it cannot show a dialog.
#include <gtest/gtest.h>

#include <cstdint>

#include "catalogue/catalogue_helpers.h"
#include "dialog_author.h"
#include "editor/setup_dialog.h"
#include "frame/edit_data.h"
#include "frame/exports.h"
#include "frame/module.h"
#include "resources/resource_ids.h"

namespace {

using catalogue_test::GuardedBuffer;

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

TEST(DialogCalls, DialogThatCannotBeShownAnswersAsUser32Does) {
  EditData edit{};
  SetupDialogContext context{&edit, nullptr};
  const auto param = reinterpret_cast<LPARAM>(&context);
  const int shown = editor_test::WithAuthor([](HWND dialog) { editor_test::Click(dialog, IDCANCEL); }, [&] {
    EXPECT_EQ(DialogBoxParamA(TavrinModule(), MAKEINTRESOURCEA(IDD_SETUP + 1), nullptr, SetupDialogProc, param), -1);
    // An owner that is not a window: no dialog, and 0.
    const auto stale = reinterpret_cast<HWND>(static_cast<uintptr_t>(0x7FFF0));
    EXPECT_EQ(DialogBoxParamA(TavrinModule(), MAKEINTRESOURCEA(IDD_SETUP), stale, SetupDialogProc, param), 0);
    // The routines do not take that 0 for OK: nothing shown, nothing stored.
    EditorHost host = catalogue_test::HostWithVersion();
    host.slot[kEditorSlotOwnerWindow] = stale;
    EXPECT_EQ(CreateObject(&host, nullptr, &edit), -1);
    EXPECT_EQ(SelectPopup(&host, 2020, nullptr, nullptr, &edit, nullptr, nullptr), 0);
  });
  EXPECT_EQ(shown, 0);
}

}  // namespace
