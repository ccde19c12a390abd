// What a marker reads, as text: its number, its place on the x axis and its level, each with its unit.
#pragma once

#include <string>
#include <string_view>

#include "entry/numeric_entry.h"
#include "traces/marker.h"

namespace frontpanels {

struct ReadoutFormat {
  const clsNumericEntry& x;
  const clsNumericEntry& y;
  std::string_view xMarkerFormat;  // empty: no finer than the points lie apart
  std::string_view yMarkerFormat;
  double pointSpacing = 0;  // in x units
};

// The same in parts, for a table.
struct MarkerReading {
  std::string id;
  std::string x;
  std::string y;
  friend bool operator==(const MarkerReading&, const MarkerReading&) = default;
};
[[nodiscard]] MarkerReading markerReading(const clsMarker& marker, const ReadoutFormat& format);

// Of a delta marker: "+200 kHz" and "-3.4 dB", its values less its partner's.
[[nodiscard]] MarkerReading deltaReading(const clsMarker& delta, const clsMarker& partner,
                                         const ReadoutFormat& format);

// "1  98.1 MHz  -43.2 dBm"
void appendReadout(std::string& text, const clsMarker& marker, const ReadoutFormat& format);
// "1  -43.2 dBm"
void appendLevelReadout(std::string& text, const clsMarker& marker, const ReadoutFormat& format);
// "1d  +200 kHz  -3.4 dB": the delta marker's values less its partner's, from the stored values.
void appendDeltaReadout(std::string& text, const clsMarker& delta, const clsMarker& partner,
                        const ReadoutFormat& format);

}  // namespace frontpanels
