// `paintTraces` beside the same picture from bare graphics calls, drawn by the real graphics interface.
#include <windows.h>

#include "bench/paint_traces_report.h"
#include "bench/paint_traces_scene.h"
#include "platform/win32/win32_gdi.h"

int main(int argc, char** argv) {
  using namespace frontpanels;
  BITMAPINFO info{};
  info.bmiHeader.biSize = sizeof info.bmiHeader;
  info.bmiHeader.biWidth = bench::kScenePx.width;
  info.bmiHeader.biHeight = -bench::kScenePx.height;
  info.bmiHeader.biPlanes = 1;
  info.bmiHeader.biBitCount = 32;
  void* bits = nullptr;
  HDC dc = CreateCompatibleDC(nullptr);
  HBITMAP bitmap = CreateDIBSection(dc, &info, DIB_RGB_COLORS, &bits, nullptr, 0);
  if (bitmap == nullptr) return 1;
  HGDIOBJ previous = SelectObject(dc, bitmap);
  const auto readPixels = [&] {
    GdiFlush();
    const auto* const first = static_cast<const std::uint32_t*>(bits);
    return std::vector<std::uint32_t>(first, first + bench::kScenePx.width * bench::kScenePx.height);
  };
  Win32Gdi gdi;
  const bool same = bench::reportPaintTraces(gdi, DcHandle{reinterpret_cast<std::uintptr_t>(dc)}, readPixels,
                                             bench::roundsFrom(argc, argv));
  SelectObject(dc, previous);
  DeleteObject(bitmap);
  DeleteDC(dc);
  return same ? 0 : 1;
}
