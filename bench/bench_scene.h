// A picture that can be drawn in two ways: by the framework and as the bare list of its graphics calls.
#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "platform/geometry.h"

namespace frontpanels::bench {

inline constexpr Size kScenePx{800, 600};

class BenchScene {
 public:
  virtual ~BenchScene() = default;

  [[nodiscard]] virtual std::string name() const = 0;
  // Each draws the next of a few frames, so that every frame has new values.
  virtual void drawFramework() = 0;
  virtual void drawBare() = 0;
  // The frame that the bare picture was captured from, by either way, for a comparison of pixels.
  virtual void drawFrameworkAgain() = 0;
  virtual void drawBareAgain() = 0;
};

// A noise floor in dBm with a few carriers, other noise in each frame.
[[nodiscard]] std::vector<std::vector<float>> noisyFrames(std::size_t frames, std::size_t points);

}  // namespace frontpanels::bench
