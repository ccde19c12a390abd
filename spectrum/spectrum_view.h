// SpectrumView: the panel that shows power against frequency. This is the whole control except its window:
// the window side (a registered control, a headless renderer, a test) hands over an environment, forwards
// events and calls the host's entry points.
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

#include "framework/panel/field_panel.h"
#include "painters/marker_commands.h"
#include "painters/multi_trace_painter.h"
#include "spectrum/spectrum_fields.h"

namespace frontpanels {

class SpectrumView final : public FieldPanel {
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
  // The limits of a parameter that has an entry here, in place of those that hold from the beginning: ranges
  // by order, for the frequencies one a band. Answers unusable parameter for another one and for what are no
  // limits.
  std::int32_t Limits(std::int16_t parameterType, const HostRecordSet& records);
  // The host's channelizations. Whoever changes them says so by ChannelizationCombo_Change, or by sending
  // which one to show.
  [[nodiscard]] clsChannelInfo& channels() noexcept { return fields_.channels; }
  void ChannelizationCombo_Change();

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

  // --- The panel as its base sees it
  // Brings fields and graph in line with the active trace.
  void refreshControls() override;
  void appendSettings(PanelSettings& settings) override;
  void resultData(std::int32_t resultTypeId, ResultReader& reader, clsBaseVFP* base) override;
  void changedTraceConfiguration(TraceState state, TraceObject* activeTrace,
                                 std::int16_t resultType) override;

  // --- As one of many
  std::int32_t measurementInfo(Variant& measurementTypes) override;
  bool actionEnabled(std::int16_t action) override;
  std::string reportHtml() override;

  // They live as long as the panel does.
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
  [[nodiscard]] std::function<void()> calling(Handler handler) {
    return whileOpen([this, handler] { (this->*handler)(); });
  }

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

  // What the host sends
  void centerFromHost(double centerHz);
  void spanFromHost(double spanHz);
  void timeIntervalFromHost(double period);
  void distanceIntervalFromHost(double distanceM);
  void displayLengthFromHost(double points);
  void averageTypeFromHost(double type);
  void showBand();
  [[nodiscard]] std::int32_t addTrace(const Variant& parameter);
  [[nodiscard]] double intervalValue();

  // Data and traces
  void DFISpectrum_DataChanged(std::int32_t index);
  [[nodiscard]] std::size_t readSweep(std::int32_t index);
  void showSweep(clsMultiTracePainter& painter, std::span<const float> levels);
  [[nodiscard]] clsMultiTracePainter* findPainter();
  [[nodiscard]] clsMultiTracePainter* activePainter() const { return markers_.activePainter(); }
  [[nodiscard]] clsMultiTracePainter& findOrAddPainter();
  void setUpTrace(clsMultiTracePainter& painter);
  void setInsets(PlotPainter& painter) const;
  void rescaled() override;
  void formatXAxis(clsMultiTracePainter& painter);
  void updateXAxisLabels();
  void adjustResolution(clsNumericEntry& formatter);
  void tracesRefreshed() override;  // a trace that scales itself takes the vertical fields along
  void showVerticalAxis();
  void menuXAxisStyle(std::int16_t style);

  // Links and menu
  [[nodiscard]] clsNumericEntry* linkedEntry(std::int32_t parameterType);
  [[nodiscard]] bool linkAction(const FrontPanelLink& link) override;
  [[nodiscard]] bool linkParameter(const FrontPanelLink& link) override;
  [[nodiscard]] std::optional<double> linkedValue(std::int32_t parameterType) override;
  [[nodiscard]] std::span<const char* const> linkedByName() const override;
  [[nodiscard]] std::vector<MenuCommand> ownMenuCommands() override;
  [[nodiscard]] PlotCommands& plotCommands() override { return markers_; }

  SpectrumFields fields_;
  MarkerCommands markers_;
  std::array<float, kMaxPoints> liveTrace_{};
  DataServer DFISpectrum_;

  bool updateInProgress_ = false;  // a value goes into the frequency entries that is not the user's
  double distanceIntervalM_ = 0;
  // What the vertical entries show of a trace that scales itself.
  std::optional<double> shownTop_;
  double shownPerDivision_ = 0;
};

}  // namespace frontpanels
