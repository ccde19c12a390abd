#include "framework/panel/base_vfp.h"

#include <algorithm>
#include <iterator>

#include "framework/support/error_handler.h"
#include "framework/support/guard.h"
#include "framework/support/host_codes.h"

namespace frontpanels {
namespace {

// A form of the host that shares the base without a display of its own to switch.
constexpr std::string_view kNetworkParametersForm = "frmNetworkParameters";

constexpr std::int16_t kLeftButton = 1;

}  // namespace

SharedPanelState& sharedPanelState() noexcept {
  static SharedPanelState state;
  return state;
}

clsBaseVFP::clsBaseVFP(const PanelEnvironment& environment, PanelControl& child)
    : child_(child),
      metrics_(environment.metrics),
      fonts_(environment.gdi, environment.metrics, boldLabels(environment.commandLine)),
      traceManager_(std::make_shared<clsTraceManager>(
          TraceManagerEnvironment{environment.gdi, environment.windowing, environment.metrics,
                                  fonts_.handles(), boldLabels(environment.commandLine)})) {
  traceManager_->setForm(&child_);
}

void clsBaseVFP::rescale(ScreenMetrics metrics) {
  guard("clsBaseVFP::rescale() ... ", [&] {
    metrics_ = metrics;
    LabelFontSet fonts = fonts_.scaledTo(metrics);
    traceManager_->rescale(metrics, fonts.handles());
    fonts_.swap(fonts);
  });
}

// --- Operations

struct clsBaseVFP::OperationRow {
  std::int16_t operation;
  std::int32_t (*run)(clsBaseVFP& base, const Variant& parameter);
};

const clsBaseVFP::OperationRow clsBaseVFP::kOperations[] = {
    {QUILL_VFP_CLOSE, [](clsBaseVFP& base, const Variant&) { return base.vfpClose(); }},
    {QUILL_VFP_SAVE,
     [](clsBaseVFP& base, const Variant&) {
       base.saveBase();
       return kStatusDone;
     }},
    {kAddTraceOperation, [](clsBaseVFP& base, const Variant& parameter) { return base.addTrace(parameter); }},
    {kRemoveTraceOperation,
     [](clsBaseVFP& base, const Variant& parameter) { return base.removeTrace(parameter); }},
    {kShowOperation, [](clsBaseVFP& base, const Variant&) { return base.show(); }},
    {QUILL_VFP_SAVE_SETUP,
     [](clsBaseVFP& base, const Variant& parameter) { return base.saveSetupUnder(parameter); }},
    {kLoggingOnOperation, [](clsBaseVFP& base, const Variant&) { return base.confirmLogging(); }},
    {kPlaybackOperation,
     [](clsBaseVFP& base, const Variant& parameter) { return base.startPlayback(parameter); }},
    {kDisplayStateOperation,
     [](clsBaseVFP& base, const Variant& parameter) { return base.setDisplayState(parameter); }},
};

std::int32_t clsBaseVFP::vfpOp(std::int32_t /*hardwareId*/, std::int16_t operation,
                               const Variant& parameter) {
  if (closing_) return kStatusDone;
  return guarded("clsBaseVFP::vfpOp() ... ", kStatusUnusableParameter, [&] {
    const auto* const row =
        std::find_if(std::begin(kOperations), std::end(kOperations),
                     [operation](const OperationRow& candidate) { return candidate.operation == operation; });
    return row == std::end(kOperations) ? kStatusUnknownOperation : row->run(*this, parameter);
  });
}

std::int32_t clsBaseVFP::vfpClose() {
  closing_ = true;
  sharedPanelState().dirty = true;
  const bool ownWindow = isCommonBase();
  commonBase_ = nullptr;
  if (ownWindow) child_.ViewVisible(false);
  return kStatusDone;
}

// The status word comes with the next change of logging or saving: a panel that was just shown has neither.
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
  return traceManager_->addTrace(parameter.toInt32());
}

std::int32_t clsBaseVFP::removeTrace(const Variant& parameter) {
  traceManager_->removeTrace(ResultTypeRecord(parameter.toInt32()));
  return kStatusDone;
}

std::int32_t clsBaseVFP::saveSetupUnder(const Variant& parameter) {
  if (!parameter.isNumeric()) {
    errorHandler().Assert("clsBaseVFP::vfpOp() ... QUILL_VFP_SAVE_SETUP requires a numeric parameter");
    return kStatusUnusableParameter;
  }
  saveSetup(parameter.toInt32());
  return kStatusDone;
}

std::int32_t clsBaseVFP::confirmLogging() {
  loggingConfirmed_ = true;
  logIndicatorHandler();
  return kStatusDone;
}

