// The scenes that come with the player: the embedded demo, played to the end
// into a GIF that decodes to the picture of its last frame, the complete
// example of docs/scene-format.md, which plays as the text says, and the
// recipes of the author's guide, which play into the animations it shows.
#include <gtest/gtest.h>

#include <gif_lib.h>
#include <filesystem>
#include <memory>
#include <nlohmann/json.hpp>
#include <png.h>

#include "tool_run.h"

namespace {

using namespace tool_test;
using nlohmann::json;

struct GifCloser {
  void operator()(GifFileType* gif) const { DGifCloseFile(gif, nullptr); }
};

TEST(DemoSceneTest, PlaysToTheEndIntoAGifOfEveryFrameEndingOnThePngFrame) {
  Folder folder;
  const json scene = json::parse(RunPlayer({"--print-demo"}, folder).out);
  const ToolRun run = RunPlayer({"--png", "last.png"}, folder);
  EXPECT_EQ(run.status, 0);
  EXPECT_EQ(run.err, "");
  EXPECT_EQ(folder.Files(), (std::vector<std::string>{"demo.gif", "last.png"}));
  const int frames = scene["frames"].get<int>();

  int error = 0;
  std::unique_ptr<GifFileType, GifCloser> gif(DGifOpenFileName((folder / "demo.gif").c_str(), &error));
  ASSERT_NE(gif, nullptr) << GifErrorString(error);
  ASSERT_EQ(DGifSlurp(gif.get()), GIF_OK) << GifErrorString(gif->Error);
  const int width = scene["canvas"]["width"].get<int>();
  const int height = scene["canvas"]["height"].get<int>();
  EXPECT_EQ(gif->SWidth, width);
  EXPECT_EQ(gif->SHeight, height);
  ASSERT_EQ(gif->ImageCount, frames);
  ASSERT_NE(gif->SColorMap, nullptr);

  // Each frame redraws only what changed: lay them over each other, as a
  // viewer does, and the last must be the picture of the last frame.
  std::vector<GifByteType> canvas(static_cast<std::size_t>(width) * height, 0);
  for (int i = 0; i < gif->ImageCount; ++i) {
    const SavedImage& frame = gif->SavedImages[i];
    GraphicsControlBlock control{};
    ASSERT_EQ(DGifSavedExtensionToGCB(gif.get(), i, &control), GIF_OK);
    EXPECT_EQ(control.DelayTime, scene["frameDelay"].get<int>());
    const GifImageDesc& d = frame.ImageDesc;
    ASSERT_TRUE(d.Left >= 0 && d.Top >= 0 && d.Left + d.Width <= width && d.Top + d.Height <= height);
    for (int y = 0; y < d.Height; ++y) {
      std::copy_n(frame.RasterBits + static_cast<std::ptrdiff_t>(y) * d.Width, d.Width,
                  canvas.begin() + static_cast<std::ptrdiff_t>(d.Top + y) * width + d.Left);
    }
  }
  png_image image{};
  image.version = PNG_IMAGE_VERSION;
  ASSERT_TRUE(png_image_begin_read_from_file(&image, (folder / "last.png").c_str()));
  ASSERT_EQ(image.width * image.height, canvas.size());
  image.format = PNG_FORMAT_RGB;
  std::vector<uint8_t> png(PNG_IMAGE_SIZE(image));
  ASSERT_TRUE(png_image_finish_read(&image, nullptr, png.data(), 0, nullptr));
  std::size_t differing = 0;
  for (std::size_t p = 0; p < canvas.size(); ++p) {
    const GifColorType colour = gif->SColorMap->Colors[canvas[p]];
    differing += colour.Red != png[3 * p] || colour.Green != png[3 * p + 1] || colour.Blue != png[3 * p + 2];
  }
  EXPECT_EQ(differing, 0u);
}

TEST(DocumentedExampleTest, PlaysAndStopsWhenItsAnchorIsDestroyed) {
  const std::string doc = ReadFile(DOCS "/scene-format.md");
  const auto start = doc.find("```json\n", doc.find("## A complete example"));
  ASSERT_NE(start, std::string::npos);
  Folder folder;
  folder.Write("example.json", doc.substr(start + 8, doc.find("```", start + 8) - start - 8));
  const ToolRun run = RunPlayer({"example.json", "--trace", "example.jsonl"}, folder);
  ASSERT_EQ(run.status, 0) << run.err;
  EXPECT_EQ(folder.Files(), (std::vector<std::string>{"example.gif", "example.json", "example.jsonl"}));

  const std::vector<std::string> lines = Lines(ReadFile(folder / "example.jsonl"));
  ASSERT_EQ(lines.size(), 200u);
  EXPECT_EQ(json::parse(lines[159])["chains"].size(), 1u);
  // Destroyed at frame 160: the chain leaves with its anchor, and nothing moves after.
  const json atDestruction = json::parse(lines[160]);
  EXPECT_TRUE(atDestruction["chains"].empty());
  EXPECT_EQ(atDestruction["objects"].size(), 5u);
  EXPECT_EQ(json::parse(lines[199])["objects"], atDestruction["objects"]);
}

// Each recipe's scene plays, without a warning, into the animation that the
// guide shows, byte for byte; the animations stay small enough for a page.
TEST(RecipeScenesTest, PlayIntoTheAnimationsTheGuideShows) {
  const std::string guide = ReadFile(DOCS "/guide.md");
  std::uintmax_t bytes = 0;
  for (const auto& scene : std::filesystem::directory_iterator(DOCS "/recipes")) {
    if (scene.path().extension() != ".json") continue;
    const std::string gif = "recipes/" + scene.path().stem().string() + ".gif";
    Folder folder;
    const ToolRun run = RunPlayer({scene.path().string(), "--gif", "played.gif"}, folder);
    EXPECT_TRUE(run.status == 0 && run.err.empty()) << gif << ": " << run.err;
    EXPECT_TRUE(ReadFile(folder / "played.gif") == ReadFile(DOCS "/" + gif)) << gif << ": scripts/doc-pictures.sh";
    EXPECT_NE(guide.find("](" + gif + ")"), std::string::npos) << gif;
    bytes += std::filesystem::file_size(DOCS "/" + gif);
  }
  EXPECT_TRUE(bytes > 0 && bytes <= 300u * 1024) << bytes;
}

}  // namespace
