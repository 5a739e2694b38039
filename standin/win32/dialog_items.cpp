// Messages to the stand-in's dialogs and their controls, and the dialog
// item calls built on them, with USER32's results: an edit notifies its
// dialog of every text change, a click focuses the button, toggles an
// automatic check box and notifies the dialog, and a check box holds only
// the states its style allows.
#include <algorithm>
#include <cstdio>
#include <cstring>
#include <new>

#include "standin_win32.h"
#include "window_store.h"

using standin::FindWindowOf;
using standin::Window;
using standin::WindowKind;

namespace {

bool IsCheckBox(WindowKind kind) { return kind == WindowKind::CheckBox || kind == WindowKind::AutoCheckBox; }
bool IsButton(WindowKind kind) {
  return IsCheckBox(kind) || kind == WindowKind::PushButton || kind == WindowKind::DefPushButton;
}

// Tells the control's dialog; the dialog may change or close meanwhile, so
// the control's parent and id are taken beforehand.
void Notify(HWND control, HWND dialog, int id, WORD code) {
  SendMessageA(dialog, WM_COMMAND, MAKEWPARAM(id, code), reinterpret_cast<LPARAM>(control));
}

// Copies at most size - 1 characters and a terminator; the count copied.
LRESULT CopyText(const std::string& text, WPARAM size, LPARAM buffer) {
  if (size == 0 || buffer == 0) return 0;
  const std::size_t count = std::min<std::size_t>(text.size(), size - 1);
  char* out = reinterpret_cast<char*>(buffer);
  std::memcpy(out, text.data(), count);
  out[count] = '\0';
  return static_cast<LRESULT>(std::strlen(out));
}

LRESULT TextMessage(Window& window, UINT Msg, WPARAM wParam, LPARAM lParam) {
  switch (Msg) {
    case WM_SETTEXT:
      try {
        window.text = lParam == 0 ? "" : reinterpret_cast<const char*>(lParam);
      } catch (const std::bad_alloc&) {
        return FALSE;  // out of memory: the text stays as it was
      }
      return TRUE;
    case WM_GETTEXT: return CopyText(window.text, wParam, lParam);
    case WM_GETTEXTLENGTH: return static_cast<LRESULT>(window.text.size());
    default: return 0;
  }
}

LRESULT DialogMessage(HWND hWnd, const Window& window, UINT Msg, WPARAM wParam, LPARAM lParam) {
  // The dialog procedure first; what it leaves, the dialog's own handling.
  // The window may be gone when the procedure returns: it is looked up again.
  const bool handled = window.proc != nullptr && window.proc(hWnd, Msg, wParam, lParam) != 0;
  Window* after = FindWindowOf(hWnd);
  if (after == nullptr) return 0;
  if (handled) return after->msgResult;
  if (Msg == DM_GETDEFID) return after->defaultId == 0 ? 0 : MAKELONG(after->defaultId, DC_HASDEFID);
  return TextMessage(*after, Msg, wParam, lParam);
}

LRESULT ControlMessage(HWND hWnd, Window& window, UINT Msg, WPARAM wParam, LPARAM lParam) {
  switch (Msg) {
    case WM_SETTEXT: {
      if (!TextMessage(window, Msg, wParam, lParam)) return FALSE;
      if (window.kind == WindowKind::Edit) {
        const HWND dialog = window.parent;
        const int id = window.id;
        Notify(hWnd, dialog, id, EN_UPDATE);
        Notify(hWnd, dialog, id, EN_CHANGE);
      }
      return TRUE;
    }
    case BM_GETCHECK: return IsCheckBox(window.kind) ? window.check : 0;
    case BM_SETCHECK:
      if (IsCheckBox(window.kind)) window.check = wParam == BST_UNCHECKED ? BST_UNCHECKED : BST_CHECKED;
      return 0;
    case BM_CLICK: {
      if (!IsButton(window.kind)) return 0;
      standin::SetFocusTo(hWnd);
      if (window.kind == WindowKind::AutoCheckBox) window.check = window.check == BST_CHECKED ? 0 : BST_CHECKED;
      Notify(hWnd, window.parent, window.id, BN_CLICKED);
      return 0;
    }
    default: return TextMessage(window, Msg, wParam, lParam);
  }
}

}  // namespace

