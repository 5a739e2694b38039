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
      {{"--settings", ".", "out.png"}, "cannot read settings file .: Is a directory"},
      {{"--settings", "/dev/zero", "out.png"}, "settings file /dev/zero holds more than 100 bytes"},
      {{"--left", "1", "--left=2", "out.png"}, "--left given twice (1, then 2)"},
      {{"--version=1"}, "--version takes no value"},
      {{"--explain", "--window-width", "9", "out.png"}, "--explain sizes its picture"},
      {{"--save-settings", "./out.png", "out.png"}, "--save-settings ./out.png: also written by the output"},
  };
  for (const auto& c : cases) {
    const ToolRun run = RunTool(EDITOR_PREVIEW, c.args, folder);
    EXPECT_EQ(run.status, 2) << c.message;
    EXPECT_EQ(run.out, "");
    EXPECT_NE(run.err.find(c.message), std::string::npos) << run.err;
    EXPECT_EQ(run.err.find('\n'), run.err.size() - 1) << run.err;
    EXPECT_EQ(ReadFile(folder / "out.png"), "old");
  }
}

// Settings no author means are drawn all the same, each said once.
TEST(EditorPreview, WarnsOfNonsenseSizesOnceAndDraws) {
  Folder folder;
  const struct {
    std::vector<std::string> args;
    std::vector<std::string> warnings;  // what each line says after "editor_preview: warning: "
  } cases[] = {
      {{"--view-template", "1", "--number-of-links", "-2", "--anchor-width", "-4"},
       {"the number of links is -2, less than 0", "the anchor width is -4, less than 0",
        "the object comes out 0 x -32 pixels"}},
      {{"--view-template", "1", "--number-of-links", "1000"}, {"the object would be 64128 x 64096 pixels, beyond what its stored 16-bit"}},
      {{"--view-template", "7"}, {"view-template is 7: the frame editor draws nothing for it"}},
  };
  for (const auto& c : cases) {
    std::vector<std::string> args = c.args;
    args.insert(args.end(), {"--explain", "out.png"});
    const ToolRun run = RunTool(EDITOR_PREVIEW, args, folder);
    EXPECT_EQ(run.status, 0) << run.err;
    const std::vector<std::string> lines = Lines(run.err);
    ASSERT_EQ(lines.size(), c.warnings.size()) << run.err;
    for (std::size_t i = 0; i < lines.size(); ++i) {
      EXPECT_EQ(lines[i].rfind("editor_preview: warning: " + c.warnings[i], 0), 0u) << lines[i];
    }
  }
}

// An object larger than a picture is scaled down to fit, in both views,
// never cut to a blank picture.
TEST(EditorPreview, LargeObjectIsScaledDownToFit) {
  Folder folder;
  for (const bool explain : {false, true}) {
    std::vector<std::string> args = {"--view-template=1", "--number-of-links", "200", "big.png"};
    if (explain) args.push_back("--explain");
    const ToolRun run = RunTool(EDITOR_PREVIEW, args, folder);
    EXPECT_NE(run.out.find("drawn at 1/4 of its size"), std::string::npos) << run.out << run.err;
    cairo_surface_t* image = cairo_image_surface_create_from_png((folder / "big.png").c_str());
    const int width = cairo_image_surface_get_width(image), height = cairo_image_surface_get_height(image);
    EXPECT_TRUE(width > 1024 && width <= 4096 && height > 1024 && height <= 4096) << width << "x" << height;
    int red = 0;
    for (int y = 0; y < height; ++y) {
      const auto* row = reinterpret_cast<const uint32_t*>(cairo_image_surface_get_data(image) +
                                                           y * cairo_image_surface_get_stride(image));
      for (int x = 0; x < width; ++x) red += (row[x] & 0xFFFFFFu) == 0xFF0000u;
    }
    EXPECT_GT(red, 50) << explain;  // the four outlines of the library's drawing
    cairo_surface_destroy(image);
  }
}

// The record written for given options shows as those options do.
TEST(EditorPreview, SavedSettingsDrawAsTheirOptions) {
  Folder folder;
  const std::vector<std::string> options = {"--view-template", "1", "--number-of-links", "4", "--starting-angle", "30"};
  std::vector<std::string> args = options;
  args.insert(args.end(), {"--save-settings", "s.bin", "given.png"});
  ASSERT_EQ(RunTool(EDITOR_PREVIEW, args, folder).status, 0);
  const ToolRun run = RunTool(EDITOR_PREVIEW, {"--settings", "-", "saved.png"}, folder, "s.bin");
  ASSERT_EQ(run.status, 0) << run.err;
  EXPECT_EQ(ReadFile(folder / "saved.png"), ReadFile(folder / "given.png"));
  const std::string record = ReadFile(folder / "s.bin");
  ASSERT_EQ(record.size(), 100u);
  EXPECT_EQ(static_cast<uint8_t>(record[24]) | static_cast<uint8_t>(record[25]) << 8, 64 + 2 * 160);  // the object's width
}

}  // namespace
