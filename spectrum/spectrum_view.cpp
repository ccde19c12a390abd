#include "spectrum/spectrum_view.h"

#include <algorithm>
#include <array>
#include <span>

#include "framework/panel/base_vfp.h"
#include "framework/panel/host_codes.h"
#include "framework/panel/hosted_panel.h"
#include "framework/panel/picture_area.h"
#include "framework/panel/report_html.h"
#include "framework/support/error_handler.h"
#include "framework/support/guard.h"
#include "painters/multi_trace_painter.h"
#include "spectrum/frequency_plan.h"
#include "spectrum/spectrum_controls.h"
#include "traces/result_types.h"

namespace frontpanels {
namespace {

constexpr double kDefaultReferenceDbm = -20.0;
constexpr double kDefaultDbPerDivision = 10.0;

// Room round the plot for its labels, in twips: a level of six characters at the left, a row of text above
// and below.
constexpr float kInsetLeftTwips = 720;
constexpr float kInsetTopTwips = 360;
constexpr float kInsetRightTwips = 180;
constexpr float kInsetBottomTwips = 315;

// What a host can link to on a panel.
enum class LinkType : std::int16_t { Result = 1, Action = 2, Parameter = 3 };

}  // namespace

class SpectrumView::Implementation : public HostedPanel {
 public:
  Implementation(const PanelEnvironment& environment, PanelHost& host, PanelContainer& container)
      : HostedPanel(environment, host, container),
        base_(environment, *this),
        DFISpectrum_(environment.hub, [this](std::int32_t index) { DFISpectrum_DataChanged(index); }) {
    DFISpectrum_.subscribe(kSpectrumPath);
  }

  void addMarker();
  void moveMarker(void (clsTraceManager::*move)());
  [[nodiscard]] clsBaseVFP& base() noexcept { return base_; }
  [[nodiscard]] const FrequencyPlan& plan() const noexcept { return plan_; }

  // PanelControl
  std::int32_t vfpOp(std::int32_t hardwareId, std::int16_t operation, const Variant& parameter,
                     clsBaseVFP* base) override;
  std::int32_t vfpSet(std::int32_t hardwareId, std::int16_t parameterType, std::int16_t index,
                      const Variant& value, clsBaseVFP* base) override;
  // The panel plays nothing by itself.
  std::int32_t playbackOp(std::int32_t, std::int16_t, const Variant&, clsBaseVFP*) override {
    return kStatusUnknownOperation;
  }
  void resultData(std::int32_t resultTypeId, ResultReader& reader, clsBaseVFP* base) override;
  std::string typeName() override { return kTypeName; }
  SideArea* displayPanel() override { return &displayPanel_; }
  SideArea* controlPanel() override { return &controlPanel_; }
  Control* MarkerToCenterButton() override { return &controls_.control("MarkerToCenterButton"); }
  ControlSet* controls() override { return &controls_; }
  void evaluateEnablingMarkerToCenter() override {}
  void Form_Resize() override;
  void refreshControls() override { refreshTraces(); }
  void refreshMenuItems() override { base_.refreshMenuItems(); }
  void closeVfp() override { base_.closeVfp(); }
  void saveVfp() override { base_.saveVfp(); }
  void appendSettings(PanelSettings& settings) override;
  void changedTraceConfiguration(TraceState state, TraceObject* activeTrace,
                                 std::int16_t resultType) override;
  void setMarkerFrameColor(Color color) override { markerFrameColor_ = color; }
  void deltaMarkerButtonEnabled(bool enable) override { deltaMarkerButtonEnabled_ = enable; }
  void frontPanelLink(const FrontPanelLink& link) override;
  std::int32_t measurementInfo(Variant& measurementTypes) override;
  std::string activeControlLink() override { return {}; }
  Variant initializeLinkValue(std::int16_t linkType, std::int32_t genericId) override;
  bool actionEnabled(std::int16_t action) override;
  std::string reportHtml() override;
  std::string linkSourceName() override;

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

  ControlSet controls_{spectrumControls()};
  PictureArea displayPanel_{controls_, controls_.picture("displayPanel")};
  PictureArea controlPanel_{controls_, controls_.picture("controlPanel")};
  clsBaseVFP base_;
  FrequencyPlan plan_;
  std::array<float, kMaxPoints> liveTrace_{};
  DataServer DFISpectrum_;

