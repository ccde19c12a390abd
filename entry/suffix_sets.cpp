// The units of the quantities that panels show.
#include <span>

#include "entry/numeric_entry.h"

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

}  // namespace

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

}  // namespace frontpanels
