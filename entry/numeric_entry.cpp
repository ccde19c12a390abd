#include "entry/numeric_entry.h"

#include <span>

#include "entry/number_format.h"
#include "framework/support/error_handler.h"
#include "framework/support/guard.h"
#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

struct SuffixRow {
  const char* name;
  double lowerLimit;
  double upperLimit;
  double scale;
};

constexpr double kNoLimit = 1e30;

// The base unit (or, for frequencies, the megahertz) comes first: numbers that no record holds are shown in
// it.
constexpr SuffixRow kChips[] = {{"chips", -kNoLimit, kNoLimit, 1}};
constexpr SuffixRow kOffset[] = {{"PN", -kNoLimit, kNoLimit, 1}};
constexpr SuffixRow kBytes[] = {
    {"Bytes", 0, 1e3, 1}, {"kBytes", 1e3, 1e6, 1e3}, {"MBytes", 1e6, kNoLimit, 1e6}};
constexpr SuffixRow kDecibels[] = {{"dB", -kNoLimit, kNoLimit, 1}};
constexpr SuffixRow kDecibelMilliwatts[] = {{"dBm", -kNoLimit, kNoLimit, 1}};
constexpr SuffixRow kDegrees[] = {{"deg", -kNoLimit, kNoLimit, 1}};
// 1 to 10 GHz stay in megahertz, as receivers are tuned: the gap below "GHz" is wanted.
constexpr SuffixRow kFrequency[] = {
    {"MHz", 1e6, 1e9, 1e6}, {"Hz", 0, 1e3, 1}, {"kHz", 1e3, 1e6, 1e3}, {"GHz", 1e10, kNoLimit, 1e9}};
constexpr SuffixRow kMeters[] = {{"m", 1, 1e3, 1}, {"km", 1e3, kNoLimit, 1e3}, {"cm", 0, 1, 1e-2}};
constexpr SuffixRow kPercent[] = {{"%", -kNoLimit, kNoLimit, 1}};
constexpr SuffixRow kTime[] = {
    {"s", 1, kNoLimit, 1}, {"ms", 1e-3, 1, 1e-3}, {"us", 1e-6, 1e-3, 1e-6}, {"ns", 0, 1e-6, 1e-9}};
constexpr SuffixRow kLongTime[] = {{"s", 1, kNoLimit, 1}, {"ms", 0, 1, 1e-3}};
constexpr SuffixRow kVolts[] = {
    {"V", 1, kNoLimit, 1}, {"mV", 1e-3, 1, 1e-3}, {"uV", 1e-6, 1e-3, 1e-6}, {"nV", 0, 1e-6, 1e-9}};
constexpr SuffixRow kMetersPerSecond[] = {{"m/s", -kNoLimit, kNoLimit, 1}};
constexpr SuffixRow kMilesPerHour[] = {{"MPH", -kNoLimit, kNoLimit, 1}};
constexpr SuffixRow kKilometersPerHour[] = {{"KPH", -kNoLimit, kNoLimit, 1}};
constexpr SuffixRow kFeet[] = {{"ft", -kNoLimit, kNoLimit, 1}};

void addRows(clsNumericEntry& entry, std::span<const SuffixRow> rows) {
  for (const SuffixRow& row : rows) entry.suffix(row.name, row.lowerLimit, row.upperLimit, row.scale);
}

double scaleOf(const Variant& scale, double lowerLimit) {
  const bool given = !scale.isEmpty();
  if (given && scale.isNumeric()) return scale.toDouble();
  if (given) {
    errorHandler().Assert("Warning...a non-numeric value has been passed to clsNumericEntry::suffix()");
  }
  return lowerLimit == 0 ? 1 : lowerLimit;
}

}  // namespace

void clsNumericEntry::suffix(std::string_view name, double lowerLimit, double upperLimit,
                             const Variant& scale) {
  guard("clsNumericEntry::suffix() failed. ", [&] {
    if (suffixes_.count() == SuffixTable::kCapacity) {
      errorHandler().Assert("clsNumericEntry::suffix() ... too many suffixes");
      return;
    }
    (void)suffixes_.add({lowerLimit, upperLimit, scaleOf(scale, lowerLimit), std::string(name)});
  });
}

void clsNumericEntry::chipSuffix() { addRows(*this, kChips); }
void clsNumericEntry::offsetSuffix() { addRows(*this, kOffset); }
void clsNumericEntry::byteSuffix() { addRows(*this, kBytes); }
void clsNumericEntry::dBSuffix() { addRows(*this, kDecibels); }
void clsNumericEntry::dBmSuffix() { addRows(*this, kDecibelMilliwatts); }
void clsNumericEntry::degreeSuffix() { addRows(*this, kDegrees); }
void clsNumericEntry::frequencySuffix() { addRows(*this, kFrequency); }
void clsNumericEntry::meterSuffix() { addRows(*this, kMeters); }
void clsNumericEntry::percentSuffix() { addRows(*this, kPercent); }
void clsNumericEntry::timeSuffix() { addRows(*this, kTime); }
void clsNumericEntry::longTimeSuffix() { addRows(*this, kLongTime); }
void clsNumericEntry::voltSuffix() { addRows(*this, kVolts); }
void clsNumericEntry::meterPerSecSuffix() { addRows(*this, kMetersPerSecond); }
void clsNumericEntry::milePerHourSuffix() { addRows(*this, kMilesPerHour); }
void clsNumericEntry::kmPerHourSuffix() { addRows(*this, kKilometersPerHour); }
void clsNumericEntry::feetSuffix() { addRows(*this, kFeet); }

std::string clsNumericEntry::formatter(double value) const {
  std::string text;
  formatter(value, text);
  return text;
}

void clsNumericEntry::formatter(double value, std::string& text) const {
  text.clear();
  guard("clsNumericEntry::formatter() failed. ",
        [&] { append(text, value, formatString_, !suppressSuffix_); });
}

double clsNumericEntry::shownScale(double value) const noexcept {
  const SuffixRecord* const unit = suffixes_.find((value - formatOffset_) / formatScale_);
  return unit == nullptr ? formatScale_ : formatScale_ * unit->scale;
}

void clsNumericEntry::append(std::string& text, double value, std::string_view format, bool withUnit) const {
  if (formatScale_ == 0) raiseDivisionByZero();
  double shown = (value - formatOffset_) / formatScale_;
  const SuffixRecord* const unit = suffixes_.find(shown);
  if (unit != nullptr) {
    if (unit->scale == 0) raiseDivisionByZero();
    shown /= unit->scale;
  }
  if (format.empty()) {
    text += numberToText(shown);
  } else {
    appendNumber(text, shown, format);
  }
  if (withUnit && unit != nullptr) (text += ' ') += unit->name;
}

}  // namespace frontpanels
