// SpectrumView towards its user: what each field does when its value has been changed.
#include <iterator>

#include "entry/entry_binding.h"
#include "framework/support/enumerated_tables.h"
#include "framework/support/error_handler.h"
#include "framework/support/flag_scope.h"
#include "framework/support/guard.h"
#include "framework/support/host_codes.h"
#include "spectrum/spectrum_view.h"

namespace frontpanels {
namespace {

constexpr std::int32_t kDownlinkRange = 0;
constexpr std::int32_t kUplinkRange = 1;

}  // namespace

// --- Fields to handlers

// An option of a pair: the code and value that it stands for, and what it changes on the panel itself.
struct SpectrumView::OptionRow {
  const char* name;
  const char* routine;
  std::int16_t parameterType;
  double value;
  Handler apply;
};

const SpectrumView::OptionRow SpectrumView::kOptions[] = {
    {"FrequencyOption", "FrequencyOption_Click()", kUnitsParameter, 1, &SpectrumView::applyUnits},
    {"ChannelOption", "ChannelOption_Click()", kUnitsParameter, 0, &SpectrumView::applyUnits},
    {"IntervalTimeOption", "IntervalTimeOption_Click()", kIntervalKindParameter, 1,
     &SpectrumView::applyInterval},
    {"IntervalDistanceOption", "IntervalDistanceOption_Click()", kIntervalKindParameter, 0,
     &SpectrumView::applyInterval},
    {"LogPwrOption", "LogPwrOption_Click()", PARM_AVERAGE_AS_LOG_POWER, 1, nullptr},
    {"LinPowerOption", "LinPowerOption_Click()", PARM_AVERAGE_AS_LOG_POWER, 0, nullptr},
    {"WidebandOption", "WidebandOption_Click()", FREQ_FILTER, 0, nullptr},
    {"NarrowbandOption", "NarrowbandOption_Click()", FREQ_FILTER, kNarrowbandFilter, nullptr},
};

void SpectrumView::bindFields() {
  bindEntries();
  bindButtons();
  ControlSet& controls = fields_.controls;
  for (const OptionRow& row : kOptions)
    controls.optionButton(row.name).Click = whileOpen([this, &row] { optionClick(row); });
  controls.optionButton("DownlinkOption").Click =
      whileOpen([this] { bandClick("DownlinkOption_Click()", kDownlinkRange); });
  controls.optionButton("UplinkOption").Click =
      whileOpen([this] { bandClick("UplinkOption_Click()", kUplinkRange); });
}

void SpectrumView::bindEntries() {
  struct EntryField {
    const char* stem;  // of its controls' names
    clsNumericEntry& (*entry)(SpectrumFields& fields);
    Handler changed;
  };
  using Fields = SpectrumFields;
  using Entry = clsNumericEntry;
  constexpr EntryField kFields[] = {
      {"CenterFrequency", [](Fields& f) -> Entry& { return f.frequency.center; },
       &SpectrumView::newCenterFrequency},
      {"FrequencySpan", [](Fields& f) -> Entry& { return f.frequency.span; },
       &SpectrumView::newFrequencySpan},
      {"FrequencyRbw", [](Fields& f) -> Entry& { return f.frequencyRbw; }, &SpectrumView::newFrequencyRbw},
      {"StartFrequency", [](Fields& f) -> Entry& { return f.frequency.start; },
       &SpectrumView::newStartFrequency},
      {"StopFrequency", [](Fields& f) -> Entry& { return f.frequency.stop; },
       &SpectrumView::newStopFrequency},
      {"AverageCount", [](Fields& f) -> Entry& { return f.averageCount; }, &SpectrumView::newAverageCount},
      {"DisplayLength", [](Fields& f) -> Entry& { return f.displayLength; }, &SpectrumView::newDisplayLength},
      {"SweepRate", [](Fields& f) -> Entry& { return f.sweepRate; }, &SpectrumView::newSweepRate},
      {"VerticalScale", [](Fields& f) -> Entry& { return f.verticalScale; }, &SpectrumView::newVerticalScale},
      {"VerticalOffset", [](Fields& f) -> Entry& { return f.verticalOffset; },
       &SpectrumView::newVerticalOffset},
  };
  for (const EntryField& field : kFields)
    bindEntry(field.entry(fields_), *controls(), field.stem, calling(field.changed));
  fields_.controls.list("AverageTypeCombo").Click = calling(&SpectrumView::newAverageType);
  fields_.controls.list("ChannelizationCombo").Click = calling(&SpectrumView::newChannelization);
}

void SpectrumView::bindButtons() {
  struct ButtonRow {
    const char* name;
    Handler click;
  };
  constexpr ButtonRow kButtons[] = {
      {"CloseButton", &SpectrumView::closeVfp},
      {"SingleSweepButton", &SpectrumView::SingleSweepButton_Click},
      {"ContinuousSweepButton", &SpectrumView::ContinuousSweepButton_Click},
      {"StopSweepButton", &SpectrumView::StopSweepButton_Click},
      {"AutoScaleBox", &SpectrumView::AutoScaleBox_Click},
      {"MarkerAddButton", &SpectrumView::addMarker},
      {"MarkerDeleteButton", &SpectrumView::deleteMarker},
      {"MarkerToMaxButton", &SpectrumView::markerToMax},
      {"MarkerDeltaButton", &SpectrumView::addDeltaMarker},
      {"MarkerToCenterButton", &SpectrumView::markerToCenter},
  };
  for (const ButtonRow& row : kButtons) fields_.controls.control(row.name).Click = calling(row.click);
}

// --- Requests

void SpectrumView::SingleSweepButton_Click() { operate("SingleSweepButton_Click()", kSingleSweepOperation); }
void SpectrumView::StopSweepButton_Click() { operate("StopSweepButton_Click()", kStopSweepOperation); }
void SpectrumView::ContinuousSweepButton_Click() {
  operate("ContinuousSweepButton_Click()", kContinuousSweepOperation);
}

// --- Frequencies

// What a user enters while an earlier entry is still with the host has to wait: the field goes back.
void SpectrumView::newCenterFrequency() {
  clsNumericEntry& center = fields_.frequency.center;
  if (updateInProgress_) return center.valueNoUpdate(center.previousValue());
  const FlagScope inProgress(updateInProgress_);
  guard("SpectrumView::newCenterFrequency()", [this] {
    showBand();
    fields_.frequency.fitCenter();
    updateXAxisLabels();
    request("newCenterFrequency()", kCenterFrequencyParameter, fields_.frequency.center.value());
  });
}

// A host that is told of the span alone would tune past the limit that the centre has given way to.
void SpectrumView::newFrequencySpan() {
  clsNumericEntry& span = fields_.frequency.span;
  if (updateInProgress_) return span.valueNoUpdate(span.previousValue());
  const FlagScope inProgress(updateInProgress_);
  guard("SpectrumView::newFrequencySpan()", [&] {
    FrequencyEntries& frequency = fields_.frequency;
    const double centerHz = frequency.center.value();
    frequency.setSpan(span.value());
    // What the host answers to the first request must not change the second one.
    const double spanHz = span.value();
    updateXAxisLabels();
    const bool moved = frequency.center.value() != centerHz;
    if (moved && !request("newFrequencySpan()", kCenterFrequencyParameter, frequency.center.value())) return;
    request("newFrequencySpan()", kSpanParameter, spanHz);
  });
}

void SpectrumView::newStartStopFrequency(bool startChanged) {
  if (updateInProgress_) return fields_.frequency.placeEdges();
  const FlagScope inProgress(updateInProgress_);
  guard("SpectrumView::newStartStopFrequency()", [&] {
    FrequencyEntries& frequency = fields_.frequency;
    frequency.joinEdges(startChanged);
    showBand();
    updateXAxisLabels();
    const double spanHz = frequency.span.value();  // whatever the host answers to the first request
    if (request("newStartStopFrequency()", kCenterFrequencyParameter, frequency.center.value()))
      request("newStartStopFrequency()", kSpanParameter, spanHz);
  });
}

void SpectrumView::bandClick(std::string_view routine, std::int32_t range) {
  if (optionChangeInProgress()) return;
  const FlagScope inProgress(updateInProgress_);
  guard([&] { return named(routine); },
        [&] {
          fields_.frequency.setBand(range);
          updateXAxisLabels();
          request(routine, kCenterFrequencyParameter, fields_.frequency.center.value());
          showBand();
        });
}

// --- The other entries and lists

void SpectrumView::newFrequencyRbw() {
  guard("SpectrumView::newFrequencyRbw()",
        [this] { request("newFrequencyRbw()", kRbwParameter, fields_.frequencyRbw.value()); });
}

void SpectrumView::newAverageCount() {
  guard("SpectrumView::newAverageCount()",
        [this] { request("newAverageCount()", kAverageCountParameter, fields_.averageCount.value()); });
}

void SpectrumView::newDisplayLength() {
  guard("SpectrumView::newDisplayLength()",
        [this] { request("newDisplayLength()", kDisplayLengthParameter, fields_.displayLength.value()); });
}

void SpectrumView::newSweepRate() {
  guard("SpectrumView::newSweepRate()", [this] {
    const double value = fields_.sweepRate.value();
    if (fields_.interval() == MeasurementInterval::Time) {
      base().measurementPeriod = value;
      request("newSweepRate()", TIME_MEASUREMENT_PERIOD, value);
    } else {
      distanceIntervalM_ = value;
      request("newSweepRate()", kDistanceIntervalParameter, value);
    }
  });
}

void SpectrumView::newAverageType() {
  fields_.averageType.Click();
  if (optionChangeInProgress() || !fields_.averageType.newValue()) return;
  guard("SpectrumView::newAverageType()", [this] {
    fields_.averageCount.Enabled(fields_.averageType.value() != kAveragingOff);
    request("newAverageType()", kAverageTypeParameter, fields_.averageType.value());
  });
}

void SpectrumView::newChannelization() {
  fields_.channelization.Click();
  if (optionChangeInProgress() || !fields_.channelization.newValue()) return;
  ChannelizationCombo_Change();
  guard("SpectrumView::ChannelizationCombo_Change()", [this] {
    request("ChannelizationCombo_Change()", kChannelizationParameter, fields_.channelization.value());
  });
}

// --- Options

void SpectrumView::optionClick(const OptionRow& row) {
  guard([&] { return named(row.routine); },
        [&] {
          if (row.apply != nullptr) (this->*row.apply)();
          if (!optionChangeInProgress()) request(row.routine, row.parameterType, row.value);
        });
}

void SpectrumView::applyUnits() {
  if (fields_.controls.optionButton("ChannelOption").Value()) return ChannelizationCombo_Change();
  fields_.frequency.showFrequencies();
  updateXAxisLabels();
  refreshTraces();
}

void SpectrumView::applyInterval() { fields_.showInterval(fields_.interval(), intervalValue()); }

void SpectrumView::ChannelizationCombo_Change() {
  if (base().closing()) return;
  guard("SpectrumView::ChannelizationCombo_Change()", [this] {
    if (!fields_.controls.optionButton("ChannelOption").Value()) return;
    if (!fields_.frequency.showChannels(fields_.channels, fields_.channelization.value()))
      fields_.frequency.showFrequencies();
    updateXAxisLabels();
    refreshTraces();
  });
}

// --- Vertical axis

void SpectrumView::newVerticalScale() {
  guard("SpectrumView::newVerticalScale()", [this] {
    const double perDivision = fields_.verticalScale.value();
    if (!(perDivision > 0))
      return errorHandler().Assert("SpectrumView::newVerticalScale() ... illegal value");
    if (clsMultiTracePainter* const painter = activePainter()) painter->setDbPerDivision(perDivision);
    refreshTraces();
  });
}

void SpectrumView::newVerticalOffset() {
  guard("SpectrumView::newVerticalOffset()", [this] {
    if (clsMultiTracePainter* const painter = activePainter())
      painter->gridScaleTop(fields_.verticalOffset.value());
    refreshTraces();
  });
}

void SpectrumView::AutoScaleBox_Click() {
  if (optionChangeInProgress()) return;
  guard("SpectrumView::AutoScaleBox_Click()", [this] {
    clsMultiTracePainter* const painter = activePainter();
    if (painter == nullptr) return;
    painter->setAutoScale(fields_.controls.checkBox("AutoScaleBox").Value() != 0);
    refreshTraces();
    showVerticalAxis();
  });
}

}  // namespace frontpanels
