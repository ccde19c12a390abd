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

constexpr std::size_t kSceneBytes = std::size_t{4} * kSceneSizePx.width * kSceneSizePx.height;

bool writeScenes(std::FILE* file, std::uint32_t rounds) {
  BITMAPINFO info{};
  info.bmiHeader = {sizeof(info.bmiHeader),
                    kSceneSizePx.width,
                    -kSceneSizePx.height,  // rows from the top
                    1,
                    32,
                    BI_RGB,
                    0,
                    0,
                    0,
                    0,
                    0};
  void* pixels = nullptr;
  const HDC dc = CreateCompatibleDC(nullptr);
  const HBITMAP bitmap = CreateDIBSection(dc, &info, DIB_RGB_COLORS, &pixels, nullptr, 0);
  if (bitmap == nullptr) return false;
  const HGDIOBJ before = SelectObject(dc, bitmap);
  Win32Gdi gdi;
  bool written = true;
  for (const SystemColor color : kSceneSystemColors) {
    const Color value = gdi.sysColor(color);
    written = written && std::fwrite(&value.bgr, sizeof(value.bgr), 1, file) == 1;
  }
  for (const Scene& scene : gdiScenes(rounds)) {
    std::memset(pixels, 0, kSceneBytes);
    SaveDC(dc);  // every scene begins with the state of a new device context
    scene.draw(gdi, DcHandle{reinterpret_cast<std::uintptr_t>(dc)}, scene.seed);
    RestoreDC(dc, -1);
    GdiFlush();
    written = written && std::fwrite(pixels, 1, kSceneBytes, file) == kSceneBytes;
  }
  SelectObject(dc, before);
  DeleteObject(bitmap);
  DeleteDC(dc);
  return written;
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
