// The editor preview, run as the program it is: the picture it writes and
// its answer to bad input.
#include <cairo.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "tools/tool_run.h"

namespace {

using namespace tool_test;

TEST(EditorPreview, TemplatePictureHasTheRectanglesWhereTheyAreDrawn) {
  Folder folder;
  ASSERT_EQ(RunTool(EDITOR_PREVIEW, {"--view-template", "1", "template.png"}, folder).status, 0);
  cairo_surface_t* image = cairo_image_surface_create_from_png((folder / "template.png").c_str());
  ASSERT_EQ(cairo_surface_status(image), CAIRO_STATUS_SUCCESS);
  EXPECT_EQ(cairo_image_surface_get_width(image), 768 + 64);
  const auto pixel = [&](int x, int y) {
    const unsigned char* row = cairo_image_surface_get_data(image) + y * cairo_image_surface_get_stride(image);
    return reinterpret_cast<const uint32_t*>(row)[x] & 0xFFFFFFu;
  };
  constexpr uint32_t kRed = 0xFF0000, kWhite = 0xFFFFFF;
  const struct {
    int x, y;
    uint32_t colour;
  } points[] = {
      {368, 383, kRed},   {399, 370, kRed},    // the anchor's left-bottom corner and right edge
      {736, 352, kRed},   {767, 370, kRed},    // the platform at 0 degrees: top and right edges
      {352, 720, kRed},   {415, 734, kRed},    // hanging down: 703 to 734, the 719 of the sine
      {384, 735, kWhite}, {400, 728, kWhite},  // just below it, and inside it
      {0, 370, kRed},     {10, 10, kWhite},    // the platform at 180 degrees; empty editor
  };
  for (const auto& p : points) EXPECT_EQ(pixel(p.x, p.y), p.colour) << p.x << "," << p.y;
  cairo_surface_destroy(image);
}

TEST(EditorPreview, BadInputIsNamedAndLeavesTheOutputAlone) {
  Folder folder;
  folder.Write("short.bin", std::string(99, '\0'));
  folder.Write("saved.bin", std::string(100, '\0'));
  folder.Write("out.png", "old");
  const struct {
    std::vector<std::string> args;
    std::string message;
  } cases[] = {
      {{"--settings", "none.bin", "out.png"}, "cannot read settings file"},
      {{"--settings", "short.bin", "out.png"}, "holds 99 bytes, not 100"},
      {{"--link-height", "12a", "out.png"}, "--link-height 12a: not a whole number"},
      {{"--number-of-links", "2147483648", "out.png"}, "out of range"},
      {{"--view-template", "256", "out.png"}, "out of range 0 to 255"},
      {{"--starting-angle", "1234567890", "out.png"}, "at most 9 characters"},
      {{"--colour", "1", "out.png"}, "unknown option --colour"},
      {{"--settings", "saved.bin", "saved.bin"}, "this is --settings"},
      {{"out.png", "--left"}, "--left needs a value"},
      {{}, "no output file given"},
  };
  for (const auto& c : cases) {
    const ToolRun run = RunTool(EDITOR_PREVIEW, c.args, folder);
    EXPECT_EQ(run.status, 2) << c.message;
    EXPECT_NE(run.err.find(c.message), std::string::npos) << run.err;
    EXPECT_EQ(run.err.find('\n'), run.err.size() - 1) << run.err;
    EXPECT_EQ(ReadFile(folder / "out.png"), "old");
  }
}

}  // namespace
