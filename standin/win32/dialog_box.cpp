// Modal dialogs over the library's dialog templates, as USER32 runs them:
// DialogBoxParamA makes the dialog and its controls from the template,
// sends WM_INITDIALOG, gives the focus to the first control with a tab
// stop, shows the dialog and runs until EndDialog. No one sits at this
// screen: the author a test installs acts once the dialog is up.
#include <cstdio>
#include <cstdlib>
#include <new>
#include <unordered_map>
#include <utility>

#include "dialog_template.h"
#include "module_resources.h"
#include "standin_win32.h"
#include "window_store.h"

namespace standin {

namespace {

std::unordered_map<uintptr_t, Window>& Windows() {
  // Never destroyed: a loaded DLL shutting down at exit still calls in.
  static auto& windows = *new std::unordered_map<uintptr_t, Window>;
  return windows;
}

uintptr_t g_nextHandle = 0x20000;
HWND g_focus = nullptr;
std::function<void(HWND)> g_author;

constexpr WORD kButtonClass = 0x0080, kEditClass = 0x0081, kStaticClass = 0x0082;

bool SameName(const std::string& text, const char* name) {
  std::size_t i = 0;
  for (; i < text.size() && name[i] != '\0'; ++i) {
    const char c = text[i] >= 'a' && text[i] <= 'z' ? static_cast<char>(text[i] - 'a' + 'A') : text[i];
    if (c != name[i]) return false;
  }
  return i == text.size() && name[i] == '\0';
}

// The kind of control a template item makes; false for a class that is not
// registered here, which makes the whole dialog fail as it does in USER32.
bool ControlKind(const DialogItemTemplate& item, WindowKind& kind) {
  WORD atom = item.windowClass.ordinal;
  if (!item.windowClass.isOrdinal) {
    if (SameName(item.windowClass.text, "BUTTON")) atom = kButtonClass;
    else if (SameName(item.windowClass.text, "EDIT")) atom = kEditClass;
    else if (SameName(item.windowClass.text, "STATIC")) atom = kStaticClass;
    else return false;
  }
  switch (atom) {
    case kEditClass: kind = WindowKind::Edit; return true;
    case kStaticClass: kind = WindowKind::Static; return true;
    case kButtonClass: break;
    default: return false;
  }
  switch (item.style & 0x0F) {
    case 0: kind = WindowKind::PushButton; return true;
    case 1: kind = WindowKind::DefPushButton; return true;
    case 2: kind = WindowKind::CheckBox; return true;
    case 3: kind = WindowKind::AutoCheckBox; return true;
    case 7: kind = WindowKind::GroupBox; return true;
    default: return false;  // radio buttons and the rest: not modelled
  }
}

// The dialog and its controls, hidden; null when a control cannot be made
// or memory runs out.
HWND CreateDialogWindows(const DialogTemplate& dialogTemplate, HWND owner, DLGPROC proc) {
  HWND handle = nullptr;
  try {
    Window dialog;
    dialog.kind = WindowKind::Dialog;
    dialog.parent = owner;
    dialog.style = dialogTemplate.style;
    dialog.text = dialogTemplate.caption;
    dialog.proc = proc;
    handle = NewWindow(std::move(dialog));
    for (const DialogItemTemplate& item : dialogTemplate.items) {
      Window control;
      if (!ControlKind(item, control.kind)) {
        DestroyDialog(handle);
        return nullptr;
      }
      control.parent = handle;
      control.id = item.id;
      control.style = item.style;
      control.text = item.title.isOrdinal ? std::string() : item.title.text;
      const bool isDefault = control.kind == WindowKind::DefPushButton;
      const HWND controlHandle = NewWindow(std::move(control));
      Window* window = FindWindowOf(handle);
      window->controls.push_back(controlHandle);
      // The last default push button made is the dialog's default.
      if (isDefault) window->defaultId = item.id;
    }
  } catch (const std::bad_alloc&) {
    if (handle != nullptr) DestroyDialog(handle);
    return nullptr;
  }
  return handle;
}

HWND FirstTabStop(const Window& dialog) {
  for (HWND control : dialog.controls) {
    const DWORD style = FindWindowOf(control)->style;
    if ((style & kTabStop) != 0 && (style & kVisible) != 0 && (style & kDisabled) == 0) return control;
  }
  return nullptr;
}

}  // namespace

HWND NewWindow(Window window) {
  const uintptr_t handle = g_nextHandle++;
  Windows().emplace(handle, std::move(window));
  return reinterpret_cast<HWND>(handle);
}

Window* FindWindowOf(HWND handle) {
  const auto found = Windows().find(reinterpret_cast<uintptr_t>(handle));
  return found == Windows().end() ? nullptr : &found->second;
}

void DestroyDialog(HWND dialog) {
  for (auto it = Windows().begin(); it != Windows().end();) {
    const bool ofDialog = it->first == reinterpret_cast<uintptr_t>(dialog) || it->second.parent == dialog;
    if (ofDialog && g_focus == reinterpret_cast<HWND>(it->first)) g_focus = nullptr;
    it = ofDialog ? Windows().erase(it) : std::next(it);
  }
}

HWND DialogItem(HWND dialog, int id) {
  const Window* window = FindWindowOf(dialog);
  if (window == nullptr || window->kind != WindowKind::Dialog) return nullptr;
  for (HWND control : window->controls) {
    if (FindWindowOf(control)->id == id) return control;
  }
  return nullptr;
}

void SetFocusTo(HWND control) { g_focus = control; }

INT_PTR RunModal(HWND dialog, HWND focus) {
  Window* window = FindWindowOf(dialog);
  if (!window->ended) {
    const HWND focusBefore = g_focus;
    // An owner that is enabled is disabled while the dialog runs.
    const HWND owner = window->parent;
    const bool disables = IsWindowEnabled(owner) != FALSE;
    if (disables) FindWindowOf(owner)->style |= kDisabled;
    if (focus != nullptr) g_focus = focus;
    window->visible = true;
    if (g_author) g_author(dialog);
    window = FindWindowOf(dialog);
    if (!window->ended) {
      // A real dialog would now wait for an author who never comes.
      std::fprintf(stderr, "standin: the dialog \"%s\" was left open, and nothing can close it\n",
                   window->text.c_str());
      std::abort();
    }
    if (Window* stillThere = disables ? FindWindowOf(owner) : nullptr) stillThere->style &= ~kDisabled;
    if (FindWindowOf(focusBefore) != nullptr) g_focus = focusBefore;
  }
  const INT_PTR result = window->result;
  DestroyDialog(dialog);
  return result;
}

}  // namespace standin

