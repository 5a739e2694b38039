// Any 100 bytes of stored settings, as a damaged or hand-edited game may
// hold them, through every routine that reads them: the run-time object and
// a few frames of a swinging chain, the editor display on the picture and
// the template path (and on the stored view flag), and the setup dialog
// opened and confirmed or cancelled. Invariants:
// - the display writes inside the rectangle it is given, draws exactly the
//   calls of its path, labels each rectangle with its own corner or centre
//   in at most 25 characters, and refreshes the rectangle it filled;
// - the dialog shows what is stored, and OK stores it back unchanged but
//   for the dialog's own rules (texts cut to 9 characters, the view flag
//   0 or 1); Cancel changes nothing.
// Nothing may crash, read past a field or overflow on any bytes.
#include <windows.h>

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>
#include <vector>

#include "editor_window.h"
#include "frame/edit_data.h"
#include "frame/exports.h"
#include "frame/host_services.h"
#include "fuzz_input.h"
#include "host.h"
#include "resources/resource_ids.h"
#include "standin_win32.h"

namespace {

uint32_t TVCALL CompatibleVersion() { return 0x02000000u | 218u; }

int32_t Wrapped(int64_t value) { return static_cast<int32_t>(static_cast<uint32_t>(value)); }

// The run-time object from these settings, and a few frames of one chain.
void Run(const EditData& stored, int frames) {
  standin::Host host(stored);
  Check(host.created());
  HostObject* anchor = host.AddObject(100, 20, 0);
  HostObject* link = host.AddObject(100, 40, 16);
  HostObject* platform = host.AddObject(100, 60, 8);
  host.Action(0, reinterpret_cast<intptr_t>(anchor));
  host.Action(1, reinterpret_cast<intptr_t>(link));
  host.Action(2, reinterpret_cast<intptr_t>(platform));
  host.Action(9);  // start every chain
  for (int i = 0; i < frames; ++i) host.RunFrame();
  host.Expression(5, {0});  // the chain's angle, a float
  Check(host.lastResultWasFloat());
}

struct Fenced {
  uint32_t before[4] = {0xDEADBEEF, 0xDEADBEEF, 0xDEADBEEF, 0xDEADBEEF};
  RECT rect{};
  uint32_t after[4] = {0xDEADBEEF, 0xDEADBEEF, 0xDEADBEEF, 0xDEADBEEF};
  bool intact() const {
    for (int i = 0; i < 4; ++i) {
      if (before[i] != 0xDEADBEEF || after[i] != 0xDEADBEEF) return false;
    }
    return true;
  }
};

// The numbers of a recorded call after its first two words.
std::vector<long long> Numbers(const std::string& call, std::size_t from) {
  std::vector<long long> numbers;
  const char* p = call.c_str() + from;
  while (*p != '\0') {
    char* end = nullptr;
    const long long value = std::strtoll(p, &end, 10);
    if (end == p) {
      ++p;
      continue;
    }
    numbers.push_back(value);
    p = end;
  }
  return numbers;
}

void Display(EditData edit, uint8_t view, int32_t left, int32_t top) {
  edit.viewTemplate = view;
  const EditData before = edit;
  standin::EditorWindow window(64, 64);
  Fenced placed;
  placed.rect.left = left;
  placed.rect.top = top;
  char placedObject[64] = {};
  EditorDisplay(window.host(), nullptr, placedObject, &edit, &placed.rect);
  const std::vector<std::string> calls = window.TakeCalls();
  Check(placed.intact());
  Check(!calls.empty() && calls[0].rfind("GetEditorSurface ", 0) == 0);

  if (view > 1) {
    Check(std::memcmp(&edit, &before, sizeof edit) == 0);
    Check(calls.size() == 1);
    return;
  }
  Check(placed.rect.left == left && placed.rect.top == top);
  Check(placed.rect.right == Wrapped(int64_t{left} + edit.objectWidth));
  Check(placed.rect.bottom == Wrapped(int64_t{top} + edit.objectHeight));
  if (view == 0) {
    Check(edit.objectWidth == 32 && edit.objectHeight == 32);
    Check(calls.size() == 6 && calls[4].rfind("Blit scratch editor ", 0) == 0);
    const std::vector<long long> blit = Numbers(calls[4], 20);
    Check(blit.size() >= 2 && blit[0] == left && blit[1] == top);
    return;
  }
  // The anchor, then three platforms, each a rectangle and its label.
  Check(calls.size() == 10);
  for (int shape = 0; shape < 4; ++shape) {
    const std::string& rectangle = calls[1 + 2 * shape];
    const std::string& label = calls[2 + 2 * shape];
    Check(rectangle.rfind("Rectangle editor ", 0) == 0 && label.rfind("DrawText editor \"(", 0) == 0);
    const std::vector<long long> corners = Numbers(rectangle, 17);
    const std::size_t open = label.find('"'), close = label.find('"', open + 1);
    const std::string text = label.substr(open + 1, close - open - 1);
    Check(text.size() <= 25);
    long long x = 0, y = 0;
    Check(std::sscanf(text.c_str(), "(%lld,%lld)", &x, &y) == 2);
    if (shape == 0) {
      Check(x == corners[0] && y == corners[1]);  // the anchor's top-left corner
    } else {
      // The platform's centre, half its size inside its top-left corner.
      Check(Wrapped(x - edit.platformWidth / 2) == corners[0]);
      Check(Wrapped(y - edit.platformHeight / 2) == corners[1]);
    }
  }
  Check(calls[9].rfind("UpdateEditorRect window ", 0) == 0);
  const std::vector<long long> refreshed = Numbers(calls[9], 24);
  Check(refreshed.size() == 4 && refreshed[0] == placed.rect.left && refreshed[1] == placed.rect.top &&
        refreshed[2] == placed.rect.right && refreshed[3] == placed.rect.bottom);
}

// A stored text as the dialog gives it back: what precedes its terminator,
// at most 9 characters, then a terminator; bytes after it stay as they were.
void CutText(char (&text)[kSettingTextSize]) {
  std::size_t length = 0;
  while (length < kSettingTextSize - 1 && text[length] != '\0') ++length;
  text[length] = '\0';
}

void Dialog(const EditData& stored, bool confirm) {
  EditorHost host{};
  host.slot[kEditorSlotGetVersion] = reinterpret_cast<void*>(&CompatibleVersion);
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
  const auto* got = reinterpret_cast<const uint8_t*>(&edit);
  const auto* want = reinterpret_cast<const uint8_t*>(&expected);
  for (std::size_t i = 0; i < sizeof edit; ++i) {
    if (got[i] != want[i]) std::fprintf(stderr, "byte %zu: %02x, expected %02x\n", i, got[i], want[i]);
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

  Run(stored, static_cast<int>(extra(8) % 8));
  Display(stored, 0, left, top);
  Display(stored, 1, left, top);
  Display(stored, stored.viewTemplate, left, top);
  Dialog(stored, true);
  Dialog(stored, false);
  return 0;
}
