#include "bench/spectrum_panel_scene.h"

#include "framework/support/host_codes.h"

namespace frontpanels::bench {
namespace {

constexpr int kMarkers = 4;
constexpr double kDivisions = 10;

}  // namespace

SpectrumPanelScene::SpectrumPanelScene(Gdi& gdi, DcHandle view)
    : gdi_(gdi),
      view_(view, kScenePx),
      panel_({gdi_, windowing_, view_, hub_, ScreenMetrics{}, ""}, owner_, owner_) {
  frames_ = noisyFrames(kFrames, SpectrumView::kMaxPoints);
  setUp();
  gdi_.start();
  publish(0);
  gdi_.stop();
}

void SpectrumPanelScene::setUp() {
  panel_.vfpSet(0, kRightPanelParameter, 0, false);
  panel_.vfpSet(0, kBottomPanelParameter, 0, false);
  panel_.vfpOp(0, kAddTraceOperation, kAddTraceOperation);
  publish(0);
  for (int i = 0; i < kMarkers; ++i) {
    panel_.addMarker();
    panel_.base().traceManager().activeTrace()->activeMarker()->point =
        SpectrumView::kMaxPoints * (i + 1) / (kMarkers + 1);
  }
  const auto& painter =
      dynamic_cast<const clsMultiTracePainter&>(*panel_.base().traceManager().activeTrace());
  const PanelArea& area = panel_.base().traceManager().drawingAreaPx();
  const double width = area.width - painter.gridScaleLeft() - static_cast<double>(painter.gridScaleRight());
  const double height = area.height - painter.gridInsetTop() - static_cast<double>(painter.gridScaleBottom());
  const double range = painter.verticalResolution() * kDivisions;
  mapping_.leftPx = painter.gridScaleLeft();
  mapping_.stepPx = width / (SpectrumView::kMaxPoints - 2);
  mapping_.pxPerUnit = height / range;
  mapping_.originPx =
      painter.gridInsetTop() + height + height * (painter.gridScaleTop().value_or(0) - range) / range;
}

void SpectrumPanelScene::publish(std::size_t frame) {
  hub_.publish(SpectrumView::kSpectrumPath, std::span<const float>(frames_[frame]));
}

void SpectrumPanelScene::drawBare(std::size_t frame) {
  const std::span<const float> values[] = {frames_[frame]};
  gdi_.draw(values, mapping_);
}

}  // namespace frontpanels::bench
