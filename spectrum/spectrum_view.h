// SpectrumView: the panel that shows power against frequency. This is the whole control except its window:
// the window side (a registered control, a headless renderer, a test) hands over an environment, forwards
// events and calls the host's entry points. Positions of mouse events are twips of the view.
//
// A setting goes one of two ways. What the user enters runs the field's handler, which tells the host by
// `frontPanelSet`; what the host sends by `vfpSet` is shown and not sent back.
#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "framework/panel/base_vfp.h"
#include "framework/panel/hosted_panel.h"
#include "framework/panel/picture_area.h"
#include "painters/multi_trace_painter.h"
#include "spectrum/spectrum_fields.h"

namespace frontpanels {

class SpectrumView final : public HostedPanel {
 public:
  static constexpr const char* kTypeName = "SpectrumView";
  static constexpr const char* kSpectrumPath = "Brantor Scanner/Spectrum/Spectrum Trace";
  static constexpr std::int16_t kSpectrumResultType = 25;
  static constexpr std::int32_t kMaxPoints = 513;

  SpectrumView(const PanelEnvironment& environment, PanelHost& host, PanelContainer& container);
  ~SpectrumView() override = default;
  SpectrumView(const SpectrumView&) = delete;
  SpectrumView& operator=(const SpectrumView&) = delete;

  // --- Entry points of the host. Each answers a status as in host_codes.h.
  std::int32_t vfpOp(std::int32_t hardwareId, std::int16_t operation, const Variant& parameter,
                     clsBaseVFP* base = nullptr) override;
  std::int32_t vfpSet(std::int32_t hardwareId, std::int16_t parameterType, std::int16_t index,
                      const Variant& value, clsBaseVFP* base = nullptr) override;
  // The panel plays nothing by itself.
  std::int32_t playbackOp(std::int32_t, std::int16_t, const Variant&, clsBaseVFP*) override;
  // Decodes a result buffer from the cursor on; cursor and bytes left end where reading ended.
  std::int32_t displayData(const Variant& vParameter, std::span<const std::uint8_t> resultData,
                           std::int32_t& dataPointer, std::int32_t& dataCount, std::int32_t resultTypeId,
                           std::int32_t resultLength) {
    return base_.displayData(vParameter, resultData, dataPointer, dataCount, resultTypeId, resultLength);
  }
  std::int32_t displayParameter(std::int16_t order, const Variant& newValue) {
    return base_.displayParameter(order, newValue);
  }
  void PopUp_Click(std::int32_t subjectId, std::int32_t buttonId) { base_.PopUp_Click(subjectId, buttonId); }
  // The limits of a parameter that has an entry here, in place of those that hold from the beginning: ranges
  // by order, for the frequencies one a band. Answers unusable parameter for another one and for what are no
  // limits.
  std::int32_t Limits(std::int16_t parameterType, const HostRecordSet& records);
  // The host's channelizations. Whoever changes them says so by ChannelizationCombo_Change, or by sending
  // which one to show.
  [[nodiscard]] clsChannelInfo& channels() noexcept { return fields_.channels; }
  void ChannelizationCombo_Change();

  // --- Events of the window
  void Form_Resize() override;     // also once after creation, when the view has its size
  void Paint() { base_.Paint(); }  // recomposes the graph and copies it to the view's device context
  void MouseDown(std::int16_t button, std::int16_t shift, float xTwips, float yTwips) {
    base_.MouseDown(button, shift, xTwips, yTwips);
  }
  void MouseMove(std::int16_t button, std::int16_t shift, float xTwips, float yTwips) {
    base_.MouseMove(button, shift, xTwips, yTwips);
  }
  void MouseUp(std::int16_t button, std::int16_t shift, float xTwips, float yTwips) {
    base_.MouseUp(button, shift, xTwips, yTwips);
  }
  void KeyDown(std::int16_t keyCode, std::int16_t shift) { base_.KeyDown(keyCode, shift); }

  // --- Marker commands. Without a trace there is nothing to mark, without a marker nothing to move: no
  // report.
  void addMarker();
  void addDeltaMarker();
  void deleteMarker();
  void markerToMax();
  void markerToMin();
  // The active marker's frequency becomes the centre; also a request to the host.
  void markerToCenter();
  // Enables the buttons that need a marker exactly when the active trace has one, as far as that of
  // evaluateEnablingMarkerToCenter may be.
  void updateMarkerButtons();
  // There is an active marker, and neither logging nor playback holds the receiver where it is.
  void evaluateEnablingMarkerToCenter() override;

