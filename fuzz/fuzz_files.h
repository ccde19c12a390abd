// One file that is there in memory alone: the fuzzer's bytes, and what is required of them as a recording.
#pragma once

#include <algorithm>
#include <cstdint>
#include <memory>
#include <optional>
#include <span>
#include <string>

#include "fuzz/fuzz_input.h"
#include "platform/runtime_error.h"
#include "platform/textfile.h"
#include "sources/frame_source.h"
#include "sources/sweep_row.h"

namespace frontpanels::fuzz {

class FuzzBytes final : public ByteReader {
 public:
  explicit FuzzBytes(std::span<const std::uint8_t> bytes) : bytes_(bytes) {}

  std::size_t read(std::span<char> into) override {
    const std::span<const std::uint8_t> rest = bytes_.subspan(at_);
    const std::size_t size = std::min(into.size(), rest.size());
    std::copy_n(rest.begin(), size, into.begin());
    at_ += size;
    return size;
  }
  void goTo(std::uint64_t positionBytes) override {
    at_ = static_cast<std::size_t>(std::min<std::uint64_t>(positionBytes, bytes_.size()));
  }
  [[nodiscard]] std::uint64_t sizeBytes() const override { return bytes_.size(); }

 private:
  std::span<const std::uint8_t> bytes_;
  std::size_t at_ = 0;
};

class FuzzFiles final : public TextFiles {
 public:
  explicit FuzzFiles(std::span<const std::uint8_t> bytes) : bytes_(bytes) {}

  [[nodiscard]] std::unique_ptr<TextReader> open(const std::string& path, std::size_t maxLineBytes) override {
    return linesOf(openBytes(path), maxLineBytes);
  }
  [[nodiscard]] std::unique_ptr<ByteReader> openBytes(const std::string&) override {
    return std::make_unique<FuzzBytes>(bytes_);
  }

 private:
  std::span<const std::uint8_t> bytes_;
};

// A text of all that is shown of a frame; numbers by their bits, so that gaps compare.
std::string textOf(const Frame& frame);

// Opens the bytes, plays all of them and goes to frames by a few bookmarks: that gives the same frames, and
// nothing is raised but that it is no recording. Null then.
std::unique_ptr<FrameSource> playEverything(TextFiles& files);

}  // namespace frontpanels::fuzz
