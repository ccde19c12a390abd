#include "workbench/spectrum_panel.h"

#include <algorithm>
#include <span>
#include <utility>
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

// The bands of the network, then what lies beside them: nobody is kept from looking there. A recording has no
// bands.
void SpectrumPanel::giveBands() {
  std::vector<std::pair<double, double>> ranges;
  const Channelization* const plan = inNetwork_ ? channelization(receiver_.channelization()) : nullptr;
  if (plan != nullptr)
    for (const ChannelBand& band : plan->bands) ranges.emplace_back(band.lowestHz, band.highestHz);
  std::vector<std::pair<double, double>> rising = ranges;
  std::sort(rising.begin(), rising.end());
  double fromHz = kLowestTunedHz;
  for (const auto& [lowestHz, highestHz] : rising) {
    ranges.emplace_back(fromHz, lowestHz);
    fromHz = highestHz;
  }
  ranges.emplace_back(fromHz, kHighestTunedHz);

  std::vector<double> limits;
  for (const auto& [lowestHz, highestHz] : ranges)
    limits.insert(limits.end(), {static_cast<double>(limits.size() / 3), lowestHz, highestHz});
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
