#include "framework/support/enumerated_tables.h"

#include <algorithm>

#include "framework/support/host_codes.h"

namespace frontpanels {
namespace {

struct Row {
  std::int32_t parameterType;
  std::int16_t value;
  const char* label;
};

// Types in the order of their numbers, values in the order in which lists show them.
constexpr Row kRows[] = {
    {FREQ_FILTER, 0, "Wideband"},
    {FREQ_FILTER, kNarrowbandFilter, "Narrowband"},

    {kCodeFormatEnumeration, 0, "IS-95B"},
    {kCodeFormatEnumeration, 1, "CDMA2000 1X"},
    {kCodeFormatEnumeration, kTripleRateCodeFormat, "CDMA2000 3X"},

    // Hosts use more result types than these; of the others nobody wrote down what they are.
    {kResultTypeEnumeration, 14, "All Pilots"},
    {kResultTypeEnumeration, 18, "Zoomed Pilots"},
    {kResultTypeEnumeration, 25, "Spectrum"},
    {kResultTypeEnumeration, 200, "User List"},
    {kResultTypeEnumeration, 201, "Top N"},

    {kChannelizationParameter, 0, "Cellular"},
    {kChannelizationParameter, 1, "PCS"},
    {kChannelizationParameter, 2, "GSM 900"},
    {kChannelizationParameter, 3, "DCS 1800"},
    {kChannelizationParameter, 4, "IMT-2000"},

    {kAverageTypeParameter, kAveragingOff, "Off"},
    {kAverageTypeParameter, 0, "Linear"},
    {kAverageTypeParameter, 1, "Exponential"},
    {kAverageTypeParameter, 2, "Max Hold"},
    {kAverageTypeParameter, 3, "Min Hold"},

    {kPowerDisplayParameter, 0, "Ec/Io"},
    {kPowerDisplayParameter, 1, "Ec"},

    {kSortModeParameter, 0, "None"},
    {kSortModeParameter, 1, "Y"},
    {kSortModeParameter, 2, "X"},
    {kSortModeParameter, 3, "History"},
    {kSortModeParameter, 4, "Show Value"},

    {kSortOrderParameter, 1, "Ascending"},
    {kSortOrderParameter, 2, "Descending"},

    {kBarLabelParameter, 0, "None"},
    {kBarLabelParameter, 2, "Delay (chips)"},
    {kBarLabelParameter, 3, "Ec (dBm)"},
    {kBarLabelParameter, 4, "Ec/Io (dB)"},
    {kBarLabelParameter, 5, "Ag. Ec (dBm)"},
    {kBarLabelParameter, 6, "Ag. Ec/Io (dB)"},
    {kBarLabelParameter, 7, "Delay Spread (chips)"},
    {kBarLabelParameter, 8, "Ag - Peak (dB)"},

    {kBarChartStyleParameter, 0, "Vertical"},
    {kBarChartStyleParameter, 1, "Horizontal"},

    {PARM_AVERAGE_AS_LOG_POWER, 1, "Log Power"},
    {PARM_AVERAGE_AS_LOG_POWER, 0, "Power"},
};

template <class Values>
auto listed(Values& values, std::int16_t value) {
  return std::find_if(values.begin(), values.end(),
                      [value](const EnumeratedValue& row) { return row.value == value; });
}

}  // namespace

EnumeratedTables::EnumeratedTables() {
  for (const Row& row : kRows) add(row.parameterType, {row.value, row.label});
}

std::span<const EnumeratedValue> EnumeratedTables::values(std::int32_t parameterType) const {
  const auto table = tables_.find(parameterType);
  if (table == tables_.end()) return {};
  return table->second;
}

std::string EnumeratedTables::label(std::int32_t parameterType, std::int16_t value) const {
  const std::span<const EnumeratedValue> table = values(parameterType);
  const auto found = listed(table, value);
  return found == table.end() ? std::to_string(value) : found->label;
}

void EnumeratedTables::add(std::int32_t parameterType, const EnumeratedValue& value) {
  std::vector<EnumeratedValue>& table = tables_[parameterType];
  const auto found = listed(table, value.value);
  if (found == table.end())
    table.push_back(value);
  else
    found->label = value.label;
}

void EnumeratedTables::replace(std::int32_t parameterType, std::span<const EnumeratedValue> values) {
  EnumeratedTables fresh(*this);  // so that a failure leaves the tables as they were
  fresh.tables_[parameterType].clear();
  for (const EnumeratedValue& value : values) fresh.add(parameterType, value);
  tables_.swap(fresh.tables_);
}

EnumeratedTables& enumeratedTables() {
  static EnumeratedTables tables;
  return tables;
}

}  // namespace frontpanels
