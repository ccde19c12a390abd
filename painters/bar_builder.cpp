#include "painters/bar_builder.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>

#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

struct OtherRow {
  std::int16_t otherIs;
  std::int32_t element;
  bool plusOffset;
  std::int32_t elementsNeeded;  // exactly as many; 0 for any
};
constexpr std::array kOthers{OtherRow{1, 1, true, 0},   OtherRow{2, 2, false, 0},  OtherRow{3, 1, true, 0},
                             OtherRow{4, 1, false, 0},  OtherRow{5, 3, true, 0},   OtherRow{6, 3, false, 0},
                             OtherRow{7, 4, false, 0},  OtherRow{8, 5, false, 6},  OtherRow{9, 2, false, 0},
                             OtherRow{10, 3, false, 0}, OtherRow{11, 2, false, 0}, OtherRow{12, 2, false, 0}};

const OtherRow* findOther(std::int16_t otherIs) noexcept {
  const auto* const row = std::find_if(kOthers.begin(), kOthers.end(),
                                       [otherIs](const OtherRow& other) { return other.otherIs == otherIs; });
  return row == kOthers.end() ? nullptr : row;
}

// The elements of one item.
class Item {
 public:
  Item(const Variant& block, std::int32_t item, std::int32_t elements)
      : block_(block),
        first_(static_cast<std::size_t>(item) * static_cast<std::size_t>(elements)),
        elements_(elements) {}

  [[nodiscard]] bool has(std::int32_t element) const noexcept { return element < elements_; }
  [[nodiscard]] Variant element(std::int32_t element) const { return block_.element(at(element)); }
  [[nodiscard]] double number(std::int32_t element) const {
    if (const auto* const singles = std::get_if<Variant::Singles>(&block_.value())) {
      return static_cast<double>((*singles)[at(element)]);
    }
    return this->element(element).toDouble();
  }

 private:
  [[nodiscard]] std::size_t at(std::int32_t element) const noexcept {
    return first_ + static_cast<std::size_t>(element);
  }

  const Variant& block_;
  std::size_t first_;
  std::int32_t elements_;
};

float toSingle(double number) { return Variant(number).toSingle(); }

void fillOther(HeldBar& bar, const Item& item, const BarRules& rules) {
  bar.other = 0;
  const OtherRow* const other = findOther(rules.otherIs);
  bar.hasOther = other != nullptr && item.has(other->element) &&
                 (other->elementsNeeded == 0 || other->elementsNeeded == rules.elementsPerValue);
  if (bar.hasOther) {
    const double offset = other->plusOffset ? rules.offset.toDouble() : 0;
    bar.other = toSingle(item.number(other->element) + offset);
  }
}

void fillExtra(HeldBar& bar, const Item& item, const BarRules& rules) {
  bar.extra = rules.defaultExtraValue;
  if (rules.extraValueMode == 2 && item.has(2)) bar.extra = item.element(2);
  if (rules.extraValueSource == 0 && item.has(3)) bar.extra = item.element(3);
  if (rules.extraValueSource == 2 && item.has(4)) bar.extra = item.element(4);
}

// The positions of the bars whose key is a number, by key and then by position.
void orderByKey(std::span<const HeldBar> bars, std::vector<std::uint32_t>& positions) {
  positions.clear();
  for (std::uint32_t i = 0; i < bars.size(); ++i) {
    if (!std::isnan(bars[i].key)) positions.push_back(i);
  }
  std::sort(positions.begin(), positions.end(), [bars](std::uint32_t a, std::uint32_t b) {
    return bars[a].key != bars[b].key ? bars[a].key < bars[b].key : a < b;
  });
}

}  // namespace

bool knownOther(std::int16_t otherIs) noexcept { return otherIs == 0 || findOther(otherIs) != nullptr; }

void requireItems(const Variant& block, std::int32_t items, std::int32_t elementsPerValue) {
  const std::size_t values = block.isArray() ? block.elementCount() : 0;
  if (values < static_cast<std::uint64_t>(items) * static_cast<std::uint64_t>(elementsPerValue)) {
    raiseSubscriptOutOfRange();
  }
}

void fillBar(HeldBar& bar, const Variant& block, std::int32_t itemIndex, const BarRules& rules) {
  const Item item(block, itemIndex, rules.elementsPerValue);
  bar.item = itemIndex;
  bar.key = toSingle(item.number(0));
  bar.value = toSingle(item.number(1) + (rules.useOffset ? rules.offset.toDouble() : 0));
  bar.label.clear();
  bar.matched = Boolean16::False;
  bar.state = Boolean16::True;
  bar.styleCode = kBarStyleCode;
  fillOther(bar, item, rules);
  fillExtra(bar, item, rules);
  bar.secondary = item.has(4) ? toSingle(item.number(4)) : 0;
  bar.auxiliary = rules.kindFlag == 1 && item.has(2) ? toSingle(item.number(2)) : -1.0F;
  bar.cellNameId2 = rules.hasCellNameLookupId2 && item.has(2) ? item.number(2) : -1.0;
}

void BarMatcher::match(std::span<HeldBar> previous, std::span<HeldBar> bars) {
  for (HeldBar& bar : bars) {
    bar.barId = 0;
    bar.updates = 1;
  }
  matchKeys(previous, bars);
  std::size_t end = bars.size();
  for (const HeldBar& gone : previous) {
    if (gone.matched == Boolean16::True) continue;
    while (end > 0 && bars[end - 1].barId != 0) --end;
    if (end > 0) bars[end - 1].barId = gone.barId;
  }
  for (HeldBar& bar : bars) {
    if (bar.barId == 0) bar.barId = freshId(bars);
  }
}

// Both sides run through their keys in order, so the k-th new bar of a key meets the k-th previous one.
void BarMatcher::matchKeys(std::span<HeldBar> previous, std::span<HeldBar> bars) {
  orderByKey(previous, previousByKey_);
  orderByKey(bars, newByKey_);
  for (HeldBar& bar : previous) bar.matched = Boolean16::False;
  auto old = previousByKey_.begin();
  for (const std::uint32_t position : newByKey_) {
    HeldBar& bar = bars[position];
    while (old != previousByKey_.end() && previous[*old].key < bar.key) ++old;
    if (old == previousByKey_.end()) return;
    HeldBar& before = previous[*old];
    if (before.key != bar.key) continue;
    bar.barId = before.barId;
    bar.updates = before.updates + (before.updates < std::numeric_limits<std::int32_t>::max() ? 1 : 0);
    before.matched = Boolean16::True;
    ++old;
  }
}

// Identities are used once. Only when there are no more the count begins again, with those that no bar has.
std::int16_t BarMatcher::freshId(std::span<const HeldBar> bars) noexcept {
  const auto taken = [bars](std::int16_t id) {
    return std::any_of(bars.begin(), bars.end(), [id](const HeldBar& bar) { return bar.barId == id; });
  };
  do {
    if (lastId_ == std::numeric_limits<std::int16_t>::max()) {
      lastId_ = 0;
      cameRound_ = true;
    }
    ++lastId_;
  } while (cameRound_ && taken(lastId_));
  return lastId_;
}

}  // namespace frontpanels
