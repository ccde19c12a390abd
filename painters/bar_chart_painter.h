// clsBarChartPainter: a set of measured items as bars, one an item, side by side or stacked. A bar is matched
// with that of the update before by its key, so that it keeps its identity, and with it its colour, wherever
// it moves to.
//
// Every routine reports its own failure and returns, leaving the chart as it was. Bars are counted from 1 in
// the sorted order. Pixels are those of the off-screen surface, rectangles are half-open.
#pragma once

#include <array>
#include <cstdint>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "entry/numeric_entry.h"
#include "painters/bar.h"
#include "painters/bar_builder.h"
#include "painters/bar_layout.h"
#include "painters/bar_order.h"
#include "painters/cell_names.h"
#include "painters/plot_painter.h"
#include "painters/property.h"

namespace frontpanels {

class clsBarChartPainter : public PlotPainter {
 public:
  static constexpr std::string_view kTypeName = "clsBarChartPainter";
  static constexpr std::int16_t kAllBars = -1;
  using BarSets = std::vector<std::vector<float>>;

  // `gdi` must outlive the painter.
  explicit clsBarChartPainter(Gdi& gdi);

  [[nodiscard]] std::string_view typeName() const override { return kTypeName; }

  // --- The block of values. Items of `elementsPerValue` consecutive values each: the key, the bar's value
  // and further quantities. An item never borrows values of the next one: a quantity whose element it lacks
  // keeps its default. What is set here holds from the next processData on, but for what says otherwise.

  // 0 or more.
  [[nodiscard]] std::int32_t numberOfMeasurements() const { return numberOfMeasurements_; }
  void numberOfMeasurements(std::int32_t count);
  // 2 or more.
  [[nodiscard]] std::int32_t elementsPerValue() const { return rules_.elementsPerValue; }
  void elementsPerValue(std::int32_t count);
  // An array of singles, doubles or variants, or null, which stands for no news. New values set
  // `dataChanged`; storage is used again for values of the same kind.
  [[nodiscard]] const Variant& trace() const { return block_; }
  void trace(const Variant& values);
  void trace(std::span<const float> values);
  // Builds the bars from the block, once for each time that `dataChanged` was set. A block with fewer values
  // than it announces is reported and the bars stay.
  void processData() override;
  void ClearBars();

  // The most bars the chart holds, at least 1. Of a longer block the first items count.
  [[nodiscard]] std::int16_t maxPNs() const { return maxPNs_; }
  void maxPNs(std::int16_t count);
  // How many bars are painted and labelled, at most maxPNs: the first ones of the order. -1 is all of them,
  // any other number below 1 is 1.
  [[nodiscard]] std::int16_t getBarsToPaint() const { return barsToPaint_; }
  void setBarsToPaint(std::int16_t count);

  // --- What bars hold. A change after the data have come shows at the next paint: the bars are filled anew
  // from the block, which is no update.

  // Added to every value while useOffset is set, and to some of the other quantities in any case. A number.
  [[nodiscard]] const Variant& offset() const { return rules_.offset; }
  void offset(const Variant& amount);
  [[nodiscard]] bool useOffset() const { return rules_.useOffset; }
  void useOffset(bool use);
  // The other quantity, by its element of an item (from 0): 0 none; 1 and 3 element 1 plus the offset; 2, 9,
  // 11 and 12 element 2; 4 element 1; 5 element 3 plus the offset; 6 and 10 element 3; 7 element 4; 8 element
  // 5 of items of 6. Any other is reported, once a time that bars are filled, and is none.
  [[nodiscard]] std::int16_t otherIs() const { return rules_.otherIs; }
  void otherIs(std::int16_t type);
  // 1: element 2 is the auxiliary value.
  [[nodiscard]] std::int16_t kindFlag() const { return rules_.kindFlag; }
  void kindFlag(std::int16_t kind);
  // The extra value is the default one; in mode 2 element 2; with four elements or more and source 0 element
  // 3; with five or more and source 2 element 4.
  [[nodiscard]] std::int16_t extraValueMode() const { return rules_.extraValueMode; }
  void extraValueMode(std::int16_t mode);
  [[nodiscard]] std::int16_t extraValueSource() const { return rules_.extraValueSource; }
  void extraValueSource(std::int16_t source);
  [[nodiscard]] const Variant& defaultExtraValue() const { return rules_.defaultExtraValue; }
  void defaultExtraValue(const Variant& value);
  // Element 2 is the second identifier of a cell's name, the key being the first.
  [[nodiscard]] bool hasCellNameLookupId2() const { return rules_.hasCellNameLookupId2; }
  void hasCellNameLookupId2(bool has);

