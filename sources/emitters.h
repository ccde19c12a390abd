// What transmits between 0 and 6 GHz on the simulated drive.
#pragma once

#include <cstdint>
#include <span>
#include <vector>

namespace frontpanels {

enum class Modulation : std::uint8_t { Carrier, NarrowFm, WideFm, Cdma, Gsm, Ofdm };
// Where its power comes from.
enum class Origin : std::uint8_t {
  Receiver,  // itself: as strong wherever it is
  Land,      // the land far around: as strong but under a roof
  Network,   // every sector of every site
  Site,      // one site
  Mobile,    // somebody near by, another one each time
};

struct Emitter {
  Modulation modulation;
  Origin origin;
  double centerHz;
  double widthHz;  // of the modulation; 0 of a carrier
  double dBm;      // radiated by a sector of Network and Site, else received on the average
  double driftHz;  // to either side
  double slotS;    // it is there or not for so long; 0: always there
  double share;    // of the slots in which it is there
  double burst;    // share of the time in which it transmits when it is there
};

// Where pilots are.
inline constexpr double kCdmaWidthHz = 1.2288e6;

// In the order of their frequencies within their rasters.
[[nodiscard]] std::vector<Emitter> emitters();

// The power spectrum of a modulation as slices of one width beside each other, from the lowest frequency on.
struct SpectrumShape {
  double firstHz;  // the middle of the first slice, from the centre
  double sliceHz;
  std::vector<double> shares;  // of the power; 1 together
};
[[nodiscard]] SpectrumShape shapeOf(Modulation modulation, double widthHz);

}  // namespace frontpanels
