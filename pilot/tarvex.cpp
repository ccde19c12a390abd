// Tarvex towards its host: operations, parameters, settings, links.
#include "pilot/tarvex.h"

#include <algorithm>
#include <cmath>
#include <iterator>

#include "framework/panel/report_html.h"
#include "framework/support/enumerated_tables.h"
#include "framework/support/error_handler.h"
#include "framework/support/guard.h"
#include "framework/support/host_codes.h"
#include "framework/support/numeric.h"
#include "pilot/pilot_controls.h"

namespace frontpanels {

Tarvex::Tarvex(const PanelEnvironment& environment, const PilotServices& services, PanelHost& host,
               PanelContainer& container)
    : FieldPanel(environment, host, container, kTypeName, pilotControls()),
      services_(services),
      fields_(*controls()),
      markers_(base().traceManager(), *controls(), kTypeName) {
  bindFields();
  subscribe(environment.hub);
  showActiveTrace();
}

// --- Operations

std::int32_t Tarvex::vfpOp(std::int32_t hardwareId, std::int16_t operation, const Variant& parameter,
                           clsBaseVFP* /*base*/) {
  if (base().closing()) return kStatusDone;
  return guarded("Tarvex::vfpOp() ... ", kStatusUnusableParameter, [&] {
    switch (operation) {
      case kAddTraceOperation:
        return addDisplay(parameter);
      case kRemoveTraceOperation:
        return removeDisplay(parameter);
      default:
        return base().vfpOp(hardwareId, operation, parameter);
    }
  });
}

// --- Parameters

// The codes that are the panel's own. A number that is none, or not finite, is passed over without an error.
struct Tarvex::ParameterRow {
  std::int16_t code;
  void (*apply)(Tarvex& panel, double value);
};

const Tarvex::ParameterRow Tarvex::kParameters[] = {
    {kCenterFrequencyParameter,
     [](Tarvex& panel, double value) { panel.fields_.carrierFrequency.valueNoUpdate(value); }},
    {kChannelizationParameter,
     [](Tarvex& panel, double value) { panel.fields_.channelization.value(toInt16(value)); }},
    {kCodeFormatParameter, [](Tarvex& panel, double value) { panel.formatFromHost(toInt16(value)); }},
    {kCodeCenterParameter, [](Tarvex& panel, double value) { panel.fields_.code.centerFromHost(value); }},
    {kCodeStartParameter, [](Tarvex& panel, double value) { panel.fields_.code.startFromHost(value); }},
    {kCodeSpanParameter, [](Tarvex& panel, double value) { panel.fields_.code.spanFromHost(value); }},
    {kPnIncrementParameter,
     [](Tarvex& panel, double value) {
       panel.fields_.code.pnIncrement.valueNoUpdate(value);
       panel.fields_.userPnList.increment(panel.fields_.code.pnIncrement.value());
     }},
};

// Those that change the chart that is the current one; without one they do nothing.
struct Tarvex::BarParameterRow {
  std::int16_t code;
  void (*apply)(Tarvex& panel, clsBarChartPainter& bars, double value);
};

const Tarvex::BarParameterRow Tarvex::kBarParameters[] = {
    {kPowerDisplayParameter,
     [](Tarvex&, clsBarChartPainter& bars, double value) { showPower(bars, value != 0); }},
    {kSortModeParameter,
     [](Tarvex&, clsBarChartPainter& bars, double value) { bars.barSortByMode(toInt16(value)); }},
    {kSortOrderParameter,
     [](Tarvex&, clsBarChartPainter& bars, double value) { bars.barSortOrder(toInt16(value)); }},
    {kBarLabelParameter,
     [](Tarvex&, clsBarChartPainter& bars, double value) { bars.otherIs(toInt16(value)); }},
    {kThresholdParameter, [](Tarvex&, clsBarChartPainter& bars, double value) { bars.threshold(value); }},
    {kBarChartStyleParameter,
     [](Tarvex&, clsBarChartPainter& bars, double value) { bars.BarChartStyle(toInt16(value)); }},
    {kShowCellNameParameter,
     [](Tarvex& panel, clsBarChartPainter& bars, double value) {
       if (panel.base().CellNamingEnabled) bars.ShowCellName(value != 0);
     }},
};

std::int32_t Tarvex::vfpSet(std::int32_t hardwareId, std::int16_t parameterType, std::int16_t index,
                            const Variant& value, clsBaseVFP* /*base*/) {
  if (base().closing()) return kStatusDone;
  return guarded("Tarvex::vfpSet() ... ", kStatusUnusableParameter, [&] {
    if (parameterType == kTopNSetParameter || parameterType == kUserListSetParameter) {
      // A word that is no boolean is an error: what is on stays on.
      const bool on = Variant(value.toText()).toBoolean();
      switchSet(parameterType == kTopNSetParameter ? PilotSet::TopN : PilotSet::UserList, on);
      return kStatusDone;
    }
    if (!setOwnParameter(parameterType, index, value))
      return base().vfpSet(hardwareId, parameterType, index, value);
    return kStatusDone;
  });
}

bool Tarvex::setOwnParameter(std::int16_t parameterType, std::int16_t index, const Variant& value) {
  const auto find = [parameterType](const auto& rows) {
    const auto* const row = std::find_if(std::begin(rows), std::end(rows), [parameterType](const auto& one) {
      return one.code == parameterType;
    });
    return row == std::end(rows) ? nullptr : row;
  };
  const ParameterRow* const own = find(kParameters);
  const BarParameterRow* const ofBars = find(kBarParameters);
  if (own == nullptr && ofBars == nullptr && parameterType != CDMA_CODE_OFFSET) return false;
  if (!value.isNumeric() || !std::isfinite(value.toDouble())) return true;
  if (own != nullptr) {
    own->apply(*this, value.toDouble());
    showCodeWindow();
  } else if (ofBars == nullptr) {
    setUserPn(index, value);
  } else if (clsBarChartPainter* const bars = currentBars()) {
    ofBars->apply(*this, *bars, value.toDouble());
    showBarSettings();
    refreshTraces();
  }
  return true;
}

// A format that nobody knows is reported and changes nothing.
void Tarvex::formatFromHost(std::int16_t format) {
  const FlagScope inProgress = changeOption();
  fields_.format.value(format);
  const ItemList& list = *fields_.format.ComboBox();
  if (list.item(list.ListIndex()).data == format) return newCdmaFormat(format);
  fields_.format.value(fields_.code.format());
}

// --- What the host keeps

// In the order in which they restore the panel: the format before what is counted in it, the start of the
// window before its span.
void Tarvex::appendSettings(PanelSettings& settings) {
  const auto on = [this](PilotSet set) { return state(set).switchedOff ? 0.0 : 1.0; };
  const PanelSetting own[] = {
      {kCodeFormatParameter, fields_.format.value()},
      {kPnIncrementParameter, fields_.code.pnIncrement.value()},
      {kCodeStartParameter, fields_.code.start.value()},
      {kCodeSpanParameter, fields_.code.span.value()},
      {kCenterFrequencyParameter, fields_.carrierFrequency.value()},
      {kChannelizationParameter, fields_.channelization.value()},
      {kTopNSetParameter, on(PilotSet::TopN)},
      {kUserListSetParameter, on(PilotSet::UserList)},
  };
  settings.insert(settings.end(), std::begin(own), std::end(own));
  const clsBarChartPainter* const bars = currentBars();
  if (bars == nullptr) return;
  const PanelSetting ofBars[] = {
      {kPowerDisplayParameter, bars->useOffset() ? 1.0 : 0.0},
      {kSortModeParameter, bars->barSortByMode()},
      {kSortOrderParameter, bars->barSortOrder()},
      {kBarLabelParameter, bars->otherIs()},
      {kBarChartStyleParameter, bars->BarChartStyle()},
      {kShowCellNameParameter, bars->ShowCellName() ? 1.0 : 0.0},
  };
  settings.insert(settings.end(), std::begin(ofBars), std::end(ofBars));
  if (bars->threshold()) settings.push_back({kThresholdParameter, *bars->threshold()});
}

std::int32_t Tarvex::measurementInfo(Variant& measurementTypes) {
  Variant::Int32s types;
  for (const PilotSetRow& row : pilotSets()) types.push_back(row.resultType);
  measurementTypes = std::move(types);
  return kStatusDone;
}

// --- Links

clsNumericEntry* Tarvex::linkedEntry(std::int32_t parameterType) {
  struct EntryRow {
    std::int16_t code;
    clsNumericEntry* entry;
  };
  const EntryRow rows[] = {{kCenterFrequencyParameter, &fields_.carrierFrequency},
                           {kCodeCenterParameter, &fields_.code.center},
                           {kCodeStartParameter, &fields_.code.start},
                           {kCodeSpanParameter, &fields_.code.span},
                           {kPnIncrementParameter, &fields_.code.pnIncrement},
                           {kThresholdParameter, &fields_.threshold},
                           {kVerticalResolutionParameter, &fields_.verticalScale},
                           {kGridTopParameter, &fields_.verticalOffset}};
  for (const EntryRow& row : rows)
    if (row.code == parameterType) return row.entry;
  return nullptr;
}

bool Tarvex::linkParameter(const FrontPanelLink& link) {
  if (clsNumericEntry* const entry = linkedEntry(link.genericId)) {
    entry->Bold(link.bold);
    entry->Italic(link.italic);
    entry->linkEnable(link.enable);
    return true;
  }
  // Parameters that no numeric entry holds.
  struct ChoiceRow {
    std::int16_t code;
    const char* controls[2];
  };
  constexpr ChoiceRow kChoices[] = {
      {kCodeFormatParameter, {"FormatComboBox", "FormatLabel"}},
      {kChannelizationParameter, {"ChannelizationCombo", nullptr}},
      {kTopNSetParameter, {"topNPilotsCheckBox", nullptr}},
      {kUserListSetParameter, {"userListCheckBox", nullptr}},
      {kPowerDisplayParameter, {"PowerDisplayComboBox", "PowerDisplayLabel"}},
      {kSortModeParameter, {"SortByComboBox", "SortByLabel"}},
      {kSortOrderParameter, {"SortAscendingOptionButton", "SortDescendingOptionButton"}},
      {kBarLabelParameter, {"BarLabelComboBox", "BarLabelLabel"}},
      {kBarChartStyleParameter, {"BarChartStyleComboBox", "BarChartStyleLabel"}},
      {kShowCellNameParameter, {"ShowCellNameCheckBox", nullptr}},
  };
  for (const ChoiceRow& row : kChoices) {
    if (row.code != link.genericId) continue;
    for (const char* const name : row.controls)
      if (name != nullptr) showLink(controls()->control(name), link);
    return true;
  }
  return false;
}

std::optional<double> Tarvex::linkedValue(std::int32_t parameterType) {
  const clsNumericEntry* const entry = linkedEntry(parameterType);
  if (entry == nullptr) return std::nullopt;
  return entry->value();
}

// --- Report

std::string Tarvex::reportHtml() {
  PanelReport page;
  page.caption = linkSourceName();
  page.settings = {{"Code format", fields_.format.ComboBox()->Text()},
                   {"Code start", fields_.code.start.text()},
                   {"Code stop", fields_.code.stop.text()},
                   {"Carrier", fields_.carrierFrequency.text()}};
  for (const PilotSetRow& row : pilotSets()) {
    const TraceObject* const display = displayOf(row);
    if (display == nullptr) continue;
    if (const auto& ioDbm = state(row.set).ioDbm)
      page.settings.push_back({std::string("Io, ") + row.title, numberToText(*ioDbm) + " dBm"});
    const auto* const bars = dynamic_cast<const clsBarChartPainter*>(display);
    for (std::int16_t i = 1; bars != nullptr && i <= bars->barArraySize(); ++i)
      page.readings.push_back({row.title, numberToText(bars->barOffset(i)),
                               numberToText(bars->barValue(i)) + (bars->useOffset() ? " dBm" : " dB")});
  }
  page.xTitle = "PN offset";
  page.yTitle = "Level";
  page.picturePng = container().picturePng();
  return frontpanels::reportHtml(page);
}

}  // namespace frontpanels
