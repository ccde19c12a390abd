// SpectrumView and its traces: live data, axes, markers.
#include <algorithm>

#include "framework/support/flag_scope.h"
#include "framework/support/guard.h"
#include "spectrum/spectrum_view.h"
#include "traces/result_types.h"

namespace frontpanels {
namespace {

// Room round the plot for its labels, in twips: a level of six characters at the left, a row of text above
// and below.
constexpr float kInsetLeftTwips = 720;
constexpr float kInsetTopTwips = 360;
constexpr float kInsetRightTwips = 180;
constexpr float kInsetBottomTwips = 315;

}  // namespace

// --- Data

void SpectrumView::DFISpectrum_DataChanged(std::int32_t index) {
  if (base().closing()) return;
  guard("SpectrumView::DfiSpectrum_DataChanged()", [&] {
    const std::size_t points = readSweep(index);
    showSweep(findOrAddPainter(), std::span(liveTrace_).first(points));
    refreshTraces();
  });
}

void SpectrumView::resultData(std::int32_t resultTypeId, ResultReader& reader, clsBaseVFP* /*base*/) {
  if (resultTypeId != kSpectrumResultType) return;
  guard("SpectrumView::resultData()", [&] {
    const std::size_t points = reader.GetFloat32Array(liveTrace_);
    showSweep(findOrAddPainter(), std::span(liveTrace_).first(points));
    refreshTraces();
  });
}

// Fills the live-trace buffer; a point that it has no room for is an array-bounds error, and the picture
// stays.
std::size_t SpectrumView::readSweep(std::int32_t index) {
  const auto points = static_cast<std::size_t>(DFISpectrum_.itemCount(index));
  if (points > liveTrace_.size()) raiseSubscriptOutOfRange();
  const std::span<const float> singles = DFISpectrum_.singles(index);
  if (singles.size() == points) {
    std::copy(singles.begin(), singles.end(), liveTrace_.begin());
    return points;
  }
  for (std::size_t item = 0; item < points; ++item)
    liveTrace_[item] = DFISpectrum_.singleValue(index, static_cast<std::int32_t>(item));
  return points;
}

// A marker keeps its point; where there is another number of points it keeps its frequency as well as it can.
// One that was restored ahead of the first sweep has none yet.
void SpectrumView::showSweep(clsMultiTracePainter& painter, std::span<const float> levels) {
  const auto points = static_cast<std::int32_t>(levels.size());
  const std::int32_t pointsBefore = painter.numberOfMeasurements();
  painter.numberOfMeasurements(points);
  painter.dataChanged(true);
  painter.span(fields_.frequency.span.value());
  painter.trace(levels);
  painter.traceSize(points);
  painter.offset(0);
  if (pointsBefore > 0 && points != pointsBefore && points > 1 && painter.span() != 0) painter.ResetMarkers();
}

clsMultiTracePainter* SpectrumView::findPainter() {
  return dynamic_cast<clsMultiTracePainter*>(base().traceManager().find(kSpectrumResultType));
}

clsMultiTracePainter& SpectrumView::findOrAddPainter() {
  if (findPainter() == nullptr)
    base().traceManager().addTraceObject(std::make_shared<clsMultiTracePainter>(gdi()), kSpectrumResultType);
  clsMultiTracePainter* const painter = findPainter();
  if (painter == nullptr) raiseObjectVariableNotSet();
  return *painter;
}

// --- Traces and axes

void SpectrumView::changedTraceConfiguration(TraceState state, TraceObject* activeTrace,
                                             std::int16_t resultType) {
  const auto fail = [this](const char* what) {
    report(std::string("changedTraceConfiguration() failed ... ") + what);
  };
  guard("SpectrumView::changedTraceConfiguration() failed ... ", [&] {
    updateMarkerButtons();
    if (state == TraceState::Removed) return;
    if (state != TraceState::Added) return fail("unrecognized trace state");
    if (resultType == 0) return fail("missing result type");
    if (activeTrace == nullptr) return fail("null trace");
    if (resultType != kSpectrumResultType)
      return fail(isKnownResultType(resultType) ? "unhandled result type" : "unrecognized result type");
    setUpTrace(dynamic_cast<clsMultiTracePainter&>(*activeTrace));
  });
}

void SpectrumView::setUpTrace(clsMultiTracePainter& painter) {
  painter.yAxisFormatter().Clear();
  painter.yAxisFormatter().dBmSuffix();
  painter.yAxisFormatter().suppressSuffix(true);
  painter.autoFormatX(true);
  painter.autoFormatY(true);
  painter.verticalResolution(fields_.verticalScale.value());
  painter.gridScaleTop(fields_.verticalOffset.value());
  painter.setAutoScale(fields_.controls.checkBox("AutoScaleBox").Value() != 0);
  painter.yAxisLabel("dBm");
  painter.spokenName("Spectrum");
  setInsets(painter);
  updateXAxisLabels();
}

void SpectrumView::setInsets(PlotPainter& painter) const {
  painter.gridScaleLeft(kInsetLeftTwips / metrics().twipsPerPixelX);
  painter.gridInsetTop(kInsetTopTwips / metrics().twipsPerPixelY);
  painter.gridScaleRight(kInsetRightTwips / metrics().twipsPerPixelX);
  painter.gridScaleBottom(kInsetBottomTwips / metrics().twipsPerPixelY);
}

void SpectrumView::rescaled() {
  for (const TracePointer& trace : base().traceManager().Traces())
    if (auto* const painter = dynamic_cast<PlotPainter*>(trace.get())) setInsets(*painter);
}

// The axis reads as the centre entry does: in the same channels or units.
void SpectrumView::formatXAxis(clsMultiTracePainter& painter) {
  clsNumericEntry& formatter = painter.xAxisFormatter();
  const clsNumericEntry& center = fields_.frequency.center;
  const bool channels = center.channelChoose();
  formatter.Clear();
  formatter.frequencySuffix();
  adjustResolution(formatter);
  if (channels) {
    formatter.CopyLimits(center);
    fields_.channels.selectChannelization(fields_.channelization.value(), formatter);
  }
  formatter.channelChoose(channels);
}

void SpectrumView::updateXAxisLabels() {
  guard("SpectrumView::updateXAxisLabels()...", [this] {
    clsMultiTracePainter* const painter = findPainter();
    if (painter == nullptr) return;
    formatXAxis(*painter);
    painter->xStart(fields_.frequency.axisStartHz());
    painter->xStop(fields_.frequency.axisStopHz());
    painter->updateXAxisLabels();
  });
}

void SpectrumView::adjustResolution(clsNumericEntry& formatter) {
  guard("SpectrumView::adjustResolution()",
        [&] { formatter.formatString(axisFormatForSpan(fields_.frequency.span.value())); });
}

// The vertical fields show what the trace has.
void SpectrumView::showVerticalAxis() {
  const clsMultiTracePainter* const painter = activePainter();
  if (painter == nullptr) return;
  const FlagScope inProgress = changeOption();
  fields_.controls.checkBox("AutoScaleBox").Value(painter->getAutoScale() ? 1 : 0);
  fields_.verticalScale.valueNoUpdate(painter->verticalResolution());
  if (const std::optional<double> top = painter->gridScaleTop()) fields_.verticalOffset.valueNoUpdate(*top);
  shownTop_ = painter->gridScaleTop();
  shownPerDivision_ = painter->verticalResolution();
}

void SpectrumView::tracesRefreshed() {
  const clsMultiTracePainter* const painter = activePainter();
  if (painter == nullptr || !painter->getAutoScale()) return;
  if (painter->gridScaleTop() != shownTop_ || painter->verticalResolution() != shownPerDivision_)
    showVerticalAxis();
}

// --- Markers

// After a close there is nothing left to mark.
void SpectrumView::addMarker() {
  if (base().closing()) return;
  markers_.addMarker();
  evaluateEnablingMarkerToCenter();
}

void SpectrumView::addDeltaMarker() {
  if (!base().closing()) markers_.addDeltaMarker();
}

void SpectrumView::deleteMarker() {
  if (base().closing()) return;
  markers_.deleteMarker();
  evaluateEnablingMarkerToCenter();
}

void SpectrumView::markerToMax() {
  if (!base().closing()) markers_.markerToMax();
}

void SpectrumView::markerToMin() {
  if (!base().closing()) markers_.markerToMin();
}

void SpectrumView::markerToCenter() {
  if (base().closing()) return;
  guard("SpectrumView::markerToCenter()", [this] {
    clsMultiTracePainter* const painter = activePainter();
    if (painter == nullptr || !mayCenterMarker()) return;
    painter->updateActiveMarker();
    fields_.frequency.center.valueNoUpdateAutoChoose(painter->activeMarker()->valueX);
    newCenterFrequency();
    refreshTraces();
  });
}

void SpectrumView::updateMarkerButtons() {
  markers_.updateMarkerButtons();
  evaluateEnablingMarkerToCenter();
}

}  // namespace frontpanels