  Color markerFrameColor_{};
  bool deltaMarkerButtonEnabled_ = true;
};

// --- Host

std::int32_t SpectrumView::Implementation::vfpOp(std::int32_t hardwareId, std::int16_t operation,
                                                 const Variant& parameter, clsBaseVFP* /*base*/) {
  if (base_.closing()) return kStatusDone;
  return guarded("SpectrumView::vfpOp() ... ", kStatusUnusableParameter, [&] {
    switch (operation) {
      case QUILL_VFP_SAVE:
        base_.saveBase();
        refreshTraces();
        return kStatusDone;
      case kAddTraceOperation:
        return addTrace(parameter);
      case QUILL_VFP_SAVE_SETUP:
        if (!parameter.isNumeric()) break;  // the base says what is wrong with it
        base_.saveSetup(parameter.toInt32());
        return kStatusDone;
      default:
        break;
    }
    return base_.vfpOp(hardwareId, operation, parameter);
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
                                                  std::int16_t index, const Variant& value,
                                                  clsBaseVFP* /*base*/) {
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
  base_.traceManager().addTraceObject(std::make_shared<clsMultiTracePainter>(gdi()), kSpectrumResultType);
  return kStatusDone;
}

// The collapse buttons lie along the areas' inner edges, and at the view's edge where an area is hidden.
void SpectrumView::Implementation::Form_Resize() {
  base_.Resize();
  const float right = InvisibleWidthMarkX1() - kCollapseButtonTwips;
  const float bottom = InvisibleHeightMarkY1() - kCollapseButtonTwips;
  controls_.control("MarkerFrameInvisibleButton").Move({right, 0, kCollapseButtonTwips, bottom});
  controls_.control("MeasurementFrameInvisibleButton")
      .Move({0, bottom, InvisibleWidthMarkX1(), kCollapseButtonTwips});
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

void SpectrumView::Implementation::resultData(std::int32_t resultTypeId, ResultReader& reader,
                                              clsBaseVFP* /*base*/) {
  if (resultTypeId != kSpectrumResultType) return;
  guard("SpectrumView::resultData()", [&] {
    const std::size_t points = reader.GetFloat32Array(liveTrace_);
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
    base_.traceManager().addTraceObject(std::make_shared<clsMultiTracePainter>(gdi()), kSpectrumResultType);
  clsMultiTracePainter* const painter = findPainter();
  if (painter == nullptr) raiseObjectVariableNotSet();
  return *painter;
}

void SpectrumView::Implementation::refreshTraces() {
  guard("SpectrumView::refreshTraces()", [this] {
    if (view().visible()) base_.traceManager().paintTraces(true);
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
  painter.gridScaleLeft(kInsetLeftTwips / metrics().twipsPerPixelX);
  painter.gridInsetTop(kInsetTopTwips / metrics().twipsPerPixelY);
  painter.gridScaleRight(kInsetRightTwips / metrics().twipsPerPixelX);
  painter.gridScaleBottom(kInsetBottomTwips / metrics().twipsPerPixelY);
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

// --- What a host keeps and asks

void SpectrumView::Implementation::appendSettings(PanelSettings& settings) {
  settings.push_back({kCenterFrequencyParameter, plan_.centerHz()});
  settings.push_back({kSpanParameter, plan_.spanHz()});
}

std::int32_t SpectrumView::Implementation::measurementInfo(Variant& measurementTypes) {
  measurementTypes = Variant::Int32s{kSpectrumResultType};
  return kStatusDone;
}

// While logging the panel stays open, in playback it cannot be closed.
bool SpectrumView::Implementation::actionEnabled(std::int16_t action) {
  if (action == QUILL_VFP_CLOSE) return !base_.recordMode && !base_.playback;
  return action == QUILL_VFP_SAVE;
}

// What the host can link to. The panel's settings are fields that only its host sets so far, so nothing on
// it can be shown bold, italic or disabled.
void SpectrumView::Implementation::frontPanelLink(const FrontPanelLink& link) {
  const auto report = [](const char* what) {
    errorHandler().Assert(std::string("SpectrumView::frontPanelLink()") + what);
  };
  switch (static_cast<LinkType>(link.linkType)) {
    case LinkType::Result:
      return report(" ... unhandled result");
    case LinkType::Action:
      if (link.genericId == QUILL_VFP_CLOSE)
        return errorHandler().Assert("I don't know how to invoke close yet!");
      return report(" ... unhandled action");
    case LinkType::Parameter:
      return report(" ... unhandled parameter");
  }
  report("...unrecognized link type");
}

Variant SpectrumView::Implementation::initializeLinkValue(std::int16_t linkType, std::int32_t genericId) {
  if (static_cast<LinkType>(linkType) != LinkType::Parameter) {
    errorHandler().Assert("SpectrumView::initializeLinkValue()...unsupported link type");
    return {};
  }
  switch (genericId) {
    case kCenterFrequencyParameter:
      return plan_.centerHz();
    case kSpanParameter:
      return plan_.spanHz();
    default:
      errorHandler().Assert("SpectrumView::initializeLinkValue() ... unhandled parameter");
      return {};
  }
}

std::string SpectrumView::Implementation::linkSourceName() {
  return base_.frontPanelCaption().empty() ? kTypeName : base_.frontPanelCaption();
}

std::string SpectrumView::Implementation::reportHtml() {
  clsNumericEntry frequency;
  frequency.frequencySuffix();
  frequency.formatString("0.########");
  PanelReport report;
  report.caption = linkSourceName();
  report.settings = {{"Center", frequency.formatter(plan_.centerHz())},
                     {"Span", frequency.formatter(plan_.spanHz())},
                     {"Start", frequency.formatter(plan_.startHz())},
                     {"Stop", frequency.formatter(plan_.stopHz())}};
  if (clsMultiTracePainter* const painter = findPainter()) {
    const std::string top = numberToText(painter->gridScaleTop().value_or(0));
    report.settings.push_back({"Reference level", top + " " + painter->yAxisLabel()});
    report.settings.push_back({"Scale", numberToText(painter->verticalResolution()) + " dB/div"});
    for (const MarkerReading& reading : painter->markerReadings())
      report.readings.push_back({reading.id, reading.x, reading.y});
  }
  report.xTitle = "Frequency";
  report.yTitle = "Level";
  report.picturePng = container().picturePng();
  return frontpanels::reportHtml(report);
}

// --- The panel from outside

SpectrumView::SpectrumView(const PanelEnvironment& environment, PanelHost& host, PanelContainer& container)
    : implementation_(std::make_unique<Implementation>(environment, host, container)) {}

SpectrumView::~SpectrumView() = default;

std::int32_t SpectrumView::vfpOp(std::int32_t hardwareId, std::int16_t operation, const Variant& parameter) {
  return implementation_->vfpOp(hardwareId, operation, parameter, nullptr);
}

std::int32_t SpectrumView::vfpSet(std::int32_t hardwareId, std::int16_t parameterType, std::int16_t index,
                                  const Variant& value) {
  return implementation_->vfpSet(hardwareId, parameterType, index, value, nullptr);
}

std::int32_t SpectrumView::displayData(const Variant& vParameter, std::span<const std::uint8_t> resultData,
                                       std::int32_t& dataPointer, std::int32_t& dataCount,
                                       std::int32_t resultTypeId, std::int32_t resultLength) {
  return base().displayData(vParameter, resultData, dataPointer, dataCount, resultTypeId, resultLength);
}

std::int32_t SpectrumView::displayParameter(std::int16_t order, const Variant& newValue) {
  return base().displayParameter(order, newValue);
}

void SpectrumView::PopUp_Click(std::int32_t subjectId, std::int32_t buttonId) {
  base().PopUp_Click(subjectId, buttonId);
}

std::string SpectrumView::Caption() { return base().Caption(); }
void SpectrumView::Form_Resize() { implementation_->Form_Resize(); }
void SpectrumView::Paint() { base().Paint(); }
void SpectrumView::Activate() { base().Activate(); }

void SpectrumView::MouseDown(std::int16_t button, std::int16_t shift, float xTwips, float yTwips) {
  base().MouseDown(button, shift, xTwips, yTwips);
}

void SpectrumView::MouseMove(std::int16_t button, std::int16_t shift, float xTwips, float yTwips) {
  base().MouseMove(button, shift, xTwips, yTwips);
}

void SpectrumView::MouseUp(std::int16_t button, std::int16_t shift, float xTwips, float yTwips) {
  base().MouseUp(button, shift, xTwips, yTwips);
}

void SpectrumView::KeyDown(std::int16_t keyCode, std::int16_t shift) { base().KeyDown(keyCode, shift); }

void SpectrumView::addMarker() { implementation_->addMarker(); }
void SpectrumView::markerToMax() { implementation_->moveMarker(&clsTraceManager::markerToMax); }
void SpectrumView::markerToMin() { implementation_->moveMarker(&clsTraceManager::markerToMin); }
clsBaseVFP& SpectrumView::base() { return implementation_->base(); }
HostedPanel& SpectrumView::control() { return *implementation_; }
const FrequencyPlan& SpectrumView::frequencyPlan() const { return implementation_->plan(); }

}  // namespace frontpanels
