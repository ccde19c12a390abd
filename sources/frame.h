// One moment of a drive: what a receiver delivered together.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "sources/sweep.h"

namespace frontpanels {

// Energy over PN offset: of all pilots, or of a window of the code.
struct PilotLevels {
  float ioDbm = 0;            // total received power
  std::vector<float> ecIoDb;  // one an offset, gaps are not-a-number; of a window from its start on
};

// In the order in which pilots' records travel.
struct PilotRecord {
  float pnOffset = 0;
  float peakEcIoDb = 0;
  float delayChips = 0;
  float aggregateEcIoDb = 0;
  float delaySpreadChips = 0;
  float aggregateMinusPeakDb = 0;
  friend bool operator==(const PilotRecord&, const PilotRecord&) = default;
};

struct PilotBars {
  float ioDbm = 0;
  std::vector<PilotRecord> pilots;
};

struct CarrierState {
  double frequencyErrorHz = 0;
  std::int32_t frequencyState = 0;  // 0 searching, 1 settling, 2 locked
  double onePps = 0;                // 1 while the receiver has the reference, else 0
};

// Whatever was not measured is absent.
struct PilotFrame {
  std::optional<PilotLevels> allPilots;
  std::optional<PilotLevels> zoomedPilots;
  std::optional<PilotBars> topN;
  std::optional<PilotBars> userList;
  std::optional<CarrierState> carrier;
};

struct Frame {
  std::uint64_t number = 0;  // counted from 1 within its source
  std::string time;          // date and time, as the source words them
  std::optional<Sweep> sweep;
  std::optional<PilotFrame> pilots;
};

}  // namespace frontpanels
