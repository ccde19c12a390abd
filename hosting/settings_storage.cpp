#include <cerrno>
#include <filesystem>
#include <fstream>
#include <optional>
#include <system_error>

#include "framework/support/guard.h"
#include "hosting/settings_file.h"
#include "hosting/taken_file.h"
#include "hosting/whole_file.h"
#include "platform/file_path.h"
#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

namespace fs = std::filesystem;

constexpr int kPathFileAccessError = 75;
// Many times what a host keeps.
constexpr std::size_t kMaxBytes = 1U << 20U;
constexpr int kMaxKept = 999;

// Leaves `file` closed where there is none.
std::error_code openFile(const fs::path& path, std::ifstream& file) {
  std::error_code error;
  const fs::file_status status = fs::status(path, error);
  if (status.type() == fs::file_type::not_found) return {};
  if (error) return error;
  if (!fs::is_regular_file(status)) throw RuntimeError(kPathFileAccessError, "this is no file");
  errno = 0;
  file.open(path, std::ios::binary);
  return file.is_open() ? std::error_code() : std::error_code(errno, std::generic_category());
}

// Nothing where there is no file.
std::optional<std::string> readText(const fs::path& path) {
  std::ifstream file;
  const std::error_code error = onceFree([&] { return openFile(path, file); });
  if (error) throw RuntimeError(kPathFileAccessError, error.message());
  if (!file.is_open()) return std::nullopt;
  std::string text(kMaxBytes + 1, '\0');
  file.read(text.data(), static_cast<std::streamsize>(text.size()));
  if (file.bad()) raiseDeviceIoError();
  text.resize(static_cast<std::size_t>(file.gcount()));
  if (text.size() > kMaxBytes) throw RuntimeError(kPathFileAccessError, "the file is larger than 1 MB");
  return text;
}

// The name under which the file is kept from now on; empty when it stays where it is.
fs::path keepAside(const fs::path& path) {
  std::error_code error;
  if (!fs::is_regular_file(path, error)) return {};
  for (int number = 1; number <= kMaxKept; ++number) {
    fs::path kept = path;
    kept += ".damaged-" + std::to_string(number);
    if (fs::symlink_status(kept, error).type() != fs::file_type::not_found) continue;
    fs::rename(path, kept, error);
    return error ? fs::path() : kept;
  }
  return {};
}

}  // namespace

LoadedSettings loadSettings(const std::string& pathUtf8) {
  LoadedSettings loaded;
  std::string reason;
  fs::path path;
  try {
    path = pathFromUtf8(pathUtf8);
    if (const std::optional<std::string> text = readText(path)) loaded.settings = SettingsFile::parse(*text);
    return loaded;
  } catch (...) {
    reason = describeCurrentException();
  }
  const fs::path kept = keepAside(path);
  loaded.mayBeReplaced = !kept.empty();
  loaded.problem =
      pathUtf8 + ": " + reason + ". Nothing of it is used; " +
      (loaded.mayBeReplaced ? "the file was kept as " + utf8FromPath(kept.filename()) + "."
                            : "the file could not be renamed, stays as it is and will not be written over.");
  return loaded;
}

void saveSettings(const std::string& pathUtf8, const SettingsFile& settings) {
  const fs::path folder = pathFromUtf8(pathUtf8).parent_path();
  std::error_code error;
  if (!folder.empty()) fs::create_directories(folder, error);
  if (error && !fs::is_directory(folder))
    throw RuntimeError(kPathFileAccessError,
                       utf8FromPath(folder) + ": cannot be created: " + error.message());
  saveWhole(pathUtf8, settings.text());
}

}  // namespace frontpanels
