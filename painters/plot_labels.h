// The labels around a plot: their texts, where they go and their drawing.
#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "platform/gdi.h"
#include "traces/trace_object.h"

namespace frontpanels {

// In the order in which places are given away: a label that would leave the panel or overlap one before it is
// left out.
enum class LabelPlace : std::uint8_t {
  YAxis,      // at each grid line of the value axis: right-aligned before the plot, or centred under it
  Left,       // under the plot, from its left edge
  Right,      // under the plot, up to its right edge
  XAxis,      // under the plot, centred
  YUnit,      // top row, right-aligned before the plot; with the value axis under the plot, at its top level
  Top,        // top row, from the plot's left edge
  TopCenter,  // top row, centred over the plot
  Bottom,     // below the axis labels, from the plot's left edge
  BottomCenter,  // below the axis labels, centred
  Readout,       // top row, up to the plot's right edge
};
inline constexpr std::size_t kLabelPlaces = 10;

// Where labels go, in pixels.
struct LabelFrame {
  Rect panel;
  Rect plot;
  std::int32_t xAxisRowHeightPx = 0;   // 0 when no label of the x axis stands under the plot
  std::int32_t rowBeforeHeightPx = 0;  // of what stands between them and the plot
  friend bool operator==(const LabelFrame&, const LabelFrame&) = default;
};

// The cell of a label whose text has the given extent; a label of the value axis is centred on its grid line.
[[nodiscard]] Rect labelCell(const LabelFrame& frame, LabelPlace place, Size extentPx,
                             std::int32_t linePx = 0);

// How many grid lines go to one label, so that labels `heightPx` high stand clear of each other.
[[nodiscard]] std::int32_t linesPerLabel(std::int32_t plotHeightPx, std::int32_t divisions,
                                         std::int32_t heightPx);

class PlotLabels {
 public:
  struct Placed {
    Rect cell;
    std::string_view text;
    LabelPlace place = LabelPlace::YAxis;
    friend bool operator==(const Placed&, const Placed&) = default;
  };

  [[nodiscard]] const std::string& text(LabelPlace place) const noexcept {
    return texts_[static_cast<std::size_t>(place)];
  }
  void text(LabelPlace place, std::string_view text);
  // The labels of the value axis, the topmost grid line's first, for a writer that uses their storage again.
  [[nodiscard]] std::vector<std::string>& yAxisTexts() noexcept {
    stale_ = true;
    return yAxisTexts_;
  }
  [[nodiscard]] const std::vector<std::string>& yAxisTexts() const noexcept { return yAxisTexts_; }

  // Whether the value axis runs along under the plot, from left to right, instead of up beside it.
  void valueAxisUnderPlot(bool under);
  // Keeps the first row under the plot, of this height, for whoever writes there.
  void keepRowUnderPlot(std::int32_t heightPx);

  // Writes the labels round the plot in the colour of texts on whatever lies there. Texts are measured
  // anew only when something has changed.
  void draw(Gdi& gdi, DcHandle dc, const LabelFonts& fonts, const Rect& panel, const Rect& plot);
  // Whether a cell lies within the panel and clear of the labels that were drawn last.
  [[nodiscard]] bool isFree(const Rect& cell) const;
  // The cell of one more label beside those that were drawn last, if there is room for it.
  [[nodiscard]] std::optional<Rect> roomFor(LabelPlace place, Size extentPx, std::int32_t linePx = 0) const;

 private:
  struct Inputs {
    Rect panel;
    Rect plot;
    FontHandle axis;
    FontHandle corner;
    friend bool operator==(const Inputs&, const Inputs&) = default;
  };

  void layOut(Gdi& gdi, DcHandle dc, const LabelFonts& fonts, const Rect& panel, const Rect& plot);
  void layOutYAxis(Gdi& gdi, DcHandle dc);
  void layOutYAxisUnderPlot(Gdi& gdi, DcHandle dc);
  void layOutXAxisRow(Gdi& gdi, DcHandle dc);
  void placeText(Gdi& gdi, DcHandle dc, LabelPlace place);
  void place(LabelPlace place, std::string_view text, Size extentPx, std::int32_t linePx = 0);
  void placeUnderPlot(std::string_view text, Size extentPx, std::int32_t linePx);
  [[nodiscard]] Size measure(Gdi& gdi, DcHandle dc, std::string_view text);

  std::array<std::string, kLabelPlaces> texts_;
  std::vector<std::string> yAxisTexts_;
  std::string topLevel_;  // with its unit, where the value axis lies under the plot
  bool valueAxisUnderPlot_ = false;
  std::int32_t keptRowHeightPx_ = 0;
  bool stale_ = true;
  Inputs inputs_;
  LabelFrame frame_;
  std::vector<Placed> placed_;
};

}  // namespace frontpanels
