#include "painters/marker_readout.h"

#include <cmath>

#include "entry/number_format.h"

namespace frontpanels {
namespace {

constexpr std::string_view kGap = "  ";

void appendX(std::string& text, double value, const ReadoutFormat& format) {
  const std::string_view numberFormat =
      !format.xMarkerFormat.empty() ? format.xMarkerFormat
                                    : formatNoFinerThan(format.pointSpacing / format.x.shownScale(value));
  format.x.append(text, value, numberFormat, true);
}

constexpr std::string_view kNoLevel = "---";

void appendY(std::string& text, double level, const ReadoutFormat& format) {
  if (std::isfinite(level)) {
    format.y.append(text, level, format.yMarkerFormat, true);
  } else {
    text += kNoLevel;
  }
}

// A difference is shown with its sign, in the unit that its size calls for; the display offset of the axis
// cancels out of it.
char signOf(double difference) { return difference < 0 ? '-' : '+'; }

}  // namespace

MarkerReading markerReading(const clsMarker& marker, const ReadoutFormat& format) {
  MarkerReading reading{marker.id, {}, {}};
  appendX(reading.x, marker.valueX, format);
  appendY(reading.y, marker.valueY, format);
  return reading;
}

void appendReadout(std::string& text, const clsMarker& marker, const ReadoutFormat& format) {
  (text += marker.id) += kGap;
  appendX(text, marker.valueX, format);
  text += kGap;
  appendY(text, marker.valueY, format);
}

void appendLevelReadout(std::string& text, const clsMarker& marker, const ReadoutFormat& format) {
  (text += marker.id) += kGap;
  appendY(text, marker.valueY, format);
}

void appendDeltaReadout(std::string& text, const clsMarker& delta, const clsMarker& partner,
                        const ReadoutFormat& format) {
  const double x = delta.valueX - partner.valueX;
  const double y = delta.valueY - partner.valueY;
  ((text += delta.id) += kGap) += signOf(x);
  appendX(text, std::fabs(x) + format.x.formatOffset(), format);
  text += kGap;
  if (std::isfinite(y)) text += signOf(y);
  appendY(text, std::fabs(y) + format.y.formatOffset(), format);
  // The difference of two levels in dBm is a ratio.
  if (text.ends_with(" dBm")) text.pop_back();
}

}  // namespace frontpanels
