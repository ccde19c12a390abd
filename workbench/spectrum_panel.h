// The host's part for a spectrum panel: its receiver, its trace, the sweeps.
#pragma once

#include "sources/receiver.h"
#include "workbench/panel.h"

namespace frontpanels::workbench {

class SpectrumPanel final : public Panel {
 public:
  SpectrumPanel(PanelFrame& frame, PanelListener& listener, const StoredPanel* stored);

  void meet(const DriveSimulator* simulator) override;
  void forgetTuning() override { receiver_.showWholeSweeps(); }
  [[nodiscard]] bool tuned() const override { return receiver_.tuned(); }
  void tune(DriveSimulator& simulator) const override;
  // As it was shown last; without values before the first one.
  [[nodiscard]] const DisplaySweep& shown() const noexcept { return shown_; }

 private:
  // Retunes the panel when the range is another, and hands it the levels.
  bool show(const Frame& frame) override;
  bool request(std::int16_t code, std::int16_t index, double value) override;
  bool requestDisplay(std::int32_t, bool) override { return false; }
  [[nodiscard]] std::vector<ReceiverSetting> takeAnswers() override { return receiver_.takeAnswers(); }
  void told(const ReceiverSetting& setting) override;
  void appendOwn(std::vector<StoredSetting>&) const override {}
  void tell(const ReceiverSetting& setting);
  void nameChannels();
  void giveBands();

  Receiver receiver_;
  FrequencyRange told_;
  bool inNetwork_ = false;  // the source is one that has bands
  DisplaySweep shown_;
};

}  // namespace frontpanels::workbench
