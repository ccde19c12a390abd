// One bar of a bar chart, as a plain value, and the bars of a chart.
#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <vector>

#include "platform/variant.h"

namespace frontpanels {

// A truth value in 16 bits, as records carry it.
enum class Boolean16 : std::int16_t { False = 0, True = -1 };

inline constexpr std::int32_t kBarStyleCode = 6;

struct Bar {
  std::int16_t barId = 0;  // from 1; stays the bar's own, with its colour, from update to update
  float value = 0;         // in the units of the value axis, the offset included
  std::string label;       // what stands at the bar, once it has been labelled
  float key = 0;           // what bars are matched by
  float other = 0;         // a second quantity, chosen by the chart's `otherIs`
  Variant extra;           // a value that is carried along for labelling
  std::int32_t styleCode = kBarStyleCode;
  Boolean16 matched = Boolean16::False;  // only while bars are being matched
  Boolean16 state = Boolean16::True;
  float secondary = 0;
  float auxiliary = -1.0F;
  double cellNameId2 = -1.0;  // second identifier of the cell's name
  friend bool operator==(const Bar&, const Bar&) = default;
};

// A bar in its chart.
struct HeldBar : Bar {
  std::int32_t item = 0;     // of the block that it was filled from, from 0
  std::int32_t updates = 0;  // that it has been in on end
  bool hasOther = false;     // whether its item had the other quantity
  friend bool operator==(const HeldBar&, const HeldBar&) = default;
};

// The bars in their order. Records outlive the bars that were in them, so that texts find their storage
// again.
class BarArray {
 public:
  [[nodiscard]] std::span<HeldBar> bars() noexcept { return std::span(records_).first(count_); }
  [[nodiscard]] std::span<const HeldBar> bars() const noexcept { return std::span(records_).first(count_); }
  void resize(std::size_t count) {
    if (records_.size() < count) records_.resize(count);
    count_ = count;
  }

 private:
  std::vector<HeldBar> records_;
  std::size_t count_ = 0;
};

}  // namespace frontpanels