using standin::FindWindowOf;
using standin::Window;
using standin::WindowKind;

std::function<void(HWND dialog)> StandinSetDialogAuthor(std::function<void(HWND dialog)> author) {
  return std::exchange(standin::g_author, std::move(author));
}

INT_PTR WINAPI DialogBoxParamA(HINSTANCE hInstance, LPCSTR lpTemplateName, HWND hWndParent, DLGPROC lpDialogFunc,
                               LPARAM dwInitParam) {
  const standin::ResourceEntry* entry = standin::FindModuleResource(hInstance, lpTemplateName, RT_DIALOG);
  if (entry == nullptr) return -1;
  // USER32 makes no dialog for an owner that is not a window, and says 0.
  if (hWndParent != nullptr && !IsWindow(hWndParent)) return 0;
  standin::DialogTemplate dialogTemplate;
  try {
    if (!standin::ReadDialogTemplate(entry->data, entry->size, dialogTemplate)) return -1;
  } catch (const std::bad_alloc&) {
    return -1;
  }
  const HWND dialog = standin::CreateDialogWindows(dialogTemplate, hWndParent, lpDialogFunc);
  if (dialog == nullptr) return -1;

  const HWND firstTabStop = standin::FirstTabStop(*FindWindowOf(dialog));
  const INT_PTR focusDefault =
      lpDialogFunc(dialog, WM_INITDIALOG, reinterpret_cast<WPARAM>(firstTabStop), dwInitParam);
  return standin::RunModal(dialog, focusDefault != 0 ? standin::FirstTabStop(*FindWindowOf(dialog)) : nullptr);
}

BOOL WINAPI EndDialog(HWND hDlg, INT_PTR nResult) {
  Window* window = FindWindowOf(hDlg);
  if (window == nullptr || window->kind != WindowKind::Dialog) return FALSE;
  window->ended = true;
  window->result = nResult;
  window->visible = false;  // hidden at once; destroyed when its loop ends
  return TRUE;
}

HWND WINAPI GetFocus(void) { return standin::g_focus; }

