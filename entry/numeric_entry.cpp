#include "entry/numeric_entry.h"

#include <cmath>

#include "entry/number_format.h"
#include "framework/support/error_handler.h"
#include "framework/support/guard.h"
#include "platform/runtime_error.h"
#include "platform/whole_number.h"

namespace frontpanels {
namespace {

double scaleOf(const Variant& scale, double lowerLimit) {
  const bool given = !scale.isEmpty();
  if (given && scale.isNumeric()) return scale.toDouble();
  if (given) {
    errorHandler().Assert("Warning...a non-numeric value has been passed to clsNumericEntry::suffix()");
  }
  return lowerLimit == 0 ? 1 : lowerLimit;
}

// Not-a-number passes for a number elsewhere.
bool isFiniteNumber(const Variant& value) { return value.isNumeric() && std::isfinite(value.toDouble()); }

double finite(double number) {
  if (!std::isfinite(number)) raiseOverflow();
  return number;
}

double toWholeResolutions(double value, double resolution) {
  return resolution * toInt32(value / resolution);
}

}  // namespace

// --- The value

void clsNumericEntry::value(double value) noexcept {
  newValue_ = setValue(value, autoChoose_) == Entered::Changed;
}

void clsNumericEntry::valueNoUpdate(double value) noexcept {
  static_cast<void>(setValue(value, autoChoose_));
}

void clsNumericEntry::valueNoUpdateAutoChoose(double value) noexcept {
  static_cast<void>(setValue(value, true));
}

clsNumericEntry::Entered clsNumericEntry::setValue(double wanted, bool chooseRange) noexcept {
  return guarded("clsNumericEntry::value() failed. ", Entered::Refused, [&] {
    const bool wasBlank = blank_ && preserveBlankEntry_;
    if (!wasBlank && wanted == value_ && limits_.hold(wanted)) {
      if (redisplay_ || text() != lastText_) reformat();
      return Entered::Same;
    }
    const std::optional<double> onGrid = snapped(finite(wanted));
    if (!onGrid) return Entered::Refused;
    const Settled result = settled(*onGrid, chooseRange);
    if (result.range) choose(*result.range);
    previousValue_ = value_;
    value_ = result.value;
    blank_ = false;
    reformat();
    return value_ == previousValue_ && !wasBlank ? Entered::Same : Entered::Changed;
  });
}

std::optional<double> clsNumericEntry::snapped(double value) const {
  if (arbitrary_) return value;
  std::optional<double> onGrid = sequence_.defined() ? chooseSequence(value) : choosePower(value);
  if (onGrid && step_) {
    onGrid = finite(channelChoose() ? nearestChannel(*onGrid) : nearestMultiple(*onGrid, *step_));
  }
  return onGrid;
}

std::optional<double> clsNumericEntry::chooseSequence(double value) const noexcept {
  return guarded("clsNumericEntry::chooseSequence() failed. ", std::optional<double>(),
                 [&] { return nearestInSequence(value, sequence_); });
}

std::optional<double> clsNumericEntry::choosePower(double value) const noexcept {
  if (!powers().defined()) return value;
  return guarded("clsNumericEntry::choosePower() failed. ", std::optional<double>(),
                 [&] { return nearestInSequence(value, powers()); });
}

StepSequence clsNumericEntry::powers() const noexcept {
  if (power_ < 2) return {};
  return {.entries = {1}, .length = 1, .base = power_};
}

// The resolution comes last: limits that are none of its multiples give way to it.
clsNumericEntry::Settled clsNumericEntry::settled(double value, bool chooseRange) const {
  Settled result;
  EntryLimits limits = limits_;
  if (chooseRange && !limits.hold(value)) {
    result.range = ranges_.firstHolding(value);
    if (result.range) limits = ranges_.find(*result.range)->limits;
  }
  result.value = limits.clamped(value);
  // Channels have a grid of their own.
  if (resolution_ && !channelChoose()) result.value = toWholeResolutions(result.value, *resolution_);
  static_cast<void>(finite(result.value));
  return result;
}

double clsNumericEntry::stepped(double value, StepDirection direction) const {
  if (const StepSequence& steps = sequence_.defined() ? sequence_ : powers(); steps.defined())
    return nextInSequence(value, direction, steps, shownScale(0));
  if (channelChoose()) return nextChannel(value, direction);
  if (step_ && normalizeAsStep_) return nextMultiple(value, direction, *step_);
  const double step = step_ ? *step_ : shownStep(value, direction);
  return toSignificantDigits(direction == StepDirection::Up ? value + step : value - step);
}

double clsNumericEntry::shownStep(double value, StepDirection direction) const {
  return display().scale * suffixStep(shownNumber(value), direction, suffixes_);
}

// --- Limits and ranges

void clsNumericEntry::MINIMUM(double minimum) noexcept {
  guard("clsNumericEntry::MINIMUM() failed. ", [&] { limits_.minimum = finite(minimum); });
}

void clsNumericEntry::MAXIMUM(double maximum) noexcept {
  guard("clsNumericEntry::MAXIMUM() failed. ", [&] { limits_.maximum = finite(maximum); });
}

void clsNumericEntry::range(std::int32_t index) noexcept {
  guard("clsNumericEntry::range() failed. ", [&] {
    const EntryRange* const range = ranges_.find(index);
    if (range == nullptr) {
      errorHandler().Assert("clsNumericEntry::range() ... illegal value");
    } else if (!range->defined) {
      errorHandler().Assert("clsNumericEntry::range() ... selected range is not valid");
    } else {
      choose(index);
      reformat();
    }
  });
}

bool clsNumericEntry::rangeDefined(std::int32_t index) const noexcept {
  const EntryRange* const range = ranges_.find(index);
  return range != nullptr && range->defined;
}

void clsNumericEntry::choose(std::int32_t index) noexcept {
  const EntryRange& range = *ranges_.find(index);
  range_ = index;
  limits_ = range.limits;
  formatOffset_ = range.displayOffset;
  formatScale_ = range.displayScale;
  redisplay_ = true;
}

const EntryRange* clsNumericEntry::rangeFor(std::string_view routine, std::int32_t index) const noexcept {
  const EntryRange* const range = ranges_.find(index);
  if (range == nullptr)
    guard(kTypeName, [routine] {
      errorHandler().Assert(std::string(kTypeName).append("::").append(routine).append("()...invalid index"));
    });
  return range;
}

double clsNumericEntry::MinimumForRange(std::int32_t index) const noexcept {
  const EntryRange* const range = rangeFor("MinimumForRange", index);
  return range == nullptr ? 0 : range->limits.minimum;
}

double clsNumericEntry::MaximumForRange(std::int32_t index) const noexcept {
  const EntryRange* const range = rangeFor("MaximumForRange", index);
  return range == nullptr ? 0 : range->limits.maximum;
}

double clsNumericEntry::FormatOffsetForRange(std::int32_t index) const noexcept {
  const EntryRange* const range = rangeFor("FormatOffsetForRange", index);
  return range == nullptr ? 0 : range->displayOffset;
}

double clsNumericEntry::FormatScaleForRange(std::int32_t index) const noexcept {
  const EntryRange* const range = rangeFor("FormatScaleForRange", index);
  return range == nullptr ? 0 : range->displayScale;
}

void clsNumericEntry::MinimumForRange(std::int32_t index, double minimum) noexcept {
  setRangeField("MinimumForRange", index, minimum, [](EntryRange& range, double value) {
    range.limits.minimum = value;
    range.defined = true;
  });
}

void clsNumericEntry::MaximumForRange(std::int32_t index, double maximum) noexcept {
  setRangeField("MaximumForRange", index, maximum, [](EntryRange& range, double value) {
    range.limits.maximum = value;
    range.defined = true;
  });
}

void clsNumericEntry::FormatOffsetForRange(std::int32_t index, double offset) noexcept {
  setRangeField("FormatOffsetForRange", index, offset,
                [](EntryRange& range, double value) { range.displayOffset = value; });
}

void clsNumericEntry::FormatScaleForRange(std::int32_t index, double scale) noexcept {
  setRangeField("FormatScaleForRange", index, scale,
                [](EntryRange& range, double value) { range.displayScale = value; });
}

void clsNumericEntry::setRangeField(std::string_view routine, std::int32_t index, double value,
                                    void (*set)(EntryRange& range, double value)) noexcept {
  if (rangeFor(routine, index) == nullptr) return;
  guard([&] { return std::string(kTypeName).append("::").append(routine).append("() failed. "); },
        [&] { set(*ranges_.find(index), finite(value)); });
}

bool clsNumericEntry::Limits(const HostRecordSet& records) noexcept {
  return guarded("clsNumericEntry::Limits() failed. ", false, [&] {
    EntryRanges::Limits limits;
    if (const std::string_view wrong = readLimits(records, limits); !wrong.empty()) {
      errorHandler().Assert(std::string(kTypeName).append(wrong));
      return false;
    }
    if (records.count() == 0) return true;
    ranges_.limits(limits);
    if (const EntryRange& chosen = *ranges_.find(range_); chosen.defined)
      limits_ = chosen.limits;
    else
      choose(*ranges_.firstDefined());
    return true;
  });
}

void clsNumericEntry::CopyLimits(const clsNumericEntry& source) noexcept {
  ranges_.limits(source.ranges_.limits());
  if (range_ != source.range_) choose(source.range_);
  limits_ = source.limits_;
}

// --- Snapping and stepping

void clsNumericEntry::sequence(std::initializer_list<Variant> mantissas) noexcept {
  guard("clsNumericEntry::sequence() failed. ", [&] {
    if (mantissas.size() > StepSequence::kCapacity) raiseSubscriptOutOfRange();
    StepSequence sequence = sequence_;
    sequence.length = 0;
    std::size_t position = 0;
    for (const Variant& mantissa : mantissas) {
      ++position;
      if (mantissa.isEmpty() || !isFiniteNumber(mantissa)) continue;
      sequence.entries[position - 1] = mantissa.toDouble();
      sequence.length = position;
    }
    sequence_ = sequence;
  });
}

void clsNumericEntry::power(const Variant& power) noexcept {
  guard("clsNumericEntry::power() failed. ", [&] {
    if (isFiniteNumber(power))
      power_ = power.toDouble();
    else
      errorHandler().Assert("Non-numeric value passed to clsNumericEntry::power");
  });
}

void clsNumericEntry::step(const Variant& step) noexcept { setGrid("step", step, step_); }

void clsNumericEntry::resolution(const Variant& resolution) noexcept {
  setGrid("resolution", resolution, resolution_);
}

void clsNumericEntry::setGrid(std::string_view routine, const Variant& value,
                              std::optional<double>& grid) noexcept {
  const auto named = [routine] { return std::string(kTypeName).append("::").append(routine); };
  guard([&] { return named().append("() failed. "); },
        [&] {
          if (value.isEmpty()) {
            grid.reset();
          } else if (!isFiniteNumber(value)) {
            errorHandler().Assert("Non-numeric value passed to " + named());
          } else if (const double number = value.toDouble(); number > 0) {
            grid = number;
          } else {
            raiseInvalidProcedureCall();
          }
        });
}

// --- Unit suffixes

void clsNumericEntry::suffix(std::string_view name, double lowerLimit, double upperLimit,
                             const Variant& scale) {
  guard("clsNumericEntry::suffix() failed. ", [&] {
    if (suffixes_.count() == SuffixTable::kCapacity) {
      errorHandler().Assert("clsNumericEntry::suffix() ... too many suffixes");
      return;
    }
    (void)suffixes_.add({lowerLimit, upperLimit, scaleOf(scale, lowerLimit), std::string(name)});
    redisplay_ = true;
  });
}

// --- The text

void clsNumericEntry::formatString(std::string_view format) {
  formatString_ = format;
  redisplay_ = true;
}

void clsNumericEntry::formatScale(double scale) noexcept {
  formatScale_ = scale;
  redisplay_ = true;
}

void clsNumericEntry::formatOffset(double offset) noexcept {
  formatOffset_ = offset;
  redisplay_ = true;
}

void clsNumericEntry::suppressSuffix(bool suppress) noexcept {
  suppressSuffix_ = suppress;
  redisplay_ = true;
}

void clsNumericEntry::decimalSeparator(std::string_view separator) {
  decimalSeparator_ = separator.empty() ? "." : separator;
  redisplay_ = true;
}

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

const SuffixRecord* clsNumericEntry::shownUnit(double value) const noexcept {
  const auto [offset, scale] = display();
  return shownSuffixes().find((value - offset) / scale);
}

double clsNumericEntry::shownScale(double value) const noexcept {
  const SuffixRecord* const unit = shownUnit(value);
  const double scale = display().scale;
  return unit == nullptr ? scale : scale * unit->scale;
}

void clsNumericEntry::append(std::string& text, double value, std::string_view format, bool withUnit) const {
  appendShown(text, shownNumber(value), format, withUnit);
}

void clsNumericEntry::appendDifference(std::string& text, double difference, std::string_view format,
                                       bool withUnit) const {
  const double scale = display().scale;
  if (scale == 0) raiseDivisionByZero();
  appendShown(text, difference / scale, format, withUnit);
}

void clsNumericEntry::appendShown(std::string& text, double shown, std::string_view format,
                                  bool withUnit) const {
  const SuffixRecord* const unit = shownSuffixes().find(shown);
  if (unit != nullptr) {
    if (unit->scale == 0) raiseDivisionByZero();
    shown /= unit->scale;
  }
  const std::size_t begin = text.size();
  if (format.empty()) {
    text += numberToText(shown);
  } else {
    appendNumber(text, shown, format);
  }
  if (decimalSeparator_ != ".")
    if (const std::size_t point = text.find('.', begin); point != std::string::npos)
      text.replace(point, 1, decimalSeparator_);
  if (withUnit && unit != nullptr) (text += ' ') += unit->name;
}

}  // namespace frontpanels
