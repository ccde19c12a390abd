#include "framework/support/enumerated_tables.h"

#include <algorithm>

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

    {kChannelizationEnumeration, 0, "Cellular"},
    {kChannelizationEnumeration, 1, "PCS"},
    {kChannelizationEnumeration, 2, "GSM 900"},
    {kChannelizationEnumeration, 3, "DCS 1800"},
    {kChannelizationEnumeration, 4, "IMT-2000"},

    {kAverageTypeEnumeration, kAveragingOff, "Off"},
    {kAverageTypeEnumeration, 0, "Linear"},
    {kAverageTypeEnumeration, 1, "Exponential"},
    {kAverageTypeEnumeration, 2, "Max Hold"},
    {kAverageTypeEnumeration, 3, "Min Hold"},

    {kPowerDisplayEnumeration, 0, "Ec/Io"},
    {kPowerDisplayEnumeration, 1, "Ec"},

    {kSortModeEnumeration, 0, "None"},
    {kSortModeEnumeration, 1, "Y"},
    {kSortModeEnumeration, 2, "X"},
    {kSortModeEnumeration, 3, "History"},
    {kSortModeEnumeration, 4, "Show Value"},

    {kSortOrderEnumeration, 1, "Ascending"},
    {kSortOrderEnumeration, 2, "Descending"},

    {kBarLabelEnumeration, 0, "None"},
    {kBarLabelEnumeration, 2, "Delay (chips)"},
    {kBarLabelEnumeration, 3, "Ec (dBm)"},
    {kBarLabelEnumeration, 4, "Ec/Io (dB)"},
    {kBarLabelEnumeration, 5, "Ag. Ec (dBm)"},
    {kBarLabelEnumeration, 6, "Ag. Ec/Io (dB)"},
    {kBarLabelEnumeration, 7, "Delay Spread (chips)"},
    {kBarLabelEnumeration, 8, "Ag - Peak (dB)"},

    {kBarChartStyleEnumeration, 0, "Vertical"},
    {kBarChartStyleEnumeration, 1, "Horizontal"},

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
