// Measures the scenes through one graphics interface and prints what came out.
#pragma once

#include <algorithm>
#include <cstdlib>
#include <functional>
#include <vector>

#include "platform/gdi.h"

namespace frontpanels::bench {

// The pixels of the view, for the proof that both ways draw the same picture.
using ReadPixels = std::function<std::vector<std::uint32_t>()>;

// Prints a row a scene, traces x points in their painter and at the end the whole panel: microseconds a frame
// as the framework and as bare calls draw it, the ratio, and heap allocations a frame. False when the two
// ways draw different pictures.
[[nodiscard]] bool reportPaintTraces(Gdi& gdi, DcHandle view, const ReadPixels& readPixels, int rounds);

// How often each way is measured: the program's argument, or enough for a steady median.
[[nodiscard]] inline int roundsFrom(int argc, char** argv) {
  return argc > 1 ? std::max(std::atoi(argv[1]), 1) : 201;
}

}  // namespace frontpanels::bench
