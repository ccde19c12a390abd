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
    : size_(size),
      gdi_(gdi),
      form_(view),
      fonts_(gdi_, kMetrics, true),
      manager_({gdi_, windowing_, kMetrics, fonts_.handles(), true}),
      painter_(std::make_shared<clsMultiTracePainter>(gdi_)) {
  manager_.setForm(&form_);
  manager_.drawingArea(0, 0, form_.ViewScaleWidth(), form_.ViewScaleHeight());
  manager_.setShadowDC();
  manager_.addTraceObject(painter_, kResultType);
  makeFrames();
  setUp();
  gdi_.start();
  paint(0);
  gdi_.stop();
}

std::vector<std::vector<float>> noisyFrames(std::size_t frames, std::size_t points) {
  std::mt19937 random(1);
  std::normal_distribution<float> noise(-95.0F, 3.0F);
  std::vector<std::vector<float>> levels(frames, std::vector<float>(points));
  for (std::vector<float>& frame : levels) {
    for (std::size_t i = 0; i < points; ++i) frame[i] = noise(random) + (i % 97 == 0 ? 45.0F : 0.0F);
  }
  return levels;
}

void PaintTracesScene::makeFrames() {
  const auto traces = static_cast<std::size_t>(size_.traces);
  auto levels = noisyFrames(kFrames * traces, static_cast<std::size_t>(size_.points));
  frames_.resize(kFrames);
  for (std::size_t i = 0; i < levels.size(); ++i)
    frames_[i / traces].emplace_back(Variant::Singles(std::move(levels[i])));
  for (const std::vector<Variant>& frame : frames_) {
    std::vector<std::span<const float>>& spans = values_.emplace_back();
    for (const Variant& trace : frame) spans.emplace_back(std::get<Variant::Singles>(trace.value()));
  }
}

void PaintTracesScene::setUp() {
  for (std::int16_t trace = 0; trace < size_.traces; ++trace)
    painter_->addNewTraceAtEnd(trace, 0, size_.points - 1, trace);
  painter_->numberOfMeasurements(size_.points);
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
    marker->point = size_.points * (i + 1) / (kMarkers + 1);
    painter_->addMarkerToTrace(marker, 0);
  }
  const double plotLeft = painter_->gridScaleLeft();
  const double plotTop = painter_->gridInsetTop();
  const double plotWidth = kScenePx.width - plotLeft - static_cast<double>(painter_->gridScaleRight());
  const double plotHeight = kScenePx.height - plotTop - static_cast<double>(painter_->gridScaleBottom());
  const double range = kDbPerDivision * kDivisions;
  mapping_.leftPx = plotLeft;
  mapping_.stepPx = plotWidth / (size_.points - 2);
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

std::string PaintTracesScene::name() const {
  return std::to_string(size_.traces) + " x " + std::to_string(size_.points);
}

}  // namespace frontpanels::bench