  // --- Order

  // 0 none: as the items came; 1 by value; 2 by key; 3 history; 4 by the other quantity. History: the bar
  // that has been in the chart for more updates on end comes first, of equal ones the strongest. Another mode
  // is refused. A change sorts at once.
  [[nodiscard]] std::int16_t barSortByMode() const { return barSortByMode_; }
  void barSortByMode(std::int16_t mode);
  // 1 ascending, any other number descending. History turned round begins with the newest and weakest.
  [[nodiscard]] std::int16_t barSortOrder() const { return barSortOrder_; }
  void barSortOrder(std::int16_t order);
  // After sorting, the bars of the first set come first, those of the second next, those of none last; a key
  // counts for the first set that has it. Inside a set the order stays.
  [[nodiscard]] bool sortBySetOrder() const { return sortBySetOrder_; }
  void sortBySetOrder(bool bySets);
  [[nodiscard]] const BarSets& setOrderList() const { return setOrderList_; }
  void setOrderList(BarSets sets);  // all of them count
  // How many sets count. More than there are is reported when bars are sorted, which then stay ungrouped.
  [[nodiscard]] std::int16_t numberOfSets() const { return numberOfSets_; }
  void numberOfSets(std::int16_t count);
  // Whether the bars are in a sorted order.
  [[nodiscard]] bool sortFlag() const { return sortFlag_; }
  void SortBars();

  // --- The bars
  [[nodiscard]] std::int32_t barArraySize() const { return static_cast<std::int32_t>(bars().size()); }
  [[nodiscard]] std::span<const HeldBar> bars() const { return bars_.bars(); }
  // Of the bar at a position; reported and 0 where there is none.
  [[nodiscard]] float barValue(std::int32_t position) const;
  [[nodiscard]] float barOffset(std::int32_t position) const;  // the key
  [[nodiscard]] float barOther(std::int32_t position) const;
  // The position of the bar with the identity; a miss is reported and 0.
  [[nodiscard]] std::int32_t findBar(std::int16_t barId) const;
  // Whether the bars have another quantity.
  [[nodiscard]] bool hasOther() const { return rules_.otherIs != 0; }
  // Whether bars have gone since the last paint, so that a host may not repaint parts only.
  [[nodiscard]] bool fullRedraw() const { return fullRedraw_; }

  // --- Value axis. While auto scale is off the axis ends with the last whole division above `axisFloor`,
  // -130 at first, unless the axis begins below it, and its top is gridScaleTop, rounded up to a whole
  // multiple of the increment where that is above 0.
  Property<double> axisFloor{-130};
  [[nodiscard]] double getIncrement() const { return increment_; }
  void setIncrement(double increment);
  // Fits the axis to the bars to be painted when they no longer fill it well. Runs by itself in each paint
  // while auto scale is on.
  void DoAutoScale();
  // The level at which a dashed line crosses the bars, if it lies within the axis. None until it is set.
  Property<std::optional<double>> threshold;

  // --- What is written. Values stand with one decimal and their unit, that of the other quantity by its
  // type: 2 and 7 chips, 3 and 5 dBm, 4, 6 and 8 dB.

  // 0 nothing; 1 the key; 2 the key and the quantities.
  [[nodiscard]] std::int16_t getBarLabeling() const { return barLabeling_; }
  void setBarLabeling(std::int16_t labeling);
  // What stands before each key.
  [[nodiscard]] const std::string& getBarLabel() const { return barLabel_; }
  void setBarLabel(std::string_view text);
  // 1: the bar's value is among the quantities.
  [[nodiscard]] std::int16_t valueIs() const { return valueIs_; }
  void valueIs(std::int16_t which);
  // The unit of the value axis and of values at bars: 0 that of `units`, 1 dB, 2 dBm, 3 chips. Setting either
  // of them writes it into yAxisLabel.
  [[nodiscard]] std::int16_t suffixIs() const { return suffixIs_; }
  void suffixIs(std::int16_t suffix);
  [[nodiscard]] const std::string& units() const { return units_; }
  void units(std::string_view text);
  // The cell's name is written at the bar, too.
  [[nodiscard]] bool ShowCellName() const { return showCellName_; }
  void ShowCellName(bool show);
  // Null until it is set: no names then.
  [[nodiscard]] const std::shared_ptr<const CellNames>& CellNameInfo() const { return cellNames_; }
  void CellNameInfo(std::shared_ptr<const CellNames> names);
  // Writes the keys.
  [[nodiscard]] clsNumericEntry& xAxisFormatter();

