// Tarvex towards its user: what each field does when its value has been changed.
#include <cmath>

#include "entry/entry_binding.h"
#include "framework/support/error_handler.h"
#include "framework/support/guard.h"
#include "framework/support/host_codes.h"
#include "framework/support/numeric.h"
#include "pilot/tarvex.h"

namespace frontpanels {
namespace {

constexpr std::int16_t kAscending = 1;
constexpr std::int16_t kDescending = 2;
constexpr std::int16_t kLastOther = 12;

}  // namespace

// --- Fields to handlers

void Tarvex::bindFields() {
  bindEntries();
  bindLists();
  bindButtons();
}

void Tarvex::bindEntries() {
  struct EntryRow {
    const char* stem;
    clsNumericEntry* entry;
    Handler changed;  // null: nothing goes by it at once
  };
  const EntryRow rows[] = {
      {"TopN", &fields_.topN, &Tarvex::newTopN},
      {"CodeStart", &fields_.code.start, &Tarvex::newCodeStart},
      {"CodeStop", &fields_.code.stop, &Tarvex::newCodeStop},
      {"CodeCenter", &fields_.code.center, &Tarvex::newCodeCenter},
      {"CodeSpan", &fields_.code.span, &Tarvex::newCodeSpan},
      {"PNIncrement", &fields_.code.pnIncrement, &Tarvex::newPnIncrement},
      {"userPNList", &fields_.userPnList.entry, nullptr},
      {"carrierFrequency", &fields_.carrierFrequency, &Tarvex::newCarrierFrequency},
      {"Threshold", &fields_.threshold, &Tarvex::newThreshold},
      {"VerticalScale", &fields_.verticalScale, &Tarvex::newVerticalScale},
      {"VerticalOffset", &fields_.verticalOffset, &Tarvex::newVerticalOffset},
  };
  for (const EntryRow& row : rows)
    bindEntry(*row.entry, *controls(), row.stem, whileOpen([this, changed = row.changed] {
      if (changed != nullptr) (this->*changed)();
    }));
}

void Tarvex::bindLists() {
  struct ListRow {
    const char* name;
    Handler click;
  };
  constexpr ListRow kLists[] = {
      {"FormatComboBox", &Tarvex::newFormat},
      {"ChannelizationCombo", &Tarvex::newChannelization},
      {"SortByComboBox", &Tarvex::SortByComboBox_Click},
      {"BarLabelComboBox", &Tarvex::BarLabelComboBox_Click},
      {"BarChartStyleComboBox", &Tarvex::NewBarChartStyle},
      {"PowerDisplayComboBox", &Tarvex::PowerDisplayComboBox_LostFocus},
      {"userPNListListBox", &Tarvex::userPNListListBox_Click},
  };
  for (const ListRow& row : kLists)
    controls()->list(row.name).Click = whileOpen([this, click = row.click] { (this->*click)(); });
}

void Tarvex::bindButtons() {
  struct ButtonRow {
    const char* name;
    Handler click;
  };
  constexpr ButtonRow kButtons[] = {
      {"CdmaUnitsPnOption", &Tarvex::newCdmaUnits},
      {"CdmaUnitsChipsOption", &Tarvex::newCdmaUnits},
      {"SortAscendingOptionButton", &Tarvex::SortAscendingOptionButton_Click},
      {"SortDescendingOptionButton", &Tarvex::SortDescendingOptionButton_Click},
      {"ShowCellNameCheckBox", &Tarvex::ShowCellNameCheckBox_Click},
      {"AutoScaleBox", &Tarvex::AutoScaleBox_Click},
      {"userPNListAddButton", &Tarvex::userPNListAddButton_Click},
      {"userPNListDeleteButton", &Tarvex::userPNListDeleteButton},
      {"userPNListImportButton", &Tarvex::userPNListImportButton},
      {"MarkerAddButton", &Tarvex::addMarker},
      {"MarkerDeleteButton", &Tarvex::deleteMarker},
      {"MarkerToMaxButton", &Tarvex::markerToMax},
      {"MarkerDeltaButton", &Tarvex::addDeltaMarker},
      {"CloseButton", &Tarvex::closeVfp},
  };
  for (const ButtonRow& row : kButtons)
    controls()->control(row.name).Click = whileOpen([this, click = row.click] { (this->*click)(); });
  for (const PilotSetRow& row : pilotSets())
    controls()->control(row.checkBox).Click = whileOpen([this, &row] { setClick(row); });
}

// --- Sets

// The host hears of the list sets by their codes, of the others by the operation that it adds them with.
void Tarvex::setClick(const PilotSetRow& row) {
  if (optionChangeInProgress()) return;
  const std::string routine = std::string(row.checkBox) + "_Click()";
  guard([&] { return named(routine); },
        [&] {
          const bool on = controls()->checkBox(row.checkBox).Value() != 0;
          if (askForSet(row, routine, on))
            switchSet(row.set, on);
          else
            showSet(row, !on);
        });
}

bool Tarvex::askForSet(const PilotSetRow& row, std::string_view routine, bool on) {
  switch (row.set) {
    case PilotSet::TopN:
      return request(routine, kTopNSetParameter, 0, on);
    case PilotSet::UserList:
      return request(routine, kUserListSetParameter, 0, on);
    case PilotSet::AllPilots:
    case PilotSet::ZoomedPilots:
      break;
  }
  return operate(routine, on ? kAddTraceOperation : kRemoveTraceOperation,
                 static_cast<std::int32_t>(row.resultType));
}

void Tarvex::newTopN() {
  guard("Tarvex::newTopN()", [this] {
    if (auto* const bars = dynamic_cast<clsBarChartPainter*>(displayOf(pilotSet(PilotSet::TopN))))
      bars->setBarsToPaint(toInt16(fields_.topN.value()));
    refreshTraces();
  });
}

// --- Code window

void Tarvex::newCodeStart() {
  guard("Tarvex::newCodeStart()", [this] { newCodeStartStop(true); });
}

void Tarvex::newCodeStop() {
  guard("Tarvex::newCodeStop()", [this] { newCodeStartStop(false); });
}

// What a user enters while an earlier entry is still with the host has to wait: the field goes back.
void Tarvex::newCodeStartStop(bool startChanged) {
  if (updateInProgress_) return fields_.code.placeEdges();
  const FlagScope inProgress(updateInProgress_);
  guard("Tarvex::newCodeStartStop()", [&] {
    fields_.code.joinEdges(startChanged);
    showCodeWindow();
    const double span = fields_.code.span.value();  // whatever the host answers to the first request
    if (request("newCodeStartStop()", kCodeStartParameter, fields_.code.start.value()))
      request("newCodeStartStop()", kCodeSpanParameter, span);
  });
}

void Tarvex::newCodeCenter() { newCodeCenterSpan(true); }

void Tarvex::newCodeSpan() {
  guard("Tarvex::newCodeSpan()", [this] { newCodeCenterSpan(false); });
}

void Tarvex::newCodeCenterSpan(bool centerChanged) {
  CodeEntries& code = fields_.code;
  if (updateInProgress_) return code.placeEdges();
  const FlagScope inProgress(updateInProgress_);
  guard("Tarvex::newCodeCenterSpan()", [&] {
    centerChanged ? code.fitCenter() : code.fitSpan();
    showCodeWindow();
    const double span = code.span.value();
    if (centerChanged) {
      request("newCodeCenterSpan()", kCodeCenterParameter, code.center.value());
    } else if (request("newCodeCenterSpan()", kCodeStartParameter, code.start.value())) {
      request("newCodeCenterSpan()", kCodeSpanParameter, span);
    }
  });
}

void Tarvex::newFormat() {
  fields_.format.Click();
  if (optionChangeInProgress() || !fields_.format.newValue()) return;
  guard("Tarvex::newCdmaFormat()", [this] {
    const std::int16_t format = fields_.format.value();
    if (request("newCdmaFormat()", kCodeFormatParameter, format)) return newCdmaFormat(format);
    const FlagScope inProgress = changeOption();
    fields_.format.value(fields_.code.format());
  });
}

void Tarvex::newCdmaFormat(std::int16_t format) {
  guard("Tarvex::newCdmaFormat()", [&] {
    fields_.code.format(format);
    fields_.showCodeUnits();
    showCodeWindow();
  });
}

void Tarvex::newCdmaUnits() {
  guard("Tarvex::newCdmaUnits()", [this] {
    const FlagScope inProgress = changeOption();
    fields_.showCodeUnits();
    showCodeWindow();
  });
}

void Tarvex::newPnIncrement() {
  guard("Tarvex::newPnIncrement()", [this] {
    const double increment = fields_.code.pnIncrement.value();
    fields_.userPnList.increment(increment);
    request("newPnIncrement()", kPnIncrementParameter, increment);
  });
}

// --- Carrier

void Tarvex::newCarrierFrequency() {
  guard("Tarvex::newCarrierFrequency()", [this] {
    request("newCarrierFrequency()", kCenterFrequencyParameter, fields_.carrierFrequency.value());
  });
}

void Tarvex::newChannelization() {
  fields_.channelization.Click();
  if (optionChangeInProgress() || !fields_.channelization.newValue()) return;
  guard("Tarvex::newChannelization()",
        [this] { request("newChannelization()", kChannelizationParameter, fields_.channelization.value()); });
}

// --- Bars

template <class Change>
void Tarvex::changeBars(Change change) {
  clsBarChartPainter* const bars = currentBars();
  if (bars == nullptr) return;
  change(*bars);
  refreshTraces();
}

void Tarvex::SortByComboBox_Click() {
  fields_.sortBy.Click();
  if (optionChangeInProgress()) return;
  guard("Tarvex::SortByComboBox_Click()", [this] {
    changeBars([this](clsBarChartPainter& bars) { bars.barSortByMode(fields_.sortBy.value()); });
  });
}

void Tarvex::SortAscendingOptionButton_Click() {
  sortOrderClick("SortAscendingOptionButton_Click()", kAscending);
}
void Tarvex::SortDescendingOptionButton_Click() {
  sortOrderClick("SortDescendingOptionButton_Click()", kDescending);
}

void Tarvex::sortOrderClick(std::string_view routine, std::int16_t order) {
  if (optionChangeInProgress()) return;
  guard([&] { return named(routine); },
        [&] { changeBars([order](clsBarChartPainter& bars) { bars.barSortOrder(order); }); });
}

void Tarvex::BarLabelComboBox_Click() {
  fields_.barLabel.Click();
  if (optionChangeInProgress()) return;
  guard("Tarvex::BarLabelComboBox_Click()", [this] {
    const ItemList& list = *fields_.barLabel.ComboBox();
    if (list.ListIndex() < 0) return report("BarLabelComboBox_Click() invalid label value");
    const std::int32_t label = list.item(list.ListIndex()).data;
    if (label < 0 || label > kLastOther) return report("BarLabelComboBox_Click() invalid label value");
    changeBars([label](clsBarChartPainter& bars) { bars.otherIs(static_cast<std::int16_t>(label)); });
  });
}

void Tarvex::NewBarChartStyle() {
  fields_.barChartStyle.Click();
  if (optionChangeInProgress()) return;
  guard("Tarvex::NewBarChartStyle()", [this] {
    changeBars([this](clsBarChartPainter& bars) { bars.BarChartStyle(fields_.barChartStyle.value()); });
  });
}

void Tarvex::newThreshold() {
  guard("Tarvex::newThreshold() ... failed", [this] {
    changeBars([this](clsBarChartPainter& bars) {
      bars.threshold(fields_.threshold.isBlank() ? std::nullopt : std::optional(fields_.threshold.value()));
    });
  });
}

void Tarvex::ShowCellNameCheckBox_Click() {
  if (optionChangeInProgress()) return;
  guard("Tarvex::ShowCellNameCheckBox_Click()", [this] {
    const bool show = controls()->checkBox("ShowCellNameCheckBox").Value() != 0;
    changeBars([show](clsBarChartPainter& bars) { bars.ShowCellName(show); });
  });
}

// Of the active trace. Its axis goes along by the set's total power, to a whole division, so that what was on
// it stays on it.
void Tarvex::PowerDisplayComboBox_LostFocus() {
  fields_.powerDisplay.Click();
  if (optionChangeInProgress()) return;
  guard("Tarvex::PowerDisplayComboBox_LostFocus()", [this] {
    TraceObject* const active = base().traceManager().activeTrace();
    const bool on = fields_.powerDisplay.value() != 0;
    if (active == nullptr || withIo(*active) == on) return;
    const PilotSetRow* const row = pilotSetOfTrace(active->resultType());
    if (row == nullptr) return;
    const double ioDbm = static_cast<double>(state(row->set).ioDbm.value_or(0));
    const double division = active->verticalResolution();
    const double top = active->gridScaleTop().value_or(0) + (on ? ioDbm : -ioDbm);
    active->gridScaleTop(roundHalfEven(top / division) * division);
    showPower(*row, on);
    showVerticalAxis();
    refreshTraces();
  });
}

// A trace has taken its offset in already: it is given its levels anew.
void Tarvex::showPower(const PilotSetRow& row, bool withIo) {
  TraceObject* const display = displayOf(row);
  if (auto* const bars = dynamic_cast<clsBarChartPainter*>(display)) showPower(*bars, withIo);
  auto* const painter = dynamic_cast<clsMultiTracePainter*>(display);
  if (painter == nullptr) return;
  showPower(*painter, withIo);
  painter->trace(levelsOf(row.set));
}

// --- Vertical axis, of the active trace

void Tarvex::newVerticalScale() {
  guard("Tarvex::newVerticalScale()", [this] {
    if (TraceObject* const active = base().traceManager().activeTrace())
      active->verticalResolution(fields_.verticalScale.value());
    refreshTraces();
  });
}

void Tarvex::newVerticalOffset() {
  guard("Tarvex::newVerticalOffset()", [this] {
    if (TraceObject* const active = base().traceManager().activeTrace())
      active->gridScaleTop(fields_.verticalOffset.value());
    refreshTraces();
  });
}

void Tarvex::AutoScaleBox_Click() {
  if (optionChangeInProgress()) return;
  guard("Tarvex::AutoScaleBox_Click()", [this] {
    TraceObject* const active = base().traceManager().activeTrace();
    if (active == nullptr) return;
    active->setAutoScale(controls()->checkBox("AutoScaleBox").Value() != 0);
    refreshTraces();
    showVerticalAxis();
  });
}

}  // namespace frontpanels
