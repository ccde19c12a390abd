#include "sources/drive_map.h"

#include <algorithm>
#include <cmath>
#include <complex>
#include <iterator>

#include "sources/portable_math.h"
#include "sources/random.h"

namespace frontpanels {
namespace {

// Purposes of random numbers.
constexpr std::uint64_t kPlacePurpose = 1;
constexpr std::uint64_t kShadowPurpose = 2;

constexpr double kSpeedMPerS = 14;
constexpr double kLapM = 9000;
constexpr MapPoint kRoadRadii{1700, 1150};

struct Obstacle {
  double fromM;
  double toM;
  double roofDb;
};
constexpr Obstacle kObstacles[] = {{2600, 3020, 25}, {6900, 6970, 3}};

constexpr const char* kNames[kSites] = {"Harbour",     "Old Mill", "Station",     "Brewery",
                                        "Water Tower", "Quarry",   "Town Hall",   "Orchard",
                                        "Lighthouse",  "Meadow",   "Observatory", "Depot"};
constexpr std::int32_t kNetworkIncrement = 4;
constexpr std::int32_t kBetweenSectors = 168;  // PN offsets

constexpr double kShadowStepM = 10;
constexpr double kShadowLengthM = 50;
constexpr double kShadowDb = 7;
constexpr auto kShadowSteps = static_cast<std::size_t>(kLapM / kShadowStepM);

constexpr double kMastM = 30;
// Free space to 100 m, from there by the power 3.2 of the distance; houses and the car's roof.
constexpr double kFreeSpaceDb = 12.45;  // at 100 m and 1 MHz
constexpr double kDbPerDecade = 32;
constexpr double kClutterDb = 18;
constexpr double kFrontToBackDb = 20;
constexpr double kPatternDb = 18.66;  // 12 dB at 65 degrees, by 1 less the cosine

double decades(double ratio) noexcept { return toDecibels(ratio) / 10; }

// Of a way too long to be told to the metre somewhere on the loop.
double lapM(double drivenM) noexcept {
  return std::clamp(drivenM - kLapM * std::floor(drivenM / kLapM), 0.0, kLapM);
}

// Neighbours are correlated by exp(-distance / 50 m), round the loop: the first lap only runs it in.
std::vector<float> shadowAlong(std::uint64_t seed, std::uint64_t site) {
  const double kept = portableExp(-kShadowStepM / kShadowLengthM);
  const double added = kShadowDb * std::sqrt(1 - kept * kept);
  std::vector<float> shadow(kShadowSteps);
  double level = 0;
  for (std::size_t step = 0; step < 2 * kShadowSteps; ++step) {
    Random random(seed, kShadowPurpose, site, step % kShadowSteps);
    level = kept * level + added * random.normal();
    shadow[step % kShadowSteps] = static_cast<float>(level);
  }
  return shadow;
}

}  // namespace

DriveMap::DriveMap(std::uint64_t seed) {
  constexpr double kFarthestM = 600;
  for (std::size_t i = 0; i < kSites; ++i) {
    Random random(seed, kPlacePurpose, i);
    Site& site = sites_[i];
    const double along = (static_cast<double>(i) + 0.2 + 0.6 * random.uniform()) / kSites;
    const double aside = kFarthestM * (2 * random.uniform() - 1);
    const MapPoint road = place(along * kLapM);
    const std::complex<double> out = portableTurn(along);
    site.place = {road.eastM + aside * out.real(), road.northM + aside * out.imag()};
    const double turned = random.uniform() / kSectorsOfSite;
    for (std::size_t sector = 0; sector < kSectorsOfSite; ++sector) {
      const std::complex<double> way = portableTurn(turned + static_cast<double>(sector) / kSectorsOfSite);
      site.directions[sector] = {way.real(), way.imag()};
      names_[i * kSectorsOfSite + sector] = {kNetworkIncrement * static_cast<std::int32_t>(i + 1) +
                                                 kBetweenSectors * static_cast<std::int32_t>(sector),
                                             std::string(kNames[i]) + " " + std::to_string(sector + 1)};
    }
    site.shadowDb = shadowAlong(seed, i);
  }
}

// --- The road

double DriveMap::drivenM(double timeS) noexcept { return kSpeedMPerS * timeS; }

MapPoint DriveMap::place(double drivenM) noexcept {
  const std::complex<double> way = portableTurn(lapM(drivenM) / kLapM);
  return {kRoadRadii.eastM * way.real(), kRoadRadii.northM * way.imag()};
}

double DriveMap::roofDb(double drivenM) noexcept {
  const double at = lapM(drivenM);
  for (const Obstacle& obstacle : kObstacles)
    if (at >= obstacle.fromM && at < obstacle.toM) return obstacle.roofDb;
  return 0;
}

DriveMap::Sky DriveMap::sky(double timeS) noexcept {
  const double driven = drivenM(timeS);
  Sky sky;
  double nearestM = driven;  // behind
  for (const Obstacle& obstacle : kObstacles) {
    const double behindM = lapM(driven - obstacle.fromM);
    if (behindM > nearestM || behindM > driven) continue;
    nearestM = behindM;
    const double lengthM = obstacle.toM - obstacle.fromM;
    sky.hidden = behindM < lengthM;
    sky.hiddenS = std::min(behindM, lengthM) / kSpeedMPerS;
    sky.sinceVisibleS = sky.hidden ? 0 : (behindM - lengthM) / kSpeedMPerS;
  }
  return sky;
}

// --- What is received

double DriveMap::distanceM(std::size_t sector, double drivenM) const noexcept {
  const MapPoint& from = sites_[sector / kSectorsOfSite].place;
  const MapPoint at = place(drivenM);
  const double east = at.eastM - from.eastM;
  const double north = at.northM - from.northM;
  return std::sqrt(east * east + north * north + kMastM * kMastM);
}

double DriveMap::shadowDb(const Site& site, double drivenM) const noexcept {
  const double at = lapM(drivenM) / kShadowStepM;
  const auto step = std::min(static_cast<std::size_t>(at), kShadowSteps - 1);
  const double part = at - static_cast<double>(step);
  const auto from = static_cast<double>(site.shadowDb[step]);
  const auto to = static_cast<double>(site.shadowDb[(step + 1) % kShadowSteps]);
  return from + part * (to - from);
}

double DriveMap::gainDb(std::size_t sector, double drivenM, double frequencyHz) const noexcept {
  const Site& site = sites_[sector / kSectorsOfSite];
  const MapPoint& direction = site.directions[sector % kSectorsOfSite];
  const MapPoint at = place(drivenM);
  const double distance = distanceM(sector, drivenM);
  const double towards =
      ((at.eastM - site.place.eastM) * direction.eastM + (at.northM - site.place.northM) * direction.northM) /
      distance;
  const double antennaDb = -std::min(kPatternDb * (1 - towards), kFrontToBackDb);
  const double lossDb = kFreeSpaceDb + 20 * decades(std::max(frequencyHz / 1e6, 1.0)) +
                        kDbPerDecade * decades(distance / 100) + kClutterDb;
  return antennaDb - lossDb + shadowDb(site, drivenM) - roofDb(drivenM);
}

}  // namespace frontpanels
