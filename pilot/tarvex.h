// Tarvex: the panel that shows the pilots of a CDMA carrier, all of them or a window of the code as traces of
// energy over PN offset, the strongest ones and those of a list as bars. This is the whole control except its
// window.
//
// A set of pilots is on display from its first whole frame, or from the host's word, until the user or the
// host switches it off. What the user enters about the measurement is a request to the host; what only
// changes the picture stays on the panel, for the trace that is the active one, and goes to the host with the
// settings.
#pragma once

#include <array>
#include <cstdint>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "framework/panel/field_panel.h"
#include "framework/support/utility.h"
#include "painters/bar_chart_painter.h"
#include "painters/cell_names.h"
#include "painters/marker_commands.h"
#include "painters/multi_trace_painter.h"
#include "pilot/multipath_frame.h"
#include "pilot/pilot_fields.h"
#include "pilot/pilot_sets.h"
#include "platform/dialogs.h"
#include "platform/textfile.h"

namespace frontpanels {

// What the import of a PN list needs. Everything referred to must outlive the panel.
struct PilotServices {
  FileDialogs& fileDialogs;
  TextFiles& textFiles;
  RegionalSeparators& separators;
};

class Tarvex final : public FieldPanel {
 public:
  static constexpr const char* kTypeName = "Tarvex";
  // Of a trace over PN offset.
  static constexpr std::size_t kMaxPoints = 513;

  Tarvex(const PanelEnvironment& environment, const PilotServices& services, PanelHost& host,
         PanelContainer& container);
  ~Tarvex() override = default;
  Tarvex(const Tarvex&) = delete;
  Tarvex& operator=(const Tarvex&) = delete;

  // --- Entry points of the host. Each answers a status as in host_codes.h.
  std::int32_t vfpOp(std::int32_t hardwareId, std::int16_t operation, const Variant& parameter,
                     clsBaseVFP* base = nullptr) override;
  std::int32_t vfpSet(std::int32_t hardwareId, std::int16_t parameterType, std::int16_t index,
                      const Variant& value, clsBaseVFP* base = nullptr) override;

  // --- Data
  // The paths that a server is subscribed to, separated by the escape character; their order is that of
  // pilotServers. Kept with the form.
  [[nodiscard]] const std::string& paths(PilotServer server) const;
  void paths(PilotServer server, std::string paths);
  // What the sets hold now: levels by PN offset, and multipath records (see MultipathFrame).
  [[nodiscard]] std::span<const float> AllPilotsData() const;
  [[nodiscard]] std::span<const float> ZoomedPilotsData() const;
  [[nodiscard]] std::span<const float> TopNData() const;
  [[nodiscard]] std::span<const float> UserListData() const;
  // Whole updates so far. It only grows, and stays at the largest number of its 16 bits.
  [[nodiscard]] std::int16_t updateCount() const noexcept { return updateCount_; }
  // Names of the cells on the bars; null for none.
  [[nodiscard]] const std::shared_ptr<const CellNames>& CellNameInfo() const noexcept { return cellNames_; }
  void CellNameInfo(std::shared_ptr<const CellNames> names);
  // A record that came in a result buffer: the set's total power, then its values.
  void resultData(std::int32_t resultTypeId, ResultReader& reader, clsBaseVFP* base) override;

  // --- Marker commands, on the traces over PN offset
  void addMarker() { markers_.addMarker(); }
  void addDeltaMarker() { markers_.addDeltaMarker(); }
  void deleteMarker() { markers_.deleteMarker(); }
  void markerToMax() { markers_.markerToMax(); }
  void markerToMin() { markers_.markerToMin(); }

  // --- The panel as its base sees it
  void refreshControls() override;
  void appendSettings(PanelSettings& settings) override;
  void changedTraceConfiguration(TraceState state, TraceObject* activeTrace,
                                 std::int16_t resultType) override;
  std::int32_t measurementInfo(Variant& measurementTypes) override;
  std::string reportHtml() override;

  [[nodiscard]] PilotFields& fields() noexcept { return fields_; }

 private:
  struct ParameterRow;
  struct BarParameterRow;
  static const ParameterRow kParameters[];
  static const BarParameterRow kBarParameters[];
  using Handler = void (Tarvex::*)();
  static constexpr std::int16_t kNoTrace = -1;

  // One set's data, and whether it is to be seen.
  struct SetState {
    std::optional<float> ioDbm;
    std::array<float, kMaxPoints> levels{};  // of a trace
    std::size_t points = 0;
    MultipathFrame frame;      // of bars
    bool switchedOff = false;  // data alone do not bring the display back
  };
  [[nodiscard]] SetState& state(PilotSet set) noexcept { return states_[static_cast<std::size_t>(set)]; }
  [[nodiscard]] const SetState& state(PilotSet set) const noexcept {
    return states_[static_cast<std::size_t>(set)];
  }

