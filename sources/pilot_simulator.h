// Pilots of the simulated network as a scanner on the drive measures them.
#pragma once

#include <array>
#include <complex>
#include <cstdint>
#include <optional>
#include <vector>

#include "sources/code_profile.h"
#include "sources/drive_map.h"
#include "sources/frame.h"
#include "sources/tuning.h"

namespace frontpanels {

inline constexpr std::size_t kMostTopN = 32;

class PilotSimulator {
 public:
  // The map must outlive this.
  PilotSimulator(std::uint64_t seed, const DriveMap& map);

  // From frame `next` on; see DriveSimulator.
  void tune(const PilotTuning& tuning, std::uint64_t next);
  void measure(std::uint64_t frame, double timeS, PilotFrame& pilots);

 private:
  static constexpr std::size_t kWaves = 6;
  // Of a sector, to the road.
  struct Path {
    double delayChips = 0;  // behind the first path
    double wobbleChips = 0;
    double share = 0;  // of the sector's power
    double phase = 0;
    std::array<double, kWaves> angles{};  // of waves that arrive together, in turns
    std::array<double, kWaves> phases{};
  };
  struct Tuned {
    double overlap = 0;    // of the receiver's band with the nearest carrier's
    double coherence = 0;  // of the pilots' power, what is left after a detuned correlation
    double carrierHz = 0;
  };

  [[nodiscard]] Tuned nearestCarrier() const;
  void receive(double timeS);
  void receive(std::size_t sector, double drivenM, const Tuned& tuned);
  [[nodiscard]] PilotLevels allPilots();
  [[nodiscard]] PilotLevels zoomedPilots();
  [[nodiscard]] PilotBars topN();
  [[nodiscard]] PilotBars userList();
  [[nodiscard]] PilotRecord record(std::int32_t pn, const CodeProfile::Peak& peak);
  [[nodiscard]] const CodeProfile::Peak& peakOf(std::int32_t pn);
  [[nodiscard]] CarrierState carrier(std::uint64_t frame, double timeS) const;

  std::uint64_t seed_;
  const DriveMap& map_;
  PilotTuning tuning_;
  std::uint64_t tunedAt_ = 1;  // the first frame on this carrier
  std::vector<double> carriersHz_;
  std::array<std::vector<Path>, kSectors> paths_;

  CodeProfile profile_;
  // Of one frame
  std::vector<CodeRay> rays_;
  std::vector<std::optional<CodeProfile::Peak>> peaks_;  // by PN offset, as far as they were asked for
  double ioMw_ = 0;
  double pilotsMw_ = 0;
  bool heard_ = false;
};

}  // namespace frontpanels
