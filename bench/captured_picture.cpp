#include "bench/captured_picture.h"

#include <cmath>

namespace frontpanels::bench {

PenHandle CapturingGdi::createPen(PenStyle style, std::int32_t widthPx, Color color) {
  const PenHandle pen = gdi_.createPen(style, widthPx, color);
  if (capturing_) {
    created_[pen.value] = pens_;
    keep(CreatePen{pens_++, style, widthPx, color});
  }
  return pen;
}

BrushHandle CapturingGdi::createSolidBrush(Color color) {
  const BrushHandle brush = gdi_.createSolidBrush(color);
  if (capturing_) {
    createdBrushes_[brush.value] = brushes_;
    keep(CreateBrush{brushes_++, color});
  }
  return brush;
}

RegionHandle CapturingGdi::createRectRgn(Rect rect) {
  const RegionHandle region = gdi_.createRectRgn(rect);
  if (capturing_) regions_[region.value] = rect;
  return region;
}

bool CapturingGdi::deleteObject(PenHandle pen) {
  if (const auto found = created_.find(pen.value); found != created_.end()) {
    keep(DeletePen{found->second});
    created_.erase(found);
  }
  return gdi_.deleteObject(pen);
}

bool CapturingGdi::deleteObject(BrushHandle brush) {
  if (const auto found = createdBrushes_.find(brush.value); found != createdBrushes_.end()) {
    keep(DeleteBrush{found->second});
    createdBrushes_.erase(found);
  }
  return gdi_.deleteObject(brush);
}

bool CapturingGdi::deleteObject(RegionHandle region) {
  regions_.erase(region.value);
  return gdi_.deleteObject(region);
}

PenHandle CapturingGdi::selectObject(DcHandle dc, PenHandle pen) {
  if (const auto found = created_.find(pen.value); found != created_.end())
    keep(SelectCreatedPen{dc, found->second});
  else
    keep(SelectPen{dc, pen});
  return gdi_.selectObject(dc, pen);
}

FontHandle CapturingGdi::selectObject(DcHandle dc, FontHandle font) {
  keep(SelectFont{dc, font});
  return gdi_.selectObject(dc, font);
}

bool CapturingGdi::selectClipRgn(DcHandle dc, RegionHandle region) {
  if (!capturing_) return gdi_.selectClipRgn(dc, region);
  if (region)
    keep(Clip{dc, regions_[region.value]});
  else
    keep(Unclip{dc});
  return gdi_.selectClipRgn(dc, region);
}

Color CapturingGdi::setTextColor(DcHandle dc, Color color) {
  keep(TextColor{dc, color});
  return gdi_.setTextColor(dc, color);
}

BackgroundMode CapturingGdi::setBkMode(DcHandle dc, BackgroundMode mode) {
  keep(TextMode{dc, mode});
  return gdi_.setBkMode(dc, mode);
}

bool CapturingGdi::fillRect(DcHandle dc, Rect rect, BrushHandle brush) {
  if (const auto found = createdBrushes_.find(brush.value); found != createdBrushes_.end())
    keep(FillWithCreated{dc, rect, found->second});
  else
    keep(Fill{dc, rect, brush});
  return gdi_.fillRect(dc, rect, brush);
}

bool CapturingGdi::moveTo(DcHandle dc, Point to) {
  keep(MoveTo{dc, to});
  return gdi_.moveTo(dc, to);
}

bool CapturingGdi::lineTo(DcHandle dc, Point to) {
  keep(LineTo{dc, to});
  return gdi_.lineTo(dc, to);
}

bool CapturingGdi::polyline(DcHandle dc, std::span<const Point> points) {
  if (!capturing_) return gdi_.polyline(dc, points);
  if (points.size() > 2)
    keep(Trace{dc, traces_++});
  else
    keep(Line{dc, {points.begin(), points.end()}});
  return gdi_.polyline(dc, points);
}

bool CapturingGdi::textOut(DcHandle dc, Point topLeft, std::string_view text) {
  if (capturing_) keep(Text{dc, topLeft, std::string(text)});
  return gdi_.textOut(dc, topLeft, text);
}

bool CapturingGdi::bitBlt(DcHandle to, Rect destination, DcHandle from, Point source, RasterOp operation) {
  keep(Blit{to, destination, from, source, operation});
  return gdi_.bitBlt(to, destination, from, source, operation);
}

// One captured call as the graphics interface's.
struct CapturingGdi::Player {
  Gdi& gdi;
  std::vector<PenHandle>& pens;
  std::vector<BrushHandle>& brushes;
  std::vector<Point>& points;
  std::span<const std::span<const float>> traces;
  const PlotMapping& map;

  void operator()(const CreatePen& c) { pens[c.slot] = gdi.createPen(c.style, c.widthPx, c.color); }
  void operator()(const DeletePen& c) { gdi.deleteObject(pens[c.slot]); }
  void operator()(const CreateBrush& c) { brushes[c.slot] = gdi.createSolidBrush(c.color); }
  void operator()(const DeleteBrush& c) { gdi.deleteObject(brushes[c.slot]); }
  void operator()(const FillWithCreated& c) { gdi.fillRect(c.dc, c.rect, brushes[c.slot]); }
  void operator()(const SelectCreatedPen& c) { gdi.selectObject(c.dc, pens[c.slot]); }
  void operator()(const SelectPen& c) { gdi.selectObject(c.dc, c.pen); }
  void operator()(const SelectFont& c) { gdi.selectObject(c.dc, c.font); }
  void operator()(const Clip& c) {
    const RegionHandle region = gdi.createRectRgn(c.rect);
    gdi.selectClipRgn(c.dc, region);
    gdi.deleteObject(region);
  }
  void operator()(const Unclip& c) { gdi.selectClipRgn(c.dc, {}); }
  void operator()(const TextColor& c) { gdi.setTextColor(c.dc, c.color); }
  void operator()(const TextMode& c) { gdi.setBkMode(c.dc, c.mode); }
  void operator()(const Fill& c) { gdi.fillRect(c.dc, c.rect, c.brush); }
  void operator()(const MoveTo& c) { gdi.moveTo(c.dc, c.to); }
  void operator()(const LineTo& c) { gdi.lineTo(c.dc, c.to); }
  void operator()(const Line& c) { gdi.polyline(c.dc, c.points); }
  void operator()(const Text& c) { gdi.textOut(c.dc, c.topLeft, c.text); }
  void operator()(const Blit& c) { gdi.bitBlt(c.to, c.destination, c.from, c.source, c.operation); }
  void operator()(const Trace& c) {
    const std::span<const float> values = traces[c.index];
    for (std::size_t i = 0; i < values.size(); ++i)
      points[i] = {static_cast<std::int32_t>(std::lrint(static_cast<double>(i) * map.stepPx + map.leftPx)),
                   static_cast<std::int32_t>(
                       std::lrint(map.originPx - static_cast<double>(values[i]) * map.pxPerUnit))};
    gdi.polyline(c.dc, std::span(points).first(values.size()));
  }
};

void CapturingGdi::draw(std::span<const std::span<const float>> traces, const PlotMapping& mapping) {
  drawnPens_.resize(pens_);
  drawnBrushes_.resize(brushes_);
  std::size_t longest = 0;
  for (const std::span<const float> trace : traces) longest = std::max(longest, trace.size());
  points_.resize(longest);
  Player player{gdi_, drawnPens_, drawnBrushes_, points_, traces, mapping};
  for (const Call& call : calls_) std::visit(player, call);
}

}  // namespace frontpanels::bench
