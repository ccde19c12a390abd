#include "sources/receiver.h"

#include <algorithm>
#include <cmath>
#include <iterator>
#include <limits>

#include "framework/support/host_codes.h"

namespace frontpanels {
namespace {

// Called with finite values only.
bool isCenter(double value) { return value >= kLowestTunedHz && value <= kHighestTunedHz; }
bool isSpan(double value) { return value > 0 && value <= kHighestTunedHz - kLowestTunedHz; }
bool isPositive(double value) { return value > 0; }
bool isNotNegative(double value) { return value >= 0; }
bool isFlag(double value) { return value == 0 || value == 1; }
bool isListValue(double value) {
  return value == std::floor(value) && std::abs(value) <= std::numeric_limits<std::int16_t>::max();
}
bool isCount(double value) { return isListValue(value) && isNotNegative(value); }

struct SettingRow {
  std::int16_t code;
  bool (*accepts)(double value);
};

constexpr SettingRow kRows[] = {
    {kCenterFrequencyParameter, isCenter},
    {kSpanParameter, isSpan},
    {kRbwParameter, isPositive},               // Hz
    {FREQ_FILTER, isFlag},                     // a narrow IF bandwidth
    {TIME_MEASUREMENT_PERIOD, isNotNegative},  // s
    {kDisplayLengthParameter, isPositive},
    {kChannelizationParameter, isListValue},
    {kAverageTypeParameter, isListValue},
    {kAverageCountParameter, isCount},
    {kUnitsParameter, isFlag},                    // frequencies rather than channels
    {kDistanceIntervalParameter, isNotNegative},  // m
    {kIntervalKindParameter, isFlag},             // the interval is a time
    {PARM_AVERAGE_AS_LOG_POWER, isFlag},          // averages of logarithmic power
};

bool isTuning(std::int16_t code) { return code == kCenterFrequencyParameter || code == kSpanParameter; }

}  // namespace

bool Receiver::request(std::int16_t code, double value) {
  const auto* const row = std::find_if(std::begin(kRows), std::end(kRows),
                                       [code](const SettingRow& r) { return r.code == code; });
  if (row == std::end(kRows)) return false;
  const bool taken = std::isfinite(value) && row->accepts(value);
  if (taken) {
    values_[code] = value;
    tuned_ = tuned_ || isTuning(code);
  }
  const bool waiting = std::find(unanswered_.begin(), unanswered_.end(), code) != unanswered_.end();
  if (!waiting && values_.count(code) != 0) unanswered_.push_back(code);
  return taken;
}

// Not before centre and span are asked for again: a panel that has changed both says so one after the other.
void Receiver::fitRange() {
  const auto center = values_.find(kCenterFrequencyParameter);
  const auto span = values_.find(kSpanParameter);
  if (!tuned_ || center == values_.end() || span == values_.end()) return;
  span->second = std::min(span->second, kHighestTunedHz - kLowestTunedHz);
  const double half = span->second / 2;
  center->second = std::clamp(center->second, kLowestTunedHz + half, kHighestTunedHz - half);
}

std::vector<ReceiverSetting> Receiver::takeAnswers() {
  fitRange();
  std::vector<ReceiverSetting> answers;
  for (const std::int16_t code : unanswered_) answers.push_back({code, values_.at(code)});
  unanswered_.clear();
  return answers;
}

std::vector<ReceiverSetting> Receiver::settings() const {
  std::vector<ReceiverSetting> all;
  for (const auto& [code, value] : values_) all.push_back({code, value});
  return all;
}

std::int16_t Receiver::channelization() const {
  const auto found = values_.find(kChannelizationParameter);
  return found == values_.end() ? std::int16_t{0} : static_cast<std::int16_t>(found->second);
}

SpectrumTuning Receiver::tuning(const SpectrumTuning& defaults) const {
  const auto value = [this](std::int16_t code, double otherwise) {
    const auto found = values_.find(code);
    return found == values_.end() ? otherwise : found->second;
  };
  SpectrumTuning tuning = defaults;
  if (tuned_) {
    const double widest = kHighestTunedHz - kLowestTunedHz;
    tuning.spanHz = std::min(value(kSpanParameter, defaults.spanHz), widest);
    const double half = tuning.spanHz / 2;
    tuning.centerHz = std::clamp(value(kCenterFrequencyParameter, defaults.centerHz), kLowestTunedHz + half,
                                 kHighestTunedHz - half);
  }
  tuning.rbwHz = value(kRbwParameter, defaults.rbwHz);
  tuning.narrowIf = value(FREQ_FILTER, defaults.narrowIf ? 1 : 0) != 0;
  tuning.periodS = value(TIME_MEASUREMENT_PERIOD, defaults.periodS);
  const double points = std::min(value(kDisplayLengthParameter, static_cast<double>(defaults.points)),
                                 static_cast<double>(kDisplayCells));
  tuning.points = static_cast<std::size_t>(std::max(points, 2.0));
  tuning.averageType = static_cast<std::int16_t>(value(kAverageTypeParameter, defaults.averageType));
  tuning.averageCount = static_cast<std::int32_t>(value(kAverageCountParameter, defaults.averageCount));
  tuning.averageLogPower = value(PARM_AVERAGE_AS_LOG_POWER, defaults.averageLogPower ? 1 : 0) != 0;
  return tuning;
}

const DisplaySweep& Receiver::receive(const Sweep& sweep) {
  display_.count = 0;
  if (sweep.levelsDb.empty()) return display_;
  const FrequencyRange whole = rangeOf(sweep);
  double& centerHz = values_.try_emplace(kCenterFrequencyParameter, whole.centerHz).first->second;
  double& spanHz = values_.try_emplace(kSpanParameter, whole.spanHz).first->second;
  if (tuned_) {
    fitRange();
    resample(sweep, {centerHz, spanHz}, display_);
  } else {
    centerHz = whole.centerHz;
    spanHz = whole.spanHz;
    resample(sweep, display_);
  }
  return display_;
}

void Receiver::showWholeSweeps() { tuned_ = false; }

}  // namespace frontpanels
