#include "fp-render/panel_setup.h"

#include <fstream>
#include <iterator>

#include "hosting/settings_file.h"
#include "platform/file_path.h"
#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

constexpr int kPathFileAccessError = 75;

std::string readText(const std::string& pathUtf8) {
  std::ifstream file(pathFromUtf8(pathUtf8), std::ios::binary);
  std::string text(std::istreambuf_iterator<char>(file), {});
  if (!file) throw RuntimeError(kPathFileAccessError, pathUtf8 + ": cannot be read");
  return text;
}

SettingsFile parsed(const std::string& pathUtf8) {
  const std::string text = readText(pathUtf8);
  try {
    return SettingsFile::parse(text);
  } catch (const RuntimeError& error) {
    throw RuntimeError(error.number(), pathUtf8 + ": " + error.description());
  }
}

}  // namespace

std::vector<StoredSetting> readPanelSetup(const std::string& pathUtf8, PanelKind panel,
                                          std::optional<std::uint64_t> setUp) {
  const SettingsFile file = parsed(pathUtf8);
  std::string name(panelWord(panel));
  if (setUp) name += " set-up " + std::to_string(*setUp);
  if (const SettingsSection* const section = file.find(name)) return section->settings();
  throw RuntimeError(kPathFileAccessError, pathUtf8 + ": has no section [" + name + "]");
}

}  // namespace frontpanels