  // --- Appearance

  // Grid lines along the bars: one more than divisions of the plot, up to 1000; none for 0 or less.
  [[nodiscard]] std::int32_t numberOfHorizontalDivisions() const { return numberOfHorizontalDivisions_; }
  void numberOfHorizontalDivisions(std::int32_t divisions);

  // 0 vertical bars side by side, 1 horizontal bars one below the other. Another style is refused.
  [[nodiscard]] std::int16_t BarChartStyle() const { return static_cast<std::int16_t>(direction_); }
  void BarChartStyle(std::int16_t style);
  // How bars are filled: 0 solid; 1 not at all, which leaves their border; 2 to 7 hatched horizontally,
  // vertically, diagonally down, diagonally up, crossed and crossed diagonally.
  [[nodiscard]] std::int16_t fillStyle() const { return fillStyle_; }
  void setFillStyle(std::int16_t style);
  // A line round every bar.
  [[nodiscard]] bool getDrawBorders() const { return drawBorders_(); }
  void setDrawBorders(bool draw) { drawBorders_(draw); }
  // Colour of the first bar as last painted; another name of activeTraceColor.
  [[nodiscard]] Color getCurrentBarColor() const { return activeTraceColor(); }
  void setCurrentBarColor(Color color) { activeTraceColor(color); }

  // --- Painting, in the order in which the trace manager calls it
  void Paint(DcHandle dc) override;
  // Directly on the surface of drawingArea, over its whole scale.
  void Paint();
  void drawMarkers(DcHandle /*dc*/) override {}
  // Keys stand under vertical bars and before horizontal ones, quantities and names at their ends or on them.
  // Texts that would overlap are left out, those of the strongest bars last; keys that found no room stand in
  // the top row, the strongest first, as many as there is room for.
  void Label(DcHandle dc, const LabelFonts& fonts) override;
  void updateMarkerDisplay(DcHandle /*dc*/, const LabelFonts& /*fonts*/) override {}

  // --- In words: the chart, then each painted bar. What its key is called goes before it, where no label
  // does: "PN 12".
  Property<std::string> spokenKey;
  void describe(GraphItems& items) override;
  [[nodiscard]] std::size_t itemCount() const override { return 1 + countToPaint(); }

  // --- Sub-traces: a bar chart draws none. It keeps the PN offsets that it was given, and while it has any
  // an update without items is ignored.
  std::int16_t addATrace(std::int16_t mode, std::int16_t pn, double value, std::int32_t size,
                         std::optional<std::int16_t> traceId = std::nullopt) override;
  [[nodiscard]] std::int16_t findATraceByPN(std::int16_t pn) const override;
  [[nodiscard]] std::int16_t pnOffset(std::int16_t index) const override;
  [[nodiscard]] std::int16_t numberOfTraces() const override;
  [[nodiscard]] std::int16_t selectedTraceIndex() const override { return selectedTraceIndex_(); }
  void selectedTraceIndex(std::int16_t index) override { selectedTraceIndex_(index); }
  [[nodiscard]] std::int32_t traceSize() const override { return traceSize_(); }
  void traceSize(std::int32_t size) { traceSize_(size); }
  [[nodiscard]] bool multiMarker() const override { return false; }

  // --- Markers are kept and given back: there are no points for them to stand on.
  [[nodiscard]] MarkerCollection& markerCollection() override { return markers_; }
  // The same one for each sub-trace. Raises "Subscript out of range" as the contract has it.
  [[nodiscard]] MarkerCollection& traceMarkerCollections(std::int16_t traceIndex) override;
  void findNearestPoint(float /*x*/, float /*y*/, clsMarker& /*marker*/,
                        std::optional<std::int16_t> /*traceIndex*/ = std::nullopt) override {}
  void addMarkerToTrace(MarkerPointer marker, std::int16_t traceId) override;
  void markerToMax() override {}
  void markerToMin() override {}
  void KeyPress(std::int16_t /*key*/) override {}

  // --- Kept and given back: the interface that both painters share
  [[nodiscard]] std::int16_t xAxisStyle() const override { return xAxisStyle_(); }
  void xAxisStyle(std::int16_t style) override { xAxisStyle_(style); }
  Property<bool> autoFormatX;
  Property<bool> useZas;
  [[nodiscard]] std::int16_t getDisplayStyle() const { return displayStyle_(); }
  void setDisplayStyle(std::int16_t style) { displayStyle_(style); }

