// Any 100 bytes of stored settings, as a damaged or hand-edited game may
// hold them, through the editor routines that read them: the display on the
// picture and the template path (and on the stored view flag), and the setup
// dialog opened and confirmed or cancelled. (The event-program fuzzer makes
// run-time objects from any settings.) Invariants:
// - the display writes inside the rectangle it is given, draws exactly the
//   calls of its path, labels each rectangle with its own corner or centre
//   in at most 25 characters, none cut off, and refreshes the rectangle it
//   filled;
// - the dialog shows what is stored, and OK stores it back unchanged but
//   for the dialog's own rules (texts cut to 9 characters, the view flag
//   0 or 1); Cancel changes nothing.
// Nothing may crash, read past a field or overflow on any bytes.
#include <windows.h>

#include <cstdint>
#include <cstdio>
#include <cstring>
#include <string>
#include <vector>

#include "catalogue/catalogue_helpers.h"
#include "editor_window.h"
#include "frame/edit_data.h"
#include "frame/exports.h"
#include "frame/host_services.h"
#include "fuzz_input.h"
#include "resources/resource_ids.h"
#include "standin_win32.h"

namespace {

int32_t Wrapped(int64_t value) { return static_cast<int32_t>(static_cast<uint32_t>(value)); }

void Display(EditData edit, uint8_t view, int32_t left, int32_t top) {
  edit.viewTemplate = view;
  const EditData before = edit;
  standin::EditorWindow window(64, 64);
  struct {
    uint32_t before[4];
    RECT rect;
    uint32_t after[4];
  } placed, sent;
  std::memset(&placed, 0xEE, sizeof placed);
  placed.rect.left = left;
  placed.rect.top = top;
  sent = placed;
  char placedObject[64] = {};
  EditorDisplay(window.host(), nullptr, placedObject, &edit, &placed.rect);
  const std::vector<std::string> calls = window.TakeCalls();
  Check(!std::memcmp(placed.before, sent.before, sizeof sent.before) &&
        !std::memcmp(placed.after, sent.after, sizeof sent.after));
  Check(!calls.empty() && calls[0].rfind("GetEditorSurface ", 0) == 0);
  if (view > 1) {
    Check(calls.size() == 1 && std::memcmp(&edit, &before, sizeof edit) == 0);
    return;
  }
  const RECT& r = placed.rect;
  Check(r.left == left && r.top == top && r.right == Wrapped(int64_t{left} + edit.objectWidth) &&
        r.bottom == Wrapped(int64_t{top} + edit.objectHeight));
  long long x = 0, y = 0, x2 = 0, y2 = 0;
  if (view == 0) {
    Check(edit.objectWidth == 32 && edit.objectHeight == 32 && calls.size() == 6);
    Check(std::sscanf(calls[4].c_str(), "Blit scratch editor %lld %lld", &x, &y) == 2 && x == left && y == top);
    return;
  }
  // The anchor, then three platforms, each a rectangle and its label.
  Check(calls.size() == 10);
  for (int shape = 0; shape < 4; ++shape) {
    long long cornerX = 0, cornerY = 0;
    Check(std::sscanf(calls[1 + 2 * shape].c_str(), "Rectangle editor %lld %lld", &cornerX, &cornerY) == 2);
    const std::string& label = calls[2 + 2 * shape];
    const std::size_t open = label.find('"'), close = label.find('"', open + 1);
    Check(close != std::string::npos && close - open - 1 <= 25 && label[close - 1] == ')');
    Check(std::sscanf(label.c_str(), "DrawText editor \"(%lld,%lld)\"", &x, &y) == 2);
    // The anchor's label shows its top-left corner, a platform's its centre.
    Check(shape == 0 ? x == cornerX && y == cornerY
                     : Wrapped(x - edit.platformWidth / 2) == cornerX && Wrapped(y - edit.platformHeight / 2) == cornerY);
  }
  Check(std::sscanf(calls[9].c_str(), "UpdateEditorRect window %lld %lld %lld %lld", &x, &y, &x2, &y2) == 4);
  Check(x == r.left && y == r.top && x2 == r.right && y2 == r.bottom);
}

// A stored text as the dialog gives it back: what precedes its terminator,
// at most 9 characters, then a terminator; bytes after it stay as they were.
void CutText(char (&text)[kSettingTextSize]) {
  std::size_t length = 0;
  while (length < kSettingTextSize - 1 && text[length] != '\0') ++length;
  text[length] = '\0';
}

void Dialog(const EditData& stored, bool confirm) {
  EditorHost host = catalogue_test::HostWithVersion();
  EditData edit = stored;
  int shown = 0;
  StandinSetDialogAuthor([&](HWND dialog) {
    ++shown;
    const struct {
      int id;
      int32_t value;
    } integers[] = {{IDC_ANCHOR_WIDTH, stored.anchorWidth},     {IDC_ANCHOR_HEIGHT, stored.anchorHeight},
                    {IDC_LINK_WIDTH, stored.linkWidth},         {IDC_LINK_HEIGHT, stored.linkHeight},
                    {IDC_PLATFORM_WIDTH, stored.platformWidth}, {IDC_PLATFORM_HEIGHT, stored.platformHeight},
                    {IDC_LINK_COUNT, stored.linkCount}};
    for (const auto& field : integers) {
      char shownText[32] = "";
      GetDlgItemTextA(dialog, field.id, shownText, sizeof shownText);
      Check(std::to_string(field.value) == shownText);
    }
    char angle[32] = "";
    GetDlgItemTextA(dialog, IDC_START_ANGLE, angle, sizeof angle);
    Check(std::strlen(angle) <= kSettingTextSize && std::strncmp(angle, stored.startAngleText, std::strlen(angle)) == 0);
    Check((IsDlgButtonChecked(dialog, IDC_VIEW_TEMPLATE) == BST_CHECKED) == (stored.viewTemplate != 0));
    SendDlgItemMessageA(dialog, confirm ? IDOK : IDCANCEL, BM_CLICK, 0, 0);
  });
  const int32_t result = SelectPopup(&host, 2020, nullptr, nullptr, &edit, nullptr, nullptr);
  StandinSetDialogAuthor(nullptr);
  Check(shown == 1);
  Check(result == (confirm ? 4 : 0));

  EditData expected = stored;
  if (confirm) {
    for (auto* text : {&expected.startAngleText, &expected.massText, &expected.gravityText,
                       &expected.linkSpacingText}) {
      CutText(*text);
    }
    expected.viewTemplate = stored.viewTemplate != 0 ? 1 : 0;
  }
  Check(std::memcmp(&edit, &expected, sizeof edit) == 0);
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  if (size < sizeof(EditData)) return -1;  // not a stored record: not kept in the corpus
  EditData stored;
  std::memcpy(&stored, data, sizeof stored);
  auto extra = [&](std::size_t i) -> uint32_t { return sizeof stored + i < size ? data[sizeof stored + i] : 0; };
  const int32_t left = static_cast<int32_t>(extra(0) << 24 | extra(1) << 16 | extra(2) << 8 | extra(3));
  const int32_t top = static_cast<int32_t>(extra(4) << 24 | extra(5) << 16 | extra(6) << 8 | extra(7));

  Display(stored, 0, left, top);
  Display(stored, 1, left, top);
  Display(stored, stored.viewTemplate, left, top);
  Dialog(stored, true);
  Dialog(stored, false);
  return 0;
}
