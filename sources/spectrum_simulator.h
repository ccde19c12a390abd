// Sweeps of a spectrum analyser on the simulated drive.
#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "sources/drive_map.h"
#include "sources/emitters.h"
#include "sources/noisy_power.h"
#include "sources/sweep.h"
#include "sources/tuning.h"

namespace frontpanels {

inline constexpr double kThermalMwPerHz = 4.0038821e-18;  // Boltzmann's constant times 290 K
inline constexpr double kNoiseFigureDb = 10;
inline constexpr double kNarrowIfHz = 30e3;  // a resolution bandwidth is no wider than the narrow IF

class SpectrumSimulator {
 public:
  // The map must outlive this.
  SpectrumSimulator(std::uint64_t seed, const DriveMap& map);

  // See DriveSimulator.
  void tune(const SpectrumTuning& tuning);
  // Frequencies and levels in dBm.
  void measure(std::uint64_t frame, double timeS, Sweep& sweep);

 private:
  // What the cells see of an emitter of power 1.
  struct Footprint {
    std::size_t emitter = 0;
    std::size_t firstCell = 0;
    std::vector<double> gains;
  };
  [[nodiscard]] bool moves(const Emitter& emitter) const noexcept;
  void place(Footprint& footprint, double centerHz) const;
  [[nodiscard]] double gain(const SpectrumShape& shape, double offsetHz) const;
  [[nodiscard]] bool isPresent(std::size_t emitter, double timeS) const;
  [[nodiscard]] double powerMw(std::size_t emitter, double timeS) const;
  [[nodiscard]] double onShare(std::size_t emitter, std::uint64_t frame, std::size_t cell) const;
  void add(const Footprint& footprint, std::uint64_t frame, double timeS);

  std::uint64_t seed_;
  const DriveMap& map_;
  std::vector<Emitter> emitters_;
  std::vector<SpectrumShape> shapes_;
  std::vector<std::size_t> emitterShapes_;  // by emitter, its shape

  double startHz_ = 0;
  double stepHz_ = 1;
  double filterHz_ = 1;  // standard deviation of the filter's power response
  Averaging averaging_ = Averaging::Power;
  std::int32_t looks_ = 1;
  std::vector<Footprint> footprints_;  // of those that may be seen
  std::vector<double> steadyMw_;       // by cell, while a sweep is being put together
  std::vector<double> noiseMw_;
};

}  // namespace frontpanels
