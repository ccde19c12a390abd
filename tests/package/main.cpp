// A stranger's program: one sweep on a spectrum panel in memory. Succeeds when the trace crosses the picture.
#include <cstdio>
#include <span>
#include <vector>

#include "framework/panel/headless.h"
#include "framework/support/host_codes.h"
#include "platform/raster/raster_gdi.h"
#include "spectrum/spectrum_view.h"

using namespace frontpanels;

namespace {

constexpr Size kPicturePx{800, 600};
constexpr Color kTraceColor = rgb(50, 156, 50);

int columnsWithTrace(const PixelView& picture) {
  int columns = 0;
  for (int x = 0; x < picture.sizePx.width; ++x) {
    int y = 0;
    while (y < picture.sizePx.height && picture.at(x, y) != kTraceColor) ++y;
    columns += y < picture.sizePx.height ? 1 : 0;
  }
  return columns;
}

}  // namespace

int main() {
  RasterGdi gdi;
  HeadlessView view(gdi.createScreen(kPicturePx), kPicturePx);
  HeadlessWindowing windowing;
  HeadlessOwner owner;
  DataHub hub;
  SpectrumView panel({gdi, windowing, view, hub, ScreenMetrics{}, ""}, owner, owner);
  panel.Form_Resize();
  panel.vfpOp(1, kAddTraceOperation, kAddTraceOperation);
  panel.vfpOp(1, kShowOperation, Variant());
  panel.Paint();
  const int before = columnsWithTrace(gdi.pixels(view.hdc()));
  std::vector<float> levelsDb(SpectrumView::kMaxPoints, -90.0F);
  levelsDb[256] = -20.0F;
  hub.publish(SpectrumView::kSpectrumPath, std::span<const float>(levelsDb));
  panel.Paint();
  const int after = columnsWithTrace(gdi.pixels(view.hdc()));
  std::printf("columns with a trace: %d, then %d\n", before, after);
  return before == 0 && after > kPicturePx.width / 2 ? 0 : 1;
}