std::int32_t clsBaseVFP::startPlayback(const Variant& parameter) {
  playback = true;
  if (!isCommonBase()) commonBase_->vfpOp(resourceId_, kPlaybackOperation, parameter);
  child_.refreshControls();
  logIndicatorHandler();
  if (child_.typeName() != kNetworkParametersForm) {
    decideMenuItem(kDisplayStateOnItem, &MenuItemState::enabled, false);
    decideMenuItem(kDisplayStateOffItem, &MenuItemState::enabled, false);
  }
  decideMenuItem(kCloseItem, &MenuItemState::enabled, false);
  child_.ViewVisible(true);
  return kStatusDone;
}

// Whatever is not 0 means on, also what is no number.
std::int32_t clsBaseVFP::setDisplayState(const Variant& parameter) {
  displayState_ = parameter.isNumeric() && parameter.toDouble() == 0 ? 0 : 1;
  child_.refreshMenuItems();
  return kStatusDone;
}

// --- The reverse path

std::int32_t clsBaseVFP::baseVfpOp(std::int32_t hardwareId, std::int16_t operation,
                                   const Variant& parameter) {
  if (closing_) return kStatusDone;
  return guarded("clsBaseVFP::baseVfpOp() ... ", kStatusUnusableParameter, [&] {
    if (operation < kFirstPlaybackOperation)
      return child_.vfpOp(hardwareId, operation, parameter, furtherArgument());
    const auto playbackOperation = static_cast<std::int16_t>(operation - kFirstPlaybackOperation);
    return child_.playbackOp(hardwareId, playbackOperation, parameter, furtherArgument());
  });
}

std::int32_t clsBaseVFP::baseVfpSet(std::int32_t hardwareId, std::int16_t parameterType, std::int16_t index,
                                    const Variant& value) {
  if (closing_) return kStatusDone;
  return guarded("clsBaseVFP::baseVfpSet() ... ", kStatusUnusableParameter,
                 [&] { return child_.vfpSet(hardwareId, parameterType, index, value, furtherArgument()); });
}

std::int32_t clsBaseVFP::displayParameter(std::int16_t order, const Variant& newValue) {
  if (closing_) return kStatusDone;
  return guarded("clsBaseVFP::displayParameter() ... ", kStatusUnusableParameter,
                 [&] { return child_.vfpSet(resourceId_, order, 0, newValue, furtherArgument()); });
}

// --- Requests to the host

void clsBaseVFP::reportStatus(std::string_view routine, std::int32_t status) {
  if (status == kStatusDone) return;
  errorHandler().ReportError(child_.typeName().append(routine) + " status = " + std::to_string(status));
}

void clsBaseVFP::closeVfp() {
  guard("clsBaseVFP::closeVfp() ... ", [this] {
    if (child_.frontPanelOp(resourceId_, virtualFrontPanelId, QUILL_VFP_CLOSE, Variant()) != kStatusDone)
      errorHandler().ReportError("QUILL_VFP_CLOSE failed");
  });
}

void clsBaseVFP::saveVfp() {
  guard("clsBaseVFP::saveVfp() ... ", [this] {
    if (child_.frontPanelOp(resourceId_, virtualFrontPanelId, QUILL_VFP_SAVE, Variant()) != kStatusDone)
      errorHandler().ReportError("QUILL_VFP_SAVE failed");
  });
}

void clsBaseVFP::saveBase() {
  guard("clsBaseVFP::saveBase() ... ", [this] {
    reportStatus("::saveBase()", child_.saveDisplaySettings(resourceId_, virtualFrontPanelId, settings()));
  });
}

void clsBaseVFP::saveSetup(std::int32_t setUpId) {
  guard("clsBaseVFP::saveSetup() ... ", [&] {
    reportStatus("::saveSetup()", child_.saveSetup(setUpId, resourceId_, virtualFrontPanelId, settings()));
  });
}

std::int32_t clsBaseVFP::frontPanelOp(std::int32_t hwId, std::int32_t vfpId, std::int16_t operation,
                                      const Variant& argument) {
  return guarded("clsBaseVFP::frontPanelOp() ... ", kStatusUnusableParameter,
                 [&] { return child_.frontPanelOp(hwId, vfpId, operation, argument); });
}

std::int32_t clsBaseVFP::frontPanelSet(std::int32_t hwId, std::int32_t vfpId, std::int16_t parameterType,
                                       std::int16_t index, const Variant& value) {
  return guarded("clsBaseVFP::frontPanelSet() ... ", kStatusUnusableParameter,
                 [&] { return child_.frontPanelSet(hwId, vfpId, parameterType, index, value); });
}

