// Draws the scenes in memory and compares them with what gdi_scenes wrote: pixel by pixel, texts by the box
// of their ink within one pixel.  compare_scenes FILE [ROUNDS [DIR]]; DIR receives pictures of scenes that
// differ.
#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <iterator>
#include <string>

#include "platform/raster/png.h"
#include "platform/raster/raster_gdi.h"
#include "tests/wine/gdi_scenes.h"

namespace frontpanels::testing {
namespace {

constexpr std::size_t kScenePixels = static_cast<std::size_t>(kSceneSizePx.width) * kSceneSizePx.height;

// The system colours and, scene by scene, the pixels.
std::vector<std::uint32_t> recordedWords(const std::string& path) {
  std::ifstream file(path, std::ios::binary);
  std::vector<std::uint32_t> words;
  for (std::uint32_t word = 0; file.read(reinterpret_cast<char*>(&word), sizeof(word));)
    words.push_back(word);
  return words;
}

std::uint32_t colorBits(std::uint32_t pixel) { return pixel & 0xFFFFFF; }

int differingPixels(const PixelView& a, const PixelView& b) {
  int count = 0;
  for (std::int32_t y = 0; y < kSceneSizePx.height; ++y) {
    for (std::int32_t x = 0; x < kSceneSizePx.width; ++x)
      count += colorBits(a.row(y)[x]) != colorBits(b.row(y)[x]);
  }
  return count;
}

// The box of what is not black.
Rect inkBox(const PixelView& view) {
  Rect box{kSceneSizePx.width, kSceneSizePx.height, 0, 0};
  for (std::int32_t y = 0; y < kSceneSizePx.height; ++y) {
    for (std::int32_t x = 0; x < kSceneSizePx.width; ++x) {
      if (colorBits(view.row(y)[x]) == 0) continue;
      box = {std::min(box.left, x), std::min(box.top, y), std::max(box.right, x + 1),
             std::max(box.bottom, y + 1)};
    }
  }
  return box;
}

bool sameWithinOnePixel(const Rect& a, const Rect& b) {
  return std::abs(a.left - b.left) <= 1 && std::abs(a.top - b.top) <= 1 && std::abs(a.right - b.right) <= 1 &&
         std::abs(a.bottom - b.bottom) <= 1 && !a.empty();
}

std::string printed(const Rect& r) {
  return "[" + std::to_string(r.left) + ", " + std::to_string(r.top) + ", " + std::to_string(r.right) + ", " +
         std::to_string(r.bottom) + ")";
}

// In words, where the two differ; empty where they do not.
std::string difference(const Scene& scene, const PixelView& ours, const PixelView& theirs) {
  if (scene.text) {
    const Rect a = inkBox(ours);
    const Rect b = inkBox(theirs);
    return sameWithinOnePixel(a, b) ? "" : "ink in " + printed(b) + ", in memory in " + printed(a);
  }
  const int differing = differingPixels(ours, theirs);
  return differing == 0 ? "" : std::to_string(differing) + " pixels differ";
}

int compare(const std::string& path, std::uint32_t rounds, const std::string& pictures) {
  const std::vector<std::uint32_t> words = recordedWords(path);
  const std::vector<Scene> scenes = gdiScenes(rounds);
  if (words.size() != std::size(kSceneSystemColors) + scenes.size() * kScenePixels)
    return std::fprintf(stderr, "\"%s\" does not hold these scenes.\n", path.c_str()), 2;
  RasterGdi gdi;
  const std::uint32_t* at = words.data();
  for (const SystemColor color : kSceneSystemColors) gdi.setSysColor(color, Color{*at++});
  int disagreements = 0;
  for (const Scene& scene : scenes) {
    const PixelView theirs{at, kSceneSizePx.width, kSceneSizePx};
    at += kScenePixels;
    const DcHandle screen = gdi.createScreen(kSceneSizePx);
    scene.draw(gdi, screen, scene.seed);
    if (const std::string what = difference(scene, gdi.pixels(screen), theirs); !what.empty()) {
      ++disagreements;
      std::printf("%s: %s\n", scene.name.c_str(), what.c_str());
      std::string error;
      if (!pictures.empty() &&
          (!writePng(pictures + "/" + scene.name + " memory.png", gdi.pixels(screen), error) ||
           !writePng(pictures + "/" + scene.name + " real.png", theirs, error))) {
        std::fprintf(stderr, "%s\n", error.c_str());
      }
    }
    gdi.deleteDC(screen);
  }
  std::printf("%zu scenes compared, %d differ\n", scenes.size(), disagreements);
  return disagreements == 0 ? 0 : 1;
}

}  // namespace
}  // namespace frontpanels::testing

int main(int argc, char** argv) {
  if (argc < 2) return std::fputs("usage: compare_scenes FILE [ROUNDS [DIR]]\n", stderr), 2;
  const auto rounds = static_cast<std::uint32_t>(argc > 2 ? std::atoi(argv[2]) : 4);
  return frontpanels::testing::compare(argv[1], rounds, argc > 3 ? argv[3] : "");
}
