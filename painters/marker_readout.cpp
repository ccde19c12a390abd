#include "painters/marker_readout.h"

#include <cmath>

#include "entry/number_format.h"

namespace frontpanels {
namespace {

constexpr std::string_view kGap = "  ";

std::string_view xFormat(double value, const ReadoutFormat& format) {
  return !format.xMarkerFormat.empty() ? format.xMarkerFormat
                                       : formatNoFinerThan(format.pointSpacing / format.x.shownScale(value));
}

void appendX(std::string& text, double value, const ReadoutFormat& format) {
  format.x.append(text, value, xFormat(value, format), true);
}

constexpr std::string_view kNoLevel = "---";

void appendY(std::string& text, double level, const ReadoutFormat& format) {
  if (std::isfinite(level)) {
    format.y.append(text, level, format.yMarkerFormat, true);
  } else {
    text += kNoLevel;
  }
}

// A difference is shown with its sign, in the unit that its size calls for.
char signOf(double difference) { return difference < 0 ? '-' : '+'; }

void appendXDifference(std::string& text, double x, const ReadoutFormat& format) {
  text += signOf(x);
  format.x.appendDifference(text, std::fabs(x), xFormat(std::fabs(x) + format.x.formatOffset(), format),
                            true);
}

void appendYDifference(std::string& text, double y, const ReadoutFormat& format) {
  if (std::isfinite(y)) text += signOf(y);
  appendY(text, std::fabs(y) + format.y.formatOffset(), format);
  // The difference of two levels in dBm is a ratio.
  if (text.ends_with(" dBm")) text.pop_back();
}

}  // namespace

MarkerReading markerReading(const clsMarker& marker, const ReadoutFormat& format) {
  MarkerReading reading{marker.id, {}, {}};
  appendX(reading.x, marker.valueX, format);
  appendY(reading.y, marker.valueY, format);
  return reading;
}

MarkerReading deltaReading(const clsMarker& delta, const clsMarker& partner, const ReadoutFormat& format) {
  MarkerReading reading{delta.id, {}, {}};
  appendXDifference(reading.x, delta.valueX - partner.valueX, format);
  appendYDifference(reading.y, delta.valueY - partner.valueY, format);
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
  (text += delta.id) += kGap;
  appendXDifference(text, delta.valueX - partner.valueX, format);
  text += kGap;
  appendYDifference(text, delta.valueY - partner.valueY, format);
}

}  // namespace frontpanels
