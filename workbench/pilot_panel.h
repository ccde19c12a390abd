// The host's part for a pilot panel: its receiver, the frames of pilots in the order of their paths, the
// names of the cells.
#pragma once

#include <string>
#include <vector>

#include "pilot/pilot_sets.h"
#include "sources/pilot_receiver.h"
#include "workbench/panel.h"

namespace frontpanels::workbench {

class PilotPanel final : public Panel {
 public:
  PilotPanel(PanelFrame& frame, PanelListener& listener, const StoredPanel* stored);

  void meet(const DriveSimulator* simulator) override;
  void forgetTuning() override {}
  void tune(DriveSimulator& simulator) const override;
  [[nodiscard]] std::vector<std::int32_t> displays() const override;
  // As they were shown last.
  [[nodiscard]] const PilotFrame& shown() const noexcept { return shown_; }
  // Puts PN offsets at the end of the user's list and names on their cells; a name of nothing only lists.
  // Answers how many were taken.
  std::size_t addCells(const std::vector<CellName>& cells);
  [[nodiscard]] std::vector<CellName> cells() const override { return ownNames_; }

 private:
  bool show(const Frame& frame) override;
  bool request(std::int16_t code, std::int16_t index, double value) override;
  bool requestDisplay(std::int32_t resultType, bool on) override;
  [[nodiscard]] std::vector<ReceiverSetting> takeAnswers() override { return receiver_.takeAnswers(); }
  void told(const ReceiverSetting&) override {}
  void appendOwn(std::vector<StoredSetting>& settings) const override;

  void forgetOwn() override;
  void restoreOwn(const StoredPanel& stored) override;
  void showDisplays(const std::vector<std::int32_t>& resultTypes);
  void showNames();
  void publishLevels(PilotServer server, const PilotLevels& levels);
  void publishBars(PilotServer server, const PilotBars& bars);
  void publishCarrier(const CarrierState& carrier);

  PilotReceiver receiver_;
  Automation names_;
  std::vector<CellName> sourceNames_;
  std::vector<CellName> ownNames_;  // imported; they stand before those of the source
  bool shownOnce_ = false;          // the displays were chosen
  PilotFrame shown_;
  std::vector<float> column_;
};

}  // namespace frontpanels::workbench
