// A folder of a test's own, its name not ASCII, gone with it; the files in it as texts.
#pragma once

#include <unistd.h>

#include <filesystem>
#include <fstream>
#include <iterator>
#include <set>
#include <string>

#include "platform/file_path.h"

namespace frontpanels::testing {

class TempFolder {
 public:
  TempFolder() : folder_(std::filesystem::temp_directory_path() / name()) {
    std::filesystem::create_directory(folder_);
  }
  ~TempFolder() {
    std::error_code ignored;
    std::filesystem::remove_all(folder_, ignored);
  }
  TempFolder(const TempFolder&) = delete;
  TempFolder& operator=(const TempFolder&) = delete;

  [[nodiscard]] std::string pathOf(const std::string& file) const { return utf8FromPath(folder_ / file); }
  void write(const std::string& file, const std::string& content) const {
    std::ofstream(folder_ / file, std::ios::binary) << content;
  }
  [[nodiscard]] std::string read(const std::string& file) const {
    std::ifstream stream(folder_ / file, std::ios::binary);
    return {std::istreambuf_iterator<char>(stream), {}};
  }
  // The names in it, in order, a blank behind each.
  [[nodiscard]] std::string names() const {
    std::set<std::string> sorted;
    for (const auto& entry : std::filesystem::directory_iterator(folder_))
      sorted.insert(utf8FromPath(entry.path().filename()));
    std::string all;
    for (const std::string& one : sorted) all += one + " ";
    return all;
  }

 private:
  static std::filesystem::path name() {
    static int count = 0;
    return pathFromUtf8("frontpanels_Gr\u00F6\u00DFe_" + std::to_string(getpid()) + "_" +
                        std::to_string(++count));
  }

  std::filesystem::path folder_;
};

}  // namespace frontpanels::testing
