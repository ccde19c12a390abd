// From a block of values to bars, and from the bars of one update to those of the next.
#pragma once

#include <cstdint>
#include <utility>
#include <vector>

#include "painters/bar.h"
#include "platform/variant.h"

namespace frontpanels {

// How an item's elements become what a bar holds.
struct BarRules {
  std::int32_t elementsPerValue = 2;
  Variant offset = 0.0;
  bool useOffset = false;
  std::int16_t otherIs = 0;
  std::int16_t kindFlag = 0;
  std::int16_t extraValueMode = 0;
  std::int16_t extraValueSource = 0;
  Variant defaultExtraValue;
  bool hasCellNameLookupId2 = false;
};

// Whether `otherIs` names a quantity, or none by 0.
[[nodiscard]] bool knownOther(std::int16_t otherIs) noexcept;

// Raises "Subscript out of range" for a block with fewer values than `items` items have.
void requireItems(const Variant& block, std::int32_t items, std::int32_t elementsPerValue);

// Fills everything of a bar but its identity and its place in the chart. A quantity whose element the item
// lacks keeps its default. Raises "Type mismatch", "Invalid use of Null" or "Overflow" for an element that is
// no number of single precision; the bar is then partly filled.
void fillBar(HeldBar& bar, const Variant& block, std::int32_t item, const BarRules& rules);

// Hands identities on. A new bar takes over that of the previous bar with the same key; of bars with equal
// keys the first takes the first's. The identities of bars that have gone go to the last of the new ones, and
// what is left gets fresh ones.
class BarMatcher {
 public:
  void match(std::span<HeldBar> previous, std::span<HeldBar> bars);

 private:
  void matchKeys(std::span<HeldBar> previous, std::span<HeldBar> bars);
  [[nodiscard]] std::int16_t freshId(std::span<const HeldBar> bars) noexcept;

  std::int16_t lastId_ = 0;
  bool cameRound_ = false;
  std::vector<std::uint32_t> previousByKey_;
  std::vector<std::uint32_t> newByKey_;
};

}  // namespace frontpanels
