#include "painters/grid.h"

#include <array>

#include "platform/gdi_scope.h"

namespace frontpanels {
namespace {

void addVerticalLines(const PlotRect& plot, const Rect& edges, std::int32_t count, std::int32_t first,
                      std::int32_t last, std::vector<GridLine>& lines) {
  for (std::int32_t i = first; i <= last; ++i) {
    const std::int32_t x = divisionLinePx(plot.left, plot.width, i, count);
    lines.push_back({{x, edges.top}, {x, edges.bottom}});
  }
}

}  // namespace

void layOutGrid(const PlotRect& plot, const GridDivisions& divisions, std::vector<GridLine>& lines) {
  lines.clear();
  const Rect edges{divisionLinePx(plot.left, plot.width, 0, 1), divisionLinePx(plot.top, plot.height, 0, 1),
                   divisionLinePx(plot.left, plot.width, 1, 1), divisionLinePx(plot.top, plot.height, 1, 1)};
  if (divisions.vertical > 0) {
    for (std::int32_t i = 0; i <= divisions.vertical; ++i) {
      const std::int32_t y = divisionLinePx(plot.top, plot.height, i, divisions.vertical);
      lines.push_back({{edges.left, y}, {edges.right, y}});
    }
  }
  if (divisions.horizontal > 0) {
    addVerticalLines(plot, edges, divisions.horizontal, 0, divisions.horizontal, lines);
  }
  addVerticalLines(plot, edges, divisions.bands, 1, divisions.bands - 1, lines);
}

void drawGrid(Gdi& gdi, DcHandle dc, const std::vector<GridLine>& lines, const GridPen& pen) {
  const SelectedPen selected(gdi, dc, pen.style, 1, pen.color);
  for (const GridLine& line : lines) gdi.polyline(dc, std::array{line.from, line.to});
}

}  // namespace frontpanels