// --- Passed on to the control

void clsBaseVFP::frontPanelLink(const FrontPanelLink& link) {
  if (closing_) return;
  guard("clsBaseVFP::frontPanelLink() ... ", [&] { child_.frontPanelLink(link); });
}

std::int32_t clsBaseVFP::measurementInfo(Variant& measurementTypes) {
  if (closing_) return kStatusDone;
  return guarded("clsBaseVFP::measurementInfo() ... ", kStatusUnusableParameter,
                 [&] { return child_.measurementInfo(measurementTypes); });
}

std::string clsBaseVFP::activeControlLink() {
  return guarded("clsBaseVFP::activeControlLink() ... ", std::string(),
                 [&] { return child_.activeControlLink(); });
}

Variant clsBaseVFP::initializeLinkValue(std::int16_t linkType, std::int32_t genericId) {
  if (closing_) return {};
  return guarded("clsBaseVFP::initializeLinkValue() ... ", Variant(),
                 [&] { return child_.initializeLinkValue(linkType, genericId); });
}

bool clsBaseVFP::actionEnabled(std::int16_t action) {
  if (closing_) return false;
  return guarded("clsBaseVFP::actionEnabled() ... ", false, [&] { return child_.actionEnabled(action); });
}

std::string clsBaseVFP::reportHtml() {
  return guarded("clsBaseVFP::reportHtml() ... ", std::string(), [&] { return child_.reportHtml(); });
}

std::string clsBaseVFP::linkSourceName() {
  return guarded("clsBaseVFP::linkSourceName() ... ", std::string(), [&] { return child_.linkSourceName(); });
}

// --- Events

void clsBaseVFP::MouseDown(std::int16_t button, std::int16_t shift, float xTwips, float yTwips) {
  guard("clsBaseVFP::MouseDown() ... ", [&] {
    if (button == kLeftButton) traceManager_->MouseDown(button, shift, xTwips, yTwips);
  });
}

void clsBaseVFP::MouseMove(std::int16_t button, std::int16_t shift, float xTwips, float yTwips) {
  guard("clsBaseVFP::MouseMove() ... ", [&] { traceManager_->MouseMove(button, shift, xTwips, yTwips); });
}

void clsBaseVFP::MouseUp(std::int16_t button, std::int16_t shift, float xTwips, float yTwips) {
  guard("clsBaseVFP::MouseUp() ... ", [&] { traceManager_->MouseUp(button, shift, xTwips, yTwips); });
}

bool clsBaseVFP::usesKey(std::int16_t keyCode, std::int16_t shift) {
  if (closing_) return false;
  return guarded("clsBaseVFP::usesKey() ... ", false, [&] {
    const auto command = plotCommandOf(keyCode, shift);
    return command && child_.canRun(*command);
  });
}

bool clsBaseVFP::KeyDown(std::int16_t keyCode, std::int16_t shift) {
  if (!usesKey(keyCode, shift)) return false;
  guard("clsBaseVFP::KeyDown() ... ", [&] { child_.run(plotCommandOf(keyCode, shift).value()); });
  return true;
}

// Keys act when they go down.
void clsBaseVFP::KeyUp(std::int16_t /*keyCode*/, std::int16_t /*shift*/) {}

void clsBaseVFP::Activate() {
  if (closing_) return;
  guard("clsBaseVFP::Activate() ... ", [this] { child_.refreshMenuItems(); });
}

void clsBaseVFP::QueryUnload(bool& cancel) {
  if (closing_) return;
  guard("clsBaseVFP::QueryUnload() ... ", [&] {
    cancel = true;
    if (!recordMode) child_.closeVfp();
  });
}

void clsBaseVFP::Paint() {
  guard("clsBaseVFP::Paint() ... ", [this] { traceManager_->paintTraces(true); });
}

// --- Members that tell when they are replaced

void clsBaseVFP::traceManager(std::shared_ptr<clsTraceManager> manager) {
  guard("clsBaseVFP::traceManager() ... ", [&] {
    if (!manager) raiseObjectVariableNotSet();
    traceManager_ = std::move(manager);
    traceManager_->setForm(&child_);
    errorHandler().Assert("Warning...clsBaseVFP::traceManager() is setting v_traceManager");
  });
}

void clsBaseVFP::popUpMenu(PopUpMenu* menu) {
  popUpMenu_ = menu;
  errorHandler().Assert("Warning...clsBaseVFP::popUpMenu() is setting v_popUpMenu");
}

void clsBaseVFP::resourceId(std::int32_t id) noexcept {
  resourceId_ = id;
  resourceIdValid_ = true;
}

}  // namespace frontpanels
