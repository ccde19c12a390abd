#include "fp-render/options.h"

#include <algorithm>
#include <iterator>
#include <string_view>

namespace frontpanels {
namespace {

// False when the value cannot be taken.
using Take = bool (*)(RenderOptions& options, const std::string& value);

struct OptionRow {
  const char* name;
  const char* value;  // what help calls it; null for an option without one
  const char* needs;  // goes on from "--option needs "
  Take take;
  const char* help;  // lines behind the first are indented by whoever writes them
};

template <auto RenderOptions::*member, auto parse>
bool takeParsed(RenderOptions& options, const std::string& value) {
  const auto parsed = parse(value);
  if (parsed) options.*member = *parsed;
  return parsed.has_value();
}

template <auto RenderOptions::*member>
bool takeText(RenderOptions& options, const std::string& value) {
  options.*member = value;
  return !value.empty();
}

template <bool RenderOptions::*member>
bool takeFlag(RenderOptions& options, const std::string& /*value*/) {
  return options.*member = true;
}

std::optional<std::uint64_t> positive(std::string_view text) { return countOf(text); }
std::optional<std::uint64_t> seedOf(std::string_view text) { return countOf(text, 0); }
std::optional<FrameRange> oneFrame(std::string_view text) {
  const auto number = countOf(text);
  if (!number) return std::nullopt;
  return FrameRange{*number, *number};
}
std::optional<std::int32_t> dotsOf(std::string_view text) {
  for (const std::int32_t dpi : {96, 144, 192})
    if (text == std::to_string(dpi)) return dpi;
  return std::nullopt;
}
std::optional<double> above0(std::optional<double> number) {
  return number && *number > 0 ? number : std::nullopt;
}
std::optional<double> spanHzOf(std::string_view text) { return above0(frequencyHzOf(text)); }
std::optional<double> perDivisionOf(std::string_view text) { return above0(levelDbOf(text)); }

// A name is no path: it must not lead out of the folder.
bool takeName(RenderOptions& options, const std::string& value) {
  options.name = value;
  return !value.empty() && value.find_first_of("/\\") == std::string::npos;
}

bool takeCaption(RenderOptions& options, const std::string& value) {
  options.caption = value;
  return true;
}

bool isPlace(std::string_view text) { return frequencyHzOf(text) || pnOffsetOf(text); }

bool takeMarker(RenderOptions& options, const std::string& value) {
  options.markers.push_back({value, std::nullopt});
  return isPlace(value);
}

bool takeDelta(RenderOptions& options, const std::string& value) {
  if (options.markers.empty() || options.markers.back().delta) return false;
  options.markers.back().delta = value;
  return isPlace(value);
}

bool takeSetting(RenderOptions& options, const std::string& value) {
  const auto setting = settingOf(value);
  if (setting) options.settings.push_back(*setting);
  return setting.has_value();
}

constexpr const char* kFrequency = "a frequency like 98.1M";
constexpr const char* kLevel = "a number of dB";
constexpr const char* kCount = "a number from 1 on";

const OptionRow kRows[] = {
    {"--panel", "PANEL", "spectrum or pilots", takeParsed<&RenderOptions::panel, panelKindOf>,
     "spectrum or pilots (default: what the recording holds; spectrum where it holds both)"},
    {"--simulate", "SEED", "a number", takeParsed<&RenderOptions::seed, seedOf>,
     "a simulated drive in place of a recording; the same seed gives the same pictures"},
    {"--frames", "N", kCount, takeParsed<&RenderOptions::frames, positive>,
     "how long the simulated drive is (default: as far as --sweeps goes, else 1)"},
    {"--sweeps", "A-B", "a range like 5-9, 5- or -9 that begins at 1 or later",
     takeParsed<&RenderOptions::range, frameRangeOf>,
     "these sweeps or frames alone, counted from 1; A- and -B leave one end open"},
    {"--sweep", "N", kCount, takeParsed<&RenderOptions::range, oneFrame>, "this one alone"},
    {"--every", "N", kCount, takeParsed<&RenderOptions::every, positive>,
     "of those every Nth, from the first one on"},
    {"--sets", "LIST", "a list of all, zoomed, top and list", takeParsed<&RenderOptions::sets, pilotSetsOf>,
     "pilots: the sets to show, of all, zoomed, top and list (default: those recorded)"},
    {"-o", "DIR", "a folder", takeText<&RenderOptions::directory>,
     "where the pictures go; created when absent (default: the current folder)"},
    {"--name", "NAME", "a name that is no path", takeName,
     "what they are called before their number (default: as the recording)"},
    {"--overwrite", nullptr, nullptr, takeFlag<&RenderOptions::overwrite>,
     "replace pictures that are there; without it they stay and drawing ends"},
    {"--size", "WxH", "a size like 800x600, from 200x150 to 7680x4320",
     takeParsed<&RenderOptions::sizePx, pictureSizeOf>, "of a picture in pixels (default: 800x600)"},
    {"--scale", "DPI", "96, 144 or 192", takeParsed<&RenderOptions::dpi, dotsOf>,
     "dots an inch of the screen that it is for: 96, 144 or 192 (default: 96)"},
    {"--fields", nullptr, nullptr, takeFlag<&RenderOptions::fields>,
     "the whole panel with its fields (default: the graph alone)"},
    {"--caption", "TEXT", nullptr, takeCaption,
     "above the graph in place of name, number and time; no row for it when empty"},
    {"--center", "F", kFrequency, takeParsed<&RenderOptions::centerHz, frequencyHzOf>,
     "spectrum: centre of the graph"},
    {"--span", "F", "a frequency above 0 like 2M", takeParsed<&RenderOptions::spanHz, spanHzOf>,
     "spectrum: width of the graph"},
    {"--top", "DB", kLevel, takeParsed<&RenderOptions::topDb, levelDbOf>,
     "level at the top of the graph (default: one that fits all of the recording)"},
    {"--per-division", "DB", "a number of dB above 0",
     takeParsed<&RenderOptions::dbPerDivision, perDivisionOf>,
     "levels of one of its ten divisions (default: likewise)"},
    {"--marker", "AT", "a frequency or a PN offset", takeMarker,
     "a marker at a frequency, or at a PN offset; as often as wanted"},
    {"--delta", "AT", "a frequency or a PN offset, and a --marker before it", takeDelta,
     "a delta marker for the --marker before it"},
    {"--peak", nullptr, nullptr, takeFlag<&RenderOptions::peak>,
     "a marker at the highest level of each picture"},
    {"--settings", "FILE", "a file", takeText<&RenderOptions::settingsFile>,
     "how the panel was set up in the workbench: its settings file"},
    {"--set-up", "N", kCount, takeParsed<&RenderOptions::setUp, positive>,
     "the set-up of that number, out of this file"},
    {"--set", "CODE[,INDEX]=VALUE", "CODE=VALUE or CODE,INDEX=VALUE", takeSetting,
     "a setting as a host sends it: codes in docs/host-contract.md; as often as wanted"},
    {"--version", nullptr, nullptr, takeFlag<&RenderOptions::version>, "the version"},
    {"--help", nullptr, nullptr, takeFlag<&RenderOptions::help>, "this text"},
};

constexpr const char* kUsageHead =
    "usage: fp-render RECORDING [OPTION]...\n"
    "       fp-render --simulate SEED [OPTION]...\n"
    "\n"
    "Draws what a recording holds as the panels show it: a PNG picture for each sweep, or each frame of "
    "pilots,\n"
    "named after the recording, all on the same vertical scale.\n"
    "\n";

constexpr const char* kUsageTail =
    "\n"
    "Frequencies are in Hz, or with a unit or its beginning: 98100000, 98.1MHz, 98.1M.\n"
    "\n"
    "examples:\n"
    "  fp-render fm.csv -o pictures --center 98M --span 4M --peak\n"
    "  fp-render drive.fpcap -o pictures --panel pilots --sets all,top --sweeps 100-200 --every 10\n"
    "\n"
    "exit codes:\n"
    "  0  all pictures were drawn\n"
    "  1  none was drawn\n"
    "  2  the command line is wrong\n"
    "  3  some were drawn, but something was wrong on the way; standard error says what\n";

const OptionRow* findOption(std::string_view name) {
  if (name == "-h") name = "--help";
  const auto* const row = std::find_if(std::begin(kRows), std::end(kRows),
                                       [name](const OptionRow& known) { return known.name == name; });
  return row == std::end(kRows) ? nullptr : row;
}

class CommandLine {
 public:
  CommandLine(std::span<const char* const> arguments, RenderOptions& options)
      : arguments_(arguments), options_(options) {}

