#include "workbench/spectrum_panel.h"

#include "workbench/failure.h"

namespace frontpanels::workbench {
namespace {

constexpr std::int32_t kResourceId = 1;
constexpr std::int32_t kMeasurementId = 1;
constexpr double kPeriodSeconds = 0.2;
constexpr const char* kSpectrumPath = "Brantor Scanner/Spectrum/Spectrum Trace";

// Codes of the host interface.
enum Parameter : std::int16_t {
  kMeasurementPeriod = 43,
  kDatabasePeriod = 44,
  kDisplayPeriod = 45,
  kMeasurement = 312,
  kCaption = 314,
  kResource = 315,
  kAutoScale = 722,
};
enum Operation : std::int16_t { kClose = 1, kAddTrace = 10, kShow = 12 };

void checkStatus(std::int32_t status, const char* meaning) {
  if (status == 0) return;
  throw HostFailure(std::string("The panel refused its ") + meaning + ": status " + std::to_string(status));
}

}  // namespace

SpectrumPanel::SpectrumPanel(PanelPlace& place, PanelRequests& requests)
    : control_(kProgId, L"SpectrumView1", place, requests),
      panel_(control_.automation()),
      hub_(Automation::create("FrontPanels.DataHub")) {
  set(kResource, "resource id", kResourceId);
  set(kMeasurement, "measurement id", kMeasurementId);
  set(kMeasurementPeriod, "measurement period", kPeriodSeconds);
  set(kDatabasePeriod, "database period", kPeriodSeconds);
  set(kDisplayPeriod, "display period", kPeriodSeconds);
  set(kCaption, "caption", "Spectrum");
  // The operation's parameter says which kind of trace; this panel has the one.
  operate(kAddTrace, "trace", static_cast<std::int32_t>(kAddTrace));
  set(kAutoScale, "auto scale", true);
  operate(kShow, "order to show", std::int32_t{0});
}

// A panel that refuses to be closed goes all the same.
SpectrumPanel::~SpectrumPanel() {
  try {
    operate(kClose, "close", std::int32_t{0});
  } catch (...) {
  }
}

void SpectrumPanel::set(const ReceiverSetting& setting) {
  const std::string meaning = "setting " + std::to_string(setting.code);
  set(setting.code, meaning.c_str(), setting.value);
  if (setting.code == Receiver::kCenterHz) told_.centerHz = setting.value;
  if (setting.code == Receiver::kSpanHz) told_.spanHz = setting.value;
}

void SpectrumPanel::show(const DisplaySweep& sweep) {
  if (sweep.range.centerHz != told_.centerHz) set({Receiver::kCenterHz, sweep.range.centerHz});
  if (sweep.range.spanHz != told_.spanHz) set({Receiver::kSpanHz, sweep.range.spanHz});
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