  // --- The panel as its base sees it
  std::string typeName() override { return kTypeName; }
  using HostedPanel::Caption;
  [[nodiscard]] const std::string& Caption() const noexcept { return base_.Caption(); }
  SideArea* displayPanel() override { return &displayPanel_; }
  SideArea* controlPanel() override { return &controlPanel_; }
  Control* MarkerToCenterButton() override { return &fields_.controls.control("MarkerToCenterButton"); }
  ControlSet* controls() override { return &fields_.controls; }
  // Brings fields and graph in line with the active trace.
  void refreshControls() override;
  void refreshMenuItems() override { base_.refreshMenuItems(); }
  void closeVfp() override;
  void saveVfp() override { base_.saveVfp(); }
  void appendSettings(PanelSettings& settings) override;
  void resultData(std::int32_t resultTypeId, ResultReader& reader, clsBaseVFP* base) override;
  void changedTraceConfiguration(TraceState state, TraceObject* activeTrace,
                                 std::int16_t resultType) override;
  void setMarkerFrameColor(Color color) override;
  void deltaMarkerButtonEnabled(bool enable) override;
  std::vector<PanelMenuItem> contextMenu() override;
  void contextMenuClick(std::int16_t id) override;

  // --- Links
  void frontPanelLink(const FrontPanelLink& link) override;
  std::int32_t measurementInfo(Variant& measurementTypes) override;
  // The name, in upper case, of the field that the user is at, where a host may link to it.
  std::string activeControlLink() override;
  Variant initializeLinkValue(std::int16_t linkType, std::int32_t genericId) override;
  bool actionEnabled(std::int16_t action) override;
  std::string reportHtml() override;
  std::string linkSourceName() override;

  // --- The parts behind the panel. They live as long as it does.
  [[nodiscard]] clsBaseVFP& base() noexcept { return base_; }
  [[nodiscard]] SpectrumFields& fields() noexcept { return fields_; }

 private:
  struct ParameterRow;
  struct OptionRow;
  static const ParameterRow kParameters[];
  static const OptionRow kOptions[];
  using Handler = void (SpectrumView::*)();

  // Fields to handlers
  void bindFields();
  void bindEntries();
  void bindButtons();
  [[nodiscard]] std::function<void()> whileOpen(Handler handler);
  // A request to the host, reported in the routine's name when it is refused.
  bool request(std::string_view routine, std::int16_t parameterType, double value);
  void operate(std::string_view routine, std::int16_t operation);
  static bool accepted(std::string_view routine, std::int32_t status);

  // Handlers of what the user enters
  void newCenterFrequency();
  void newFrequencySpan();
  void newStartFrequency() { newStartStopFrequency(true); }
  void newStopFrequency() { newStartStopFrequency(false); }
  void newStartStopFrequency(bool startChanged);
  void newFrequencyRbw();
  void newAverageCount();
  void newDisplayLength();
  void newSweepRate();
  void newVerticalScale();
  void newVerticalOffset();
  void newAverageType();
  void newChannelization();
  void AutoScaleBox_Click();
  void optionClick(const OptionRow& row);
  void bandClick(std::string_view routine, std::int32_t range);
  void applyUnits();
  void applyInterval();
  void SingleSweepButton_Click();
  void ContinuousSweepButton_Click();
  void StopSweepButton_Click();
  // Logging and playback keep the measurement area away.
  void toggleMeasurementArea() {
    if (base_.bottomPanelEnabled()) base_.bottomPanelVisible(!base_.bottomPanelVisible());
  }
  void toggleDisplayArea() { base_.rightPanelVisible(!base_.rightPanelVisible()); }

  // What the host sends
  void centerFromHost(double centerHz);
  void spanFromHost(double spanHz);
  void timeIntervalFromHost(double period);
  void distanceIntervalFromHost(double distanceM);
  void displayLengthFromHost(double points);
  void averageTypeFromHost(double type);
  void select(std::string_view option);
  void showBand();
  [[nodiscard]] std::int32_t addTrace(const Variant& parameter);
  [[nodiscard]] double intervalValue() const;
  [[nodiscard]] bool mayCenterMarker();

  // Data and traces
  void DFISpectrum_DataChanged(std::int32_t index);
  [[nodiscard]] std::size_t readSweep(std::int32_t index);
  void showSweep(clsMultiTracePainter& painter, std::span<const float> levels);
  [[nodiscard]] clsMultiTracePainter* findPainter();
  [[nodiscard]] clsMultiTracePainter* activePainter();
  [[nodiscard]] clsMultiTracePainter& findOrAddPainter();
  void setUpTrace(clsMultiTracePainter& painter);
  void formatXAxis(clsMultiTracePainter& painter);
  void updateXAxisLabels();
  void adjustResolution();
  void refreshTraces();
  void showVerticalAxis();
  void followAutoScale();
  void menuXAxisStyle(std::int16_t style);

  // Links
  [[nodiscard]] clsNumericEntry* linkedEntry(std::int32_t parameterType);
  [[nodiscard]] bool linkAction(const FrontPanelLink& link);
  [[nodiscard]] bool linkParameter(const FrontPanelLink& link);

  SpectrumFields fields_;
  PictureArea displayPanel_;
  PictureArea controlPanel_;
  clsBaseVFP base_;
  std::array<float, kMaxPoints> liveTrace_{};
  DataServer DFISpectrum_;

  bool updateInProgress_ = false;        // a value goes into the frequency entries that is not the user's
  bool optionChangeInProgress_ = false;  // the program changes an option, a list or a box
  double distanceIntervalM_ = 0;
  // What the vertical entries show of a trace that scales itself.
  std::optional<double> shownTop_;
  double shownPerDivision_ = 0;
};

}  // namespace frontpanels
