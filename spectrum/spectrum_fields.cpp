#include "spectrum/spectrum_fields.h"

#include <string>

#include "framework/support/enumerated_tables.h"
#include "framework/support/error_handler.h"
#include "framework/support/guard.h"
#include "framework/support/host_codes.h"

namespace frontpanels {
namespace {

struct EntryRow {
  clsNumericEntry SpectrumFields::*entry;
  void (clsNumericEntry::*units)();
  double minimum;
  double maximum;
  double value;
  double step;
};

constexpr EntryRow kEntries[] = {
    {&SpectrumFields::frequencyRbw, &clsNumericEntry::frequencySuffix, 1, 10e6, 100e3, 0},
    {&SpectrumFields::averageCount, &clsNumericEntry::noSuffix, 1, 1000, 10, 1},
    {&SpectrumFields::displayLength, &clsNumericEntry::noSuffix, 1, 3001, 513, 1},
    {&SpectrumFields::verticalScale, &clsNumericEntry::noSuffix, 0.1, 50, 10, 0},
    {&SpectrumFields::verticalOffset, &clsNumericEntry::dBmSuffix, -200, 100, -20, 0},
};

// By MeasurementInterval.
constexpr EntryRow kIntervals[] = {
    {&SpectrumFields::sweepRate, &clsNumericEntry::longTimeSuffix, 1e-3, 3600, 1, 0},
    {&SpectrumFields::sweepRate, &clsNumericEntry::meterSuffix, 0.1, 10e3, 1, 0},
};

constexpr const char* kChosenAtFirst[] = {"DownlinkOption", "FrequencyOption", "IntervalTimeOption",
                                          "LogPwrOption", "WidebandOption"};

constexpr std::size_t kOptionsOfPair = 2;
struct HostTable {
  std::int32_t parameterType;
  const char* name;
};
constexpr HostTable kHostTables[] = {{FREQ_FILTER, "FREQ_FILTER"},
                                     {PARM_AVERAGE_AS_LOG_POWER, "PARM_AVERAGE_AS_LOG_POWER"}};

void setUp(SpectrumFields& fields, const EntryRow& row) {
  clsNumericEntry& entry = fields.*row.entry;
  (entry.*row.units)();
  entry.MINIMUM(row.minimum);
  entry.MAXIMUM(row.maximum);
  entry.Arbitrary(row.step == 0);
  if (row.step != 0) entry.step(row.step);
  entry.formatString("0.########");
  entry.valueNoUpdate(row.value);
}

}  // namespace

SpectrumFields::SpectrumFields(ControlSet& controlsOfPanel) : controls(controlsOfPanel) {
  setUpEntries();
  setUpLists();
  for (const char* const option : kChosenAtFirst) controls.optionButton(option).Value(true);
  for (const HostTable& table : kHostTables)
    if (enumeratedValues(table.parameterType).size() != kOptionsOfPair)
      errorHandler().Assert(
          std::string("SpectrumView::form_Load() ... recieved unexpected number of records on parameter ") +
          table.name);
}

void SpectrumFields::setUpEntries() {
  for (const EntryRow& row : kEntries) setUp(*this, row);
  frequencyRbw.Arbitrary(false);
  frequencyRbw.sequence({1, 3});
  frequencyRbw.valueNoUpdate(frequencyRbw.value());
  showInterval(MeasurementInterval::Time, kIntervals[0].value);
}

void SpectrumFields::setUpLists() {
  averageType.ComboBox(&controls.list("AverageTypeCombo"));
  averageType.Label(&controls.label("AverageTypeLabel"));
  averageType.parameterType(kAverageTypeParameter);
  averageType.value(kAveragingOff);
  channelization.ComboBox(&controls.list("ChannelizationCombo"));
  channelization.parameterType(kChannelizationParameter);
  if (const auto known = enumeratedValues(kChannelizationParameter); !known.empty())
    channelization.value(known.front().value);
}

void SpectrumFields::showInterval(MeasurementInterval interval, double value) noexcept {
  guard("SpectrumView::showInterval()", [&] {
    const auto kind = static_cast<std::size_t>(interval);
    sweepRate.Clear();
    setUp(*this, kIntervals[kind]);
    if (intervalLimits_[kind]) {
      sweepRate.MINIMUM(intervalLimits_[kind]->minimum);
      sweepRate.MAXIMUM(intervalLimits_[kind]->maximum);
    }
    if (value > 0) sweepRate.valueNoUpdate(value);
  });
}

bool SpectrumFields::intervalLimits(MeasurementInterval kind, const HostRecordSet& records) noexcept {
  clsNumericEntry reader;
  if (!reader.Limits(records)) return false;
  if (records.count() == 0) return true;
  intervalLimits_[static_cast<std::size_t>(kind)] = EntryLimits{reader.MINIMUM(), reader.MAXIMUM()};
  if (interval() == kind) {
    sweepRate.MINIMUM(reader.MINIMUM());
    sweepRate.MAXIMUM(reader.MAXIMUM());
  }
  return true;
}

}  // namespace frontpanels
