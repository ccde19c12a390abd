// The lines of a plot's grid, as values and on a surface.
#pragma once

#include <cstdint>
#include <vector>

#include "painters/axis.h"
#include "platform/gdi.h"

namespace frontpanels {

struct GridLine {
  Point from;
  Point to;
  friend bool operator==(const GridLine&, const GridLine&) = default;
};

struct GridDivisions {
  std::int32_t vertical =
      0;  // of the value axis: one horizontal line more than divisions; none for 0 or less
  std::int32_t horizontal = 0;  // of the x axis, likewise
  std::int32_t bands = 0;       // a vertical line at each boundary between two bands; none for 1 or less
  friend bool operator==(const GridDivisions&, const GridDivisions&) = default;
};

// Horizontal lines from the top, vertical lines from the left, band boundaries; both outer edges are lines.
// `lines` is overwritten, its storage used again. Raises "Overflow".
void layOutGrid(const PlotRect& plot, const GridDivisions& divisions, std::vector<GridLine>& lines);

struct GridPen {
  PenStyle style = PenStyle::Solid;
  Color color;
};
void drawGrid(Gdi& gdi, DcHandle dc, const std::vector<GridLine>& lines, const GridPen& pen);

}  // namespace frontpanels
