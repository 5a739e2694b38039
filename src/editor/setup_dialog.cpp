#include "editor/setup_dialog.h"

#include <cstring>

#include "frame/edit_data.h"
#include "frame/host_services.h"
#include "frame/module.h"
#include "resources/resource_ids.h"

namespace {

struct TextEdit {
  int id;
  char (EditData::*field)[kSettingTextSize];
};
struct NumberEdit {
  int id;
  int32_t EditData::*field;
};

// In the order the dialog fills and reads them.
constexpr TextEdit kTextEdits[] = {{IDC_START_ANGLE, &EditData::startAngleText},
                                   {IDC_MASS, &EditData::massText},
                                   {IDC_LINK_SPACING, &EditData::linkSpacingText},
                                   {IDC_GRAVITY, &EditData::gravityText}};
constexpr NumberEdit kNumberEdits[] = {{IDC_ANCHOR_WIDTH, &EditData::anchorWidth},
                                       {IDC_ANCHOR_HEIGHT, &EditData::anchorHeight},
                                       {IDC_LINK_WIDTH, &EditData::linkWidth},
                                       {IDC_LINK_HEIGHT, &EditData::linkHeight},
                                       {IDC_PLATFORM_WIDTH, &EditData::platformWidth},
                                       {IDC_PLATFORM_HEIGHT, &EditData::platformHeight},
                                       {IDC_LINK_COUNT, &EditData::linkCount}};

void ShowSettings(HWND dialog, const EditData& edit) {
  for (const TextEdit& text : kTextEdits) {
    // A stored text without a terminator is shown as its ten bytes; nothing
    // behind the field is read.
    char shown[kSettingTextSize + 1] = {};
    std::memcpy(shown, edit.*text.field, kSettingTextSize);
    SetDlgItemTextA(dialog, text.id, shown);
  }
  for (const NumberEdit& number : kNumberEdits) {
    SetDlgItemInt(dialog, number.id, static_cast<UINT>(edit.*number.field), TRUE);
  }
  CheckDlgButton(dialog, IDC_VIEW_TEMPLATE, edit.viewTemplate != 0 ? BST_CHECKED : BST_UNCHECKED);
}

void StoreSettings(HWND dialog, EditData& edit) {
  // At most nine characters and the terminator: longer text is cut.
  for (const TextEdit& text : kTextEdits) {
    GetDlgItemTextA(dialog, text.id, edit.*text.field, static_cast<int>(kSettingTextSize));
  }
  // Text that is not a whole number gives 0, which is what is stored.
  for (const NumberEdit& number : kNumberEdits) {
    edit.*number.field = static_cast<int32_t>(GetDlgItemInt(dialog, number.id, nullptr, TRUE));
  }
  edit.viewTemplate = IsDlgButtonChecked(dialog, IDC_VIEW_TEMPLATE) == BST_CHECKED ? 1 : 0;
}

// A short help in a message box that the dialog owns, so that the dialog
// waits for it; its texts come from the string table. The settings are
// neither read nor stored.
void ShowHelp(HWND dialog) {
  char caption[64] = "";
  char text[1024] = "";
  LoadStringA(TavrinModule(), IDS_SETUP_HELP_CAPTION, caption, sizeof caption);
  LoadStringA(TavrinModule(), IDS_SETUP_HELP_TEXT, text, sizeof text);
  MessageBoxA(dialog, text, caption, MB_OK | MB_ICONINFORMATION);
}

}  // namespace

INT_PTR CALLBACK SetupDialogProc(HWND dialog, UINT message, WPARAM wParam, LPARAM lParam) noexcept {
  if (message == WM_INITDIALOG) {
    SetWindowLongPtrA(dialog, DWLP_USER, lParam);
    if (const auto* context = reinterpret_cast<SetupDialogContext*>(lParam)) ShowSettings(dialog, *context->edit);
    return TRUE;  // the focus goes to the first control with a tab stop
  }
  if (message != WM_COMMAND) return FALSE;
  // A command that comes before WM_INITDIALOG finds no context yet.
  auto* context = reinterpret_cast<SetupDialogContext*>(GetWindowLongPtrA(dialog, DWLP_USER));
  if (context == nullptr) return FALSE;
  switch (LOWORD(wParam)) {
    case IDOK:
      StoreSettings(dialog, *context->edit);
      EndDialog(dialog, 0);
      break;
    case IDCANCEL:  // also what the Escape key sends
      EndDialog(dialog, -1);
      break;
    case IDC_SETUP_HELP:
      if (HIWORD(wParam) == BN_CLICKED) ShowHelp(dialog);
      break;
    default:  // the edits' notifications: the dialog stays as it is
      break;
  }
  return FALSE;
}

INT_PTR RunSetupDialog(EditorHost* host, EditData* edit) noexcept {
  SetupDialogContext context{edit, host};
  const auto owner = static_cast<HWND>(host->slot[kEditorSlotOwnerWindow]);
  // USER32 answers 0, the result of OK, when the owner is not a window: the
  // caller would take a dialog never shown for settings confirmed. That
  // failure is reported as -1, as every other failure to show the dialog is.
  if (owner != nullptr && !IsWindow(owner)) return -1;
  return DialogBoxParamA(TavrinModule(), MAKEINTRESOURCEA(IDD_SETUP), owner, SetupDialogProc,
                         reinterpret_cast<LPARAM>(&context));
}
