#include "hosting/whole_file.h"

#include <cerrno>
#include <cstdio>
#include <memory>
#include <string>
#include <system_error>

#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

constexpr int kPathFileAccessError = 75;

// Writes, flushes and closes; the error number of what failed first, 0 when all went well.
int writeFile(const std::filesystem::path& path, std::span<const std::uint8_t> bytes) {
  errno = 0;
  std::FILE* const file = std::fopen(path.string().c_str(), "wb");
  if (file == nullptr) return errno;
  const bool written =
      std::fwrite(bytes.data(), 1, bytes.size(), file) == bytes.size() && std::fflush(file) == 0;
  const int writeError = written ? 0 : errno;
  const int closeError = std::fclose(file) == 0 ? 0 : errno;
  return writeError != 0 ? writeError : closeError;
}

}  // namespace

void saveWhole(const std::filesystem::path& path, std::span<const std::uint8_t> bytes) {
  std::filesystem::path aside = path;
  aside += ".part";
  std::error_code error(writeFile(aside, bytes), std::generic_category());
  if (!error) std::filesystem::rename(aside, path, error);
  if (!error) return;
  std::error_code ignored;
  std::filesystem::remove(aside, ignored);
  throw RuntimeError(kPathFileAccessError, path.string() + ": cannot be written: " + error.message());
}

}  // namespace frontpanels
