// The windows of the stand-in's dialogs, by handle: each modal dialog and
// the controls made from its template. Handles are never reused, so a
// window that has gone is simply not found.
#pragma once

#include <windows.h>

#include <string>
#include <vector>

namespace standin {

constexpr DWORD kTabStop = 0x00010000L;   // WS_TABSTOP
constexpr DWORD kVisible = 0x10000000L;   // WS_VISIBLE
constexpr DWORD kDisabled = 0x08000000L;  // WS_DISABLED

enum class WindowKind { Dialog, PushButton, DefPushButton, CheckBox, AutoCheckBox, GroupBox, Edit, Static };

struct Window {
  WindowKind kind = WindowKind::Dialog;
  HWND parent = nullptr;  // the dialog, for a control; the owner, for a dialog
  int id = 0;
  DWORD style = 0;
  std::string text;
  UINT check = BST_UNCHECKED;  // check boxes

  // Dialogs only.
  DLGPROC proc = nullptr;
  LONG_PTR user = 0;       // DWLP_USER
  LONG_PTR msgResult = 0;  // DWLP_MSGRESULT
  std::vector<HWND> controls;  // in template order
  int defaultId = 0;           // the default push button's id, 0 for none
  bool visible = false;
  bool ended = false;
  INT_PTR result = 0;
};

// A new window; its handle.
HWND NewWindow(Window window);
// The dialog and all its controls.
void DestroyDialog(HWND dialog);
// The live window of a handle, or null.
Window* FindWindowOf(HWND handle);

// The control of `dialog` with `id`, or null.
HWND DialogItem(HWND dialog, int id);

// Which control has the keyboard focus (null for none).
void SetFocusTo(HWND control);

// Runs a dialog that its procedure has initialised until EndDialog, as
// USER32's modal loop does: shown, with the focus on `focus` (unless null)
// and its owner disabled, while the author acts; then the owner is enabled
// again, the focus goes back where it was, and the dialog is destroyed.
// What EndDialog was given.
INT_PTR RunModal(HWND dialog, HWND focus);

}  // namespace standin
