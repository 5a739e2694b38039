// The embedded demo, played to the end: what it shows and the files it makes.
#include <gtest/gtest.h>

#include <gif_lib.h>
#include <memory>
#include <nlohmann/json.hpp>
#include <png.h>

#include "player_run.h"

namespace {

using namespace player_test;
using nlohmann::json;

class DemoSceneTest : public ::testing::Test {
 protected:
  // The demo is played once for all the tests here.
  static void SetUpTestSuite() {
    folder_ = new Folder;
    const PlayerRun printed = RunPlayer({"--print-demo"}, *folder_);
    scene_ = new json(json::parse(printed.out));
    run_ = new PlayerRun(RunPlayer({"--png", "last.png", "--trace", "demo.jsonl"}, *folder_));
  }
  static void TearDownTestSuite() {
    delete run_;
    delete scene_;
    delete folder_;
  }

  static int Frames() { return (*scene_)["frames"].get<int>(); }
  static std::vector<json> Trace() {
    std::vector<json> lines;
    for (const std::string& line : Lines(ReadFile(*folder_ / "demo.jsonl"))) lines.push_back(json::parse(line));
    return lines;
  }
  static const json* ObjectNamed(const json& line, const std::string& name) {
    for (const json& object : line["objects"]) {
      if (object["name"] == name) return &object;
    }
    return nullptr;
  }

  static Folder* folder_;
  static json* scene_;
  static PlayerRun* run_;
};

Folder* DemoSceneTest::folder_ = nullptr;
json* DemoSceneTest::scene_ = nullptr;
PlayerRun* DemoSceneTest::run_ = nullptr;

TEST_F(DemoSceneTest, PlaysToTheEndWithoutError) {
  EXPECT_EQ(run_->status, 0);
  EXPECT_EQ(run_->err, "");
  EXPECT_EQ(folder_->Files(), (std::vector<std::string>{"demo.gif", "demo.jsonl", "last.png"}));
  EXPECT_EQ(Trace().size(), static_cast<std::size_t>(Frames()));
}

TEST_F(DemoSceneTest, DestroysAChainAndRebuildsItAtTheEnd) {
  auto anchors = [](const json& line) {
    std::vector<std::string> names;
    for (const json& chain : line["chains"]) names.push_back(chain["anchor"].get<std::string>());
    return names;
  };
  const std::vector<json> trace = Trace();
  ASSERT_FALSE(trace.empty());
  const std::vector<std::string> built{"anchorA", "anchorB", "anchorC"};
  const std::vector<std::string> without{"anchorA", "anchorC"};
  const std::vector<std::string> rebuilt{"anchorA", "anchorC", "anchorB2"};
  EXPECT_EQ(anchors(trace.front()), built);
  EXPECT_EQ(anchors(trace.back()), rebuilt);
  bool sawWithout = false;
  for (const json& line : trace) sawWithout = sawWithout || anchors(line) == without;
  EXPECT_TRUE(sawWithout);
  for (const json& chain : trace.back()["chains"]) EXPECT_EQ(chain["swinging"], 1);
}

// The rider is moved only by "DeltaX(" and "DeltaY(" of chain 0, and stays
// where it was put on the platform: centred, 15 pixels above it.
TEST_F(DemoSceneTest, RiderRidesThePlatformOfChainZero) {
  for (const json& line : Trace()) {
    SCOPED_TRACE("frame " + line["frame"].dump());
    const json* rider = ObjectNamed(line, "rider");
    const json* platform = ObjectNamed(line, "platformA");
    ASSERT_TRUE(rider && platform);
    EXPECT_NEAR((*rider)["x"].get<int>(), (*platform)["x"].get<int>(), 1);
    EXPECT_NEAR((*rider)["y"].get<int>(), (*platform)["y"].get<int>() - 15, 1);
  }
}

struct GifCloser {
  void operator()(GifFileType* gif) const { DGifCloseFile(gif, nullptr); }
};

// The picture of a PNG file as RGB bytes.
std::vector<uint8_t> ReadPng(const std::string& path, int& width, int& height) {
  png_image image{};
  image.version = PNG_IMAGE_VERSION;
  if (!png_image_begin_read_from_file(&image, path.c_str())) return {};
  image.format = PNG_FORMAT_RGB;
  std::vector<uint8_t> pixels(PNG_IMAGE_SIZE(image));
  if (!png_image_finish_read(&image, nullptr, pixels.data(), 0, nullptr)) return {};
  width = static_cast<int>(image.width);
  height = static_cast<int>(image.height);
  return pixels;
}

TEST_F(DemoSceneTest, GifDecodesWithEveryFrameAndEndsOnThePngFrame) {
  int error = 0;
  std::unique_ptr<GifFileType, GifCloser> gif(DGifOpenFileName((*folder_ / "demo.gif").c_str(), &error));
  ASSERT_NE(gif, nullptr) << GifErrorString(error);
  ASSERT_EQ(DGifSlurp(gif.get()), GIF_OK) << GifErrorString(gif->Error);

  const int width = (*scene_)["canvas"]["width"].get<int>();
  const int height = (*scene_)["canvas"]["height"].get<int>();
  EXPECT_EQ(gif->SWidth, width);
  EXPECT_EQ(gif->SHeight, height);
  ASSERT_EQ(gif->ImageCount, Frames());
  ASSERT_NE(gif->SColorMap, nullptr);

  // Each frame redraws only what changed: lay them over each other, as a
  // viewer does, and the last must be the picture of the last frame.
  std::vector<GifByteType> canvas(static_cast<std::size_t>(width) * height, 0);
  for (int i = 0; i < gif->ImageCount; ++i) {
    const SavedImage& frame = gif->SavedImages[i];
    GraphicsControlBlock control{};
    ASSERT_EQ(DGifSavedExtensionToGCB(gif.get(), i, &control), GIF_OK);
    EXPECT_EQ(control.DelayTime, (*scene_)["frameDelay"].get<int>());
    const GifImageDesc& d = frame.ImageDesc;
    ASSERT_TRUE(d.Left >= 0 && d.Top >= 0 && d.Left + d.Width <= width && d.Top + d.Height <= height);
    for (int y = 0; y < d.Height; ++y) {
      std::copy_n(frame.RasterBits + static_cast<std::ptrdiff_t>(y) * d.Width, d.Width,
                  canvas.begin() + static_cast<std::ptrdiff_t>(d.Top + y) * width + d.Left);
    }
  }
  int pngWidth = 0, pngHeight = 0;
  const std::vector<uint8_t> png = ReadPng(*folder_ / "last.png", pngWidth, pngHeight);
  ASSERT_EQ(pngWidth, width);
  ASSERT_EQ(pngHeight, height);
  std::size_t differing = 0;
  for (std::size_t p = 0; p < canvas.size(); ++p) {
    const GifColorType colour = gif->SColorMap->Colors[canvas[p]];
    differing += colour.Red != png[3 * p] || colour.Green != png[3 * p + 1] || colour.Blue != png[3 * p + 2];
  }
  EXPECT_EQ(differing, 0u);
}

}  // namespace
