#include "entry/entry_steps.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <span>

#include "entry/number_format.h"
#include "platform/runtime_error.h"
#include "platform/whole_number.h"

namespace frontpanels {
namespace {

// Values this close, relatively, are the same step: a step that was worked out is a bit off the typed one.
constexpr double kSame = 1e-12;

// By squaring, which is the same on every machine and exact as long as doubles are.
double powerOf(double base, int exponent) {
  double power = 1;
  for (auto bits = static_cast<unsigned>(exponent); bits != 0; bits >>= 1U) {
    if ((bits & 1U) != 0) power *= base;
    base *= base;
  }
  return power;
}

// Divided for small values: 5 / 1000 is the double of 0.005, 5 times the double of 0.001 need not be.
double scaled(double mantissa, double base, int exponent) {
  return exponent >= 0 ? mantissa * powerOf(base, exponent) : mantissa / powerOf(base, -exponent);
}

// The decade that a value above 0 lies in. May be one off at its ends, where the logarithm is rounded.
int decadeOf(double value, double base) {
  return static_cast<int>(std::floor(std::log(value) / std::log(base)));
}

// The values of a sequence above 0.
class Steps {
 public:
  explicit Steps(const StepSequence& sequence) : base_(sequence.base) {
    for (const double entry : std::span(sequence.entries).first(sequence.length))
      if (entry > 0 && std::isnormal(entry)) mantissas_[count_++] = mantissaOf(entry);
    if (count_ == 0) raiseInvalidProcedureCall();
    std::ranges::sort(std::span(mantissas_).first(count_));
  }

  [[nodiscard]] double first() const { return mantissas_[0]; }
  // Infinite, or 0, where no double is left.
  [[nodiscard]] double above(double value) const {
    const int decade = decadeOf(value, base_);
    for (int shift = -1; shift <= 2; ++shift)
      for (std::size_t i = 0; i < count_; ++i)
        if (const double step = scaled(mantissas_[i], base_, decade + shift); step > value * (1 + kSame))
          return step;
    return HUGE_VAL;
  }
  [[nodiscard]] double below(double value) const {
    const int decade = decadeOf(value, base_);
    for (int shift = 1; shift >= -2; --shift)
      for (std::size_t i = count_; i > 0; --i)
        if (const double step = scaled(mantissas_[i - 1], base_, decade + shift); step < value * (1 - kSame))
          return step;
    return 0;
  }

 private:
  [[nodiscard]] double mantissaOf(double entry) const {
    const double mantissa = scaled(entry, base_, -decadeOf(entry, base_));
    if (mantissa < 1) return mantissa * base_;
    return mantissa < base_ ? mantissa : mantissa / base_;
  }

  std::array<double, StepSequence::kCapacity> mantissas_{};
  std::size_t count_ = 0;
  double base_;
};

}  // namespace

double nearestInSequence(double value, const StepSequence& sequence) {
  const Steps steps(sequence);
  if (value == 0) return 0;
  const double magnitude = std::fabs(value);
  const double higher = steps.above(magnitude);
  const double lower = steps.below(std::min(higher, std::numeric_limits<double>::max()));
  return std::copysign(magnitude / lower <= higher / magnitude ? lower : higher, value);
}

double nextInSequence(double value, StepDirection direction, const StepSequence& sequence, double unit) {
  const Steps steps(sequence);
  const bool up = direction == StepDirection::Up;
  double next = 0;
  if (value == 0)
    next = up ? steps.first() * unit : -steps.first() * unit;
  else if (value > 0)
    next = up ? steps.above(value) : steps.below(value);
  else
    next = up ? -steps.below(-value) : -steps.above(-value);
  if (!std::isfinite(next)) raiseOverflow();
  return next;
}

double suffixStep(double shown, StepDirection direction, const SuffixTable& suffixes) noexcept {
  const bool up = direction == StepDirection::Up;
  const SuffixRecord* holding = nullptr;
  const SuffixRecord* ending = nullptr;
  const SuffixRecord* beyond = nullptr;
  for (const SuffixRecord& record : suffixes) {
    const double begin = up ? record.lowerLimit : record.upperLimit;
    const double end = up ? record.upperLimit : record.lowerLimit;
    const bool begun = up ? begin <= shown : begin >= shown;
    const bool ended = up ? end <= shown : end >= shown;
    if (begun && !ended) holding = &record;
    if (end == shown) ending = &record;
    if (!begun && (beyond == nullptr || (up ? begin < beyond->lowerLimit : begin > beyond->upperLimit)))
      beyond = &record;
  }
  if (holding != nullptr) return holding->scale;
  if (ending != nullptr) return beyond != nullptr ? beyond->scale : ending->scale;
  const SuffixRecord* const unit = suffixes.find(shown);
  return unit == nullptr ? 1 : unit->scale;
}

double nearestMultiple(double value, double step) noexcept {
  return toSignificantDigits(step * roundHalfEven(value / step));
}

double nextMultiple(double value, StepDirection direction, double step) noexcept {
  constexpr double kSameCount = 1e-9;
  double count = value / step;
  const double whole = roundHalfEven(count);
  if (std::fabs(count - whole) <= kSameCount * std::max(1.0, std::fabs(whole))) count = whole;
  const double next = direction == StepDirection::Up ? std::floor(count) + 1 : std::ceil(count) - 1;
  return toSignificantDigits(step * next);
}

}  // namespace frontpanels
