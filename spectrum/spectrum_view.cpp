// SpectrumView towards its host: operations, parameters, settings.
#include "spectrum/spectrum_view.h"

#include <algorithm>
#include <cmath>
#include <iterator>

#include "framework/support/enumerated_tables.h"
#include "framework/support/flag_scope.h"
#include "framework/support/guard.h"
#include "framework/support/host_codes.h"
#include "framework/support/numeric.h"
#include "spectrum/spectrum_controls.h"

namespace frontpanels {

SpectrumView::SpectrumView(const PanelEnvironment& environment, PanelHost& host, PanelContainer& container)
    : FieldPanel(environment, host, container, kTypeName, spectrumControls()),
      fields_(*controls()),
      markers_(base().traceManager(), *controls(), kTypeName),
      DFISpectrum_(environment.hub, [this](std::int32_t index) { DFISpectrum_DataChanged(index); }) {
  base().SupportsMarkerToCenter = true;
  bindFields();
  updateMarkerButtons();
  fields_.averageCount.Enabled(fields_.averageType.value() != kAveragingOff);
  DFISpectrum_.subscribe(kSpectrumPath);
}

// --- Operations

std::int32_t SpectrumView::vfpOp(std::int32_t hardwareId, std::int16_t operation, const Variant& parameter,
                                 clsBaseVFP* /*base*/) {
  if (base().closing()) return kStatusDone;
  return guarded("SpectrumView::vfpOp() ... ", kStatusUnusableParameter, [&] {
    switch (operation) {
      case QUILL_VFP_SAVE:
        base().saveBase();
        refreshTraces();
        return kStatusDone;
      case kAddTraceOperation:
        return addTrace(parameter);
      case QUILL_VFP_SAVE_SETUP:
        if (!parameter.isNumeric()) break;  // the base says what is wrong with it
        base().saveSetup(parameter.toInt32());
        return kStatusDone;
      default:
        break;
    }
    const std::int32_t status = base().vfpOp(hardwareId, operation, parameter);
    if (operation == QUILL_VFP_CLOSE) sharedPanelState().dirty = true;
    return status;
  });
}

std::int32_t SpectrumView::addTrace(const Variant& parameter) {
  if (!parameter.isNumeric() || parameter.toDouble() != kAddTraceOperation) return kStatusUnusableParameter;
  base().traceManager().addTraceObject(std::make_shared<clsMultiTracePainter>(gdi()), kSpectrumResultType);
  return kStatusDone;
}

// --- Parameters

// The codes that are the panel's own. A value that is no finite number is passed over without an error.
struct SpectrumView::ParameterRow {
  std::int16_t code;
  void (*apply)(SpectrumView& panel, double value);  // null: nothing here goes by it
};

const SpectrumView::ParameterRow SpectrumView::kParameters[] = {
    // Settings that the host sends to every panel of its window and that mean nothing to this one.
    {11, nullptr},
    {15, nullptr},
    {18, nullptr},
    {kCenterFrequencyParameter, [](SpectrumView& panel, double value) { panel.centerFromHost(value); }},
    {kSpanParameter, [](SpectrumView& panel, double value) { panel.spanFromHost(value); }},
    {kRbwParameter,
     [](SpectrumView& panel, double value) { panel.fields_.frequencyRbw.valueNoUpdate(value); }},
    {FREQ_FILTER,
     [](SpectrumView& panel, double value) {
       panel.select(value == kNarrowbandFilter ? "NarrowbandOption" : "WidebandOption");
     }},
    {TIME_MEASUREMENT_PERIOD, [](SpectrumView& panel, double value) { panel.timeIntervalFromHost(value); }},
    {kDisplayLengthParameter, [](SpectrumView& panel, double value) { panel.displayLengthFromHost(value); }},
    {kChannelizationParameter,
     [](SpectrumView& panel, double value) {
       panel.fields_.channelization.value(toInt16(value));
       panel.ChannelizationCombo_Change();
     }},
    {kAverageTypeParameter, [](SpectrumView& panel, double value) { panel.averageTypeFromHost(value); }},
    {kAverageCountParameter,
     [](SpectrumView& panel, double value) { panel.fields_.averageCount.valueNoUpdate(value); }},
    {kUnitsParameter, [](SpectrumView& panel,
                         double value) { panel.select(value != 0 ? "FrequencyOption" : "ChannelOption"); }},
    {kDistanceIntervalParameter,
     [](SpectrumView& panel, double value) { panel.distanceIntervalFromHost(value); }},
    {kIntervalKindParameter,
     [](SpectrumView& panel, double value) {
       panel.select(value == 0 ? "IntervalDistanceOption" : "IntervalTimeOption");
     }},
    {PARM_AVERAGE_AS_LOG_POWER,
     [](SpectrumView& panel, double value) { panel.select(value != 0 ? "LogPwrOption" : "LinPowerOption"); }},
};

std::int32_t SpectrumView::vfpSet(std::int32_t hardwareId, std::int16_t parameterType, std::int16_t index,
                                  const Variant& value, clsBaseVFP* /*base*/) {
  if (base().closing()) return kStatusDone;
  return guarded("SpectrumView::vfpSet() ... ", kStatusUnusableParameter, [&] {
    const auto* const row = std::find_if(
        std::begin(kParameters), std::end(kParameters),
        [parameterType](const ParameterRow& candidate) { return candidate.code == parameterType; });
    if (row == std::end(kParameters)) return base().vfpSet(hardwareId, parameterType, index, value);
    if (row->apply == nullptr || !value.isNumeric()) return kStatusDone;
    if (const double number = value.toDouble(); std::isfinite(number)) row->apply(*this, number);
    return kStatusDone;
  });
}

void SpectrumView::centerFromHost(double centerHz) {
  const FlagScope inProgress(updateInProgress_);
  fields_.frequency.setCenter(centerHz);
  showBand();
  updateXAxisLabels();
}

void SpectrumView::spanFromHost(double spanHz) {
  const FlagScope inProgress(updateInProgress_);
  fields_.frequency.setSpan(spanHz);
  updateXAxisLabels();
}

void SpectrumView::timeIntervalFromHost(double period) {
  base().measurementPeriod = period;
  if (fields_.interval() == MeasurementInterval::Time) fields_.sweepRate.valueNoUpdate(period);
}

void SpectrumView::distanceIntervalFromHost(double distanceM) {
  distanceIntervalM_ = distanceM;
  if (fields_.interval() == MeasurementInterval::Distance) fields_.sweepRate.valueNoUpdate(distanceM);
}

void SpectrumView::displayLengthFromHost(double points) {
  fields_.displayLength.valueNoUpdate(points);
  if (clsMultiTracePainter* const painter = findPainter()) painter->span(fields_.frequency.span.value());
  updateXAxisLabels();
}

void SpectrumView::averageTypeFromHost(double type) {
  const FlagScope inProgress = changeOption();
  fields_.averageType.value(toInt16(type));
  fields_.averageCount.Enabled(fields_.averageType.value() != kAveragingOff);
}

void SpectrumView::showBand() { select(fields_.frequency.downlink() ? "DownlinkOption" : "UplinkOption"); }

double SpectrumView::intervalValue() {
  return fields_.interval() == MeasurementInterval::Time ? base().measurementPeriod : distanceIntervalM_;
}

// --- Limits

std::int32_t SpectrumView::Limits(std::int16_t parameterType, const HostRecordSet& records) {
  if (base().closing()) return kStatusDone;
  const auto taken = [&] {
    switch (parameterType) {
      case kCenterFrequencyParameter:
        return fields_.frequency.limits(records);
      case TIME_MEASUREMENT_PERIOD:
        return fields_.intervalLimits(MeasurementInterval::Time, records);
      case kDistanceIntervalParameter:
        return fields_.intervalLimits(MeasurementInterval::Distance, records);
      default:
        clsNumericEntry* const entry = linkedEntry(parameterType);
        return entry != nullptr && entry->Limits(records);
    }
  };
  return taken() ? kStatusDone : kStatusUnusableParameter;
}

// --- What the host keeps

// In the order in which they restore the panel: the kind of interval before its value, the averaging before
// its count, the centre before the span that may push it.
void SpectrumView::appendSettings(PanelSettings& settings) {
  const ControlSet& controls = fields_.controls;
  const auto chosen = [&controls](const char* option) {
    return controls.optionButton(option).Value() ? 1.0 : 0.0;
  };
  const PanelSetting own[] = {
      {kChannelizationParameter, fields_.channelization.value()},
      {kUnitsParameter, chosen("FrequencyOption")},
      {kCenterFrequencyParameter, fields_.frequency.center.value()},
      {kSpanParameter, fields_.frequency.span.value()},
      {kRbwParameter, fields_.frequencyRbw.value()},
      {FREQ_FILTER, chosen("NarrowbandOption")},
      {kIntervalKindParameter, chosen("IntervalTimeOption")},
      {kDistanceIntervalParameter, distanceIntervalM_},
      {kDisplayLengthParameter, fields_.displayLength.value()},
      {kAverageTypeParameter, fields_.averageType.value()},
      {kAverageCountParameter, fields_.averageCount.value()},
      {PARM_AVERAGE_AS_LOG_POWER, chosen("LogPwrOption")},
  };
  settings.insert(settings.end(), std::begin(own), std::end(own));
}

// --- Graph

void SpectrumView::refreshControls() {
  if (base().closing()) return;
  guard("SpectrumView::refreshControls()...", [this] {
    showVerticalAxis();
    updateMarkerButtons();
    updateXAxisLabels();
    refreshTraces();
  });
}

}  // namespace frontpanels
