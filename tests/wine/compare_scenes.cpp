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

class Recorded {
 public:
  explicit Recorded(const std::string& path) : file_(path, std::ios::binary) {}
  std::uint32_t word() {
    std::uint32_t value = 0;
    file_.read(reinterpret_cast<char*>(&value), sizeof(value));
    return value;
  }
  bool scene(std::vector<std::uint32_t>& pixels) {
    pixels.resize(kScenePixels);
    return static_cast<bool>(
        file_.read(reinterpret_cast<char*>(pixels.data()), static_cast<std::streamsize>(4 * kScenePixels)));
  }
  bool atEnd() { return file_.peek() == std::ifstream::traits_type::eof(); }

 private:
  std::ifstream file_;
};

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

bool agree(const Scene& scene, const PixelView& ours, const PixelView& theirs) {
  if (scene.text) {
    const Rect a = inkBox(ours);
    const Rect b = inkBox(theirs);
    if (sameWithinOnePixel(a, b)) return true;
    std::printf("%s: ink in [%d, %d, %d, %d), in memory in [%d, %d, %d, %d)\n", scene.name.c_str(), b.left,
                b.top, b.right, b.bottom, a.left, a.top, a.right, a.bottom);
    return false;
  }
  const int differing = differingPixels(ours, theirs);
  if (differing > 0) std::printf("%s: %d pixels differ\n", scene.name.c_str(), differing);
  return differing == 0;
}

int compare(const std::string& path, std::uint32_t rounds, const std::string& pictures) {
  Recorded recorded(path);
  RasterGdi gdi;
  for (const SystemColor color : kSceneSystemColors) gdi.setSysColor(color, Color{recorded.word()});
  int disagreements = 0;
  std::vector<std::uint32_t> pixels;
  const std::vector<Scene> scenes = gdiScenes(rounds);
  for (const Scene& scene : scenes) {
    if (!recorded.scene(pixels)) {
      std::fprintf(stderr, "\"%s\" ends before the scene \"%s\".\n", path.c_str(), scene.name.c_str());
      return 2;
    }
    const PixelView theirs{pixels.data(), kSceneSizePx.width, kSceneSizePx};
    const DcHandle screen = gdi.createScreen(kSceneSizePx);
    scene.draw(gdi, screen, scene.seed);
    if (!agree(scene, gdi.pixels(screen), theirs)) {
      ++disagreements;
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
  return disagreements == 0 && recorded.atEnd() ? 0 : 1;
}

}  // namespace
}  // namespace frontpanels::testing

int main(int argc, char** argv) {
  if (argc < 2) return std::fputs("usage: compare_scenes FILE [ROUNDS [DIR]]\n", stderr), 2;
  const auto rounds = static_cast<std::uint32_t>(argc > 2 ? std::atoi(argv[2]) : 4);
  return frontpanels::testing::compare(argv[1], rounds, argc > 3 ? argv[3] : "");
}
