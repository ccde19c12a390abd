// Captures in files of the system, in a folder that each test has of its own.
#pragma once

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <iterator>

#include "platform/textfile.h"
#include "sources/capture_writer.h"
#include "tests/sources/frame_samples.h"
#include "tests/support/memory_text_files.h"
#include "tests/support/raised.h"

namespace frontpanels::testing {

namespace fs = std::filesystem;

class CaptureFixture : public ::testing::Test {
 protected:
  void SetUp() override {
    fs::remove_all(folder_);
    fs::create_directories(folder_);
  }
  void TearDown() override { fs::remove_all(folder_); }

  // Its name is not ASCII.
  [[nodiscard]] fs::path native() const { return folder_ / u8"Gr\u00F6\u00DFe.capture"; }
  [[nodiscard]] std::string path() const {
    const std::u8string text = native().u8string();
    return {text.begin(), text.end()};
  }
  [[nodiscard]] std::string bytes() const {
    std::ifstream file(native(), std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
  }
  void setBytes(const std::string& content) const {
    std::ofstream(native(), std::ios::binary)
        .write(content.data(), static_cast<std::streamsize>(content.size()));
  }

  // Three frames: of a sweep, of all that there can be, of nothing but a time.
  std::string threeFrames() const {
    fs::remove(native());
    CaptureWriter writer(path());
    writer.append(sweepFrame("one", {-1, -2, -3}));
    writer.append(fullFrame("two"));
    Frame third;
    third.time = "three";
    writer.append(third);
    return bytes();
  }
  static constexpr const char* kFirst = "1 one sweep 100 10 1 -1 -2 -3\n";
  static std::string second(int number = 2) {
    return std::to_string(number) + " two" + kFullFrameText + "\n";
  }
  static std::string third(int number = 3) { return std::to_string(number) + " three\n"; }

  // What plays of bytes that a file might hold.
  std::unique_ptr<FrameSource> open(const std::string& content) {
    files.contents["a"] = content;
    return openRecording(files, "a");
  }

  MemoryTextFiles files;

 private:
  fs::path folder_ =
      fs::temp_directory_path() /
      (std::string("frontpanels_capture_") + ::testing::UnitTest::GetInstance()->current_test_info()->name());
};

}  // namespace frontpanels::testing
