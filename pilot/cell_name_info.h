// The names of cells, as the host tells them: by one identifier, or by two.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "painters/cell_names.h"

namespace frontpanels {

class clsCellNameInfo final : public CellNames {
 public:
  static constexpr std::string_view kTypeName = "clsCellNameInfo";

  // Forgets the names and the greatest length.
  void Initialize() noexcept;

  // Adds an entry, `name` in UTF-8. One whose identifiers have a name already is kept, but never found.
  // Counts have 16 bits: a 32768th entry and a name of more than 32767 characters are refused and reported as
  // an overflow, and change nothing.
  void SetCellName(double id1, double id2, std::string_view name) noexcept;

  // Takes the same time however many names there are, and allocates nothing. 0 and -0 are equal; what is not
  // a number equals nothing.
  [[nodiscard]] std::string_view GetCellName(double id1, double id2) const noexcept override;

  // Characters (UTF-16 units) of the longest name since Initialize, or what was set if that is more.
  [[nodiscard]] std::int16_t maxCellNameLength() const noexcept { return maxCellNameLength_; }
  void maxCellNameLength(std::int16_t length) noexcept { maxCellNameLength_ = length; }

 private:
  struct Entry {
    double id1 = 0;
    double id2 = 0;
    std::string name;
  };
  // For each key the number of the first entry that has it: a table with open addressing, a power of two of
  // places, of which at least half are free.
  using Places = std::vector<std::uint16_t>;

  void add(double id1, double id2, std::string_view name);
  void growPlaces();
  void enter(std::uint16_t entry) noexcept;
  // Where the entry stands in its table, or the free place where it would.
  [[nodiscard]] std::size_t placeOf(double id1) const noexcept;
  [[nodiscard]] std::size_t placeOf(double id1, double id2) const noexcept;

  std::vector<Entry> entries_;
  Places byFirst_;  // by id1 alone
  Places byBoth_;
  std::int16_t maxCellNameLength_ = 0;
};

}  // namespace frontpanels
