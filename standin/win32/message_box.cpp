// MessageBoxA for the one kind of box the library shows: a text and an OK
// button, in a modal dialog that the given window owns. As under USER32, the
// text is the static control 0xFFFF, OK is the default button and has the
// focus, the caption of a box without one is "Error", and Escape, which
// sends Cancel, ends the box with IDCANCEL although it shows no such button.
#include <new>
#include <utility>

#include "window_store.h"

namespace {

constexpr int kTextId = 0xFFFF;
constexpr UINT kButtonsMask = 0x000F;

INT_PTR CALLBACK MessageBoxProc(HWND box, UINT message, WPARAM wParam, LPARAM) {
  if (message == WM_COMMAND && (LOWORD(wParam) == IDOK || LOWORD(wParam) == IDCANCEL)) EndDialog(box, LOWORD(wParam));
  return FALSE;
}

HWND NewControl(HWND box, standin::WindowKind kind, int id, DWORD style, const char* text) {
  standin::Window control;
  control.kind = kind;
  control.parent = box;
  control.id = id;
  control.style = standin::kVisible | style;
  control.text = text;
  const HWND handle = standin::NewWindow(std::move(control));
  standin::FindWindowOf(box)->controls.push_back(handle);
  return handle;
}

}  // namespace

int WINAPI MessageBoxA(HWND hWnd, LPCSTR lpText, LPCSTR lpCaption, UINT uType) {
  // Other sets of buttons are not modelled: no box, as when it cannot be made.
  if ((uType & kButtonsMask) != MB_OK) return 0;
  // Wine answers an owner that is not a window with -1 and shows nothing.
  if (hWnd != nullptr && !IsWindow(hWnd)) return -1;
  HWND box = nullptr;
  HWND ok = nullptr;
  try {
    standin::Window dialog;
    dialog.parent = hWnd;
    dialog.text = lpCaption != nullptr ? lpCaption : "Error";
    dialog.proc = MessageBoxProc;
    dialog.defaultId = IDOK;
    box = standin::NewWindow(std::move(dialog));
    ok = NewControl(box, standin::WindowKind::DefPushButton, IDOK, standin::kTabStop, "OK");
    NewControl(box, standin::WindowKind::Static, kTextId, 0, lpText != nullptr ? lpText : "");
  } catch (const std::bad_alloc&) {
    if (box != nullptr) standin::DestroyDialog(box);
    return 0;
  }
  return static_cast<int>(standin::RunModal(box, ok));
}
