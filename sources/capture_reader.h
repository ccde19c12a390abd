// The frames of a capture: the project's own recordings, written by `CaptureWriter`.
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <span>
#include <string>
#include <vector>

#include "platform/textfile.h"
#include "sources/capture_blocks.h"
#include "sources/frame_reader.h"

namespace frontpanels {

class CaptureReader final : public FrameReader {
 public:
  static constexpr std::size_t kKeptProblems = 5;

  // Whether what begins like this, up to kCaptureHeaderBytes of it, is a capture, perhaps cut within its
  // header.
  [[nodiscard]] static bool recognises(std::span<const char> head);

  // Raises a run-time error that names the file: when it cannot be opened, is no capture or one of another
  // version. `files` must outlive the reader.
  CaptureReader(TextFiles& files, std::string path);

  bool next(Frame& frame) override;
  [[nodiscard]] FramePlace place() const override { return {blocks_->positionBytes(), 0}; }
  void goTo(const FramePlace& place) override;

  [[nodiscard]] std::uint64_t sizeBytes() const override { return sizeBytes_; }
  [[nodiscard]] const std::string& path() const override { return path_; }
  [[nodiscard]] const char* formatName() const override { return "capture"; }
  [[nodiscard]] std::string problemReport() const override;

 private:
  void checkHeader(std::span<const char> head);
  [[nodiscard]] bool nextFrame(Frame& frame);
  [[nodiscard]] bool nextBlock();
  [[nodiscard]] const char* decode(Frame& frame) const;
  void noteDamage(std::uint64_t atBytes, const std::string& text);
  void keepProblem(std::uint64_t atBytes, const std::string& text);

  TextFiles& files_;
  std::string path_;
  std::uint64_t sizeBytes_ = 0;
  std::unique_ptr<CaptureBlocks> blocks_;
  CaptureBlock block_;
  std::vector<char> payload_;
  std::uint64_t frames_ = 0;

  bool readFailed_ = false;
  bool cutShort_ = false;
  std::uint64_t damages_ = 0;
  std::vector<std::string> problems_;  // the first ones
};

}  // namespace frontpanels
