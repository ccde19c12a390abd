// The order of a chart's bars.
#pragma once

#include <cstdint>
#include <span>
#include <vector>

#include "painters/bar.h"

namespace frontpanels {

enum class BarSort : std::int16_t { Arrival = 0, Value = 1, Key = 2, History = 3, Other = 4 };

// Bars that compare equal, or that cannot be compared, keep the order they had. Storage is used again.
class BarOrder {
 public:
  void sort(std::span<HeldBar> bars, BarSort by, bool ascending);
  // The bars of the first set first, those of no set last; inside a set they keep their order.
  void groupBySets(std::span<HeldBar> bars, std::span<const std::vector<float>> sets);
  // Positions (from 0) by falling value, those without one last.
  [[nodiscard]] std::span<const std::uint32_t> strongestFirst(std::span<const HeldBar> bars);

 private:
  void arrange(std::span<HeldBar> bars) noexcept;

  std::vector<std::uint32_t> order_;
  std::vector<std::uint32_t> setOf_;
  std::vector<std::uint32_t> nextOfSet_;
};

}  // namespace frontpanels
