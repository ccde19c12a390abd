// The command line.
#pragma once

#include <cstdint>
#include <optional>
#include <stdexcept>
#include <string>
#include <vector>

#include "hosting/setting_names.h"

namespace frontpanels::workbench {

struct Options {
  std::string recording;                         // empty: see `simulate`
  std::optional<std::uint64_t> simulate;         // the seed of a simulated drive
  std::optional<std::vector<PanelKind>> panels;  // absent: those of the settings, else what the source has
  std::string settingsFile;                      // empty: the user's own, none when unattended
  std::string screenshotFolder;                  // empty: none are taken
  std::string exportFolder;             // exports go there without a question; empty: the user is asked
  std::string record;                   // a capture of what is played; empty: none
  std::optional<std::uint64_t> sweeps;  // stop after so many; without it at the recording's end
  bool exit = false;                    // unattended: no questions, and the program ends when the play does
  bool help = false;
};

inline constexpr std::uint64_t kUsualSeed = 1;

class UsageError : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

// `arguments` without the program's name. Raises `UsageError`.
[[nodiscard]] Options parseOptions(const std::vector<std::string>& arguments);

inline constexpr const char* kUsage =
    "workbench [RECORDING | --simulate SEED] [OPTION...]\n"
    "\n"
    "Plays a recording (rtl_power, hackrf_sweep, or a capture of its own) or a simulated drive into the "
    "panels. Without one: what was played last, else the recording that it carries.\n"
    "\n"
    "  --simulate SEED       a simulated drive; the same number gives the same drive\n"
    "  --panels LIST         open these: spectrum, pilots, or both with a comma between\n"
    "  --settings FILE       keep the settings there instead of in the user's own folder\n"
    "  --record FILE         record what is played, as a capture\n"
    "  --screenshots FOLDER  of each frame shown, save a picture of the window and one of each panel's "
    "graph\n"
    "  --exports FOLDER      save exports there without asking for a name\n"
    "  --sweeps N            stop after N frames\n"
    "  --exit                unattended: ask nothing, end with the play\n"
    "  --help                show this and end\n"
    "\n"
    "Ends with 0 when all went well, 1 when something failed, 2 for a command line that it does not "
    "understand, 3 when the panels are not registered.\n";

enum class ExitCode : int { Done = 0, Failed = 1, Usage = 2, NotRegistered = 3 };

}  // namespace frontpanels::workbench
