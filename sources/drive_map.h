// The land that the drive goes through: a loop of road, a dozen sites of three sectors beside it, a tunnel
// and a bridge. What is received where is a function of the place alone.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <span>
#include <string>
#include <vector>

namespace frontpanels {

inline constexpr std::size_t kSites = 12;
inline constexpr std::size_t kSectorsOfSite = 3;
inline constexpr std::size_t kSectors = kSites * kSectorsOfSite;

// Of a sector of a site.
struct SiteName {
  std::int32_t pnOffset = 0;
  std::string name;
  friend bool operator==(const SiteName&, const SiteName&) = default;
};

struct MapPoint {
  double eastM = 0;
  double northM = 0;
};

class DriveMap {
 public:
  // The sites stand, and the land shadows them, as the seed says.
  explicit DriveMap(std::uint64_t seed);

  [[nodiscard]] static double drivenM(double timeS) noexcept;
  [[nodiscard]] static MapPoint place(double drivenM) noexcept;
  // What the land over the road takes away.
  [[nodiscard]] static double roofDb(double drivenM) noexcept;
  // Since when the sky has been hidden, and for how long it was hidden last.
  struct Sky {
    bool hidden = false;
    double hiddenS = 0;        // of the present or the last obstacle, up to now
    double sinceVisibleS = 0;  // 0 while hidden
  };
  [[nodiscard]] static Sky sky(double timeS) noexcept;

  // By sector, those of a site beside each other.
  [[nodiscard]] std::span<const SiteName, kSectors> names() const noexcept { return names_; }
  // Between what a site radiates in its sector's direction and what is received at a place, dB below 0:
  // distance, antenna, shadows and the roof; no fading.
  [[nodiscard]] double gainDb(std::size_t sector, double drivenM, double frequencyHz) const noexcept;
  [[nodiscard]] double distanceM(std::size_t sector, double drivenM) const noexcept;

 private:
  struct Site {
    MapPoint place;
    std::array<MapPoint, kSectorsOfSite> directions;  // of length 1
    std::vector<float> shadowDb;                      // along the road
  };
  [[nodiscard]] double shadowDb(const Site& site, double drivenM) const noexcept;

  std::array<Site, kSites> sites_;
  std::array<SiteName, kSectors> names_;
};

}  // namespace frontpanels
