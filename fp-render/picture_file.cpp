#include "fp-render/picture_file.h"

#include <cerrno>
#include <cstdio>
#include <system_error>

#include "hosting/whole_file.h"
#include "platform/file_path.h"
#include "platform/raster/png.h"
#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

namespace fs = std::filesystem;

constexpr int kFileAlreadyExists = 58;
constexpr int kPathFileAccessError = 75;

// An empty file that keeps the name for this program until the picture is there.
class Claim {
 public:
  explicit Claim(const fs::path& path) : path_(path) {
    errno = 0;
    std::FILE* const file = std::fopen(path.string().c_str(), "wbx");
    if (file == nullptr && errno == EEXIST)
      throw RuntimeError(kFileAlreadyExists, path.string() + ": is there already; --overwrite replaces it");
    if (file == nullptr)
      throw RuntimeError(kPathFileAccessError,
                         path.string() + ": cannot be written: " + std::generic_category().message(errno));
    std::fclose(file);
  }
  ~Claim() {
    std::error_code ignored;
    if (!kept_) fs::remove(path_, ignored);
  }
  Claim(const Claim&) = delete;
  Claim& operator=(const Claim&) = delete;
  void keep() noexcept { kept_ = true; }

 private:
  const fs::path& path_;
  bool kept_ = false;
};

}  // namespace

void createFolder(const std::string& folder) {
  std::error_code error;
  fs::create_directories(folder, error);
  if (!error && !fs::is_directory(folder)) error = std::make_error_code(std::errc::not_a_directory);
  if (error) throw RuntimeError(kPathFileAccessError, folder + ": cannot be created: " + error.message());
}

std::string PictureFiles::save(const std::string& name, const PixelView& picture) {
  const fs::path path = folder_ / name;
  std::string problem;
  if (!encodePng(picture, png_, problem))
    throw RuntimeError(kPathFileAccessError, path.string() + ": " + problem);
  if (overwrite_) {
    saveWhole(utf8FromPath(path), png_);
  } else {
    Claim claim(path);
    saveWhole(utf8FromPath(path), png_);
    claim.keep();
  }
  return path.string();
}

}  // namespace frontpanels
