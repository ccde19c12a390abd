// Pictures as files.
#pragma once

#include <cstdint>
#include <filesystem>
#include <string>
#include <vector>

#include "platform/raster/pixels.h"

namespace frontpanels {

// Also where it is there already. Raises a run-time error that names the folder.
void createFolder(const std::string& folder);

class PictureFiles {
 public:
  PictureFiles(std::filesystem::path folder, bool overwrite)
      : folder_(std::move(folder)), overwrite_(overwrite) {}

  // The picture whole or nothing of it, answering its path. Raises a run-time error that names the file: when
  // it cannot be written, and when it is there already and is not to be overwritten, whoever wrote it: of two
  // programs that save the same picture at once one is refused.
  [[nodiscard]] std::string save(const std::string& name, const PixelView& picture);

 private:
  std::filesystem::path folder_;
  bool overwrite_;
  std::vector<std::uint8_t> png_;
};

}  // namespace frontpanels
