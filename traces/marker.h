// One marker on a trace point: a plain record with its drawing. Positions are pixels of the off-screen
// surface.
#pragma once

#include <cstdint>
#include <string>

#include "platform/gdi.h"

namespace frontpanels {

class clsMarker {
 public:
  std::int32_t positionX = 0;
  std::int32_t positionY = 0;
  std::int32_t positionY2 = 0;  // second end of multi and strip-chart markers
  std::int32_t point = 0;       // index of the trace point
  double valueX = 0;
  double valueY = 0;
  bool DELTA = false;
  bool active = false;
  std::string id;            // "1", "2", ...; a delta marker's is its partner's followed by "d"
  std::string deltaPartner;  // the partner's id, on both markers of a pair
  std::int16_t height = 12;
  std::int16_t width = 8;
  bool multiMarker = false;
  bool stripChartMarker = false;
  std::int16_t traceId = 0;

  // Drawn with the pen that is selected, or, when it is the active one, with a wider one of its own. Raises
  // "Overflow" when a corner leaves the 32-bit range.
  void draw(Gdi& gdi, DcHandle dc) const;
  // Writes the id beside the glyph with the font, colour and background mode that are set in `dc`.
  void drawId(Gdi& gdi, DcHandle dc) const;
  // What draw() covers, its lines' far ends included. Raises "Overflow" as draw() does.
  [[nodiscard]] Rect boundsPx() const;
};

// The id of a marker's delta partner: "3" gives "3d".
[[nodiscard]] std::string deltaMarkerId(const std::string& id);

}  // namespace frontpanels