  // What is wrong; empty when nothing is.
  std::string read() {
    bool optionsEnded = false;
    while (next_ < arguments_.size()) {
      const std::string argument = arguments_[next_++];
      std::string problem;
      if (!optionsEnded && argument == "--")
        optionsEnded = true;
      else if (!optionsEnded && argument.starts_with('-'))
        problem = readOption(argument);
      else
        problem = readRecording(argument);
      if (!problem.empty()) return problem;
    }
    return options_.help || options_.version ? std::string() : problemOfAll();
  }

 private:
  std::string readRecording(const std::string& argument) {
    if (!options_.recording.empty()) return "more than one recording";
    if (argument.empty()) return "the recording's name is empty";
    options_.recording = argument;
    return {};
  }

  std::string readOption(const std::string& argument) {
    const std::size_t equals = argument.starts_with("--") ? argument.find('=') : std::string::npos;
    const std::string name = argument.substr(0, equals);
    const OptionRow* const row = findOption(name);
    if (row == nullptr) return "unknown option " + name;
    std::string value;
    if (row->value == nullptr) {
      if (equals != std::string::npos) return name + " takes no value";
    } else if (equals != std::string::npos) {
      value = argument.substr(equals + 1);
    } else if (next_ < arguments_.size()) {
      value = arguments_[next_++];
    } else {
      return name + " needs a value";
    }
    if (row->take(options_, value)) return {};
    return name + " needs " + row->needs + ", not \"" + value + "\"";
  }

