// What the library asks the frame editor to draw, observed through the
// drawing service calls it makes: natively through the DRAVO2 stand-in it
// is linked against, under Wine through the stand-in DRAVO2.dll, whose
// ordinals the Windows loader resolves.
#include <gtest/gtest.h>

#include <cstring>
#include <string>
#include <vector>

#include "editor_window.h"
#include "frame/edit_data.h"
#include "frame/exports.h"

namespace {

using Calls = std::vector<std::string>;

EditData Defaults(uint8_t viewTemplate) {
  EditData edit{};
  WriteEditDataDefaults(edit);
  edit.viewTemplate = viewTemplate;
  return edit;
}

RECT Place(int32_t left, int32_t top) {
  RECT rect{};
  rect.left = left;
  rect.top = top;
  rect.right = rect.bottom = 12345;  // filled by the routine, or left alone
  return rect;
}

Calls Display(EditorHost* host, EditData& edit, RECT& rect) {
  standin::EditorWindow window(8, 8);
  EditorHost* const record = host != nullptr ? host : window.host();
  char placed[64] = {};
  EditorDisplay(record, nullptr, placed, &edit, &rect);
  return window.TakeCalls();
}

// The text of each label drawn, in drawing order.
std::vector<std::string> Labels(const Calls& calls) {
  std::vector<std::string> labels;
  for (const std::string& call : calls) {
    if (call.rfind("DrawText editor \"", 0) == 0) {
      const std::size_t start = call.find('"') + 1;
      labels.push_back(call.substr(start, call.find('"', start) - start));
    }
  }
  return labels;
}

// The picture at the object's corner through a scratch surface, or nothing:
// the rectangle is filled once there is a surface.
TEST(EditorDisplay, ShowsThePictureOrNothingAsTheSettingsSay) {
  const Calls picture = {"GetEditorSurface window 0",   "Construct scratch",
                         "Create scratch 4 4 editor",   "LoadBitmap scratch 401 1 -> 32x32",
                         "Blit scratch editor 110 20 1 0 0 0", "Destruct scratch"};
  const struct {
    const char* name;
    bool surface;
    uint8_t viewTemplate;
    Calls calls;
    int16_t width, height;
    LONG right;
  } cases[] = {{"view template 0", true, 0, picture, 32, 32, 142},
               {"no editor surface", false, 1, {"GetEditorSurface null 0"}, 70, 50, 12345},
               {"view template 2", true, 2, {"GetEditorSurface window 0"}, 70, 50, 180}};
  for (const auto& c : cases) {
    SCOPED_TRACE(c.name);
    EditData edit = Defaults(c.viewTemplate);
    edit.objectWidth = 70;
    edit.objectHeight = 50;
    EditorHost noWindow{};
    RECT rect = Place(110, 20);
    EXPECT_EQ(Display(c.surface ? nullptr : &noWindow, edit, rect), c.calls);
    EXPECT_EQ(edit.objectWidth, c.width);
    EXPECT_EQ(edit.objectHeight, c.height);
    EXPECT_EQ(rect.right, c.right);
  }
}

TEST(EditorDisplay, DrawsTheTemplateWithItsSizes) {
  EditData edit = Defaults(1);
  RECT rect = Place(0, 0);
  const std::string args = " 1 0 0 1 0 0 0 0 0 8";
  EXPECT_EQ(Display(nullptr, edit, rect), (Calls{
      "GetEditorSurface window 0",
      "Rectangle editor 368 352 400 384 255 0 0 1",
      "DrawText editor \"(368,352)\" -1 368 352 432 416" + args,
      "Rectangle editor 704 352 768 384 255 0 0 1",
      "DrawText editor \"(736,368)\" -1 672 352 800 416" + args,
      // The sine of 90 degrees with the chains' degree factor falls just short of 1.
      "Rectangle editor 352 703 416 735 255 0 0 1",
      "DrawText editor \"(384,719)\" -1 320 703 448 767" + args,
      "Rectangle editor 0 352 64 384 255 0 0 1",
      "DrawText editor \"(32,368)\" -1 -32 352 96 416" + args,
      "UpdateEditorRect window 0 0 768 736",
  }));
  EXPECT_EQ(edit.objectWidth, 768);
  EXPECT_EQ(edit.objectHeight, 736);

  // An anchor and a platform that are not square: no width stands in for a height.
  edit.anchorWidth = 20;
  edit.anchorHeight = 50;
  edit.platformWidth = 80;
  edit.platformHeight = 24;
  const Calls calls = Display(nullptr, edit, rect);
  ASSERT_GE(calls.size(), 5u);
  EXPECT_EQ(Calls(calls.begin() + 1, calls.begin() + 5),
            (Calls{"Rectangle editor 382 339 402 389 255 0 0 1", "DrawText editor \"(382,339)\" -1 382 339 422 439" + args,
                   "Rectangle editor 704 352 784 376 255 0 0 1",
                   "DrawText editor \"(744,364)\" -1 664 352 824 400" + args}));
}

TEST(EditorDisplay, TemplateSettingsSetTheRadiusAndTheSwing) {
  struct Case {
    const char* angle;
    const char* spacing;
    int32_t links;
    int16_t width, height;
    std::vector<std::string> labels;  // the anchor's, then the three platforms'
  };
  const Case cases[] = {
      {"30", "0", 10, 768, 736, {"(368,352)", "(560,672)", "(384,719)", "(208,672)"}},
      {"0", "0", 10, 768, 736, {"(368,352)", "(384,719)", "(384,719)", "(384,719)"}},
      {"45.9", "0", 10, 768, 736, {"(368,352)", "(632,616)", "(384,719)", "(135,616)"}},
      {"-30.7", "0", 10, 768, 736, {"(368,352)", "(208,672)", "(384,719)", "(560,672)"}},
      {"90", "2.9", 10, 812, 780, {"(390,374)", "(780,390)", "(406,763)", "(32,390)"}},
      {"90", "0", 0, 128, 96, {"(48,32)", "(96,48)", "(64,79)", "(32,48)"}},
      // Not a number: no swing and no spacing.
      {"abc", "x", 10, 768, 736, {"(368,352)", "(384,719)", "(384,719)", "(384,719)"}},
  };
  for (const Case& c : cases) {
    SCOPED_TRACE(std::string(c.angle) + " / " + c.spacing + " / " + std::to_string(c.links));
    EditData edit = Defaults(1);
    std::strcpy(edit.startAngleText, c.angle);
    std::strcpy(edit.linkSpacingText, c.spacing);
    edit.linkCount = c.links;
    RECT rect = Place(0, 0);
    EXPECT_EQ(Labels(Display(nullptr, edit, rect)), c.labels);
    EXPECT_EQ(edit.objectWidth, c.width);
    EXPECT_EQ(edit.objectHeight, c.height);
  }
}

}  // namespace
