#include "workbench/spectrum_panel.h"

#include "framework/support/host_codes.h"
#include "spectrum/spectrum_view.h"

namespace frontpanels::workbench {

SpectrumPanel::SpectrumPanel(PanelFrame& frame, PanelListener& listener, const StoredPanel* stored)
    : Panel(PanelKind::Spectrum, frame, listener, stored) {
  // The operation's parameter says which kind of trace; this panel has the one.
  operate(kAddTraceOperation, static_cast<std::int32_t>(kAddTraceOperation));
  set(kAutoScaleParameter, true);
  showFirst(stored);
}

bool SpectrumPanel::request(std::int16_t code, std::int16_t, double value) {
  return receiver_.request(code, value);
}

void SpectrumPanel::told(const ReceiverSetting& setting) {
  if (setting.code == kCenterFrequencyParameter) told_.centerHz = setting.value;
  if (setting.code == kSpanParameter) told_.spanHz = setting.value;
}

void SpectrumPanel::tell(const ReceiverSetting& setting) {
  set(setting.code, setting.value);
  told(setting);
}

bool SpectrumPanel::show(const Frame& frame) {
  if (!frame.sweep) return false;
  shown_ = receiver_.receive(*frame.sweep);
  if (shown_.count == 0) return false;
  if (shown_.range.centerHz != told_.centerHz) tell({kCenterFrequencyParameter, shown_.range.centerHz});
  if (shown_.range.spanHz != told_.spanHz) tell({kSpanParameter, shown_.range.spanHz});
  publish(SpectrumView::kSpectrumPath, shown_.shown());
  return true;
}

// The panel learns what the simulated receiver is set to where nothing was asked for.
void SpectrumPanel::meet(const DriveSimulator* simulator) {
  if (simulator != nullptr) tell({kRbwParameter, receiver_.tuning(SpectrumTuning{}).rbwHz});
}

void SpectrumPanel::tune(DriveSimulator& simulator) const {
  simulator.tune(receiver_.tuning(SpectrumTuning{}));
}

}  // namespace frontpanels::workbench
