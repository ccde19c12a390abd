// The host's part for a panel, as far as it is the same for all: identity, periods, caption, place, show;
// answers to its requests; its pop-up menu; what is kept for it; pictures and reports.
#pragma once

#include <windows.h>

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "hosting/settings_file.h"
#include "sources/drive_simulator.h"
#include "sources/frame.h"
#include "sources/receiver.h"
#include "workbench/automation.h"
#include "workbench/hosted_control.h"
#include "workbench/panel_kinds.h"
#include "workbench/panel_window.h"

namespace frontpanels::workbench {

// What the program hears of its panels. All but `operationAsked` come when the panel's event is over.
class PanelListener {
 public:
  // The panel wants to be closed, by its window, its menu or its own button.
  virtual void closeAsked(PanelKind kind) = 0;
  // One sweep, sweeps, none any more: an operation of the host. Called inside the panel's event; false
  // refuses.
  virtual bool operationAsked(PanelKind kind, std::int16_t operation) = 0;
  // There are requests to be answered with `Panel::answer`, once the event is over.
  virtual void answerWanted(PanelKind kind) = 0;
  // Handed over by the panel, with the id of a set-up or as the settings that hold; inside the panel's event.
  virtual void settingsHanded(PanelKind kind, std::optional<std::int32_t> setUp,
                              std::vector<StoredSetting> settings) = 0;
  // The user wants the panel's pop-up menu.
  virtual void popUpAsked(PanelKind kind, POINT onScreen) = 0;

 protected:
  ~PanelListener() = default;
};

struct CellName {
  std::int32_t pnOffset = 0;
  std::string name;
};

// What is kept for a panel from one run to the next.
struct StoredPanel {
  Properties properties;
  std::vector<StoredSetting> settings;
  std::optional<RECT> boundsTwips;
  // Result types of the displays that were on, of a panel with several.
  std::optional<std::vector<std::int32_t>> displays;
  std::vector<CellName> cells;
};

struct PopUpItem {
  std::int16_t id = 0;
  const char* caption = nullptr;
  bool checked = false;
  bool enabled = true;
};

class Panel : private PanelWindowEvents, private PanelRequests {
 public:
  Panel(const Panel&) = delete;
  Panel& operator=(const Panel&) = delete;
  virtual ~Panel();

  [[nodiscard]] PanelKind kind() const noexcept { return row_.kind; }
  [[nodiscard]] PanelWindow& window() noexcept { return window_; }

  // Hands over what the frame has for the panel.
  void receive(const Frame& frame);
  // What the source knows beside its frames; null for a recording.
  virtual void meet(const DriveSimulator* simulator) = 0;
  // Another source: what the panel was tuned to no longer holds.
  virtual void forgetTuning() = 0;
  virtual void tune(DriveSimulator& simulator) const = 0;
  // Tells the panel what was set since the last call. True when something was.
  bool answer();

  // Operations of the host
  void save();
  void saveSetUp(std::int32_t setUp);
  void restore(const StoredPanel& stored);
  void logging(bool on);
  void playback();
  [[nodiscard]] bool isPlayback() const noexcept { return playback_; }

  // The host's pop-up menu, with the panel's word on which items are checked and greyed.
  [[nodiscard]] std::vector<PopUpItem> popUpItems();
  void popUpClick(std::int16_t item);

  [[nodiscard]] Properties properties() const { return control_->properties(); }
  [[nodiscard]] RECT boundsTwips();
  [[nodiscard]] virtual std::vector<std::int32_t> displays() const { return {}; }
  [[nodiscard]] virtual std::vector<CellName> cells() const { return {}; }
  // Whether the panel was tuned by its user, rather than following its source.
  [[nodiscard]] virtual bool tuned() const { return false; }
  // Read from the panel, with what the host knows besides.
  [[nodiscard]] std::vector<StoredSetting> settings();
  // What the graph shows, as PNG.
  void savePicture(const std::string& path) { panel_->call("SavePicture", {path}); }
  [[nodiscard]] std::string reportHtml() { return panel_->text("reportHtml"); }

 protected:
  // Raises `NotRegistered`, or a failure that says what the panel refused.
  Panel(PanelKind kind, PanelFrame& frame, PanelListener& listener, const StoredPanel* stored);

  void set(std::int16_t code, const Value& value, std::int16_t index = 0);
  void operate(std::int16_t operation, const Value& parameter);
  void publish(std::string_view path, const Value& value);
  [[nodiscard]] Automation& automation() noexcept { return *panel_; }
  // The end of each panel's construction.
  void showFirst(const StoredPanel* stored);

  // False when the frame has nothing for the panel.
  virtual bool show(const Frame& frame) = 0;
  // A request of the panel; false, and nothing has changed, for what the receiver cannot take.
  virtual bool request(std::int16_t code, std::int16_t index, double value) = 0;
  // Operations 10 and 11: a display of the panel comes or goes.
  virtual bool requestDisplay(std::int32_t resultType, bool on) = 0;
  [[nodiscard]] virtual std::vector<ReceiverSetting> takeAnswers() = 0;
  // The panel was told a setting of its receiver.
  virtual void told(const ReceiverSetting& setting) = 0;
  // What the host keeps beside what the panel hands over; it is restored after that, and forgotten before.
  virtual void forgetOwn() {}
  virtual void restoreOwn(const StoredPanel&) {}
  virtual void appendOwn(std::vector<StoredSetting>& settings) const = 0;

 private:
  // PanelWindowEvents
  void closeAsked() override { listener_.closeAsked(kind()); }
  void popUpAsked(POINT onScreen) override { listener_.popUpAsked(kind(), onScreen); }
  // PanelRequests
  std::int32_t frontPanelOp(PanelIds ids, std::int16_t operation, std::int32_t argument) override;
  std::int32_t frontPanelSet(PanelIds ids, std::int16_t parameterType, std::int16_t index,
                             double value) override;
  std::int32_t saveDisplaySettings(PanelIds ids, const VARIANT& list) override;
  std::int32_t saveSetup(std::int32_t setUpId, PanelIds ids) override;

  void introduce();
  void giveCaption();
  void restoreOne(const StoredSetting& setting);
  void restoreMarkers();
  [[nodiscard]] std::vector<StoredSetting> storedSettings(const VARIANT& list) const;
  void close() noexcept;
  [[nodiscard]] bool answers() const noexcept { return ready_ && !closed_; }

  const PanelKindRow& row_;
  PanelListener& listener_;
  PanelWindow window_;
  std::optional<HostedControl> control_;
  std::optional<Automation> panel_;
  std::optional<Automation> hub_;
  // To be restored once there is a trace to stand on; none at all is a restored state, too.
  std::optional<std::vector<StoredSetting>> markers_;
  bool received_ = false;
  bool measurementShown_ = true;  // before it logged
  bool playback_ = false;
  bool logging_ = false;
  bool changed_ = false;  // asked for since the last answer
  bool ready_ = false;    // whole: requests can be dealt with
  bool closed_ = false;
};

[[nodiscard]] std::unique_ptr<Panel> openPanel(PanelKind kind, PanelFrame& frame, PanelListener& listener,
                                               const StoredPanel* stored);

}  // namespace frontpanels::workbench