  // Data
  void subscribe(DataHub& hub);
  void pathChanged(PilotServer server, std::int32_t index);
  void showCarrier(const DataServer& source, std::int32_t index);
  void takeIo(PilotSet set, const Variant& value);
  [[nodiscard]] std::span<const float> readPath(const DataServer& source, std::int32_t index);
  void takeLevels(PilotSet set, std::span<const float> levels);
  void takeColumn(PilotSet set, const DataServer& source, std::int32_t index);
  [[nodiscard]] std::span<const float> levelsOf(PilotSet set) const;
  void showLevels(PilotSet set);
  void showBars(PilotSet set);
  void completeUpdate();
  void showIo();

  // Displays
  [[nodiscard]] std::int32_t addDisplay(const Variant& resultType);
  [[nodiscard]] std::int32_t removeDisplay(const Variant& resultType);
  void addDisplay(const PilotSetRow& row);
  void removeDisplay(const PilotSetRow& row);
  void switchSet(PilotSet set, bool on);
  void showSet(const PilotSetRow& row, bool on);
  void setInsets(PlotPainter& painter) const;
  void rescaled() override;
  void setUp(clsMultiTracePainter& painter, PilotSet set);
  void setUp(clsBarChartPainter& painter, PilotSet set);
  void placeXAxis(clsMultiTracePainter& painter, PilotSet set);
  [[nodiscard]] TraceObject* displayOf(const PilotSetRow& row);
  template <class Painter>
  [[nodiscard]] Painter* findOrAddDisplay(PilotSet set);
  [[nodiscard]] clsBarChartPainter* currentBars();
  [[nodiscard]] clsBarChartPainter* userListBars();
  void chooseCurrentBars(const TraceObject* activeTrace);
  [[nodiscard]] static bool withIo(const TraceObject& display);
  void showActiveTrace();
  void showBarSettings();
  void showBarLabel(std::int16_t otherIs);
  void showVerticalAxis();
  void tracesRefreshed() override;

  // Fields to handlers
  void bindFields();
  void bindEntries();
  void bindLists();
  void bindButtons();
  void setClick(const PilotSetRow& row);
  [[nodiscard]] bool askForSet(const PilotSetRow& row, std::string_view routine, bool on);
  void newTopN();
  void newCodeStart();
  void newCodeStop();
  void newCodeStartStop(bool startChanged);
  void newCodeCenter();
  void newCodeSpan();
  void newCodeCenterSpan(bool centerChanged);
  void newFormat();
  void newCdmaFormat(std::int16_t format);
  void newCdmaUnits();
  void newPnIncrement();
  void newCarrierFrequency();
  void newChannelization();
  template <class Change>
  void changeBars(Change change);
  void SortByComboBox_Click();
  void SortAscendingOptionButton_Click();
  void SortDescendingOptionButton_Click();
  void sortOrderClick(std::string_view routine, std::int16_t order);
  void BarLabelComboBox_Click();
  void NewBarChartStyle();
  void newThreshold();
  void ShowCellNameCheckBox_Click();
  void PowerDisplayComboBox_LostFocus();
  void newVerticalScale();
  void newVerticalOffset();
  void AutoScaleBox_Click();

  // The user's PN list
  struct PnEdit {
    std::int16_t index;
    std::int32_t pn;
  };
  void userPNListAddButton_Click();
  void userPNListDeleteButton();
  void userPNListListBox_Click();
  void userPNListImportButton();
  [[nodiscard]] std::optional<std::vector<std::int32_t>> readPnFile(const std::string& path);
  void importPns(std::span<const std::int32_t> pns);
  [[nodiscard]] bool tellHostOfPn(std::string_view routine, const PnEdit& edit);
  void takeBack(std::int32_t position, std::int32_t pn);
  void userPnListChanged();

  // What the host sends
  bool setOwnParameter(std::int16_t parameterType, std::int16_t index, const Variant& value);
  void formatFromHost(std::int16_t format);
  void setUserPn(std::int16_t index, const Variant& value);
  void showCodeWindow();
  void showPower(const PilotSetRow& row, bool withIo);
  static void showPower(clsBarChartPainter& bars, bool withIo);
  static void showPower(clsMultiTracePainter& painter, bool withIo);

  // Links
  bool linkParameter(const FrontPanelLink& link) override;
  std::optional<double> linkedValue(std::int32_t parameterType) override;
  [[nodiscard]] clsNumericEntry* linkedEntry(std::int32_t parameterType);
  [[nodiscard]] PlotCommands& plotCommands() override { return markers_; }

  PilotServices services_;
  PilotFields fields_;
  MarkerCommands markers_;
  std::array<SetState, kPilotSets> states_;
  std::array<std::string, kPilotServers> paths_;
  std::vector<float> values_;  // of the path that is being read
  std::int16_t updateCount_ = 0;
  std::int16_t currentBarTrace_ = kNoTrace;  // the chart that codes and bar fields act on
  std::shared_ptr<const CellNames> cellNames_;
  // What the vertical entries show of a display that scales itself.
  std::optional<double> shownTop_;
  double shownPerDivision_ = 0;
  const PnEdit* editWithHost_ = nullptr;  // the edit of the list that the host is being told of
  bool updateInProgress_ = false;         // an entry of the code window is with the host

  std::vector<std::unique_ptr<DataServer>> servers_;  // in the order of PilotServer
};

}  // namespace frontpanels
