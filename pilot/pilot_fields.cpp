#include "pilot/pilot_fields.h"

#include <algorithm>
#include <iterator>

#include "framework/support/enumerated_tables.h"
#include "framework/support/host_codes.h"
#include "pilot/code_units.h"

namespace frontpanels {
namespace {

struct EntryRow {
  clsNumericEntry PilotFields::*entry;
  void (clsNumericEntry::*units)();
  double minimum;
  double maximum;
  double value;
  double step;  // 0: any value
  const char* format;
};

constexpr EntryRow kEntries[] = {
    {&PilotFields::topN, &clsNumericEntry::noSuffix, 1, 40, 20, 1, "0"},
    {&PilotFields::threshold, &clsNumericEntry::noSuffix, -1000, 1000, 0, 0, "0.##"},
    {&PilotFields::carrierFrequency, &clsNumericEntry::frequencySuffix, 0, 6e9, 1e9, 0, "0.########"},
    {&PilotFields::io, &clsNumericEntry::dBmSuffix, -1e9, 1e9, 0, 0, "0.##"},
    {&PilotFields::verticalScale, &clsNumericEntry::noSuffix, 0.001, 1000, 3, 0, "0.###"},
    {&PilotFields::verticalOffset, &clsNumericEntry::noSuffix, -1000, 1000, 0, 0, "0.##"},
};

struct ListRow {
  clsEnumeratedParameter PilotFields::*list;
  std::int32_t parameterType;
  const char* comboBox;
  const char* label;  // null: its frame says what it is
  std::int16_t value;
};

constexpr ListRow kLists[] = {
    {&PilotFields::format, kCodeFormatEnumeration, "FormatComboBox", "FormatLabel", 0},
    {&PilotFields::channelization, kChannelizationParameter, "ChannelizationCombo", nullptr, 0},
    {&PilotFields::sortBy, kSortModeParameter, "SortByComboBox", "SortByLabel", 1},
    {&PilotFields::barChartStyle, kBarChartStyleParameter, "BarChartStyleComboBox", "BarChartStyleLabel", 0},
    {&PilotFields::powerDisplay, kPowerDisplayParameter, "PowerDisplayComboBox", "PowerDisplayLabel", 0},
};

// Values of otherIs: what any record holds, and what only multipath records do.
constexpr std::int16_t kCommonBarLabels[] = {0, 2, 3, 4};
constexpr std::int16_t kMultipathBarLabels[] = {5, 6, 7, 8};

constexpr const char* kUserPnListFields[] = {"userPNListFrame",        "userPNListTextBox",
                                             "userPNListSpinButton",   "userPNListAddButton",
                                             "userPNListImportButton", "userPNListListBox"};
constexpr const char* kBarFields[] = {
    "SortByLabel",         "SortByComboBox",   "SortAscendingOptionButton", "SortDescendingOptionButton",
    "BarLabelLabel",       "BarLabelComboBox", "BarChartStyleLabel",        "BarChartStyleComboBox",
    "ShowCellNameCheckBox"};

}  // namespace

PilotFields::PilotFields(ControlSet& ofPanel)
    : controls(ofPanel), userPnList(ofPanel.list("userPNListListBox")) {
  setUpEntries();
  setUpLists();
  for (const char* const option : {"CdmaUnitsPnOption", "SortDescendingOptionButton"})
    controls.optionButton(option).Value(true);
  controls.control("I0TextBox").Enabled(false);
  enableUserPnList(false);
  enableBarFields(false);
}

void PilotFields::setUpEntries() {
  for (const EntryRow& row : kEntries) {
    clsNumericEntry& entry = this->*row.entry;
    (entry.*row.units)();
    entry.MINIMUM(row.minimum);
    entry.MAXIMUM(row.maximum);
    entry.Arbitrary(row.step == 0);
    if (row.step != 0) entry.step(row.step);
    entry.formatString(row.format);
    entry.valueNoUpdate(row.value);
  }
  threshold.preserveBlankEntry(true);
  threshold.blank();
  io.preserveBlankEntry(true);
  io.textBox(&controls.textBox("I0TextBox"));
  io.blank();
}

void PilotFields::setUpLists() {
  for (const ListRow& row : kLists) {
    clsEnumeratedParameter& parameter = this->*row.list;
    parameter.ComboBox(&controls.list(row.comboBox));
    if (row.label != nullptr) parameter.Label(&controls.label(row.label));
    parameter.parameterType(row.parameterType);
    parameter.value(row.value);
  }
  barLabel.subset(true);
  barLabel.ComboBox(&controls.list("BarLabelComboBox"));
  barLabel.Label(&controls.label("BarLabelLabel"));
  barLabel.parameterType(kBarLabelParameter);
  for (const std::int16_t value : kCommonBarLabels) barLabel.Add(value);
  barLabel.value(0);
}

void PilotFields::showCodeUnits() {
  const CodeUnits units =
      controls.optionButton("CdmaUnitsPnOption").Value() ? CodeUnits::Pn : CodeUnits::Chips;
  code.units(units);
  userPnList.units(units, chipsPerPn(code.format()));
}

bool PilotFields::barLabelsForMultipath(bool multipath) {
  constexpr std::int32_t kFew = std::size(kCommonBarLabels);
  constexpr std::int32_t kMany = kFew + std::size(kMultipathBarLabels);
  const std::int32_t count = controls.list("BarLabelComboBox").ListCount();
  if (count == (multipath ? kMany : kFew)) return true;
  if (count != (multipath ? kFew : kMany)) return false;
  for (const std::int16_t value : kMultipathBarLabels)
    multipath ? barLabel.Add(value) : barLabel.Remove(value);
  return true;
}

void PilotFields::enableUserPnList(bool enable) {
  userPnListEnabled_ = enable;
  for (const char* const name : kUserPnListFields) controls.control(name).Enabled(enable);
  updateDeleteButton();
}

void PilotFields::updateDeleteButton() {
  controls.control("userPNListDeleteButton").Enabled(userPnListEnabled_ && userPnList.selected() >= 0);
}

void PilotFields::enableBarFields(bool enable) {
  for (const char* const name : kBarFields) controls.control(name).Enabled(enable);
  threshold.controlEnable(enable);
}

}  // namespace frontpanels
