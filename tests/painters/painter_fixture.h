// A painter on a recording surface: panel (10, 20) of 100 x 50 pixels, insets that leave the plot (15, 24) of
// 80 x 40, no grid, values from -100 to 0 (0.4 pixels a unit), ten positions 10 pixels apart.
#pragma once

#include <cmath>
#include <limits>
#include <memory>
#include <string>
#include <vector>

#include "painters/multi_trace_painter.h"
#include "tests/support/fake_surface.h"
#include "tests/support/recording_gdi.h"
#include "tests/support/reporting_fixture.h"

namespace frontpanels::testing {

inline constexpr float kGap = std::numeric_limits<float>::quiet_NaN();
inline constexpr Color kGreen = rgb(50, 156, 50);
inline constexpr Color kRed = rgb(255, 0, 0);

class PainterTest : public ReportingTest {
 protected:
  PainterTest() : painter(gdi) {
    painter.scaleLeft(10);
    painter.scaleTop(20);
    painter.scaleWidth(100);
    painter.scaleHeight(50);
    painter.gridScaleLeft(5);
    painter.gridInsetTop(4);
    painter.gridScaleRight(15);
    painter.gridScaleBottom(6);
    painter.numberOfVerticalDivisions(0);
    painter.numberOfHorizontalDivisions(0);
    painter.numberOfMeasurements(10);
  }

  void give(Variant::Singles values) {
    painter.traceSize(static_cast<std::int32_t>(values.size()) - 1);
    painter.trace(Variant(std::move(values)));
  }
  void paint() { painter.Paint(dc); }
  // The lines that the next paint draws, as "x,y x,y | x,y x,y".
  [[nodiscard]] std::string painted() {
    gdi.clear();
    paint();
    return drawn();
  }
  [[nodiscard]] std::string painted(Variant::Singles values) {
    give(std::move(values));
    return painted();
  }
  [[nodiscard]] std::string drawn() const {
    std::string text;
    for (const Call& line : gdi.polylines()) {
      text += text.empty() ? "" : " |";
      for (const Point at : line.points)
        text += (text.empty() ? "" : " ") + std::to_string(at.x) + "," + std::to_string(at.y);
    }
    return text;
  }
  MarkerPointer addMarker(const char* id, std::int32_t point, std::int16_t traceId = 0) {
    auto marker = std::make_shared<clsMarker>();
    marker->id = id;
    marker->point = point;
    painter.addMarkerToTrace(marker, traceId);
    return marker;
  }

  RecordingGdi gdi;
  DcHandle dc = gdi.viewDc();
  clsMultiTracePainter painter;
};

}  // namespace frontpanels::testing
