// `paintTraces` beside the same picture from bare graphics calls, drawn in memory.
#include "bench/paint_traces_report.h"
#include "bench/paint_traces_scene.h"
#include "platform/raster/raster_gdi.h"

int main(int argc, char** argv) {
  using namespace frontpanels;
  RasterGdi gdi;
  const DcHandle view = gdi.createScreen(bench::kScenePx);
  const auto readPixels = [&] {
    const PixelView pixels = gdi.pixels(view);
    std::vector<std::uint32_t> copy;
    for (std::int32_t y = 0; y < bench::kScenePx.height; ++y) {
      const std::uint32_t* const row = pixels.row(y);
      copy.insert(copy.end(), row, row + bench::kScenePx.width);
    }
    return copy;
  };
  return bench::reportPaintTraces(gdi, view, readPixels, bench::roundsFrom(argc, argv)) ? 0 : 1;
}
