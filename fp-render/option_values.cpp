#include "fp-render/option_values.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <iterator>

#include "entry/entry_text.h"
#include "entry/numeric_entry.h"
#include "pilot/code_units.h"

namespace frontpanels {
namespace {

template <class Number>
bool readWhole(std::string_view text, Number& number) {
  const auto [stop, error] = std::from_chars(text.data(), text.data() + text.size(), number);
  return error == std::errc{} && stop == text.data() + text.size();
}

// What stands before the first `separator`, taken out of the text with it; all of a text that has none.
std::string_view takeUntil(std::string_view& text, char separator) {
  const std::size_t at = text.find(separator);
  const std::string_view front = text.substr(0, at);
  text.remove_prefix(at == std::string_view::npos ? text.size() : at + 1);
  return front;
}

bool within(Size size, Size least, Size most) {
  return size.width >= least.width && size.width <= most.width && size.height >= least.height &&
         size.height <= most.height;
}

// Settings of a panel are written with a point, whoever runs the program.
std::optional<double> entered(std::string_view text, void (clsNumericEntry::*addUnits)()) {
  clsNumericEntry units;
  (units.*addUnits)();
  return parseEntryText(text, units.suffixes(), 1, ".");
}

struct SetName {
  std::string_view name;
  PilotSet set;
};
constexpr SetName kSetNames[] = {{"all", PilotSet::AllPilots},
                                 {"zoomed", PilotSet::ZoomedPilots},
                                 {"top", PilotSet::TopN},
                                 {"list", PilotSet::UserList}};

}  // namespace

std::optional<std::uint64_t> countOf(std::string_view text, std::uint64_t least, std::uint64_t most) {
  std::uint64_t number = 0;
  if (!readWhole(text, number) || number < least || number > most) return std::nullopt;
  return number;
}

std::optional<Size> pictureSizeOf(std::string_view text) {
  Size size;
  if (text.find('x') == std::string_view::npos || !readWhole(takeUntil(text, 'x'), size.width) ||
      !readWhole(text, size.height) || !within(size, kSmallestPicturePx, kLargestPicturePx))
    return std::nullopt;
  return size;
}

std::optional<FrameRange> frameRangeOf(std::string_view text) {
  FrameRange range;
  const bool open = text.find('-') != std::string_view::npos;
  const std::string_view first = takeUntil(text, '-');
  if (first.empty() && text.empty()) return std::nullopt;
  if (!first.empty()) {
    const auto number = countOf(first);
    if (!number) return std::nullopt;
    range.first = *number;
  }
  if (!open) {
    range.last = range.first;
  } else if (!text.empty()) {
    range.last = countOf(text);
    if (!range.last || *range.last < range.first) return std::nullopt;
  }
  return range;
}

std::optional<PanelKind> panelKindOf(std::string_view text) {
  for (const PanelKind panel : {PanelKind::Spectrum, PanelKind::Pilots})
    if (text == panelWord(panel)) return panel;
  return std::nullopt;
}

std::optional<ShownSets> pilotSetsOf(std::string_view text) {
  ShownSets sets{};
  if (text.ends_with(',')) return std::nullopt;
  do {
    const std::string_view name = takeUntil(text, ',');
    const auto* const row = std::find_if(std::begin(kSetNames), std::end(kSetNames),
                                         [name](const SetName& known) { return known.name == name; });
    if (row == std::end(kSetNames)) return std::nullopt;
    sets[static_cast<std::size_t>(row->set)] = true;
  } while (!text.empty());
  return sets;
}

std::optional<StoredSetting> settingOf(std::string_view text) {
  if (text.find('=') == std::string_view::npos) return std::nullopt;
  std::string_view place = takeUntil(text, '=');
  StoredSetting setting;
  double number = 0;
  setting.value = textToNumber(text, number) ? Variant(number) : Variant(std::string(text));
  const bool indexed = place.find(',') != std::string_view::npos;
  if (!readWhole(takeUntil(place, ','), setting.code) || setting.code < 1) return std::nullopt;
  if (indexed && !readWhole(place, setting.index)) return std::nullopt;
  return setting;
}

std::optional<double> frequencyHzOf(std::string_view text) {
  const std::optional<double> hertz = entered(text, &clsNumericEntry::frequencySuffix);
  return hertz && *hertz >= 0 ? hertz : std::nullopt;
}

std::optional<double> pnOffsetOf(std::string_view text) {
  const std::optional<double> offset = entered(text, &clsNumericEntry::offsetSuffix);
  return offset && *offset >= 0 && *offset < kPilotOffsets ? offset : std::nullopt;
}

std::optional<double> levelDbOf(std::string_view text) {
  const std::optional<double> level = entered(text, &clsNumericEntry::dBSuffix);
  return level ? level : entered(text, &clsNumericEntry::dBmSuffix);
}

}  // namespace frontpanels
