#include "spectrum/spectrum_view.h"

#include <algorithm>
#include <array>
#include <span>

#include "framework/panel/base_vfp.h"
#include "framework/panel/host_codes.h"
#include "framework/panel/panel_control.h"
#include "framework/support/error_handler.h"
#include "framework/support/guard.h"
#include "painters/multi_trace_painter.h"
#include "spectrum/frequency_plan.h"
#include "traces/result_types.h"

namespace frontpanels {
namespace {

constexpr std::int16_t kLeftButton = 1;
constexpr std::int16_t kLeftArrow = 37;
constexpr std::int16_t kRightArrow = 39;
constexpr double kDefaultReferenceDbm = -20.0;
constexpr double kDefaultDbPerDivision = 10.0;

// Room round the plot for its labels, in twips: a level of six characters at the left, a row of text above
// and below.
constexpr float kInsetLeftTwips = 720;
constexpr float kInsetTopTwips = 360;
constexpr float kInsetRightTwips = 180;
constexpr float kInsetBottomTwips = 315;

}  // namespace

class SpectrumView::Implementation : public PanelControl {
 public:
  Implementation(const PanelEnvironment& environment, PanelHost& host, PanelContainer& container)
      : gdi_(environment.gdi),
        view_(environment.view),
        metrics_(environment.metrics),
        host_(host),
        container_(container),
        base_(environment, *this),
        DFISpectrum_(environment.hub, [this](std::int32_t index) { DFISpectrum_DataChanged(index); }) {
    DFISpectrum_.subscribe(kSpectrumPath);
  }

  std::int32_t vfpOp(std::int32_t hardwareId, std::int16_t operation, const Variant& parameter);
  std::int32_t vfpSet(std::int32_t hardwareId, std::int16_t parameterType, std::int16_t index,
                      const Variant& value);
  void addMarker();
  void moveMarker(void (clsTraceManager::*move)());
  [[nodiscard]] clsBaseVFP& base() noexcept { return base_; }
  [[nodiscard]] const FrequencyPlan& plan() const noexcept { return plan_; }

  // PanelControl: the drawing surface forwards to the view, whose pixels it measures in twips.
  float ViewScaleLeft() override { return 0; }
  float ViewScaleTop() override { return 0; }
  float ViewScaleWidth() override {
    return static_cast<float>(view_.clientSizePx().width) * metrics_.twipsPerPixelX;
  }
  float ViewScaleHeight() override {
    return static_cast<float>(view_.clientSizePx().height) * metrics_.twipsPerPixelY;
  }
  float ViewUseableScaleWidth() override { return ViewScaleWidth(); }
  float ViewUseableScaleHeight() override { return ViewScaleHeight(); }
  WindowHandle ViewHWnd() override { return view_.hwnd(); }
  DcHandle ViewHDC() override { return view_.hdc(); }
  MousePointer ViewMousePointer() override { return view_.mousePointer(); }
  void ViewMousePointer(MousePointer pointer) override { view_.mousePointer(pointer); }
  DrawMode ViewDrawMode() override { return drawMode_; }
  void ViewDrawMode(DrawMode mode) override {
    drawMode_ = mode;
    gdi_.setRop2(view_.hdc(), mode);
  }
  PenStyle ViewDrawStyle() override { return drawStyle_; }
  void ViewDrawStyle(PenStyle style) override { drawStyle_ = style; }
  void Refresh() override { view_.refresh(); }
  ScaleMode ViewScaleMode() override { return ScaleMode::Twips; }
  std::int16_t ViewDrawWidth() override { return 1; }
  void ViewState(std::int16_t state) override {
    winState_ = state;
    container_.viewState(state);
  }
  void ViewVisible(bool visible) override {
    view_.visible(visible);
    container_.visible(visible);
  }
  void ViewRefresh() override { view_.refresh(); }
  void Caption(std::string_view text) override { container_.caption(text); }
  std::int32_t frontPanelOp(std::int32_t hwId, std::int32_t vfpId, std::int16_t operation,
                            const Variant& argument) override {
    return host_.frontPanelOp(hwId, vfpId, operation, argument);
  }
  std::string typeName() override { return kTypeName; }
  std::int16_t winState() override { return winState_; }
  SideArea* displayPanel() override { return nullptr; }
  SideArea* controlPanel() override { return nullptr; }
  void InvisibleWidthMarkX1(float x) override { invisibleWidthMarkX1_ = x; }
  void InvisibleHeightMarkY1(float y) override { invisibleHeightMarkY1_ = y; }
  void refreshControls() override { refreshTraces(); }
  void refreshMenuItems() override {}
  void changedTraceConfiguration(TraceState state, TraceObject* activeTrace,
                                 std::int16_t resultType) override;
  void setMarkerFrameColor(Color color) override { markerFrameColor_ = color; }
  void deltaMarkerButtonEnabled(bool enable) override { deltaMarkerButtonEnabled_ = enable; }

