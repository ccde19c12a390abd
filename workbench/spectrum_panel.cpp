#include "workbench/spectrum_panel.h"

#include "framework/support/host_codes.h"
#include "workbench/failure.h"

namespace frontpanels::workbench {
namespace {

constexpr std::int32_t kResourceId = 1;
constexpr std::int32_t kMeasurementId = 1;
constexpr double kPeriodSeconds = 0.2;
constexpr const char* kSpectrumPath = "Brantor Scanner/Spectrum/Spectrum Trace";

void checkStatus(std::int32_t status, const char* meaning) {
  if (status == 0) return;
  throw HostFailure(std::string("The panel refused its ") + meaning + ": status " + std::to_string(status));
}

}  // namespace

SpectrumPanel::SpectrumPanel(PanelPlace& place, PanelRequests& requests)
    : control_(kProgId, L"SpectrumView1", place, requests),
      panel_(control_.automation()),
      hub_(Automation::create("FrontPanels.DataHub")) {
  set(PARM_RESOURCE_ID, "resource id", kResourceId);
  set(PARM_MEASUREMENT_ID, "measurement id", kMeasurementId);
  set(TIME_MEASUREMENT_PERIOD, "measurement period", kPeriodSeconds);
  set(TIME_DATABASE_PERIOD, "database period", kPeriodSeconds);
  set(TIME_DISPLAY_PERIOD, "display period", kPeriodSeconds);
  set(kCaptionParameter, "caption", "Spectrum");
  // The operation's parameter says which kind of trace; this panel has the one.
  operate(kAddTraceOperation, "trace", static_cast<std::int32_t>(kAddTraceOperation));
  set(kAutoScaleParameter, "auto scale", true);
  operate(kShowOperation, "order to show", std::int32_t{0});
}

// A panel that refuses to be closed goes all the same.
SpectrumPanel::~SpectrumPanel() {
  try {
    operate(QUILL_VFP_CLOSE, "close", std::int32_t{0});
  } catch (...) {
  }
}

void SpectrumPanel::set(const ReceiverSetting& setting) {
  const std::string meaning = "setting " + std::to_string(setting.code);
  set(setting.code, meaning.c_str(), setting.value);
  if (setting.code == kCenterFrequencyParameter) told_.centerHz = setting.value;
  if (setting.code == kSpanParameter) told_.spanHz = setting.value;
}

void SpectrumPanel::show(const DisplaySweep& sweep) {
  if (sweep.range.centerHz != told_.centerHz) set({kCenterFrequencyParameter, sweep.range.centerHz});
  if (sweep.range.spanHz != told_.spanHz) set({kSpanParameter, sweep.range.spanHz});
  hub_.call("Publish", {kSpectrumPath, sweep.shown()});
}

void SpectrumPanel::savePicture(const std::string& path) { panel_.call("SavePicture", {path}); }

void SpectrumPanel::set(std::int16_t parameter, const char* meaning, const Value& value) {
  checkStatus(panel_.number("vfpSet", {kResourceId, parameter, std::int16_t{0}, value}), meaning);
}

void SpectrumPanel::operate(std::int16_t operation, const char* meaning, const Value& parameter) {
  checkStatus(panel_.number("vfpOp", {kResourceId, operation, parameter}), meaning);
}

}  // namespace frontpanels::workbench
