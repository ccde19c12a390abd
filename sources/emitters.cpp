#include "sources/emitters.h"

#include <algorithm>
#include <cmath>
#include <iterator>

#include "sources/portable_math.h"

namespace frontpanels {
namespace {

using enum Modulation;
using enum Origin;

// Emitters alike, a raster apart.
struct Raster {
  Emitter first;
  double spacingHz;
  int count;
};

constexpr Raster kRasters[] = {
    {{Carrier, Receiver, 10e6, 0, -104, 0, 0, 1, 1}, 10e6, 599},  // the reference and its harmonics
    {{Carrier, Land, 1.26e6, 0, -72, 20, 0, 1, 1}, 90e3, 4},
    {{WideFm, Land, 88.9e6, 150e3, -62, 0, 0, 1, 1}, 1.6e6, 12},
    {{Carrier, Land, 113.3e6, 0, -84, 100, 0, 1, 1}, 2.1e6, 2},
    {{NarrowFm, Land, 154.25e6, 11e3, -88, 400, 6, 0.5, 1}, 360e3, 8},
    {{NarrowFm, Land, 460.1e6, 11e3, -86, 600, 5, 0.5, 1}, 225e3, 12},
    {{Ofdm, Land, 521e6, 5.38e6, -58, 0, 0, 1, 1}, 12e6, 6},
    {{Ofdm, Network, 751e6, 9e6, 52, 0, 0, 1, 1}, 0, 1},
    // Cellular uplink: telephones on the channels of the downlink, 45 MHz below it.
    {{NarrowFm, Mobile, 825.45e6, 16e3, -78, 300, 12, 0.4, 1}, 630e3, 10},
    {{Cdma, Mobile, 832.26e6, kCdmaWidthHz, -88, 0, 15, 0.7, 1}, 1.23e6, 2},
    {{Cdma, Mobile, 836.52e6, kCdmaWidthHz, -88, 0, 15, 0.7, 1}, 1.23e6, 3},
    {{Gsm, Mobile, 844.2e6, 200e3, -76, 0, 9, 0.5, 0.125}, 800e3, 5},
    // Cellular downlink.
    {{NarrowFm, Site, 870.45e6, 16e3, 44, 300, 12, 0.7, 1}, 630e3, 10},
    {{Cdma, Network, 877.26e6, kCdmaWidthHz, 55, 0, 0, 1, 1}, 1.23e6, 2},  // channels 242, 283
    {{Cdma, Network, 881.52e6, kCdmaWidthHz, 55, 0, 0, 1, 1}, 1.23e6, 3},  // channels 384, 425, 466
    {{Carrier, Land, 886.1e6, 0, -82, 60e3, 40, 0.6, 1}, 0, 1},            // an oscillator that wanders
    {{Ofdm, Network, 887.6e6, 1.08e6, 48, 0, 45, 0.8, 1}, 0, 1},
    {{Gsm, Site, 889.2e6, 200e3, 50, 0, 0, 1, 0.75}, 800e3, 5},
    // GSM 900, DCS 1800.
    {{Gsm, Mobile, 891.4e6, 200e3, -76, 0, 9, 0.5, 0.125}, 1.8e6, 12},
    {{Gsm, Site, 936.4e6, 200e3, 52, 0, 0, 1, 0.75}, 1.8e6, 12},
    {{Gsm, Mobile, 1712.6e6, 200e3, -80, 0, 9, 0.5, 0.125}, 3e6, 20},
    {{Gsm, Site, 1807.6e6, 200e3, 54, 0, 0, 1, 0.75}, 3e6, 20},
    // PCS: channels 25, 50 and 75, and behind them GSM.
    {{Cdma, Mobile, 1851.25e6, kCdmaWidthHz, -90, 0, 15, 0.7, 1}, 1.25e6, 3},
    {{Cdma, Network, 1931.25e6, kCdmaWidthHz, 57, 0, 0, 1, 1}, 1.25e6, 3},
    {{Gsm, Site, 1946.2e6, 200e3, 54, 0, 0, 1, 0.75}, 2.2e6, 18},
    // IMT-2000, wireless networks, radar.
    {{Ofdm, Mobile, 1925e6, 3.84e6, -86, 0, 12, 0.6, 1}, 10e6, 4},
    {{Ofdm, Network, 2115e6, 3.84e6, 57, 0, 0, 1, 1}, 10e6, 5},
    {{Ofdm, Mobile, 2412e6, 16.5e6, -74, 0, 3, 0.7, 0.4}, 25e6, 3},
    {{Ofdm, Network, 2630e6, 18e6, 58, 0, 0, 1, 1}, 20e6, 2},
    {{Ofdm, Network, 3500e6, 38e6, 60, 0, 0, 1, 1}, 60e6, 2},
    {{Ofdm, Mobile, 5180e6, 16.5e6, -78, 0, 3, 0.6, 0.4}, 60e6, 5},
};

// A modulation's density, by the distance from the centre in widths; in dB, straight in between.
struct ShapePoint {
  double widths;
  double dB;
};
constexpr ShapePoint kNarrowFmShape[] = {{0, 0}, {0.25, -3}, {0.5, -12}, {0.8, -35}, {1.2, -60}};
constexpr ShapePoint kWideFmShape[] = {{0, 0}, {0.2, -2}, {0.5, -15}, {0.7, -40}, {1.0, -65}};
// The filter of the base station: flat to 590 kHz, down by 40 dB at 740 kHz, and what its amplifier adds
// beside.
constexpr ShapePoint kCdmaShape[] = {{0, 0},       {0.480, 0},   {0.500, -3}, {0.530, -12},
                                     {0.602, -40}, {0.732, -45}, {1.1, -52},  {1.61, -64}};
// Gaussian minimum shift keying of 271 kbit/s.
constexpr ShapePoint kGsmShape[] = {{0, 0},   {0.25, -2}, {0.5, -9}, {0.75, -22},
                                    {1, -34}, {1.5, -52}, {2, -62}};
constexpr ShapePoint kOfdmShape[] = {{0, 0}, {0.498, 0}, {0.505, -22}, {0.55, -36}, {0.7, -44}, {1, -56}};

std::span<const ShapePoint> pointsOf(Modulation modulation) {
  switch (modulation) {
    case NarrowFm:
      return kNarrowFmShape;
    case WideFm:
      return kWideFmShape;
    case Cdma:
      return kCdmaShape;
    case Gsm:
      return kGsmShape;
    case Ofdm:
      return kOfdmShape;
    case Carrier:
      break;
  }
  return {};
}

double densityDb(std::span<const ShapePoint> points, double widths) {
  std::size_t next = 1;
  while (next + 1 < points.size() && points[next].widths < widths) ++next;
  const ShapePoint& from = points[next - 1];
  const ShapePoint& to = points[next];
  return from.dB + (to.dB - from.dB) * (widths - from.widths) / (to.widths - from.widths);
}

}  // namespace

std::vector<Emitter> emitters() {
  std::vector<Emitter> all;
  for (const Raster& raster : kRasters)
    for (int i = 0; i < raster.count; ++i) {
      all.push_back(raster.first);
      all.back().centerHz += i * raster.spacingHz;
    }
  return all;
}

SpectrumShape shapeOf(Modulation modulation, double widthHz) {
  constexpr int kSlices = 129;
  const std::span<const ShapePoint> points = pointsOf(modulation);
  if (points.empty()) return {0, 0, {1.0}};
  const double edgeHz = points.back().widths * widthHz;
  SpectrumShape shape{-edgeHz, 2 * edgeHz / (kSlices - 1), {}};
  double sum = 0;
  for (int slice = 0; slice < kSlices; ++slice) {
    const double offsetHz = shape.firstHz + slice * shape.sliceHz;
    shape.shares.push_back(fromDecibels(densityDb(points, std::fabs(offsetHz) / widthHz)));
    sum += shape.shares.back();
  }
  for (double& share : shape.shares) share /= sum;
  return shape;
}

}  // namespace frontpanels
