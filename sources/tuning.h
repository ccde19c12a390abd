// What panels ask a receiver for, as values.
#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "framework/support/enumerated_tables.h"
#include "sources/resample.h"

namespace frontpanels {

// From the beginning: the downlink of the cellular band.
struct SpectrumTuning {
  double centerHz = 881.5e6;
  double spanHz = 25e6;
  double rbwHz = 100e3;
  double periodS = 1;                  // from sweep to sweep
  std::size_t points = kDisplayCells;  // of a sweep
  bool narrowIf = false;
  std::int16_t averageType = kAveragingOff;
  std::int32_t averageCount = 10;
  bool averageLogPower = true;

  friend bool operator==(const SpectrumTuning&, const SpectrumTuning&) = default;
};

// From the beginning: CDMA channel 384 of the cellular band, every set, the whole code.
struct PilotTuning {
  double carrierHz = 881.52e6;
  double periodS = 1;           // from frame to frame
  std::int32_t codeFormat = 0;  // 0 IS-95B, 1 CDMA2000 1X, 2 CDMA2000 3X
  double codeStart = 0;         // the window of the code, in chips of the format
  double codeSpan = 32767;
  bool allPilots = true;
  bool zoomedPilots = true;
  bool topN = true;
  bool userList = true;
  std::vector<std::int32_t> userPns;  // PN offsets, 0 to 511
  double pnIncrement = 1;             // from one PN offset that is searched to the next

  friend bool operator==(const PilotTuning&, const PilotTuning&) = default;
};

}  // namespace frontpanels