 private:
  struct ParameterRow;
  static const ParameterRow kParameters[];

  void DFISpectrum_DataChanged(std::int32_t index);
  [[nodiscard]] std::size_t readSweep(std::int32_t index);
  void showSweep(clsMultiTracePainter& painter, std::span<const float> levels);
  [[nodiscard]] clsMultiTracePainter* findPainter();
  [[nodiscard]] clsMultiTracePainter& findOrAddPainter();
  [[nodiscard]] std::int32_t addTrace(const Variant& parameter);
  void setUpTrace(clsMultiTracePainter& painter);
  void updateXAxisLabels();
  void adjustResolution();
  void refreshTraces();

  Gdi& gdi_;
  GraphView& view_;
  ScreenMetrics metrics_;
  PanelHost& host_;
  PanelContainer& container_;
  clsBaseVFP base_;
  FrequencyPlan plan_;
  std::array<float, kMaxPoints> liveTrace_{};
  DataServer DFISpectrum_;

  DrawMode drawMode_ = DrawMode::CopyPen;
  PenStyle drawStyle_ = PenStyle::Solid;
  std::int16_t winState_ = 0;
  float invisibleWidthMarkX1_ = 0;
  float invisibleHeightMarkY1_ = 0;
  Color markerFrameColor_{};
  bool deltaMarkerButtonEnabled_ = true;
};

// --- Host

std::int32_t SpectrumView::Implementation::vfpOp(std::int32_t hardwareId, std::int16_t operation,
                                                 const Variant& parameter) {
  if (base_.closing()) return kStatusDone;
  return guarded("SpectrumView::vfpOp() ... ", kStatusUnusableParameter, [&] {
    return operation == kAddTraceOperation ? addTrace(parameter)
                                           : base_.vfpOp(hardwareId, operation, parameter);
  });
}

// The codes that are the panel's own. A value that is not numeric is passed over without an error.
struct SpectrumView::Implementation::ParameterRow {
  std::int16_t code;
  void (*apply)(Implementation& panel, double value);
};

const SpectrumView::Implementation::ParameterRow SpectrumView::Implementation::kParameters[] = {
    // Settings that the host sends to every panel of its window and that mean nothing to this one.
    {11, [](Implementation&, double) {}},
    {15, [](Implementation&, double) {}},
    {18, [](Implementation&, double) {}},
    {kCenterFrequencyParameter,
     [](Implementation& panel, double value) {
       panel.plan_.setCenter(value);
       panel.updateXAxisLabels();
     }},
    {kSpanParameter,
     [](Implementation& panel, double value) {
       panel.plan_.setSpan(value);
       panel.adjustResolution();
       panel.updateXAxisLabels();
     }},
};

std::int32_t SpectrumView::Implementation::vfpSet(std::int32_t hardwareId, std::int16_t parameterType,
                                                  std::int16_t index, const Variant& value) {
  if (base_.closing()) return kStatusDone;
  return guarded("SpectrumView::vfpSet() ... ", kStatusUnusableParameter, [&] {
    const auto* const row = std::find_if(
        std::begin(kParameters), std::end(kParameters),
        [parameterType](const ParameterRow& candidate) { return candidate.code == parameterType; });
    if (row == std::end(kParameters)) return base_.vfpSet(hardwareId, parameterType, index, value);
    if (value.isNumeric()) row->apply(*this, value.toDouble());
    return kStatusDone;
  });
}

std::int32_t SpectrumView::Implementation::addTrace(const Variant& parameter) {
  if (!parameter.isNumeric() || parameter.toDouble() != kAddTraceOperation) return kStatusUnusableParameter;
  base_.traceManager().addTraceObject(std::make_shared<clsMultiTracePainter>(gdi_), kSpectrumResultType);
  return kStatusDone;
}

// --- Live data

void SpectrumView::Implementation::DFISpectrum_DataChanged(std::int32_t index) {
  if (base_.closing()) return;
  guard("SpectrumView::DfiSpectrum_DataChanged()", [&] {
    const std::size_t points = readSweep(index);
    showSweep(findOrAddPainter(), std::span(liveTrace_).first(points));
    refreshTraces();
  });
}

// Fills the live-trace buffer; a point that it has no room for is an array-bounds error, and the picture
// stays.
std::size_t SpectrumView::Implementation::readSweep(std::int32_t index) {
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

void SpectrumView::Implementation::showSweep(clsMultiTracePainter& painter, std::span<const float> levels) {
  painter.numberOfMeasurements(static_cast<std::int32_t>(levels.size()));
  painter.dataChanged(true);
  painter.span(plan_.stopHz() - plan_.startHz());  // less than the span where a limit cuts it off
  painter.trace(levels);
  painter.traceSize(static_cast<std::int32_t>(levels.size()));
  painter.offset(0);
}

clsMultiTracePainter* SpectrumView::Implementation::findPainter() {
  return dynamic_cast<clsMultiTracePainter*>(base_.traceManager().find(kSpectrumResultType));
}

clsMultiTracePainter& SpectrumView::Implementation::findOrAddPainter() {
  if (findPainter() == nullptr)
    base_.traceManager().addTraceObject(std::make_shared<clsMultiTracePainter>(gdi_), kSpectrumResultType);
  clsMultiTracePainter* const painter = findPainter();
  if (painter == nullptr) raiseObjectVariableNotSet();
  return *painter;
}

void SpectrumView::Implementation::refreshTraces() {
  guard("SpectrumView::refreshTraces()", [this] {
    if (view_.visible()) base_.traceManager().paintTraces(true);
  });
}

// --- Traces

void SpectrumView::Implementation::changedTraceConfiguration(TraceState state, TraceObject* activeTrace,
                                                             std::int16_t resultType) {
  const auto fail = [](const char* what) {
    errorHandler().Assert(std::string("SpectrumView::changedTraceConfiguration() failed ... ") + what);
  };
  guard("SpectrumView::changedTraceConfiguration() failed ... ", [&] {
    if (state == TraceState::Removed) return;
    if (state != TraceState::Added) return fail("unrecognized trace state");
    if (resultType == 0) return fail("missing result type");
    if (activeTrace == nullptr) return fail("null trace");
    if (resultType != kSpectrumResultType)
      return fail(isKnownResultType(resultType) ? "unhandled result type" : "unrecognized result type");
    setUpTrace(dynamic_cast<clsMultiTracePainter&>(*activeTrace));
  });
}

void SpectrumView::Implementation::setUpTrace(clsMultiTracePainter& painter) {
  painter.yAxisFormatter().dBmSuffix();
  painter.yAxisFormatter().suppressSuffix(true);
  painter.xAxisFormatter().frequencySuffix();
  painter.autoFormatX(true);
  painter.autoFormatY(true);
  painter.verticalResolution(kDefaultDbPerDivision);
  painter.gridScaleTop(kDefaultReferenceDbm);
  painter.setAutoScale(false);
  painter.xAxisStyle(1);
  painter.yAxisLabel("dBm");
  painter.gridScaleLeft(kInsetLeftTwips / metrics_.twipsPerPixelX);
  painter.gridInsetTop(kInsetTopTwips / metrics_.twipsPerPixelY);
  painter.gridScaleRight(kInsetRightTwips / metrics_.twipsPerPixelX);
  painter.gridScaleBottom(kInsetBottomTwips / metrics_.twipsPerPixelY);
  adjustResolution();
  updateXAxisLabels();
}

void SpectrumView::Implementation::updateXAxisLabels() {
  guard("SpectrumView::updateXAxisLabels()...", [this] {
    clsMultiTracePainter* const painter = findPainter();
    if (painter == nullptr) return;
    painter->xStart(plan_.startHz());
    painter->xStop(plan_.stopHz());
    painter->updateXAxisLabels();
  });
}

void SpectrumView::Implementation::adjustResolution() {
  guard("SpectrumView::adjustResolution()", [this] {
    if (clsMultiTracePainter* const painter = findPainter())
      painter->xAxisFormatter().formatString(std::string(axisFormatForSpan(plan_.spanHz())));
  });
}

void SpectrumView::Implementation::addMarker() {
  guard("SpectrumView::addMarker() ... ", [this] {
    const TraceObject* const active = base_.traceManager().activeTrace();
    if (active != nullptr && active->numberOfTraces() > 0)
      base_.traceManager().addMarker(active->selectedTraceIndex());
  });
}

// Without a marker there is nothing to move and nothing wrong.
void SpectrumView::Implementation::moveMarker(void (clsTraceManager::*move)()) {
  const TraceObject* const active = base_.traceManager().activeTrace();
  if (active != nullptr && active->activeMarker() != nullptr) (base_.traceManager().*move)();
}

// --- The panel from outside

SpectrumView::SpectrumView(const PanelEnvironment& environment, PanelHost& host, PanelContainer& container)
    : implementation_(std::make_unique<Implementation>(environment, host, container)) {}

SpectrumView::~SpectrumView() = default;

std::int32_t SpectrumView::vfpOp(std::int32_t hardwareId, std::int16_t operation, const Variant& parameter) {
  return implementation_->vfpOp(hardwareId, operation, parameter);
}

std::int32_t SpectrumView::vfpSet(std::int32_t hardwareId, std::int16_t parameterType, std::int16_t index,
                                  const Variant& value) {
  return implementation_->vfpSet(hardwareId, parameterType, index, value);
}

std::string SpectrumView::Caption() { return base().Caption(); }
void SpectrumView::Form_Resize() { base().Resize(); }
void SpectrumView::Paint() { base().traceManager().paintTraces(true); }

void SpectrumView::MouseDown(std::int16_t button, std::int16_t shift, float xTwips, float yTwips) {
  if (button == kLeftButton) base().traceManager().MouseDown(button, shift, xTwips, yTwips);
}

void SpectrumView::MouseMove(std::int16_t button, std::int16_t shift, float xTwips, float yTwips) {
  base().traceManager().MouseMove(button, shift, xTwips, yTwips);
}

void SpectrumView::MouseUp(std::int16_t button, std::int16_t shift, float xTwips, float yTwips) {
  base().traceManager().MouseUp(button, shift, xTwips, yTwips);
}

void SpectrumView::KeyDown(std::int16_t keyCode, std::int16_t /*shift*/) {
  if (keyCode == kLeftArrow) base().traceManager().moveMarkerLeft();
  if (keyCode == kRightArrow) base().traceManager().moveMarkerRight();
}

void SpectrumView::addMarker() { implementation_->addMarker(); }
void SpectrumView::markerToMax() { implementation_->moveMarker(&clsTraceManager::markerToMax); }
void SpectrumView::markerToMin() { implementation_->moveMarker(&clsTraceManager::markerToMin); }
clsBaseVFP& SpectrumView::base() { return implementation_->base(); }
PanelControl& SpectrumView::control() { return *implementation_; }
const FrequencyPlan& SpectrumView::frequencyPlan() const { return implementation_->plan(); }

}  // namespace frontpanels
