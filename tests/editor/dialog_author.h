// The author at the setup dialog, for tests that run both against the
// Win32 stand-in and under Wine against real USER32. The author acts once
// the dialog is up, through the Win32 calls alone: it reads and types into
// controls, clicks buttons and presses keys as the dialog's message loop
// would see them.
#pragma once

#include <windows.h>

#include <gtest/gtest.h>

#include <functional>
#include <string>

#if !defined(_WIN32)
#include "standin_win32.h"
#endif

namespace editor_test {

using Author = std::function<void(HWND dialog)>;

// What a dialog that the author leaves open is ended with, so that a
// failing test does not wait forever.
constexpr INT_PTR kLeftOpen = 12345;

inline std::string ReadText(HWND dialog, int id) {
  char text[2048] = "";
  GetDlgItemTextA(dialog, id, text, sizeof text);
  return text;
}
inline void Type(HWND dialog, int id, const char* text) { SetDlgItemTextA(dialog, id, text); }
inline void Click(HWND dialog, int id) { SendDlgItemMessageA(dialog, id, BM_CLICK, 0, 0); }
// A key reaches the control with the focus; the dialog's loop hands it to
// IsDialogMessageA first.
inline void PressKey(HWND dialog, WPARAM key) {
  MSG message{};
  message.hwnd = GetFocus() != nullptr ? GetFocus() : dialog;
  message.message = WM_KEYDOWN;
  message.wParam = key;
  IsDialogMessageA(dialog, &message);
}

namespace detail {

// Who acts at the dialogs a call shows, and how many came up.
struct Hand {
  Author author;
  int shown = 0;
};
inline Hand g_atDialog, g_atBox;

template <Hand& hand>
inline void Act(HWND dialog) {
  ++hand.shown;
  hand.author(dialog);
  if (IsWindowVisible(dialog)) {
    ADD_FAILURE() << "the author left the dialog open";
    EndDialog(dialog, kLeftOpen);
  }
}

#if defined(_WIN32)
inline BOOL CALLBACK FindDialog(HWND window, LPARAM found) {
  char name[16] = "";
  GetClassNameA(window, name, sizeof name);
  if (std::string(name) != "#32770" || !IsWindowVisible(window)) return TRUE;
  *reinterpret_cast<HWND*>(found) = window;
  return FALSE;
}
// The modal loop dispatches the thread's timer: once the dialog is shown,
// the author takes over. Windows are found from the top, and an owned
// window lies above its owner: a message box comes before its dialog.
template <Hand& hand>
inline void CALLBACK OnTimer(HWND, UINT, UINT_PTR timer, DWORD) {
  HWND dialog = nullptr;
  EnumThreadWindows(GetCurrentThreadId(), FindDialog, reinterpret_cast<LPARAM>(&dialog));
  if (dialog == nullptr) return;
  KillTimer(nullptr, timer);
  Act<hand>(dialog);
}
#endif

// Makes the call `open`, with `author` at each dialog it shows; the number
// of dialogs shown.
template <Hand& hand>
inline int Run(Author author, const std::function<void()>& open) {
  hand = Hand{std::move(author), 0};
#if defined(_WIN32)
  const UINT_PTR timer = SetTimer(nullptr, 0, 10, OnTimer<hand>);
  open();
  KillTimer(nullptr, timer);
#else
  auto before = StandinSetDialogAuthor(Act<hand>);
  open();
  StandinSetDialogAuthor(std::move(before));
#endif
  return hand.shown;
}

}  // namespace detail

// Makes the call `open`, with `author` at each dialog it shows; the number
// of dialogs shown.
inline int WithAuthor(Author author, const std::function<void()>& open) {
  return detail::Run<detail::g_atDialog>(std::move(author), open);
}

// Clicks button `id` of `dialog`, with `answer` at the message box that the
// click shows; the number of boxes shown.
inline int ClickIntoMessageBox(HWND dialog, int id, Author answer) {
  return detail::Run<detail::g_atBox>(std::move(answer), [&] { Click(dialog, id); });
}

}  // namespace editor_test
