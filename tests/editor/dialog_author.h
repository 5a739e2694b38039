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

inline Author g_author;
inline int g_dialogsShown = 0;
inline Author g_boxAuthor;
inline int g_boxesShown = 0;
inline HWND g_owner = nullptr;  // of the dialog the next timer looks for

// `author` at a dialog that is up, which it must close.
inline void ActIn(HWND dialog, const Author& author, int& shown) {
  ++shown;
  author(dialog);
  if (IsWindowVisible(dialog)) {
    ADD_FAILURE() << "the author left the dialog open";
    EndDialog(dialog, kLeftOpen);
  }
}
inline void Act(HWND dialog) { ActIn(dialog, g_author, g_dialogsShown); }
inline void ActInBox(HWND box) { ActIn(box, g_boxAuthor, g_boxesShown); }

#if defined(_WIN32)
inline BOOL CALLBACK FindDialog(HWND window, LPARAM found) {
  char name[16] = "";
  GetClassNameA(window, name, sizeof name);
  if (std::string(name) != "#32770" || !IsWindowVisible(window) || GetWindow(window, GW_OWNER) != g_owner) {
    return TRUE;
  }
  *reinterpret_cast<HWND*>(found) = window;
  return FALSE;
}
// A modal loop dispatches the thread's timers: once a dialog that g_owner
// owns is shown, `act` takes over.
template <void (*act)(HWND)>
inline void CALLBACK OnTimer(HWND, UINT, UINT_PTR timer, DWORD) {
  HWND dialog = nullptr;
  EnumThreadWindows(GetCurrentThreadId(), FindDialog, reinterpret_cast<LPARAM>(&dialog));
  if (dialog == nullptr) return;
  KillTimer(nullptr, timer);
  act(dialog);
}
#endif

// Makes the call `open`, which shows a modal dialog owned by `owner`, and
// has `act` work it once it is up.
template <void (*act)(HWND)>
inline void Run(HWND owner, const std::function<void()>& open) {
#if defined(_WIN32)
  g_owner = owner;
  const UINT_PTR timer = SetTimer(nullptr, 0, 10, OnTimer<act>);
  open();
  KillTimer(nullptr, timer);
#else
  (void)owner;
  StandinSetDialogAuthor(act);
  open();
  StandinSetDialogAuthor(nullptr);
#endif
}

}  // namespace detail

// Makes the call `open`, with `author` at each dialog it shows; the number
// of dialogs shown.
inline int WithAuthor(Author author, const std::function<void()>& open) {
  detail::g_author = std::move(author);
  detail::g_dialogsShown = 0;
  detail::Run<detail::Act>(nullptr, open);
  return detail::g_dialogsShown;
}

// Clicks button `id` of `dialog`, with `answer` at the message box that the
// click shows, owned by the dialog; the number of boxes shown.
inline int ClickIntoMessageBox(HWND dialog, int id, Author answer) {
  detail::g_boxAuthor = std::move(answer);
  detail::g_boxesShown = 0;
  detail::Run<detail::ActInBox>(dialog, [&] { Click(dialog, id); });
#if !defined(_WIN32)
  StandinSetDialogAuthor(detail::Act);  // back to the dialog's author
#endif
  return detail::g_boxesShown;
}

}  // namespace editor_test
