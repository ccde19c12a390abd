#include "workbench/options.h"

#include <algorithm>
#include <charconv>
#include <iterator>

namespace frontpanels::workbench {
namespace {

std::uint64_t numberFrom(const std::string& option, const std::string& text, std::uint64_t lowest) {
  std::uint64_t number = 0;
  const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
  if (error != std::errc() || end != text.data() + text.size() || number < lowest)
    throw UsageError(option + " needs a number from " + std::to_string(lowest) + ", not \"" + text + "\"");
  return number;
}

std::vector<PanelKind> panelsFrom(const std::string& list) {
  std::vector<PanelKind> panels;
  for (std::size_t begin = 0; begin <= list.size();) {
    const std::size_t end = std::min(list.find(',', begin), list.size());
    const std::string word = list.substr(begin, end - begin);
    const std::optional<PanelKind> panel = panelOfWord(word);
    if (!panel || panelWord(*panel) != word)
      throw UsageError("--panels knows spectrum and pilots, not \"" + word + "\"");
    if (std::find(panels.begin(), panels.end(), *panel) == panels.end()) panels.push_back(*panel);
    begin = end + 1;
  }
  return panels;
}

struct ValueOption {
  const char* name;
  void (*take)(Options& options, const std::string& value);
};

constexpr ValueOption kValueOptions[] = {
    {"--simulate", [](Options& o, const std::string& v) { o.simulate = numberFrom("--simulate", v, 0); }},
    {"--panels", [](Options& o, const std::string& v) { o.panels = panelsFrom(v); }},
    {"--settings", [](Options& o, const std::string& v) { o.settingsFile = v; }},
    {"--record", [](Options& o, const std::string& v) { o.record = v; }},
    {"--screenshots", [](Options& o, const std::string& v) { o.screenshotFolder = v; }},
    {"--exports", [](Options& o, const std::string& v) { o.exportFolder = v; }},
    {"--sweeps", [](Options& o, const std::string& v) { o.sweeps = numberFrom("--sweeps", v, 1); }},
};

void takeRecording(Options& options, const std::string& argument) {
  if (!options.recording.empty())
    throw UsageError("one recording at a time: \"" + options.recording + "\" and \"" + argument + "\"");
  if (argument.empty()) throw UsageError("the recording's name is empty");
  options.recording = argument;
}

}  // namespace

Options parseOptions(const std::vector<std::string>& arguments) {
  Options options;
  for (std::size_t i = 0; i < arguments.size(); ++i) {
    const std::string& argument = arguments[i];
    const auto* const row = std::find_if(std::begin(kValueOptions), std::end(kValueOptions),
                                         [&argument](const ValueOption& o) { return argument == o.name; });
    if (row != std::end(kValueOptions)) {
      if (++i == arguments.size() || arguments[i].empty()) throw UsageError(argument + " needs a value");
      row->take(options, arguments[i]);
    } else if (argument == "--exit") {
      options.exit = true;
    } else if (argument == "--help") {
      options.help = true;
    } else if (argument.starts_with("--")) {
      throw UsageError("unknown option " + argument);
    } else {
      takeRecording(options, argument);
    }
  }
  if (options.simulate && !options.recording.empty())
    throw UsageError("either a recording or a simulated drive, not both");
  if (options.simulate && options.exit && !options.sweeps)
    throw UsageError("a simulated drive has no end: --exit needs --sweeps as well");
  return options;
}

}  // namespace frontpanels::workbench
