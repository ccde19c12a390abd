// Painting and labelling of the bar chart painter.
#include <algorithm>
#include <array>
#include <cmath>

#include "entry/number_format.h"
#include "framework/support/guard.h"
#include "framework/support/numeric.h"
#include "painters/bar_chart_painter.h"
#include "platform/gdi_scope.h"
#include "traces/plot_colors.h"

namespace frontpanels {
namespace {

// By identity, round and round. Each stands out (3 to 1) against the usual button faces, and white text
// stands out against each.
constexpr std::array kBarColors{rgb(0, 84, 200), rgb(196, 0, 0),   rgb(0, 116, 40),   rgb(136, 0, 168),
                                rgb(160, 84, 0), rgb(0, 112, 124), rgb(212, 0, 128),  rgb(96, 104, 0),
                                rgb(0, 0, 112),  rgb(104, 0, 32),  rgb(116, 76, 255), rgb(80, 48, 0)};
constexpr Color kTextOnBar = rgb(255, 255, 255);

constexpr std::int16_t kSolidFill = 0;
constexpr std::int16_t kNoFill = 1;  // the styles behind it are hatches, in the order of HatchStyle

constexpr std::string_view kQuantityFormat = "0.0";
constexpr std::string_view kBetweenTexts = "  ";
constexpr std::string_view kBetweenKeys = ", ";

constexpr std::array<std::string_view, 4> kSuffixUnits{"", "dB", "dBm", "chips"};
// By `otherIs`.
constexpr std::array<std::string_view, 9> kOtherUnits{"",    "",   "chips", "dBm", "dB",
                                                      "dBm", "dB", "chips", "dB"};

std::size_t colorOf(const Bar& bar) {
  return static_cast<std::size_t>(std::max<std::int16_t>(bar.barId, 1) - 1) % kBarColors.size();
}

std::string_view unitOfOther(std::int16_t otherIs) {
  const auto index = static_cast<std::size_t>(otherIs);
  return otherIs > 0 && index < kOtherUnits.size() ? kOtherUnits[index] : std::string_view();
}

// False, and nothing appended, for what is no number.
bool appendQuantity(std::string& text, std::string_view before, float number, std::string_view unit) {
  if (!std::isfinite(number)) return false;
  appendNumber(text.append(before), static_cast<double>(number), kQuantityFormat);
  if (!unit.empty()) text.append(" ").append(unit);
  return true;
}

// A brush a colour, made when it is first asked for and deleted with the others.
class BarBrushes {
 public:
  BarBrushes(Gdi& gdi, std::int16_t fillStyle) : gdi_(gdi), colors_(gdi), fillStyle_(fillStyle) {}
  ~BarBrushes() {
    for (const BrushHandle brush : brushes_) {
      if (brush) gdi_.deleteObject(brush);
    }
  }
  BarBrushes(const BarBrushes&) = delete;
  BarBrushes& operator=(const BarBrushes&) = delete;

  // Null when it could not be made.
  [[nodiscard]] BrushHandle of(std::size_t color) {
    if (!brushes_[color]) brushes_[color] = create(colors_.line(kBarColors[color]));
    return brushes_[color];
  }

 private:
  [[nodiscard]] BrushHandle create(Color color) {
    if (fillStyle_ == kSolidFill) return gdi_.createSolidBrush(color);
    return gdi_.createHatchBrush(static_cast<HatchStyle>(fillStyle_ - kNoFill - 1), color);
  }

