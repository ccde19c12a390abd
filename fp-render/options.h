// The command line of fp-render.
#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string>

namespace frontpanels {

struct RenderOptions {
  bool help = false;
  bool version = false;
  std::string recording;
  std::string directory = ".";
  std::optional<std::uint64_t> sweep;  // counted from 1; all when absent
};

inline constexpr const char* kRenderUsage =
    "usage: fp-render RECORDING [-o DIR] [--sweep N]\n"
    "\n"
    "Draws the sweeps of a recording of rtl_power or hackrf_sweep as the spectrum panel shows them: one PNG\n"
    "picture a sweep, named after the recording, all on the same vertical scale.\n"
    "\n"
    "  -o DIR      where the pictures go; created when absent (default: the current directory)\n"
    "  --sweep N   this sweep alone, counted from 1\n"
    "  --help      this text\n"
    "  --version   the version\n"
    "\n"
    "The exit code is 0 when a picture was drawn, 1 when none was, 2 when the command line is wrong.\n";

// `arguments` are those after the program's name. False, with the reason in `problem`, when they make no
// sense.
[[nodiscard]] bool parseOptions(std::span<const char* const> arguments, RenderOptions& options,
                                std::string& problem);

}  // namespace frontpanels
