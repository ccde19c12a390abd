// Names of cells by their identifiers, as a chart asks for them.
#pragma once

#include <string_view>

namespace frontpanels {

class CellNames {
 public:
  virtual ~CellNames() = default;

  // The name of the first cell with both identifiers, of the first one with `id1` when `id2` is negative;
  // "Unknown" where there is none. Good until names are next stored.
  [[nodiscard]] virtual std::string_view GetCellName(double id1, double id2) const noexcept = 0;
};

}  // namespace frontpanels