  Gdi& gdi_;
  PlotColors colors_;
  std::int16_t fillStyle_;
  std::array<BrushHandle, kBarColors.size()> brushes_{};
};

// The first row of a letter's cell is empty. Texts one below the other count without it, so that as many keys
// stand before horizontal bars as can be read there.
std::int32_t airOverLetters(BarDirection direction) { return direction == BarDirection::Horizontal ? 1 : 0; }

Size lettersOf(Size extentPx, BarDirection direction) {
  if (extentPx == Size{}) return {};
  return {extentPx.width, std::max(1, extentPx.height - airOverLetters(direction))};
}

void drawBorder(Gdi& gdi, DcHandle dc, const Rect& bar) {
  const std::int32_t right = bar.right - 1;
  const std::int32_t bottom = bar.bottom - 1;
  gdi.polyline(dc, std::array{Point{bar.left, bar.top}, Point{right, bar.top}, Point{right, bottom},
                              Point{bar.left, bottom}, Point{bar.left, bar.top}});
}

}  // namespace

void clsBarChartPainter::Paint(DcHandle dc) {
  guard("clsBarChartPainter::Paint()...", [&] { paintPanel(dc, panelRect()); });
}

void clsBarChartPainter::Paint() {
  guard("clsBarChartPainter::Paint()...", [this] {
    const PlotRect area = surfaceRect();
    paintPanel(surfaceDc(), area);
  });
}

void clsBarChartPainter::paintPanel(DcHandle dc, const PlotRect& panel) {
  refreshStaleBars();
  fillWithBackground(dc, panel);
  fullRedraw_ = false;
  chooseAxis();
  const PlotRect plot = panel.shrunk(insets());
  if (!plot.drawable()) return;
  direction_ == BarDirection::Vertical ? PaintVerticalBarChart(dc, plot) : PaintHorizontalBarChart(dc, plot);
}

void clsBarChartPainter::PaintVerticalBarChart(DcHandle dc, const PlotRect& plot) {
  drawGridOver(dc, plot, {shownDivisions_, numberOfHorizontalDivisions_, 0});
  paintBars(dc, frameOf(plot));
}

void clsBarChartPainter::PaintHorizontalBarChart(DcHandle dc, const PlotRect& plot) {
  drawGridOver(dc, plot, {numberOfHorizontalDivisions_, shownDivisions_, 0});
  paintBars(dc, frameOf(plot));
}

BarFrame clsBarChartPainter::frameOf(const PlotRect& plot) const {
  return {plot, direction_, range(), countToPaint()};
}

void clsBarChartPainter::chooseAxis() {
  const std::int32_t before = shownDivisions_;
  shownDivisions_ = numberOfVerticalDivisions();
  if (getAutoScale()) DoAutoScale();
  FixedAxis shown{axis(), shownDivisions_};
  if (!getAutoScale()) {
    const double top =
        increment_ > 0 ? std::ceil(shown.range.maximum / increment_) * increment_ : shown.range.maximum;
    if (shownDivisions_ > 0) shown = fixedAxis(top, getDbPerDivision(), shownDivisions_, axisFloor());
  }
  range(shown.range);
  shownDivisions_ = shown.divisions;
  if (shownDivisions_ != before) forgetYAxisLabels();
}

void clsBarChartPainter::paintBars(DcHandle dc, const BarFrame& frame) {
  const std::span<const HeldBar> painted = barsToPaint();
  const PlotColors colors(gdi());
  if (!painted.empty()) activeTraceColor(colors.line(kBarColors[colorOf(painted.front())]));
  if (fillStyle_ != kNoFill) {
    const TextStyleScope hatchesLetThrough(gdi(), dc, kTextOnBar, BackgroundMode::Transparent);
    BarBrushes brushes(gdi(), fillStyle_);
    for (std::size_t i = 0; i < painted.size(); ++i) {
      const Rect bar = frame.bar(i, static_cast<double>(painted[i].value));
      if (bar.empty()) continue;
      if (const BrushHandle brush = brushes.of(colorOf(painted[i]))) gdi().fillRect(dc, bar, brush);
    }
  }
  if (drawBorders_() || fillStyle_ == kNoFill) {
    const SelectedPen pen(gdi(), dc, PenStyle::Solid, 1, colors.text());
    for (std::size_t i = 0; i < painted.size(); ++i) {
      const Rect bar = frame.bar(i, static_cast<double>(painted[i].value));
      if (!bar.empty()) drawBorder(gdi(), dc, bar);
    }
  }
  paintThreshold(dc, frame);
}

// A line in the background's colour below the dashes, so that they show on bars of any colour.
void clsBarChartPainter::paintThreshold(DcHandle dc, const BarFrame& frame) {
  if (!threshold()) return;
  const auto line = frame.line(*threshold());
  if (!line) return;
  const PlotColors colors(gdi());
  {
    const SelectedPen pen(gdi(), dc, PenStyle::Solid, 1, colors.background());
    gdi().polyline(dc, *line);
  }
  const TextStyleScope gaps(gdi(), dc, colors.text(), BackgroundMode::Transparent);
  const SelectedPen pen(gdi(), dc, PenStyle::Dash, 1, colors.text());
  gdi().polyline(dc, *line);
}

// --- Labels

void clsBarChartPainter::Label(DcHandle dc, const LabelFonts& fonts) {
  direction_ == BarDirection::Vertical ? LabelVerticalBarChart(dc, fonts)
                                       : LabelHorizontalBarChart(dc, fonts);
}

void clsBarChartPainter::LabelVerticalBarChart(DcHandle dc, const LabelFonts& fonts) {
  guard("clsBarChartPainter::LabelVerticalBarChart()...", [&] {
    labels().valueAxisUnderPlot(false);
    labels().keepRowUnderPlot(barLabeling_ == 0 ? 0 : toInt32(fonts.cellHeightPx));
    labelBars(dc, fonts);
  });
}

void clsBarChartPainter::LabelHorizontalBarChart(DcHandle dc, const LabelFonts& fonts) {
  guard("clsBarChartPainter::LabelHorizontalBarChart()...", [&] {
    labels().valueAxisUnderPlot(true);
    labels().keepRowUnderPlot(0);
    labelBars(dc, fonts);
  });
}

void clsBarChartPainter::labelBars(DcHandle dc, const LabelFonts& fonts) {
  drawLabels(dc, fonts);
  const PlotRect plot = plotRect();
  if (barLabeling_ == 0 || !plot.drawable()) return;
  composeTexts();
  const TextStyleScope style(gdi(), dc, PlotColors(gdi()).text(), BackgroundMode::Transparent);
  {
    const SelectedFont font(gdi(), dc, fonts.axis);
    layOutTexts(dc, frameOf(plot));
    writeTexts(dc);
  }
  const SelectedFont font(gdi(), dc, fonts.corner);
  writeKeysWithoutRoom(dc);
}

std::string_view clsBarChartPainter::valueUnit() const {
  return suffixIs_ == 0 ? std::string_view(units_) : kSuffixUnits[static_cast<std::size_t>(suffixIs_)];
}

void clsBarChartPainter::composeTexts() {
  texts_.resize(countToPaint());
  for (std::size_t i = 0; i < texts_.size(); ++i) composeText(bars_.bars()[i], texts_[i]);
}

void clsBarChartPainter::appendKey(std::string& text, const Bar& bar) const {
  xAxisFormatter_.append(text, static_cast<double>(bar.key), xAxisFormatter_.formatString(),
                         !xAxisFormatter_.suppressSuffix());
}

std::string_view clsBarChartPainter::cellNameOf(const Bar& bar) const {
  if (!showCellName_ || cellNames_ == nullptr) return {};
  return cellNames_->GetCellName(static_cast<double>(bar.key), bar.cellNameId2);
}

// Into the bar's label, one text behind the other.
void clsBarChartPainter::composeText(HeldBar& bar, Texts& texts) {
  std::array<std::size_t, BarTextSizes::kQuantities + 1> ends{};
  texts.count = 0;
  bar.label.clear();
  const auto end = [&] { ends[texts.count++] = bar.label.size(); };
  const auto quantity = [&](float number, std::string_view unit) {
    if (appendQuantity(bar.label, kBetweenTexts, number, unit)) end();
  };
  bar.label.append(barLabel_).append(barLabel_.empty() ? "" : " ");
  appendKey(bar.label, bar);
  end();
  if (barLabeling_ == 2 && valueIs_ == 1) quantity(bar.value, valueUnit());
  if (barLabeling_ == 2 && bar.hasOther) quantity(bar.other, unitOfOther(rules_.otherIs));
  if (const std::string_view name = cellNameOf(bar); !name.empty()) {
    bar.label.append(kBetweenTexts).append(name);
    end();
  }
  std::size_t from = 0;
  for (std::size_t part = 0; part < texts.count; ++part) {
    texts.parts[part] = std::string_view(bar.label).substr(from, ends[part] - from);
    from = ends[part] + kBetweenTexts.size();
  }
}

void clsBarChartPainter::layOutTexts(DcHandle dc, const BarFrame& frame) {
  const std::span<const HeldBar> painted = barsToPaint();
  const auto extent = [&](std::string_view text) {
    return lettersOf(gdi().textExtent(dc, text), direction_);
  };
  lengthsPx_.resize(painted.size());
  sizes_.assign(painted.size(), {});
  for (std::size_t i = 0; i < painted.size(); ++i) {
    lengthsPx_[i] = frame.lengthPx(static_cast<double>(painted[i].value));
    sizes_[i].key = extent(texts_[i].parts[0]);
    for (std::size_t part = 1; part < texts_[i].count; ++part) {
      sizes_[i].quantities[part - 1] = extent(texts_[i].parts[part]);
    }
  }
  layout_.layOut(frame, panelRect().toPixels(), lengthsPx_, sizes_, order_.strongestFirst(painted), labels(),
                 fillStyle_ == kSolidFill);
}

// Grid and threshold give way to texts that lie on them.
void clsBarChartPainter::writeTexts(DcHandle dc) {
  const std::int32_t airPx = airOverLetters(direction_);
  const PlotColors colors(gdi());
  const BrushHandle background = colors.backgroundBrush();
  const std::span<const HeldBar> painted = barsToPaint();
  for (const bool inside : {false, true}) {
    const TextStyleScope style(gdi(), dc, inside ? kTextOnBar : colors.text(), BackgroundMode::Transparent);
    for (const BarTextLayout::Placed& text : layout_.placed()) {
      if (text.inside != inside) continue;
      if (background && !inside && text.part > 0) gdi().fillRect(dc, text.cell, background);
      if (inside && colors.byScheme()) {
        const Color bar = kBarColors[colorOf(painted[text.bar])];
        gdi().setTextColor(dc, colors.textOn(colors.line(bar), kTextOnBar));
      }
      gdi().textOut(dc, {text.cell.left, text.cell.top - airPx}, texts_[text.bar].parts[text.part]);
    }
  }
}

// In the top row, as many as there is room for; the text grows by one key until there is none.
void clsBarChartPainter::writeKeysWithoutRoom(DcHandle dc) {
  keysWithoutRoom_.clear();
  std::size_t fitting = 0;
  std::optional<Rect> place;
  for (const std::uint32_t bar : layout_.withoutKey()) {
    keysWithoutRoom_.append(fitting == 0 ? "" : kBetweenKeys).append(texts_[bar].parts[0]);
    const auto cell = labels().roomFor(LabelPlace::Readout, gdi().textExtent(dc, keysWithoutRoom_));
    if (!cell || layout_.covers(*cell)) break;
    place = cell;
    fitting = keysWithoutRoom_.size();
  }
  if (place)
    gdi().textOut(dc, {place->left, place->top}, std::string_view(keysWithoutRoom_).substr(0, fitting));
}

// --- In words

void clsBarChartPainter::describe(GraphItems& items) {
  guard("clsBarChartPainter::describe()...", [&] {
    const std::span<const HeldBar> painted = barsToPaint();
    std::string summary = countOf(painted.size(), "bar");
    const auto largest = std::max_element(painted.begin(), painted.end(), [](const Bar& a, const Bar& b) {
      return a.value < b.value || (!std::isfinite(a.value) && std::isfinite(b.value));
    });
    if (largest != painted.end())
      summary.append(", largest ").append(spokenNameOf(*largest)).append(", ") += spokenValueOf(*largest);
    items.add(chartItem("Bars", std::move(summary)));
    const PlotRect plot = plotRect();
    const bool seen = plot.drawable();
    for (std::size_t i = 0; i < painted.size(); ++i) {
      GraphItem item{
          GraphItemKind::Bar, spokenNameOf(painted[i]), spokenValueOf(painted[i]), {}, false, seen};
      // A bar that has no length still has its place, where its key stands.
      if (const BarFrame frame = frameOf(plot); seen)
        item.placePx = frame.rect(frame.along(i),
                                  {0, std::max(1, frame.lengthPx(static_cast<double>(painted[i].value)))});
      items.add(std::move(item));
    }
  });
}

std::string clsBarChartPainter::spokenNameOf(const Bar& bar) const {
  std::string name = barLabel_.empty() ? spokenKey() : barLabel_;
  if (!name.empty()) name += ' ';
  appendKey(name, bar);
  if (const std::string_view cell = cellNameOf(bar); !cell.empty()) name.append(", ").append(cell);
  return name;
}

std::string clsBarChartPainter::spokenValueOf(const HeldBar& bar) const {
  std::string value;
  if (!appendQuantity(value, "", bar.value, valueUnit())) value = "no value";
  if (bar.hasOther) appendQuantity(value, ", ", bar.other, unitOfOther(rules_.otherIs));
  return value;
}

}  // namespace frontpanels
