// A bar chart of 40 bars, each with its key, two quantities and a name where there is room, from the new
// values to the finished copy, beside the same picture as bare graphics calls.
#pragma once

#include <cstdint>
#include <memory>
#include <vector>

#include "bench/bench_scene.h"
#include "bench/captured_picture.h"
#include "bench/paint_traces_scene.h"
#include "painters/bar_chart_painter.h"

namespace frontpanels::bench {

class BarChartScene final : public BenchScene {
 public:
  BarChartScene(Gdi& gdi, DcHandle view, std::int16_t style);

  [[nodiscard]] std::string name() const override {
    return painter_->BarChartStyle() == 0 ? "bars up" : "bars along";
  }
  void drawFramework() override { paint(++frame_ % kFrames); }
  void drawBare() override { gdi_.draw({}, {}); }
  void drawFrameworkAgain() override { paint(0); }
  void drawBareAgain() override { drawBare(); }

 private:
  static constexpr std::size_t kFrames = 8;

  void setUp(std::int16_t style);
  void makeFrames();
  void paint(std::size_t frame);

  CapturingGdi gdi_;
  BenchForm form_;
  NoWindowing windowing_;
  LabelFontSet fonts_;
  clsTraceManager manager_;
  std::shared_ptr<clsBarChartPainter> painter_;
  std::vector<std::vector<float>> frames_;
  std::size_t frame_ = 0;
};

}  // namespace frontpanels::bench