 private:
  [[nodiscard]] const Bar& barAt(std::int32_t position) const;  // raises "Subscript out of range"
  template <class T>
  void fillBy(T& setting, const T& value);
  template <class T>
  void sortBy(T& setting, const T& value);
  // How the members of one bar's text lie in its label.
  struct Texts {
    std::array<std::string_view, BarTextSizes::kQuantities + 1> parts;  // the key, then the quantities
    std::size_t count = 0;
  };
  void paintPanel(DcHandle dc, const PlotRect& panel);
  void PaintVerticalBarChart(DcHandle dc, const PlotRect& plot);
  void PaintHorizontalBarChart(DcHandle dc, const PlotRect& plot);
  void chooseAxis();
  void paintBars(DcHandle dc, const BarFrame& frame);
  void paintThreshold(DcHandle dc, const BarFrame& frame);
  [[nodiscard]] std::int32_t shownDivisions() const override { return shownDivisions_; }
  [[nodiscard]] BarFrame frameOf(const PlotRect& plot) const;

  void LabelVerticalBarChart(DcHandle dc, const LabelFonts& fonts);
  void LabelHorizontalBarChart(DcHandle dc, const LabelFonts& fonts);
  void labelBars(DcHandle dc, const LabelFonts& fonts);
  void composeTexts();
  void composeText(HeldBar& bar, Texts& texts);
  void appendKey(std::string& text, const Bar& bar) const;
  [[nodiscard]] std::string_view cellNameOf(const Bar& bar) const;  // empty where none is shown
  [[nodiscard]] std::string spokenNameOf(const Bar& bar) const;
  [[nodiscard]] std::string spokenValueOf(const HeldBar& bar) const;
  void layOutTexts(DcHandle dc, const BarFrame& frame);
  void writeTexts(DcHandle dc);
  void writeKeysWithoutRoom(DcHandle dc);
  [[nodiscard]] std::string_view valueUnit() const;

  // Fills the records from the block, raising as fillBar does, and reports a quantity that is not known.
  template <class ItemOf>
  void fillFromBlock(std::size_t count, ItemOf itemOf);
  void takeFilled();
  void refreshStaleBars();
  void SortBarsBySet();
  [[nodiscard]] std::size_t countToPaint() const;
  [[nodiscard]] std::span<const HeldBar> barsToPaint() const { return bars().first(countToPaint()); }

  Variant block_ = Variant::null();
  std::int32_t numberOfMeasurements_ = 0;
  BarRules rules_;
  bool blockHeld_ = false;  // the bars were filled from the block as it is
  bool barsStale_ = false;  // what bars hold was changed since they were filled

  std::int16_t maxPNs_ = 40;
  std::int16_t barsToPaint_ = 20;
  BarArray bars_;
  BarArray filled_;  // storage of filling: what is there at the end takes the place of bars_
  BarMatcher matcher_;
  BarOrder order_;
  bool fullRedraw_ = false;

  std::int16_t barSortByMode_ = static_cast<std::int16_t>(BarSort::Value);
  std::int16_t barSortOrder_ = 0;
  bool sortBySetOrder_ = false;
  BarSets setOrderList_;
  std::int16_t numberOfSets_ = 0;
  bool sortFlag_ = false;

  double increment_ = 0;
  std::int32_t shownDivisions_ = 10;
  std::int16_t barLabeling_ = 2;
  std::string barLabel_;
  std::int16_t valueIs_ = 0;
  std::int16_t suffixIs_ = 0;
  std::string units_;
  bool showCellName_ = false;
  std::shared_ptr<const CellNames> cellNames_;
  clsNumericEntry xAxisFormatter_;

  BarDirection direction_ = BarDirection::Vertical;
  std::int32_t numberOfHorizontalDivisions_ = 1;
  std::int16_t fillStyle_ = 0;
  Property<bool> drawBorders_;
  Property<std::int16_t> displayStyle_;
  Property<std::int16_t> xAxisStyle_;

  // Storage of labelling, used again.
  std::vector<Texts> texts_;
  std::vector<BarTextSizes> sizes_;
  std::vector<std::int32_t> lengthsPx_;
  BarTextLayout layout_;
  std::string keysWithoutRoom_;

  std::vector<std::int16_t> tracePns_;
  Property<std::int16_t> selectedTraceIndex_;
  Property<std::int32_t> traceSize_;
  MarkerCollection markers_;
};

}  // namespace frontpanels
