#include "bench/paint_traces_scene.h"

#include <cmath>
#include <random>

namespace frontpanels::bench {
namespace {

constexpr ScreenMetrics kMetrics{};
constexpr double kTopDbm = -20;
constexpr double kDbPerDivision = 10;
constexpr std::int32_t kDivisions = 10;
constexpr std::int16_t kMarkers = 4;
constexpr std::int16_t kResultType = 25;

}  // namespace

PaintTracesScene::PaintTracesScene(Gdi& gdi, DcHandle view, SceneSize size)
    : gdi_(gdi),
      form_(view),
      fonts_(gdi_, kMetrics, true),
      manager_({gdi_, windowing_, kMetrics, fonts_.handles(), true}),
      painter_(std::make_shared<clsMultiTracePainter>(gdi_)) {
  manager_.setForm(&form_);
  manager_.drawingArea(0, 0, form_.ViewScaleWidth(), form_.ViewScaleHeight());
  manager_.setShadowDC();
  manager_.addTraceObject(painter_, kResultType);
  makeFrames(size);
  setUp(size);
  gdi_.start();
  paint(0);
  gdi_.stop();
}

// A noise floor with a few carriers, other noise in each frame.
void PaintTracesScene::makeFrames(SceneSize size) {
  std::mt19937 random(1);
  std::normal_distribution<float> noise(-95.0F, 3.0F);
  frames_.resize(kFrames);
  for (std::vector<Variant>& frame : frames_) {
    for (std::int16_t trace = 0; trace < size.traces; ++trace) {
      std::vector<float> values(static_cast<std::size_t>(size.points));
      for (std::size_t i = 0; i < values.size(); ++i) {
        values[i] = noise(random);
        if (i % 97 == 0) values[i] += 45.0F;
      }
      frame.emplace_back(Variant::Singles(std::move(values)));
    }
  }
  for (const std::vector<Variant>& frame : frames_) {
    std::vector<std::span<const float>>& spans = values_.emplace_back();
    for (const Variant& trace : frame) spans.emplace_back(std::get<Variant::Singles>(trace.value()));
  }
}

void PaintTracesScene::setUp(SceneSize size) {
  for (std::int16_t trace = 0; trace < size.traces; ++trace)
    painter_->addNewTraceAtEnd(trace, 0, size.points - 1, trace);
  painter_->numberOfMeasurements(size.points);
  painter_->yAxisFormatter().dBmSuffix();
  painter_->yAxisFormatter().suppressSuffix(true);
  painter_->xAxisFormatter().frequencySuffix();
  painter_->gridScaleTop(kTopDbm);
  painter_->verticalResolution(kDbPerDivision);
  painter_->xStart(88e6);
  painter_->xStop(108e6);
  painter_->xAxisStyle(1);
  painter_->updateXAxisLabels();
  for (std::int16_t i = 0; i < kMarkers; ++i) {
    const auto marker = std::make_shared<clsMarker>();
    marker->id = std::to_string(i + 1);
    marker->point = size.points * (i + 1) / (kMarkers + 1);
    painter_->addMarkerToTrace(marker, 0);
  }
  const double plotLeft = painter_->gridScaleLeft();
  const double plotTop = painter_->gridInsetTop();
  const double plotWidth = kScenePx.width - plotLeft - static_cast<double>(painter_->gridScaleRight());
  const double plotHeight = kScenePx.height - plotTop - static_cast<double>(painter_->gridScaleBottom());
  const double range = kDbPerDivision * kDivisions;
  mapping_.leftPx = plotLeft;
  mapping_.stepPx = plotWidth / (size.points - 2);
  mapping_.pxPerUnit = plotHeight / range;
  mapping_.originPx = plotTop + plotHeight + plotHeight * (kTopDbm - range) / range;
}

void PaintTracesScene::paint(std::size_t frame) {
  for (std::size_t trace = 0; trace < frames_[frame].size(); ++trace)
    painter_->trace(static_cast<std::int16_t>(trace), frames_[frame][trace]);
  painter_->dataChanged(true);
  manager_.paintTraces(true);
}

void PaintTracesScene::paintBare(std::size_t frame) { gdi_.draw(values_[frame], mapping_); }

void PaintTracesScene::drawPanel() { paint(++panelFrame_ % kFrames); }
void PaintTracesScene::drawBare() { paintBare(++bareFrame_ % kFrames); }
void PaintTracesScene::drawPanelAgain() { paint(0); }
void PaintTracesScene::drawBareAgain() { paintBare(0); }

}  // namespace frontpanels::bench
