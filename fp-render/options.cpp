#include "fp-render/options.h"

#include <charconv>
#include <string_view>

namespace frontpanels {
namespace {

bool parseSweep(std::string_view text, RenderOptions& options) {
  std::uint64_t number = 0;
  const auto [stop, error] = std::from_chars(text.data(), text.data() + text.size(), number);
  if (error != std::errc{} || stop != text.data() + text.size() || number == 0) return false;
  options.sweep = number;
  return true;
}

}  // namespace

bool parseOptions(std::span<const char* const> arguments, RenderOptions& options, std::string& problem) {
  const auto wrong = [&problem](std::string text) {
    problem = std::move(text);
    return false;
  };
  bool optionsEnded = false;
  for (std::size_t i = 0; i < arguments.size(); ++i) {
    const std::string argument = arguments[i];
    if (optionsEnded || !argument.starts_with('-')) {
      if (!options.recording.empty()) return wrong("more than one recording");
      if (argument.empty()) return wrong("the recording's name is empty");
      options.recording = argument;
    } else if (argument == "--") {
      optionsEnded = true;
    } else if (argument == "--help" || argument == "-h") {
      options.help = true;
    } else if (argument == "--version") {
      options.version = true;
    } else if (argument == "-o" || argument == "--sweep") {
      if (++i == arguments.size()) return wrong(argument + " needs a value");
      const std::string value = arguments[i];
      if (argument == "-o" && value.empty()) return wrong("-o needs a folder");
      if (argument == "-o") options.directory = value;
      if (argument == "--sweep" && !parseSweep(value, options)) {
        return wrong("--sweep needs a number from 1 on, not \"" + value + "\"");
      }
    } else {
      return wrong("unknown option " + argument);
    }
  }
  if (options.recording.empty() && !options.help && !options.version) return wrong("no recording named");
  return true;
}

}  // namespace frontpanels
