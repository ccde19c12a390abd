#include "hosting/whole_file.h"

#include <fcntl.h>

#include <algorithm>
#include <cerrno>
#include <filesystem>
#include <system_error>
#include <utility>

#include "hosting/taken_file.h"
#include "platform/file_path.h"
#include "platform/runtime_error.h"

#ifdef _WIN32
#include <io.h>
#include <share.h>
#include <sys/stat.h>
#else
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>
#endif

namespace frontpanels {
namespace {

namespace fs = std::filesystem;

constexpr int kPathFileAccessError = 75;

std::error_code lastError() noexcept { return {errno, std::generic_category()}; }

// What the two systems word differently: a file of one's own, open for writing and empty.
#ifdef _WIN32
int openOwn(const fs::path& path) noexcept {
  // Shared with nobody: a second program cannot open it before this one is through.
  return _wsopen(path.c_str(), _O_CREAT | _O_TRUNC | _O_WRONLY | _O_BINARY | _O_NOINHERIT, _SH_DENYRW,
                 _S_IREAD | _S_IWRITE);
}
int writeSome(int file, const std::uint8_t* bytes, std::size_t count) noexcept {
  return _write(file, bytes, static_cast<unsigned>(count));
}
int bringToDisk(int file) noexcept { return _commit(file); }
int closeFile(int file) noexcept { return _close(file); }
void bringNameToDisk(const fs::path&) noexcept {}
// An open file cannot be renamed here.
constexpr bool kCloseBeforeRename = true;
#else
// A lock on a file that was renamed away meanwhile is none on this path: that file must not be emptied.
bool isAt(const fs::path& path, int file) noexcept {
  struct stat opened {};
  struct stat named {};
  return fstat(file, &opened) == 0 && lstat(path.c_str(), &named) == 0 && opened.st_dev == named.st_dev &&
         opened.st_ino == named.st_ino;
}

int openOwn(const fs::path& path) noexcept {
  constexpr mode_t kWhateverTheUserAllows = 0666;
  const int file = open(path.c_str(), O_CREAT | O_WRONLY | O_CLOEXEC | O_NOFOLLOW, kWhateverTheUserAllows);
  if (file < 0) return file;
  bool own = flock(file, LOCK_EX | LOCK_NB) == 0;
  if (own && !isAt(path, file)) {
    own = false;
    errno = EWOULDBLOCK;
  }
  if (own && ftruncate(file, 0) == 0) return file;
  const int error = errno;
  close(file);
  errno = error;
  return -1;
}
ssize_t writeSome(int file, const std::uint8_t* bytes, std::size_t count) noexcept {
  return write(file, bytes, count);
}
int bringToDisk(int file) noexcept { return fsync(file); }
int closeFile(int file) noexcept { return close(file); }
// So that a renaming outlives a loss of power; not every file system can.
void bringNameToDisk(const fs::path& path) noexcept {
  const int folder = open(path.has_parent_path() ? path.parent_path().c_str() : ".", O_RDONLY | O_CLOEXEC);
  if (folder < 0) return;
  static_cast<void>(fsync(folder));
  close(folder);
}
constexpr bool kCloseBeforeRename = false;
#endif

// The file aside; its name goes with it unless it was renamed.
class AsideFile {
 public:
  explicit AsideFile(fs::path path) : path_(std::move(path)) {}
  ~AsideFile() {
    std::error_code ignored;
    // Without a lock it may be another program's by now; one that cannot be removed while open waits.
    if (kCloseBeforeRename) static_cast<void>(shut());
    if (own_) fs::remove(path_, ignored);
    static_cast<void>(shut());
  }
  AsideFile(const AsideFile&) = delete;
  AsideFile& operator=(const AsideFile&) = delete;

  std::error_code openFile() noexcept {
    file_ = openOwn(path_);
    own_ = file_ >= 0;
    return own_ ? std::error_code() : lastError();
  }

  std::error_code fill(std::span<const std::uint8_t> bytes) noexcept {
    constexpr std::size_t kAtOnce = 1U << 30U;  // a count of bytes must fit an int where writing answers one
    while (!bytes.empty()) {
      const auto written = writeSome(file_, bytes.data(), std::min(bytes.size(), kAtOnce));
      if (written < 0 && errno == EINTR) continue;
      if (written < 0) return lastError();
      if (written == 0) return std::make_error_code(std::errc::no_space_on_device);
      bytes = bytes.subspan(static_cast<std::size_t>(written));
    }
    return bringToDisk(file_) == 0 ? std::error_code() : lastError();
  }

  std::error_code rename(const fs::path& path) {
    std::error_code error;
    if (const fs::file_status old = fs::status(path, error); fs::exists(old))
      fs::permissions(path_, old.permissions(), error);
    if (kCloseBeforeRename && shut() != 0) return lastError();
    fs::rename(path_, path, error);
    if (error) return error;
    own_ = false;
    bringNameToDisk(path);
    return {};
  }

 private:
  int shut() noexcept { return file_ < 0 ? 0 : closeFile(std::exchange(file_, -1)); }

  fs::path path_;
  int file_ = -1;
  bool own_ = false;
};

std::error_code saveOnce(const fs::path& path, std::span<const std::uint8_t> bytes) {
  fs::path aside = path;
  aside += ".part";
  AsideFile file(std::move(aside));
  std::error_code error = file.openFile();
  if (!error) error = file.fill(bytes);
  if (!error) error = file.rename(path);
  return error;
}

std::error_code save(fs::path path, std::span<const std::uint8_t> bytes) {
  std::error_code error;
  if (fs::is_symlink(path, error)) {
    path = fs::canonical(path, error);
    if (error) return error;
  }
  // From its beginning each time: where a file is closed before it is renamed, another program may have taken
  // it.
  return onceFree([&] { return saveOnce(path, bytes); });
}

}  // namespace

void saveWhole(const std::string& pathUtf8, std::span<const std::uint8_t> bytes) {
  if (const std::error_code error = save(pathFromUtf8(pathUtf8), bytes))
    throw RuntimeError(kPathFileAccessError, pathUtf8 + ": cannot be written: " + error.message());
}

void saveWhole(const std::string& pathUtf8, std::string_view text) {
  saveWhole(pathUtf8, std::span(reinterpret_cast<const std::uint8_t*>(text.data()), text.size()));
}

}  // namespace frontpanels
