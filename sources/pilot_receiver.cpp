#include "sources/pilot_receiver.h"

#include <algorithm>
#include <cmath>
#include <iterator>

#include "framework/support/host_codes.h"
#include "framework/support/numeric.h"
#include "sources/short_code.h"

namespace frontpanels {
namespace {

constexpr double kMostPns = 32768;  // places in the list travel as 16-bit indices
constexpr double kLastPn = kPnOffsets - 1;

bool isWhole(double value) { return value == std::floor(value); }
bool isListed(std::int32_t enumeration, double value) {
  const std::span<const EnumeratedValue> known = enumeratedValues(enumeration);
  return std::any_of(known.begin(), known.end(),
                     [value](const EnumeratedValue& row) { return row.value == value; });
}
// A boolean of the panel's is -1 for a host that reads it as a number.
bool isFlag(double value) { return value == 0 || std::abs(value) == 1; }
bool isPosition(double value, std::int32_t format) {
  return isWhole(value) && value >= 0 && value <= lastChip(format);
}

struct SettingRow {
  std::int16_t code;
  bool (*accepts)(double value, std::int32_t codeFormat);
};

// Called with finite values only.
constexpr SettingRow kRows[] = {
    {kCenterFrequencyParameter,
     [](double value, std::int32_t) { return value >= kLowestTunedHz && value <= kHighestTunedHz; }},
    {kChannelizationParameter,
     [](double value, std::int32_t) { return isListed(kChannelizationParameter, value); }},
    {kCodeFormatParameter,
     [](double value, std::int32_t) { return isListed(kCodeFormatEnumeration, value); }},
    // Of an odd span it lies between two chips.
    {kCodeCenterParameter,
     [](double value, std::int32_t format) {
       return isWhole(2 * value) && value >= 0 && value <= lastChip(format);
     }},
    {kCodeStartParameter, isPosition},
    {kCodeSpanParameter, isPosition},
    {kTopNSetParameter, [](double value, std::int32_t) { return isFlag(value); }},
    {kUserListSetParameter, [](double value, std::int32_t) { return isFlag(value); }},
    {kPnIncrementParameter,
     [](double value, std::int32_t) { return isWhole(value) && value >= 1 && value <= kLastPn; }},
};

// As the panel converts them.
double converted(double chips, std::int32_t from, std::int32_t to) {
  const double oneRate =
      from == kTripleRateCodeFormat ? roundHalfEven(chips / chipsOfOffset(from) * kChipsPerOffset) : chips;
  return to == kTripleRateCodeFormat ? roundHalfEven(oneRate / kChipsPerOffset * chipsOfOffset(to)) : oneRate;
}

}  // namespace

// --- Requests

bool PilotReceiver::request(std::int16_t code, std::int16_t index, double value) {
  if (code == CDMA_CODE_OFFSET) return takeList(index, value);
  const auto* const row = std::find_if(std::begin(kRows), std::end(kRows),
                                       [code](const SettingRow& r) { return r.code == code; });
  if (row == std::end(kRows)) return false;
  const bool taken = std::isfinite(value) && row->accepts(value, codeFormat());
  if (taken) take(code, value);
  const bool waiting = std::find(unanswered_.begin(), unanswered_.end(), code) != unanswered_.end();
  if (!waiting && this->value(code)) unanswered_.push_back(code);
  return taken;
}

void PilotReceiver::take(std::int16_t code, double value) {
  const double last = lastChip(codeFormat());
  const Window window = window_.value_or(Window{0, last, last / 2});
  switch (code) {
    case kTopNSetParameter:
      sets_[kTopN] = value != 0;
      break;
    case kUserListSetParameter:
      sets_[kUserList] = value != 0;
      break;
    case kCodeFormatParameter:
      format(static_cast<std::int32_t>(value));
      break;
    case kCodeStartParameter:
      place(value, std::min(window.span, last - value));
      break;
    case kCodeSpanParameter:
      place(window.start, std::min(value, last - window.start));
      break;
    case kCodeCenterParameter:
      placeRound(roundHalfEven(value), window.span);
      break;
    default:
      values_[code] = value;
  }
}

void PilotReceiver::place(double start, double span) { window_ = Window{start, span, start + span / 2}; }

// The window gives way at the ends of the code.
void PilotReceiver::placeRound(double center, double span) {
  const double start = roundHalfEven(center - span / 2);
  const double inside = std::clamp(start, 0.0, lastChip(codeFormat()) - span);
  window_ = Window{inside, span, inside == start ? center : inside + span / 2};
}

void PilotReceiver::format(std::int32_t format) {
  const std::int32_t before = codeFormat();
  values_[kCodeFormatParameter] = format;
  if (!window_) return;
  const double span = std::min(converted(window_->span, before, format), lastChip(format));
  place(std::min(converted(window_->start, before, format), lastChip(format) - span), span);
}

bool PilotReceiver::takeList(std::int16_t index, double value) {
  const auto count = static_cast<std::int32_t>(userPns_.size());
  if (!isWhole(value) || !(value >= 0 && value <= kLastPn)) return false;
  const auto pn = static_cast<std::int32_t>(value);
  const std::int32_t position = index < 0 ? -1 - index : index;
  if (index >= 0) {
    if (position > count || count >= kMostPns) return false;
    userPns_.insert(userPns_.begin() + position, pn);
  } else {
    if (position >= count || userPns_[static_cast<std::size_t>(position)] != pn) return false;
    userPns_.erase(userPns_.begin() + position);
  }
  listEdited_ = true;
  return true;
}

bool PilotReceiver::display(std::int32_t resultType, bool on) {
  constexpr std::int32_t kResultTypes[kSets] = {14, 18, 201, 200};
  const auto* const found = std::find(std::begin(kResultTypes), std::end(kResultTypes), resultType);
  if (found == std::end(kResultTypes)) return false;
  sets_[static_cast<std::size_t>(found - std::begin(kResultTypes))] = on;
  return true;
}

// --- Answers

std::vector<ReceiverSetting> PilotReceiver::takeAnswers() {
  std::vector<ReceiverSetting> answers;
  for (const std::int16_t code : unanswered_) answers.push_back({code, value(code).value()});
  unanswered_.clear();
  return answers;
}

std::vector<ReceiverSetting> PilotReceiver::settings() const {
  std::vector<ReceiverSetting> all;
  for (const SettingRow& row : kRows)
    if (const auto held = value(row.code); held && row.code != kCodeCenterParameter)
      all.push_back({row.code, *held});
  return all;
}

std::int32_t PilotReceiver::codeFormat() const {
  return static_cast<std::int32_t>(value(kCodeFormatParameter).value_or(0));
}

std::optional<double> PilotReceiver::value(std::int16_t code) const {
  switch (code) {
    case kTopNSetParameter:
      return sets_[kTopN];
    case kUserListSetParameter:
      return sets_[kUserList];
    case kCodeStartParameter:
      return window_ ? std::optional(window_->start) : std::nullopt;
    case kCodeSpanParameter:
      return window_ ? std::optional(window_->span) : std::nullopt;
    case kCodeCenterParameter:
      return window_ ? std::optional(window_->center) : std::nullopt;
    default:
      break;
  }
  const auto found = values_.find(code);
  return found == values_.end() ? std::nullopt : std::optional(found->second);
}

PilotTuning PilotReceiver::tuning(const PilotTuning& defaults) const {
  PilotTuning tuning = defaults;
  tuning.carrierHz = value(kCenterFrequencyParameter).value_or(defaults.carrierHz);
  tuning.pnIncrement = value(kPnIncrementParameter).value_or(defaults.pnIncrement);
  if (values_.count(kCodeFormatParameter) != 0 || window_) tuning.codeFormat = codeFormat();
  tuning.codeStart =
      window_ ? window_->start : converted(defaults.codeStart, defaults.codeFormat, tuning.codeFormat);
  tuning.codeSpan =
      window_ ? window_->span : converted(defaults.codeSpan, defaults.codeFormat, tuning.codeFormat);
  tuning.allPilots = sets_[kAllPilots].value_or(defaults.allPilots);
  tuning.zoomedPilots = sets_[kZoomedPilots].value_or(defaults.zoomedPilots);
  tuning.topN = sets_[kTopN].value_or(defaults.topN);
  tuning.userList = sets_[kUserList].value_or(defaults.userList);
  if (listEdited_) tuning.userPns = userPns_;
  return tuning;
}

}  // namespace frontpanels
