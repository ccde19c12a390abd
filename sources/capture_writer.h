// Writes a capture: the project's own recording of frames (docs/capture-format.md), one whole block a frame.
#pragma once

#include <cstdint>
#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

#include "sources/frame.h"

namespace frontpanels {

class CaptureWriter {
 public:
  // A file that is not there is created, a capture is continued behind its last whole block. Raises a
  // run-time error that names the file: when it is anything else, which stays as it is, or cannot be written.
  explicit CaptureWriter(const std::string& pathUtf8);

  // Hands the frame to the system before it returns. Its number is not kept: a capture is counted anew.
  // Raises a run-time error that names the file and the reason; what was written before is then whole, what
  // there is of this frame is taken away again, and the next call tries again.
  void append(const Frame& frame);

  // Appended by this writer.
  [[nodiscard]] std::uint64_t frames() const noexcept { return frames_; }
  [[nodiscard]] const std::string& path() const noexcept { return path_; }

 private:
  void open(std::ios::openmode keep);
  void write(const std::vector<char>& bytes);
  void takeBackWhatIsCut() const noexcept;
  [[noreturn]] void raiseNotWritten(int reason) const;

  std::string path_;
  std::filesystem::path native_;
  std::ofstream file_;
  std::uint64_t wholeBytes_ = 0;
  std::uint64_t frames_ = 0;
  std::vector<char> block_;
};

}  // namespace frontpanels
