#include "bench/paint_traces_report.h"

#include <algorithm>
#include <array>
#include <chrono>
#include <cstdio>

#include "bench/allocation_count.h"
#include "bench/bar_chart_scene.h"
#include "bench/paint_traces_scene.h"
#include "bench/spectrum_panel_scene.h"

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

bool samePicture(BenchScene& scene, const ReadPixels& readPixels) {
  scene.drawFrameworkAgain();
  const std::vector<std::uint32_t> panel = readPixels();
  scene.drawBareAgain();
  return panel == readPixels();
}

bool report(BenchScene& scene, const ReadPixels& readPixels, int rounds) {
  const bool same = samePicture(scene, readPixels);
  if (!same)
    std::printf("%s: the framework and the bare calls draw different pictures\n", scene.name().c_str());
  std::vector<double> framework;
  std::vector<double> bare;
  std::vector<double> ratio;
  std::uint64_t allocations = 0;
  for (int round = 0; round < rounds; ++round) {
    const std::uint64_t before = allocationCount();
    framework.push_back(microsecondsAFrame([&] { scene.drawFramework(); }));
    allocations = allocationCount() - before;
    bare.push_back(microsecondsAFrame([&] { scene.drawBare(); }));
    ratio.push_back(framework.back() / bare.back());
  }
  std::printf("%-10s %12.1f %12.1f %8.3f %12.2f\n", scene.name().c_str(), median(framework), median(bare),
              median(ratio), static_cast<double>(allocations) / kFramesARound);
  return same;
}

}  // namespace

bool reportPaintTraces(Gdi& gdi, DcHandle view, const ReadPixels& readPixels, int rounds) {
  bool same = true;
  std::printf("%-10s %12s %12s %8s %12s\n", "scene", "drawn, us", "bare, us", "ratio", "allocations");
  for (const SceneSize& size : kSceneSizes) {
    PaintTracesScene scene(gdi, view, size);
    same = report(scene, readPixels, rounds) && same;
  }
  for (const std::int16_t style : std::array<std::int16_t, 2>{0, 1}) {
    BarChartScene chart(gdi, view, style);
    same = report(chart, readPixels, rounds) && same;
  }
  SpectrumPanelScene panel(gdi, view);
  return report(panel, readPixels, rounds) && same;
}

}  // namespace frontpanels::bench
