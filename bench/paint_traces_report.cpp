#include "bench/paint_traces_report.h"

#include <algorithm>
#include <chrono>
#include <cstdio>

#include "bench/allocation_count.h"
#include "bench/paint_traces_scene.h"

namespace frontpanels::bench {
namespace {

// Short stretches in turn: what else the machine does falls on both alike.
constexpr int kFramesARound = 10;

template <class Draw>
double microsecondsAFrame(Draw draw) {
  const auto start = std::chrono::steady_clock::now();
  for (int frame = 0; frame < kFramesARound; ++frame) draw();
  const std::chrono::duration<double, std::micro> taken = std::chrono::steady_clock::now() - start;
  return taken.count() / kFramesARound;
}

double median(std::vector<double> values) {
  std::nth_element(values.begin(), values.begin() + values.size() / 2, values.end());
  return values[values.size() / 2];
}

bool samePicture(PaintTracesScene& scene, const ReadPixels& readPixels) {
  scene.drawPanelAgain();
  const std::vector<std::uint32_t> panel = readPixels();
  scene.drawBareAgain();
  return panel == readPixels();
}

}  // namespace

bool reportPaintTraces(Gdi& gdi, DcHandle view, const ReadPixels& readPixels, int rounds) {
  bool same = true;
  std::printf("%-10s %12s %12s %8s %12s\n", "T x P", "panel, us", "bare, us", "ratio", "allocations");
  for (const SceneSize& size : kSceneSizes) {
    PaintTracesScene scene(gdi, view, size);
    if (!samePicture(scene, readPixels)) {
      std::printf("%d x %d: the panel and the bare calls draw different pictures\n", size.traces,
                  size.points);
      same = false;
    }
    std::vector<double> panel;
    std::vector<double> bare;
    std::vector<double> ratio;
    std::uint64_t allocations = 0;
    for (int round = 0; round < rounds; ++round) {
      const std::uint64_t before = allocationCount();
      panel.push_back(microsecondsAFrame([&] { scene.drawPanel(); }));
      allocations = allocationCount() - before;
      bare.push_back(microsecondsAFrame([&] { scene.drawBare(); }));
      ratio.push_back(panel.back() / bare.back());
    }
    std::printf("%d x %-6d %12.1f %12.1f %8.3f %12.2f\n", size.traces, size.points, median(panel),
                median(bare), median(ratio), static_cast<double>(allocations) / kFramesARound);
  }
  return same;
}

}  // namespace frontpanels::bench
