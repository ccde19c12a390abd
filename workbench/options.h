// The command line.
#pragma once

#include <cstdint>
#include <optional>
#include <stdexcept>
#include <string>
#include <vector>

namespace frontpanels::workbench {

struct Options {
  std::string recording;                // empty: the one that the program carries
  std::string screenshotFolder;         // empty: none are taken
  std::optional<std::uint64_t> sweeps;  // stop after so many; without it at the recording's end
  bool exit = false;                    // unattended: no boxes, and the program ends when the play does
  bool help = false;
};

class UsageError : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

// `arguments` without the program's name. Raises `UsageError`.
[[nodiscard]] Options parseOptions(const std::vector<std::string>& arguments);

inline constexpr const char* kUsage =
    "workbench [RECORDING] [--screenshots FOLDER] [--sweeps N] [--exit]\n"
    "\n"
    "Plays a recording of rtl_power or hackrf_sweep into a spectrum panel; without one, the recording that "
    "it "
    "carries.\n"
    "\n"
    "  --screenshots FOLDER  of each sweep shown, save a picture of the window and one of the panel's graph\n"
    "  --sweeps N            stop after N sweeps\n"
    "  --exit                unattended: ask nothing, end with the play\n"
    "  --help                show this and end\n"
    "\n"
    "Ends with 0 when all went well, 1 when something failed, 2 for a command line that it does not "
    "understand, "
    "3 when the panel is not registered.\n";

enum class ExitCode : int { Done = 0, Failed = 1, Usage = 2, NotRegistered = 3 };

}  // namespace frontpanels::workbench
