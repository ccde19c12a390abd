#include "framework/panel/base_vfp.h"

#include <algorithm>
#include <iterator>

#include "framework/panel/host_codes.h"
#include "framework/support/error_handler.h"
#include "framework/support/guard.h"

namespace frontpanels {
namespace {

constexpr float kSmallestDrawingAreaTwips = 10.0F;
constexpr double kMarginShare = 0.025;
constexpr float kMarginPenWidths = 4.0F;

// The larger of four pen widths and a fortieth of the length.
float marginTwips(float lengthTwips, std::int16_t penWidthPx, float twipsPerPixel) {
  const float byPen = kMarginPenWidths * static_cast<float>(penWidthPx) * twipsPerPixel;
  const auto byLength = static_cast<float>(kMarginShare * static_cast<double>(lengthTwips));
  return std::max(byPen, byLength);
}

}  // namespace

SharedPanelState& sharedPanelState() noexcept {
  static SharedPanelState state;
  return state;
}

// One row a code. A code whose value must be a number names the message for one that is none.
struct clsBaseVFP::ParameterRow {
  std::int16_t code;
  const char* mustBeNumeric;
  void (*apply)(clsBaseVFP& base, const Variant& value);
};

const clsBaseVFP::ParameterRow clsBaseVFP::kParameters[] = {
    {TIME_MEASUREMENT_PERIOD, "clsBaseVFP::vfpSet() TIME_MEASUREMENT_PERIOD must be numeric",
     [](clsBaseVFP& base, const Variant& value) { base.measurementPeriod_ = value.toDouble(); }},
    {TIME_DATABASE_PERIOD, "clsBaseVFP::vfpSet() TIME_DATABASE_PERIOD must be numeric",
     [](clsBaseVFP& base, const Variant& value) { base.databasePeriod_ = value.toDouble(); }},
    {TIME_DISPLAY_PERIOD, "clsBaseVFP::vfpSet() TIME_DISPLAY_PERIOD must be numeric",
     [](clsBaseVFP& base, const Variant& value) { base.displayPeriod_ = value.toDouble(); }},
    {PARM_MEASUREMENT_ID, "clsBaseVFP::vfpSet() PARM_MEASUREMENT_ID must be numeric",
     [](clsBaseVFP& base, const Variant& value) { base.measurementId_ = value.toInt32(); }},
    {kCaptionParameter, nullptr,
     [](clsBaseVFP& base, const Variant& value) {
       base.frontPanelCaption_ = value.toText();
       base.Caption(base.frontPanelCaption_);
     }},
    {PARM_RESOURCE_ID, "clsBaseVFP::vfpSet() PARM_RESOURCE_ID must be numeric",
     [](clsBaseVFP& base, const Variant& value) {
       base.resourceId_ = value.toInt32();
       base.resourceIdValid_ = true;
     }},
    {kXAxisStyleParameter, nullptr,
     [](clsBaseVFP& base, const Variant& value) {
       base.activePainter().xAxisStyle(value.toInt16());
       base.child_.refreshControls();
     }},
    {kVerticalResolutionParameter, nullptr,
     [](clsBaseVFP& base, const Variant& value) {
       // Through text: the host's single-precision 0.1 arrives as the 0.1 that it shows.
       base.activePainter().verticalResolution(Variant(value.toText()).toDouble());
       base.child_.refreshControls();
     }},
    {kGridTopParameter, nullptr,
     [](clsBaseVFP& base, const Variant& value) {
       base.activePainter().gridScaleTop(value.toDouble());
       base.child_.refreshControls();
     }},
    {kYAxisStyleParameter, nullptr,
     [](clsBaseVFP& base, const Variant& value) {
       base.activePainter().yAxisStyle(value.toInt16());
       base.child_.refreshControls();
     }},
    {kAutoScaleParameter, nullptr,
     [](clsBaseVFP& base, const Variant& value) {
       base.activePainter().setAutoScale(value.toBoolean());
       base.child_.refreshControls();
     }},
};

clsBaseVFP::clsBaseVFP(const PanelEnvironment& environment, PanelControl& child)
    : child_(child),
      metrics_(environment.metrics),
      fonts_(environment.gdi, environment.metrics, boldLabels(environment.commandLine)),
      traceManager_({environment.gdi, environment.windowing, environment.metrics, fonts_.handles(),
                     boldLabels(environment.commandLine)}) {
  traceManager_.setForm(&child_);
}

// --- Host

std::int32_t clsBaseVFP::vfpOp(std::int32_t /*hardwareId*/, std::int16_t operation,
                               const Variant& parameter) {
  if (closing_) return kStatusDone;
  return guarded("clsBaseVFP::vfpOp() ... ", kStatusUnusableParameter, [&] {
    switch (operation) {
      case QUILL_VFP_CLOSE:
        closing_ = true;
        return vfpClose();
      case kAddTraceOperation:
        return addTrace(parameter);
      case kRemoveTraceOperation:
        return removeTrace(parameter);
      case kShowOperation:
        return show();
      default:
        return kStatusUnknownOperation;
    }
  });
}

std::int32_t clsBaseVFP::vfpSet(std::int32_t /*hardwareId*/, std::int16_t parameterType,
                                std::int16_t /*index*/, const Variant& value) {
  if (closing_) return kStatusDone;
  return guarded("clsBaseVFP::vfpSet() ... ", kStatusUnusableParameter, [&] {
    const auto* const row = std::find_if(
        std::begin(kParameters), std::end(kParameters),
        [parameterType](const ParameterRow& candidate) { return candidate.code == parameterType; });
    if (row == std::end(kParameters)) {
      reportUnhandled(parameterType);
      return kStatusDone;
    }
    if (row->mustBeNumeric != nullptr && !value.isNumeric()) {
      errorHandler().Assert(row->mustBeNumeric);
      return kStatusUnusableParameter;
    }
    row->apply(*this, value);
    return kStatusDone;
  });
}

void clsBaseVFP::reportUnhandled(std::int16_t parameterType) {
  if (!warnOnUnhandledParameters) return;
  errorHandler().Assert(child_.typeName() +
                        "::vfpSet() ... unhandled parameterType = " + std::to_string(parameterType));
}

std::int32_t clsBaseVFP::vfpClose() {
  sharedPanelState().dirty = true;
  child_.ViewVisible(false);
  return kStatusDone;
}

void clsBaseVFP::closeVfp() {
  guard("clsBaseVFP::closeVfp() ... ", [this] {
    const std::int32_t status =
        child_.frontPanelOp(resourceId_, virtualFrontPanelId, QUILL_VFP_CLOSE, Variant());
    if (status != kStatusDone) errorHandler().ReportError("QUILL_VFP_CLOSE failed");
  });
}

std::int32_t clsBaseVFP::show() {
  if (windowOwner) {
    child_.ViewVisible(false);
    child_.ViewState(0);
    child_.ViewVisible(true);
  }
  child_.refreshControls();
  child_.refreshMenuItems();
  Caption(frontPanelCaption_);
  saved_ = true;
  return kStatusDone;
}

std::int32_t clsBaseVFP::addTrace(const Variant& parameter) {
  if (!parameter.isNumeric()) return kStatusUnusableParameter;
  return traceManager_.addTrace(parameter.toInt32());
}

std::int32_t clsBaseVFP::removeTrace(const Variant& parameter) {
  traceManager_.removeTrace(ResultTypeRecord(parameter.toInt32()));
  return kStatusDone;
}

TraceObject& clsBaseVFP::activePainter() {
  if (traceManager_.activeTrace() == nullptr) raiseObjectVariableNotSet();
  return *traceManager_.activeTrace();
}

void clsBaseVFP::Caption(const std::string& text) {
  caption_ = text;
  child_.Caption(caption_);
}

// --- Areas

void clsBaseVFP::rightPanelVisible(bool visible) {
  rightPanelVisible_ = visible;
  showSideArea(child_.displayPanel(), visible);
}

void clsBaseVFP::bottomPanelVisible(bool visible) {
  bottomPanelVisible_ = visible;
  showSideArea(child_.controlPanel(), visible);
}

void clsBaseVFP::showSideArea(SideArea* area, bool visible) {
  guard("clsBaseVFP::showSideArea() ... ", [&] {
    if (area != nullptr) area->Visible(visible);
    child_.refreshMenuItems();
    Resize();
  });
}

SideArea* clsBaseVFP::shownDisplayPanel() { return rightPanelVisible_ ? child_.displayPanel() : nullptr; }
SideArea* clsBaseVFP::shownControlPanel() { return bottomPanelVisible_ ? child_.controlPanel() : nullptr; }

void clsBaseVFP::Resize() {
  guard("clsBaseVFP::Resize() ... ", [this] {
    reportWrongScaleModes();
    placeSideAreas();
    setDrawingArea();
  });
}

void clsBaseVFP::reportWrongScaleModes() {
  const auto check = [this](ScaleMode mode, const char* where) {
    if (mode != ScaleMode::Twips)
      errorHandler().Assert("clsBaseVFP::Resize() ... " + child_.typeName() + where);
  };
  check(child_.ViewScaleMode(), ".ScaleMode should be vbTwips");
  if (SideArea* const area = child_.controlPanel())
    check(area->ScaleMode(), ".ControlPanel.ScaleMode should be vbTwips");
  if (SideArea* const area = child_.displayPanel())
    check(area->ScaleMode(), ".DisplayPanel.ScaleMode should be vbTwips");
}

// The bottom area spans the whole width, the right one ends above it.
void clsBaseVFP::placeSideAreas() {
  const float viewWidth = child_.ViewScaleWidth();
  const float viewHeight = child_.ViewScaleHeight();
  float graphHeight = viewHeight;
  if (SideArea* const bottom = shownControlPanel()) {
    graphHeight = std::max(viewHeight - bottom->Height(), 0.0F);
    bottom->Move(0, graphHeight, viewWidth, bottom->Height());
  }
  child_.InvisibleHeightMarkY1(graphHeight);
  float graphWidth = viewWidth;
  if (SideArea* const right = shownDisplayPanel()) {
    graphWidth = std::max(viewWidth - right->Width(), 0.0F);
    right->Move(graphWidth, 0, right->Width(), graphHeight);
  }
  child_.InvisibleWidthMarkX1(graphWidth);
}

void clsBaseVFP::setDrawingArea() {
  guard("clsBaseVFP::setDrawingArea() ... ", [this] {
    float height = child_.ViewScaleHeight();
    if (SideArea* const bottom = shownControlPanel()) height -= bottom->Height();
    height = std::max(height, kSmallestDrawingAreaTwips);
    float width = child_.ViewScaleWidth();
    if (SideArea* const right = shownDisplayPanel()) width -= right->Width();
    width = std::max(width, kSmallestDrawingAreaTwips);
    const float marginX = marginTwips(width, child_.ViewDrawWidth(), metrics_.twipsPerPixelX);
    const float marginY = marginTwips(height, child_.ViewDrawWidth(), metrics_.twipsPerPixelY);
    traceManager_.drawingArea(marginX, marginY, width - marginX * 2.0F, height - marginY * 2.0F);
    traceManager_.setShadowDC();
    traceManager_.paintTraces(true);
    child_.ViewRefresh();
  });
}

}  // namespace frontpanels
