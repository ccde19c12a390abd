#include "pilot/code_entries.h"

#include <algorithm>
#include <string_view>

#include "framework/support/guard.h"
#include "framework/support/numeric.h"
#include "pilot/code_units.h"

namespace frontpanels {
namespace {

constexpr std::string_view kCodeFormat = "0.####";
constexpr double kLargestPnIncrement = 511;

}  // namespace

void showCodeUnits(clsNumericEntry& entry, CodeUnits units, double chipsPerUnit, std::int32_t chipsPerPn) {
  const double scale = units == CodeUnits::Pn ? chipsPerPn / chipsPerUnit : 1.0 / chipsPerUnit;
  entry.formatScale(scale);
  entry.step(std::max(scale, 1.0));  // a click moves by a PN offset, or by a chip
  entry.reformat();
}

CodeEntries::CodeEntries() : lastChip_(kLastIs95BChip) {
  for (clsNumericEntry* const entry : {&start, &stop, &center, &span}) {
    entry->formatString(kCodeFormat);
    entry->Arbitrary(true);
    entry->resolution(1);
    entry->MINIMUM(0);
    entry->MAXIMUM(lastChip_);
  }
  pnIncrement.formatString(kCodeFormat);
  pnIncrement.MINIMUM(1);
  pnIncrement.MAXIMUM(kLargestPnIncrement);
  pnIncrement.step(1);
  pnIncrement.valueNoUpdate(1);
  units(CodeUnits::Pn);
  place(0, lastChip_);
}

double CodeEntries::startPn() const noexcept { return start_ / chipsPerPn(format_); }

void CodeEntries::format(std::int16_t format) noexcept {
  guard("Tarvex::newCdmaFormat()", [&] {
    const auto convert = [this, format](double chips) {
      return static_cast<double>(IS95BToCurrentChips(format, CurrentToIS95BChips(format_, toInt32(chips))));
    };
    const double from = convert(start_);
    const double chips = convert(span_);
    lastChip_ = IS95BToCurrentChips(format, kLastIs95BChip);
    format_ = format;
    for (clsNumericEntry* const entry : {&start, &stop, &center, &span}) entry->MAXIMUM(lastChip_);
    units(units_);
    place(from, chips);
  });
}

void CodeEntries::units(CodeUnits units) noexcept {
  units_ = units;
  for (clsNumericEntry* const entry : {&start, &stop, &center, &span})
    showCodeUnits(*entry, units, 1, chipsPerPn(format_));
}

void CodeEntries::startFromHost(double chips) noexcept {
  const double from = std::clamp(roundHalfEven(chips), 0.0, lastChip_);
  place(from, std::min(span_, lastChip_ - from));
}

void CodeEntries::spanFromHost(double chips) noexcept {
  place(start_, std::clamp(roundHalfEven(chips), 0.0, lastChip_ - start_));
}

void CodeEntries::centerFromHost(double chips) noexcept {
  const double around = roundHalfEven(chips);
  place(roundHalfEven(around - span_ * 0.5), span_, around);
}

void CodeEntries::fitCenter() noexcept { centerFromHost(center.value()); }

void CodeEntries::fitSpan() noexcept {
  place(roundHalfEven(center_ - span.value() * 0.5), span.value(), center_);
}

void CodeEntries::joinEdges(bool startChanged) noexcept {
  double low = startChanged ? start.value() : start_;
  double high = startChanged ? start_ + span_ : stop.value();
  if (low > high) (startChanged ? high : low) = startChanged ? low : high;
  place(low, high - low);
}

void CodeEntries::placeEdges() noexcept { show(); }

void CodeEntries::place(double from, double chips, double around) noexcept {
  span_ = std::clamp(chips, 0.0, lastChip_);
  start_ = std::clamp(from, 0.0, lastChip_ - span_) + 0.0;  // no negative 0
  center_ = start_ == from ? around : start_ + span_ * 0.5;
  show();
}

void CodeEntries::show() noexcept {
  start.valueNoUpdate(start_);
  stop.valueNoUpdate(start_ + span_);
  center.valueNoUpdate(center_);
  span.valueNoUpdate(span_);
}

}  // namespace frontpanels
