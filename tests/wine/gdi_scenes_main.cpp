// Draws the scenes with the real graphics interface and writes system colours and pixels to a file, for
// compare_scenes to look at.  gdi_scenes FILE [ROUNDS]
#include <windows.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>

#include "platform/win32/win32_gdi.h"
#include "tests/wine/gdi_scenes.h"

namespace frontpanels::testing {
namespace {

struct Canvas {
  HDC dc = CreateCompatibleDC(nullptr);
  HBITMAP bitmap = nullptr;
  HGDIOBJ before = nullptr;
  void* pixels = nullptr;

  Canvas() {
    BITMAPINFO info{};
    info.bmiHeader.biSize = sizeof(info.bmiHeader);
    info.bmiHeader.biWidth = kSceneSizePx.width;
    info.bmiHeader.biHeight = -kSceneSizePx.height;  // rows from the top
    info.bmiHeader.biPlanes = 1;
    info.bmiHeader.biBitCount = 32;
    bitmap = CreateDIBSection(dc, &info, DIB_RGB_COLORS, &pixels, nullptr, 0);
    before = SelectObject(dc, bitmap);
  }
  ~Canvas() {
    SelectObject(dc, before);
    DeleteObject(bitmap);
    DeleteDC(dc);
  }
  Canvas(const Canvas&) = delete;
  Canvas& operator=(const Canvas&) = delete;
};

constexpr std::size_t kSceneBytes = std::size_t{4} * kSceneSizePx.width * kSceneSizePx.height;

bool writeScenes(std::FILE* file, std::uint32_t rounds) {
  Win32Gdi gdi;
  for (const SystemColor color : kSceneSystemColors) {
    const Color value = gdi.sysColor(color);
    if (std::fwrite(&value.bgr, sizeof(value.bgr), 1, file) != 1) return false;
  }
  for (const Scene& scene : gdiScenes(rounds)) {
    const Canvas canvas;
    if (canvas.pixels == nullptr) return false;
    std::memset(canvas.pixels, 0, kSceneBytes);
    scene.draw(gdi, DcHandle{reinterpret_cast<std::uintptr_t>(canvas.dc)}, scene.seed);
    GdiFlush();
    if (std::fwrite(canvas.pixels, 1, kSceneBytes, file) != kSceneBytes) return false;
  }
  return true;
}

}  // namespace
}  // namespace frontpanels::testing

int main(int argc, char** argv) {
  if (argc < 2) return std::fputs("usage: gdi_scenes FILE [ROUNDS]\n", stderr), 2;
  std::FILE* file = std::fopen(argv[1], "wb");
  if (file == nullptr) return std::fprintf(stderr, "\"%s\" cannot be opened for writing.\n", argv[1]), 1;
  const auto rounds = static_cast<std::uint32_t>(argc > 2 ? std::atoi(argv[2]) : 4);
  const bool written = frontpanels::testing::writeScenes(file, rounds);
  const bool closed = std::fclose(file) == 0;
  if (!written || !closed) return std::fputs("The scenes could not be drawn or written.\n", stderr), 1;
  return 0;
}
