// Takes the pictures of the setup dialog and of the help that its Help
// button shows: loads the library as the host does, creates a new object,
// whose dialog opens, and copies the dialog, then the help, from the screen
// into BMP files. scripts/doc-pictures.sh runs it under Wine on a virtual
// display, in the folder that holds the library.
//
// usage: dialog_screenshot tavrin.dll DIALOG.bmp HELP.bmp
#include <windows.h>

#include <cstdint>
#include <cstdio>
#include <string>

#include "frame/abi.h"
#include "frame/edit_data.h"
#include "frame/host_services.h"
#include "resources/resource_ids.h"

namespace {

const char* g_dialogFile = nullptr;
const char* g_helpFile = nullptr;
HWND g_dialog = nullptr;
bool g_saved = true;

// Version 2.0, build 218: a host that can show the object.
uint32_t TVCALL HostVersion() { return 0x02000000u | 218u; }

// Copies what the screen shows of the window, frame and caption included,
// into a 24-bit BMP file once the window has painted itself.
bool SaveWindow(HWND window, const char* path) {
  RedrawWindow(window, nullptr, nullptr, RDW_INVALIDATE | RDW_UPDATENOW | RDW_ALLCHILDREN | RDW_FRAME);
  RECT rect{};
  GetWindowRect(window, &rect);
  const LONG width = rect.right - rect.left, height = rect.bottom - rect.top;
  BITMAPINFOHEADER header{};
  header.biSize = sizeof header;
  header.biWidth = width;
  header.biHeight = height;  // bottom-up rows, as a BMP file keeps them
  header.biPlanes = 1;
  header.biBitCount = 24;
  header.biCompression = BI_RGB;
  const DWORD imageBytes = static_cast<DWORD>((width * 3 + 3) & ~3) * static_cast<DWORD>(height);
  const HDC screen = GetDC(nullptr);
  const HDC memory = CreateCompatibleDC(screen);
  void* pixels = nullptr;
  const HBITMAP bitmap =
      CreateDIBSection(screen, reinterpret_cast<BITMAPINFO*>(&header), DIB_RGB_COLORS, &pixels, nullptr, 0);
  const HGDIOBJ before = SelectObject(memory, bitmap);
  bool saved = bitmap != nullptr && BitBlt(memory, 0, 0, width, height, screen, rect.left, rect.top, SRCCOPY);
  GdiFlush();
  BITMAPFILEHEADER file{};
  file.bfType = 0x4D42;  // "BM"
  file.bfOffBits = sizeof file + sizeof header;
  file.bfSize = file.bfOffBits + imageBytes;
  if (FILE* out = saved ? std::fopen(path, "wb") : nullptr) {
    saved = std::fwrite(&file, sizeof file, 1, out) == 1 && std::fwrite(&header, sizeof header, 1, out) == 1 &&
            std::fwrite(pixels, 1, imageBytes, out) == imageBytes;
    saved = std::fclose(out) == 0 && saved;
  } else {
    saved = false;
  }
  SelectObject(memory, before);
  if (bitmap != nullptr) DeleteObject(bitmap);
  DeleteDC(memory);
  ReleaseDC(nullptr, screen);
  if (!saved) std::fprintf(stderr, "dialog_screenshot: cannot save %s\n", path);
  return saved;
}

// The visible dialog that `owner` owns (null: one without an owner).
struct Search {
  HWND owner;
  HWND found;
};
BOOL CALLBACK FindDialog(HWND window, LPARAM param) {
  auto* search = reinterpret_cast<Search*>(param);
  char name[16] = "";
  GetClassNameA(window, name, sizeof name);
  if (std::string(name) != "#32770" || !IsWindowVisible(window) || GetWindow(window, GW_OWNER) != search->owner) {
    return TRUE;
  }
  search->found = window;
  return FALSE;
}
HWND DialogOwnedBy(HWND owner) {
  Search search{owner, nullptr};
  EnumThreadWindows(GetCurrentThreadId(), FindDialog, reinterpret_cast<LPARAM>(&search));
  return search.found;
}

// The modal loops dispatch the thread's timers: these act once the help, or
// the dialog, is up.
void CALLBACK InHelp(HWND, UINT, UINT_PTR timer, DWORD) {
  const HWND box = DialogOwnedBy(g_dialog);
  if (box == nullptr) return;
  KillTimer(nullptr, timer);
  g_saved = SaveWindow(box, g_helpFile) && g_saved;
  SendDlgItemMessageA(box, IDOK, BM_CLICK, 0, 0);
}

void CALLBACK InDialog(HWND, UINT, UINT_PTR timer, DWORD) {
  g_dialog = DialogOwnedBy(nullptr);
  if (g_dialog == nullptr) return;
  KillTimer(nullptr, timer);
  g_saved = SaveWindow(g_dialog, g_dialogFile) && g_saved;
  const UINT_PTR help = SetTimer(nullptr, 0, 200, InHelp);
  SendDlgItemMessageA(g_dialog, IDC_SETUP_HELP, BM_CLICK, 0, 0);
  KillTimer(nullptr, help);
  SendDlgItemMessageA(g_dialog, IDCANCEL, BM_CLICK, 0, 0);
}

}  // namespace

int main(int argc, char** argv) {
  if (argc != 4) {
    std::fprintf(stderr, "usage: dialog_screenshot tavrin.dll DIALOG.bmp HELP.bmp\n");
    return 2;
  }
  g_dialogFile = argv[2];
  g_helpFile = argv[3];
  using CreateObjectFn = int32_t(TVCALL*)(EditorHost*, void*, EditData*);
  const HMODULE library = LoadLibraryA(argv[1]);
  const auto createObject =
      library != nullptr ? reinterpret_cast<CreateObjectFn>(reinterpret_cast<void*>(GetProcAddress(library, "CreateObject"))) : nullptr;
  if (createObject == nullptr) {
    std::fprintf(stderr, "dialog_screenshot: cannot load CreateObject from %s\n", argv[1]);
    return 1;
  }
  EditorHost host{};
  host.slot[kEditorSlotGetVersion] = reinterpret_cast<void*>(&HostVersion);
  EditData edit{};
  SetTimer(nullptr, 0, 200, InDialog);
  // Cancel ends the dialog with -1; anything else means it never opened.
  if (createObject(&host, nullptr, &edit) != -1 || g_dialog == nullptr) {
    std::fprintf(stderr, "dialog_screenshot: the setup dialog did not open\n");
    return 1;
  }
  return g_saved ? 0 : 1;
}