LRESULT WINAPI SendMessageA(HWND hWnd, UINT Msg, WPARAM wParam, LPARAM lParam) {
  Window* window = FindWindowOf(hWnd);
  if (window == nullptr) return 0;
  if (window->kind == WindowKind::Dialog) return DialogMessage(hWnd, *window, Msg, wParam, lParam);
  return ControlMessage(hWnd, *window, Msg, wParam, lParam);
}

HWND WINAPI GetDlgItem(HWND hDlg, int nIDDlgItem) { return standin::DialogItem(hDlg, nIDDlgItem); }

LRESULT WINAPI SendDlgItemMessageA(HWND hDlg, int nIDDlgItem, UINT Msg, WPARAM wParam, LPARAM lParam) {
  const HWND control = GetDlgItem(hDlg, nIDDlgItem);
  return control == nullptr ? 0 : SendMessageA(control, Msg, wParam, lParam);
}

BOOL WINAPI SetDlgItemTextA(HWND hDlg, int nIDDlgItem, LPCSTR lpString) {
  return static_cast<BOOL>(SendDlgItemMessageA(hDlg, nIDDlgItem, WM_SETTEXT, 0, reinterpret_cast<LPARAM>(lpString)));
}

int WINAPI GetWindowTextA(HWND hWnd, LPSTR lpString, int nMaxCount) {
  if (lpString != nullptr && nMaxCount > 0) lpString[0] = '\0';
  if (nMaxCount <= 0) return 0;
  return static_cast<int>(
      SendMessageA(hWnd, WM_GETTEXT, static_cast<WPARAM>(nMaxCount), reinterpret_cast<LPARAM>(lpString)));
}

UINT WINAPI GetDlgItemTextA(HWND hDlg, int nIDDlgItem, LPSTR lpString, int cchMax) {
  return static_cast<UINT>(GetWindowTextA(GetDlgItem(hDlg, nIDDlgItem), lpString, cchMax));
}

// USER32 reports success whether or not the item exists.
BOOL WINAPI SetDlgItemInt(HWND hDlg, int nIDDlgItem, UINT uValue, BOOL bSigned) {
  char text[16];
  if (bSigned) std::snprintf(text, sizeof text, "%d", static_cast<int>(uValue));
  else std::snprintf(text, sizeof text, "%u", uValue);
  SetDlgItemTextA(hDlg, nIDDlgItem, text);
  return TRUE;
}

// The item's text, read into 30 characters as USER32 reads it, converted
// as the C library's strtol (or strtoul) with base 10 does with 32-bit
// longs: leading white space and a sign allowed, conversion up to the first
// character that is not a digit. No digit at all, or a value beyond the
// range, fails with 0; an unsigned conversion of a negative number wraps.
UINT WINAPI GetDlgItemInt(HWND hDlg, int nIDDlgItem, BOOL* lpTranslated, BOOL bSigned) {
  if (lpTranslated != nullptr) *lpTranslated = FALSE;
  char text[30];
  if (SendDlgItemMessageA(hDlg, nIDDlgItem, WM_GETTEXT, sizeof text, reinterpret_cast<LPARAM>(text)) == 0) return 0;
  const char* c = text;
  while (*c == ' ' || (*c >= '\t' && *c <= '\r')) ++c;
  const bool negative = *c == '-';
  if (*c == '-' || *c == '+') ++c;
  if (*c < '0' || *c > '9') return 0;
  uint64_t magnitude = 0;
  for (; *c >= '0' && *c <= '9'; ++c) {
    magnitude = magnitude * 10 + static_cast<uint64_t>(*c - '0');
    if (magnitude > 0xFFFFFFFFu) return 0;  // out of range even unsigned
  }
  if (bSigned && magnitude > (negative ? 0x80000000u : 0x7FFFFFFFu)) return 0;
  if (lpTranslated != nullptr) *lpTranslated = TRUE;
  const auto value = static_cast<uint32_t>(magnitude);
  return negative ? 0u - value : value;
}

// USER32 reports success whether or not the item is a check box.
BOOL WINAPI CheckDlgButton(HWND hDlg, int nIDButton, UINT uCheck) {
  SendDlgItemMessageA(hDlg, nIDButton, BM_SETCHECK, uCheck, 0);
  return TRUE;
}

UINT WINAPI IsDlgButtonChecked(HWND hDlg, int nIDButton) {
  return static_cast<UINT>(SendDlgItemMessageA(hDlg, nIDButton, BM_GETCHECK, 0, 0));
}