BOOL WINAPI IsWindow(HWND hWnd) { return FindWindowOf(hWnd) != nullptr; }

BOOL WINAPI IsWindowEnabled(HWND hWnd) {
  const Window* window = FindWindowOf(hWnd);
  return window != nullptr && (window->style & standin::kDisabled) == 0;
}

// Only a dialog has an owner; its controls are its children.
HWND WINAPI GetWindow(HWND hWnd, UINT uCmd) {
  const Window* window = FindWindowOf(hWnd);
  if (window == nullptr || uCmd != GW_OWNER || window->kind != WindowKind::Dialog) return nullptr;
  return window->parent;
}

BOOL WINAPI IsWindowVisible(HWND hWnd) {
  const Window* window = FindWindowOf(hWnd);
  if (window == nullptr) return FALSE;
  if (window->kind == WindowKind::Dialog) return window->visible;
  return (window->style & standin::kVisible) != 0 && IsWindowVisible(window->parent);
}

namespace {

// The dialog's slot at `index`, or null for an index that is not one.
LONG_PTR* DialogSlot(HWND hWnd, int index) {
  Window* window = FindWindowOf(hWnd);
  if (window == nullptr || window->kind != WindowKind::Dialog) return nullptr;
  if (index == static_cast<int>(DWLP_USER)) return &window->user;
  if (index == DWLP_MSGRESULT) return &window->msgResult;
  return nullptr;
}

}  // namespace

#if UINTPTR_MAX == 0xFFFFFFFFu
LONG WINAPI SetWindowLongA(HWND hWnd, int nIndex, LONG dwNewLong) {
#else
LONG_PTR WINAPI SetWindowLongPtrA(HWND hWnd, int nIndex, LONG_PTR dwNewLong) {
#endif
  LONG_PTR* slot = DialogSlot(hWnd, nIndex);
  if (slot == nullptr) return 0;
  return std::exchange(*slot, dwNewLong);
}

#if UINTPTR_MAX == 0xFFFFFFFFu
LONG WINAPI GetWindowLongA(HWND hWnd, int nIndex) {
#else
LONG_PTR WINAPI GetWindowLongPtrA(HWND hWnd, int nIndex) {
#endif
  const LONG_PTR* slot = DialogSlot(hWnd, nIndex);
  return slot == nullptr ? 0 : *slot;
}

// What the dialog's message loop does with a key: Escape presses Cancel;
// Enter presses the focused default push button, else the dialog's default
// button, else OK. No other message is modelled; like USER32, every message
// for the dialog or one of its controls counts as handled.
BOOL WINAPI IsDialogMessageA(HWND hDlg, MSG* lpMsg) {
  const Window* dialog = FindWindowOf(hDlg);
  if (dialog == nullptr || dialog->kind != WindowKind::Dialog || lpMsg == nullptr) return FALSE;
  const Window* target = FindWindowOf(lpMsg->hwnd);
  if (lpMsg->hwnd != hDlg && (target == nullptr || target->parent != hDlg)) return FALSE;
  if (lpMsg->message != WM_KEYDOWN) return TRUE;
  const auto press = [hDlg](int id, WPARAM command) {
    SendMessageA(hDlg, WM_COMMAND, command, reinterpret_cast<LPARAM>(GetDlgItem(hDlg, id)));
  };
  if (lpMsg->wParam == VK_ESCAPE) {
    press(IDCANCEL, IDCANCEL);
  } else if (lpMsg->wParam == VK_RETURN) {
    const HWND focus = GetFocus();
    const Window* focused = FindWindowOf(focus);
    const LRESULT defaultId = SendMessageA(hDlg, DM_GETDEFID, 0, 0);
    if (focused != nullptr && focused->parent == hDlg && focused->kind == WindowKind::DefPushButton) {
      press(focused->id, MAKEWPARAM(focused->id, BN_CLICKED));
    } else if (HIWORD(defaultId) == DC_HASDEFID) {
      const HWND button = GetDlgItem(hDlg, LOWORD(defaultId));
      if (button == nullptr || (FindWindowOf(button)->style & standin::kDisabled) == 0) {
        press(LOWORD(defaultId), MAKEWPARAM(LOWORD(defaultId), BN_CLICKED));
      }
    } else {
      press(IDOK, IDOK);
    }
  }
  return TRUE;
}