  [[nodiscard]] std::string problemOfAll() {
    if (options_.setUp && options_.settingsFile.empty()) return "--set-up goes with --settings";
    if (!options_.seed) {
      if (options_.recording.empty()) return "no recording named";
      if (options_.frames) return "--frames goes with --simulate";
      return {};
    }
    if (!options_.recording.empty()) return "--simulate stands in place of a recording";
    if (!options_.frames && !options_.range.last && options_.range.first > 1)
      return "a simulated drive has no end: --sweeps needs one, or --frames";
    return {};
  }

  std::span<const char* const> arguments_;
  RenderOptions& options_;
  std::size_t next_ = 0;
};

}  // namespace

bool parseOptions(std::span<const char* const> arguments, RenderOptions& options, std::string& problem) {
  problem = CommandLine(arguments, options).read();
  return problem.empty();
}

std::string problemWith(const RenderOptions& options, PanelKind panel) {
  const bool spectrum = panel == PanelKind::Spectrum;
  if (spectrum && options.sets) return "--sets is for pilots";
  if (!spectrum && options.centerHz) return "--center is for a spectrum";
  if (!spectrum && options.spanHz) return "--span is for a spectrum";
  const auto wrong = [spectrum](const char* option, const std::string& place) {
    if (spectrum ? frequencyHzOf(place).has_value() : pnOffsetOf(place).has_value()) return std::string();
    return std::string(option) +
           (spectrum ? " needs a frequency like 98.1M" : " needs a PN offset from 0 to 511") + ", not \"" +
           place + "\"";
  };
  for (const MarkerPlace& marker : options.markers) {
    std::string problem = wrong("--marker", marker.place);
    if (problem.empty() && marker.delta) problem = wrong("--delta", *marker.delta);
    if (!problem.empty()) return problem;
  }
  return {};
}

std::string renderUsage() {
  constexpr std::size_t kColumn = 26;
  std::string usage = kUsageHead;
  for (const OptionRow& row : kRows) {
    std::string left = std::string("  ") + row.name;
    if (row.value != nullptr) left.append(" ").append(row.value);
    if (left.size() + 2 > kColumn) {
      usage += left + '\n';
      left.clear();
    }
    usage += left + std::string(kColumn - left.size(), ' ') + row.help + '\n';
  }
  return usage + kUsageTail;
}

}  // namespace frontpanels
