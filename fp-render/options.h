// The command line of fp-render.
#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <vector>

#include "fp-render/option_values.h"

namespace frontpanels {

// Where a marker is to stand, as it was given: the unit is that of the panel, which the recording may choose.
struct MarkerPlace {
  std::string place;
  std::optional<std::string> delta;  // of its delta marker
  friend bool operator==(const MarkerPlace&, const MarkerPlace&) = default;
};

struct RenderOptions {
  bool help = false;
  bool version = false;

  // What is drawn: one of the first two.
  std::string recording;
  std::optional<std::uint64_t> seed;  // of a simulated drive
  std::optional<std::uint64_t> frames;
  std::optional<PanelKind> panel;  // by what the recording holds when absent
  FrameRange range;
  std::uint64_t every = 1;
  std::optional<ShownSets> sets;  // those that the recording holds when absent

  // Where to.
  std::string directory = ".";
  std::string name;  // of the pictures; the recording's when empty
  bool overwrite = false;

  // How it looks.
  Size sizePx{800, 600};
  std::int32_t dpi = 96;
  bool fields = false;
  std::optional<std::string> caption;
  std::optional<double> centerHz;
  std::optional<double> spanHz;
  std::optional<double> topDb;
  std::optional<double> dbPerDivision;
  std::vector<MarkerPlace> markers;
  bool peak = false;
  std::string settingsFile;
  std::optional<std::uint64_t> setUp;
  std::vector<StoredSetting> settings;  // behind those of the file
};

// `arguments` are those after the program's name. False, with the reason in `problem`, when they make no
// sense.
[[nodiscard]] bool parseOptions(std::span<const char* const> arguments, RenderOptions& options,
                                std::string& problem);
// Why the options make no sense for a panel; empty when they do.
[[nodiscard]] std::string problemWith(const RenderOptions& options, PanelKind panel);

[[nodiscard]] std::string renderUsage();

}  // namespace frontpanels
