#include "workbench/spectrum_panel.h"

#include <span>
#include <vector>

#include "framework/support/host_codes.h"
#include "sources/channel_plans.h"
#include "spectrum/spectrum_view.h"

namespace frontpanels::workbench {

SpectrumPanel::SpectrumPanel(PanelFrame& frame, PanelListener& listener, const StoredPanel* stored)
    : Panel(PanelKind::Spectrum, frame, listener, stored) {
  // The operation's parameter says which kind of trace; this panel has the one.
  operate(kAddTraceOperation, static_cast<std::int32_t>(kAddTraceOperation));
  set(kAutoScaleParameter, true);
  nameChannels();
  showFirst(stored);
}

// Of all networks; which of them, and whether frequencies or channels are shown, the user chooses.
void SpectrumPanel::nameChannels() {
  for (const Channelization& plan : channelizations()) {
    for (const ChannelBand& band : plan.bands) {
      automation().call("ChannelZero", {band.order, band.zeroHz});
      automation().call("ChannelSpacing", {band.order, band.spacingHz});
      for (const ChannelBlock& block : band.blocks)
        automation().call("ChannelDiscontinuity", {band.order, block.channel, block.lowest, block.highest});
    }
    automation().call("ChannelLookup", {plan.value, plan.bands.front().order, plan.bands.back().order});
  }
}

// The bands of the network, then all that can be tuned to: nobody is kept from looking beside them. A
// recording has no bands.
void SpectrumPanel::giveBands() {
  std::vector<double> limits;
  double order = 0;
  if (inNetwork_) {
    if (const Channelization* const plan = channelization(receiver_.channelization()))
      for (const ChannelBand& band : plan->bands)
        limits.insert(limits.end(), {order++, band.lowestHz, band.highestHz});
  }
  limits.insert(limits.end(), {order, kLowestTunedHz, kHighestTunedHz});
  static_cast<void>(
      automation().number("Limits", {kCenterFrequencyParameter, std::span<const double>(limits)}));
}

bool SpectrumPanel::request(std::int16_t code, std::int16_t, double value) {
  return receiver_.request(code, value);
}

void SpectrumPanel::told(const ReceiverSetting& setting) {
  if (setting.code == kCenterFrequencyParameter) told_.centerHz = setting.value;
  if (setting.code == kSpanParameter) told_.spanHz = setting.value;
  if (setting.code == kChannelizationParameter) giveBands();
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
  inNetwork_ = simulator != nullptr;
  giveBands();
  if (simulator != nullptr) tell({kRbwParameter, receiver_.tuning(SpectrumTuning{}).rbwHz});
}

void SpectrumPanel::tune(DriveSimulator& simulator) const {
  simulator.tune(receiver_.tuning(SpectrumTuning{}));
}

}  // namespace frontpanels::workbench
