#include "bench/bar_chart_scene.h"

#include <random>

namespace frontpanels::bench {
namespace {

constexpr ScreenMetrics kMetrics{};
constexpr std::int16_t kResultType = 208;
constexpr std::int32_t kBars = 40;
constexpr std::int32_t kElements = 6;

class Names final : public CellNames {
 public:
  [[nodiscard]] std::string_view GetCellName(double id1, double /*id2*/) const noexcept override {
    return id1 < 250 ? "Station Road West 1" : "Quay";
  }
};

}  // namespace

BarChartScene::BarChartScene(Gdi& gdi, DcHandle view, std::int16_t style)
    : gdi_(gdi),
      form_(view),
      fonts_(gdi_, kMetrics, true),
      manager_({gdi_, windowing_, kMetrics, fonts_.handles(), true}),
      painter_(std::make_shared<clsBarChartPainter>(gdi_)) {
  manager_.setForm(&form_);
  manager_.drawingArea(0, 0, form_.ViewScaleWidth(), form_.ViewScaleHeight());
  manager_.setShadowDC();
  manager_.addTraceObject(painter_, kResultType);
  makeFrames();
  setUp(style);
  paint(0);
  gdi_.start();
  paint(0);
  gdi_.stop();
}

// Pilots come in another order each time and a few levels apart, so every frame sorts, measures and places.
void BarChartScene::makeFrames() {
  std::mt19937 random(1);
  std::normal_distribution<float> noise(0.0F, 0.5F);
  frames_.resize(kFrames);
  for (std::size_t frame = 0; frame < kFrames; ++frame) {
    for (std::int32_t i = 0; i < kBars; ++i) {
      const auto pilot = static_cast<float>((static_cast<std::size_t>(i) + frame * 7) % kBars);
      const float peak = -3.0F - pilot * 0.6F + noise(random);
      frames_[frame].insert(frames_[frame].end(),
                            {pilot * 12 + 4, peak, pilot * 1.5F, peak + 1, pilot / 4, 1.0F});
    }
  }
}

void BarChartScene::setUp(std::int16_t style) {
  painter_->BarChartStyle(style);
  painter_->setBarsToPaint(clsBarChartPainter::kAllBars);
  painter_->setDbPerDivision(3);
  painter_->suffixIs(1);
  painter_->valueIs(1);
  painter_->otherIs(2);
  painter_->ShowCellName(true);
  painter_->CellNameInfo(std::make_shared<Names>());
  painter_->threshold(-15.0);
  painter_->topLabel("Top N");
}

void BarChartScene::paint(std::size_t frame) {
  painter_->numberOfMeasurements(kBars);
  painter_->dataChanged(true);
  painter_->trace(std::span<const float>(frames_[frame]));
  painter_->elementsPerValue(kElements);
  painter_->offset(-60.0);
  manager_.paintTraces(true);
}

}  // namespace frontpanels::bench
