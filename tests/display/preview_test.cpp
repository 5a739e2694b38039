// The editor preview, run as the program it is: the picture it writes and
// its answer to bad input.
#include <cairo.h>
#include <gtest/gtest.h>
#include <sys/wait.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>
#include <vector>

namespace {

namespace fs = std::filesystem;

std::string ReadFile(const fs::path& path) {
  std::ifstream file(path, std::ios::binary);
  std::ostringstream text;
  text << file.rdbuf();
  return text.str();
}

struct ToolRun {
  int status = -1;
  std::string err;
};

class PreviewTest : public ::testing::Test {
 protected:
  void SetUp() override {
    std::string pattern = (fs::temp_directory_path() / "editor_preview_test.XXXXXX").string();
    ASSERT_NE(mkdtemp(pattern.data()), nullptr);
    folder_ = pattern;
  }
  void TearDown() override { fs::remove_all(folder_); }

  ToolRun Preview(const std::vector<std::string>& args) {
    std::string command = "exec '" EDITOR_PREVIEW "'";
    for (const std::string& arg : args) command += " '" + arg + "'";
    command += " 2>'" + (folder_ / "err").string() + "'";
    const int status = std::system(command.c_str());
    ToolRun run;
    if (status != -1 && WIFEXITED(status)) run.status = WEXITSTATUS(status);
    run.err = ReadFile(folder_ / "err");
    return run;
  }

  fs::path folder_;
};

TEST_F(PreviewTest, TemplatePictureHasTheRectanglesWhereTheyAreDrawn) {
  const fs::path png = folder_ / "template.png";
  ASSERT_EQ(Preview({"--view-template", "1", png.string()}).status, 0);
  cairo_surface_t* image = cairo_image_surface_create_from_png(png.c_str());
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

TEST_F(PreviewTest, BadInputIsNamedAndLeavesTheOutputAlone) {
  std::ofstream(folder_ / "short.bin", std::ios::binary) << std::string(99, '\0');
  const std::string saved = (folder_ / "saved.bin").string();
  std::ofstream(saved, std::ios::binary) << std::string(100, '\0');
  const std::string out = (folder_ / "out.png").string();
  std::ofstream(out) << "old";
  const struct {
    std::vector<std::string> args;
    std::string message;
  } cases[] = {
      {{"--settings", (folder_ / "none.bin").string(), out}, "cannot read settings file"},
      {{"--settings", (folder_ / "short.bin").string(), out}, "holds 99 bytes, not 100"},
      {{"--link-height", "12a", out}, "--link-height 12a: not a whole number"},
      {{"--number-of-links", "2147483648", out}, "out of range"},
      {{"--view-template", "256", out}, "out of range 0 to 255"},
      {{"--starting-angle", "1234567890", out}, "at most 9 characters"},
      {{"--colour", "1", out}, "unknown option --colour"},
      {{"--settings", saved, saved}, "this is --settings"},
      {{out, "--left"}, "--left needs a value"},
      {{}, "no output file given"},
  };
  for (const auto& c : cases) {
    const ToolRun run = Preview(c.args);
    EXPECT_EQ(run.status, 2) << c.message;
    EXPECT_NE(run.err.find(c.message), std::string::npos) << run.err;
    EXPECT_EQ(run.err.find('\n'), run.err.size() - 1) << run.err;
    EXPECT_EQ(ReadFile(out), "old");
  }
}

}  // namespace
