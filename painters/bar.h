// One bar of a bar chart, as a plain value. It is copied whole.
#pragma once

#include <cstdint>
#include <string>

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

}  // namespace frontpanels
