// What a matched filter for the short code shows over the positions of the code: pilots' paths, each with the
// side lobes of the code, and noise. Its power is averaged over a few passes of the code.
#pragma once

#include <bitset>
#include <complex>
#include <cstddef>
#include <cstdint>
#include <span>
#include <vector>

#include "sources/short_code.h"

namespace frontpanels {

// A path of a pilot. The square of its amplitude is its Ec/Io.
struct CodeRay {
  double chips = 0;  // where in the code, 0 up to 32768
  std::complex<float> amplitude;
};

inline constexpr std::int32_t kPasses = 4;

class CodeProfile {
 public:
  explicit CodeProfile(std::uint64_t seed);

  // Another frame; the rays must outlive its use. `noise` is the mean of the filter's noise, an Ec/Io.
  void begin(std::uint64_t frame, std::span<const CodeRay> rays, double noise);

  struct Peak {
    double chips = 0;
    float level = 0;  // Ec/Io as a ratio
  };
  [[nodiscard]] float level(double chips);
  // The largest from a position up to another one, which does not belong to it: of whole chips and of where
  // paths are.
  [[nodiscard]] Peak peak(double fromChips, double toChips);

 private:
  // Of a chip, the mean of the filter's noise being 1: of a pass that has all of the pilots, and the power of
  // the other passes.
  struct Noise {
    std::complex<float> amplitude;
    float power = 0;
  };
  void fill(std::size_t block);
  void addSignal(const CodeRay& ray, double firstChips, std::span<std::complex<float>> sums) const;
  [[nodiscard]] const Noise& noiseAt(std::size_t chip);
  [[nodiscard]] float level(std::complex<float> signal, const Noise& noise) const;
  [[nodiscard]] bool reaches(const CodeRay& ray, double fromChips, double toChips) const;

  std::uint64_t seed_;
  std::uint64_t frame_ = 0;
  std::span<const CodeRay> rays_;
  float noise_ = 0;
  std::span<const std::complex<float>> correlation_;
  std::vector<std::complex<float>> units_;  // of all directions
  // By chip, as far as they were asked for.
  std::bitset<kPnOffsets> filled_;
  std::vector<Noise> noises_;
  std::vector<float> levels_;
};

}  // namespace frontpanels
