// What the frame editor shows of the object: its picture, or a preview of one
// chain built from the template sizes of the setup dialog.
#include <cmath>

#include "chains/float_math.h"
#include "editor/drawing_services.h"
#include "editor/template_reading.h"
#include "editor/wrapping_arithmetic.h"
#include "frame/edit_data.h"
#include "frame/exports.h"
#include "frame/host_services.h"
#include "frame/module.h"
#include "resources/resource_ids.h"

namespace {

// A stored record may hold any 32-bit sizes, which the host works out with
// wrapping arithmetic (editor/wrapping_arithmetic.h).
int32_t Half(int32_t value) { return value / 2; }  // toward zero; never overflows

// cx + R cos(angle) or cy + R sin(angle), saturated at the int32 range when R
// is huge.
int32_t OnArc(int32_t centre, int32_t radius, double trig) {
  return TruncateToInt(static_cast<double>(radius) * trig + static_cast<double>(centre), 0);
}

void DrawRectangle(HostSurface* surface, int32_t x1, int32_t y1, int32_t x2, int32_t y2) {
  HostSurfaceRectangle(surface, x1, y1, x2, y2, 255, 0, 0, 1);
}

// Writes `value` in decimal, as "%i" would, at `out`; returns its end. Two
// integers are all the labels print, so the C library's whole formatted
// printing, with its floating-point and locale machinery, stays out.
char* WriteDecimal(char* out, int32_t value) {
  uint32_t magnitude = static_cast<uint32_t>(value);
  if (value < 0) {
    *out++ = '-';
    magnitude = 0u - magnitude;  // also for the lowest int32
  }
  char digits[10];
  int count = 0;
  do {
    digits[count++] = static_cast<char>('0' + magnitude % 10);
    magnitude /= 10;
  } while (magnitude != 0);
  while (count > 0) *out++ = digits[--count];
  return out;
}

void DrawLabel(HostSurface* surface, int32_t shownX, int32_t shownY, RECT rect) {
  // "(x,y)": two signed 32-bit numbers, a comma and two brackets, at most 25
  // characters, so the text always fits with its terminator.
  char text[26];
  char* end = text;
  *end++ = '(';
  end = WriteDecimal(end, shownX);
  *end++ = ',';
  end = WriteDecimal(end, shownY);
  *end++ = ')';
  *end = '\0';
  HostSurfaceDrawText(surface, text, -1, &rect, 1, 0, 0, 1, 0, 0, 0, 0, 0, 8);
}

// Bitmap 401 at the object's top-left corner, through a scratch surface that
// lives in this routine's storage. The surface is created 4 by 4; the load
// service takes the bitmap's own size.
void DrawPicture(HostSurface* editor, int32_t left, int32_t top) {
  alignas(kScratchSurfaceAlign) unsigned char storage[kScratchSurfaceBytes];
  auto* scratch = reinterpret_cast<HostSurface*>(storage);
  HostSurfaceConstruct(scratch);
  HostSurfaceCreate(scratch, 4, 4, editor);
  HostSurfaceLoadBitmap(scratch, TavrinModule(), IDB_PICTURE, 1);
  HostSurfaceBlit(scratch, editor, left, top, 1, 0, 0, 0);
  HostSurfaceDestruct(scratch);
}

// The anchor at the centre of the object's area and the platform at three
// places on its arc: swung by -A, hanging straight down, swung by +A.
void DrawTemplate(HostSurface* editor, const EditData& edit, const RECT& rect, int32_t radius, int32_t angle) {
  const auto left = static_cast<int32_t>(rect.left);
  const auto top = static_cast<int32_t>(rect.top);
  const int32_t cx = WrapAdd(left, Half(WrapSub(static_cast<int32_t>(rect.right), left)));
  const int32_t cy = WrapAdd(top, Half(WrapSub(static_cast<int32_t>(rect.bottom), top)));

  const int32_t anchorLeft = WrapSub(cx, Half(edit.anchorWidth));
  const int32_t anchorTop = WrapSub(cy, Half(edit.anchorHeight));
  DrawRectangle(editor, anchorLeft, anchorTop, WrapAdd(cx, Half(edit.anchorWidth)),
                WrapAdd(cy, Half(edit.anchorHeight)));
  // The anchor's label shows its top-left corner and starts there.
  DrawLabel(editor, anchorLeft, anchorTop,
            RECT{anchorLeft, anchorTop, WrapAdd(anchorLeft, WrapMul(2, edit.anchorWidth)),
                 WrapAdd(anchorTop, WrapMul(2, edit.anchorHeight))});

  int32_t theta = WrapSub(90, angle);
  for (int i = 0; i < 3; ++i, theta = WrapAdd(theta, angle)) {
    const double radians = static_cast<double>(theta) * kDegree;
    const int32_t px = OnArc(cx, radius, std::cos(radians));
    const int32_t py = OnArc(cy, radius, std::sin(radians));
    const int32_t platformTop = WrapSub(py, Half(edit.platformHeight));
    DrawRectangle(editor, WrapSub(px, Half(edit.platformWidth)), platformTop, WrapAdd(px, Half(edit.platformWidth)),
                  WrapAdd(py, Half(edit.platformHeight)));
    // A platform's label shows its centre, in a rectangle centred on px and
    // twice the platform's width wide.
    DrawLabel(editor, px, py,
              RECT{WrapSub(px, edit.platformWidth), platformTop, WrapAdd(px, edit.platformWidth),
                   WrapAdd(platformTop, WrapMul(2, edit.platformHeight))});
  }
}

}  // namespace

TAVRIN_EXPORT void TVCALL EditorDisplay(EditorHost* host, void*, void* placed, EditData* edit, RECT* rect) {
  void* const window = host->slot[kEditorSlotEditorWindow];
  HostSurface* const editor = HostGetEditorSurface(window, 0);
  if (editor == nullptr) return;

  const int32_t spacing = SettingInteger(edit->linkSpacingText);
  const int32_t angle = SettingInteger(edit->startAngleText);
  const int32_t radius = TemplateRadius(*edit, spacing);

  // The sizes are 16-bit fields and keep the low 16 bits.
  if (edit->viewTemplate == 1) {
    edit->objectWidth = static_cast<int16_t>(WrapAdd(edit->platformWidth, WrapMul(2, radius)));
    edit->objectHeight = static_cast<int16_t>(WrapAdd(edit->platformHeight, WrapMul(2, radius)));
  } else if (edit->viewTemplate == 0) {
    edit->objectWidth = 32;
    edit->objectHeight = 32;
  }
  GetObjectRect(host, rect, placed, edit);

  if (edit->viewTemplate == 0) {
    DrawPicture(editor, static_cast<int32_t>(rect->left), static_cast<int32_t>(rect->top));
  } else if (edit->viewTemplate == 1) {
    DrawTemplate(editor, *edit, *rect, radius, angle);
    HostUpdateEditorRect(window, rect);
  }
}
