// Painting of the multi-trace painter.
#include <array>
#include <cmath>

#include "framework/support/guard.h"
#include "framework/support/numeric.h"
#include "painters/multi_trace_painter.h"
#include "painters/trace_values.h"
#include "platform/gdi_scope.h"
#include "platform/runtime_error.h"
#include "traces/plot_colors.h"

namespace frontpanels {
namespace {

constexpr std::array kTraceColors{rgb(50, 156, 50),   rgb(255, 0, 0),   rgb(0, 0, 255),   rgb(255, 255, 0),
                                  rgb(255, 255, 255), rgb(0, 255, 255), rgb(255, 0, 255), rgb(0, 0, 0)};

// Narrows the clip to the plot for a block and puts the panel's back at its end. The bottom edge, where the
// smallest value lies, belongs to what is drawn; the right edge does not.
class PlotClip {
 public:
  PlotClip(Gdi& gdi, DcHandle dc, const PlotRect& plot, RegionHandle panelClip)
      : gdi_(gdi), dc_(dc), panelClip_(panelClip) {
    Rect area = plot.toPixels();
    area.bottom = toInt32(area.bottom + 1.0);
    region_ = gdi_.createRectRgn(area);
    if (region_) gdi_.selectClipRgn(dc_, region_);
  }
  ~PlotClip() {
    if (!region_) return;
    gdi_.selectClipRgn(dc_, panelClip_);
    gdi_.deleteObject(region_);
  }
  PlotClip(const PlotClip&) = delete;
  PlotClip& operator=(const PlotClip&) = delete;

 private:
  Gdi& gdi_;
  DcHandle dc_;
  RegionHandle panelClip_;
  RegionHandle region_{};
};

}  // namespace

Color clsMultiTracePainter::traceColor(std::size_t index) {
  return kTraceColors[index < kTraceColors.size() ? index : 0];
}

void clsMultiTracePainter::Paint(DcHandle dc) {
  guard("clsMultiTracePainter::Paint() ...", [&] { paintPanel(dc, panelRect()); });
}

void clsMultiTracePainter::Paint() {
  guard("clsMultiTracePainter::Paint() ...", [this] {
    const PlotRect area = surfaceRect();
    paintPanel(surfaceDc(), area);
  });
}

void clsMultiTracePainter::paintPanel(DcHandle dc, const PlotRect& panel) {
  const PlotRect plot = panel.shrunk(insets());
  forgetPoints();
  if (!plot.drawable()) return;
  chooseRange();
  drawGridOver(dc, plot,
               {numberOfVerticalDivisions(), numberOfHorizontalDivisions_,
                multiBand() ? numberOfBands() : std::int16_t{0}});
  if (range().extent() > 0) drawTraces(dc, plot);
}

void clsMultiTracePainter::forgetPoints() noexcept {
  for (TraceSlot& slot : traces_.traces()) slot.points.clear();
}

void clsMultiTracePainter::chooseRange() {
  if (getAutoScale()) DoAutoScale();
  range(calcMinMax() ? dataRange().value_or(axis()) : axis());
}

void clsMultiTracePainter::drawTraces(DcHandle dc, const PlotRect& plot) {
  // The divisor N - 2 is wanted: the last two positions fall outside the plot on the right. With N = 2 the
  // step of the paint before stays.
  if (numberOfMeasurements() != 2) xStepPx_ = plot.width / (numberOfMeasurements() - 2.0);
  const ValueAxis y(plot, range());
  const PlotClip clip(gdi(), dc, plot, panelClip());
  const PlotColors colors(gdi());
  // What lies between the dashes of a line shows through.
  const TextStyleScope gaps(gdi(), dc, colors.text(), BackgroundMode::Transparent);
  const auto traces = traces_.traces();
  for (std::size_t t = 0; t < traces.size(); ++t) {
    if (!traces[t].data.isArray()) continue;
    placePoints(traces[t], plot, y);
    const Color color = colors.line(traceColor(t));
    drawTrace(dc, traces[t].points, {colors.traceStyle(t), color});
    dataChanged(false);
    if (t == static_cast<std::size_t>(selectedTraceIndex_)) activeTraceColor(color);
  }
}

void clsMultiTracePainter::placePoints(TraceSlot& slot, const PlotRect& plot, const ValueAxis& y) {
  const double left = plot.left;
  const double origin =
      slot.orientation == TraceOrientation::FromRight ? left + plot.width - slot.size * xStepPx_ : left;
  const PointAxis x(origin, xStepPx_);
  withValues(slot, converted_,
             "clsMultiTracePainter::Paint() ... unrecognized array type.  Will be handled as Variant (SLOW!)",
             [&](auto values) { slot.points.place(values, x, y); });
}

void clsMultiTracePainter::drawTrace(DcHandle dc, const TracePoints& points, GridPen look) {
  const SelectedPen pen(gdi(), dc, look.style, 1, look.color);
  for (const TracePoints::Stretch& stretch : points.stretches()) {
    const auto line = points.points(stretch);
    if (line.size() > 1) {
      gdi().polyline(dc, line);
    } else {  // a line of one point draws nothing: a lone value between two gaps is a mark one pixel wide
      gdi().polyline(dc, std::array{line[0], Point{toInt32(line[0].x + 1.0), line[0].y}});
    }
  }
}

void clsMultiTracePainter::Label(DcHandle dc, const LabelFonts& fonts) {
  guard("clsMultiTracePainter::Label() ...", [&] {
    if (xLabelsStale_) updateXAxisLabels();
    drawLabels(dc, fonts);
  });
}

}  // namespace frontpanels
