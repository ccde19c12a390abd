// Unit suffixes of a numeric entry: which unit a number is shown in.
#pragma once

#include <array>
#include <cstddef>
#include <string>

namespace frontpanels {

// A unit and the numbers that are shown in it: from `lowerLimit` up to but not including `upperLimit`, so
// that two records that meet share no number. Limits are in the base unit; `scale` is how many base units
// make one of this.
struct SuffixRecord {
  double lowerLimit = 0;
  double upperLimit = 0;
  double scale = 1;
  std::string name;
  friend bool operator==(const SuffixRecord&, const SuffixRecord&) = default;
};

class SuffixTable {
 public:
  static constexpr std::size_t kCapacity = 10;

  // False, and nothing added, when the table is full.
  [[nodiscard]] bool add(SuffixRecord record);
  // The last added record whose limits hold the number. A number that none holds (below zero, or in a gap
  // between records) is shown in the unit of the first. Null only when the table is empty.
  [[nodiscard]] const SuffixRecord* find(double number) const noexcept;

  [[nodiscard]] std::size_t count() const noexcept { return count_; }
  [[nodiscard]] const SuffixRecord* begin() const noexcept { return records_.data(); }
  [[nodiscard]] const SuffixRecord* end() const noexcept { return records_.data() + count_; }

 private:
  std::array<SuffixRecord, kCapacity> records_;
  std::size_t count_ = 0;
};

}  // namespace frontpanels
