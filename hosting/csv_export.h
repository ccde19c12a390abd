// What a panel shows, as a table for other programs: comma-separated values with a head of "# name: value"
// lines. docs/exports.md shows each kind.
#pragma once

#include <span>
#include <string>
#include <utility>
#include <vector>

#include "hosting/setting_names.h"
#include "hosting/stored_setting.h"
#include "sources/frame.h"
#include "sources/resample.h"

namespace frontpanels {

// When, of what and with which settings, in this order.
struct ExportHeader {
  std::vector<std::pair<std::string, std::string>> entries;
};

// By name; a setting without one goes by its code.
void addSettings(ExportHeader& header, PanelKind panel, std::span<const StoredSetting> settings);

// Frequency in Hz and level in dB, a line a point from the left edge to the right one; a gap has no level.
[[nodiscard]] std::string sweepCsv(const ExportHeader& header, const DisplaySweep& sweep);

// A table for each set that the frame has, and for the carrier, parted by empty lines.
[[nodiscard]] std::string pilotsCsv(const ExportHeader& header, const PilotFrame& frame);

}  // namespace frontpanels
