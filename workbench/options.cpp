#include "workbench/options.h"

#include <charconv>

namespace frontpanels::workbench {
namespace {

const std::string& argumentOf(const std::vector<std::string>& arguments, std::size_t& place) {
  const std::string& option = arguments[place];
  if (++place == arguments.size() || arguments[place].empty()) throw UsageError(option + " needs a value");
  return arguments[place];
}

std::uint64_t countFrom(const std::string& text) {
  std::uint64_t count = 0;
  const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), count);
  if (error != std::errc() || end != text.data() + text.size() || count == 0)
    throw UsageError("--sweeps needs a number from 1, not \"" + text + "\"");
  return count;
}

}  // namespace

Options parseOptions(const std::vector<std::string>& arguments) {
  Options options;
  for (std::size_t i = 0; i < arguments.size(); ++i) {
    const std::string& argument = arguments[i];
    if (argument == "--screenshots") {
      options.screenshotFolder = argumentOf(arguments, i);
    } else if (argument == "--sweeps") {
      options.sweeps = countFrom(argumentOf(arguments, i));
    } else if (argument == "--exit") {
      options.exit = true;
    } else if (argument == "--help") {
      options.help = true;
    } else if (argument.starts_with("--")) {
      throw UsageError("unknown option " + argument);
    } else if (!options.recording.empty()) {
      throw UsageError("one recording at a time: \"" + options.recording + "\" and \"" + argument + "\"");
    } else if (argument.empty()) {
      throw UsageError("the recording's name is empty");
    } else {
      options.recording = argument;
    }
  }
  return options;
}

}  // namespace frontpanels::workbench
