// Text files that exist in a test only.
#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <map>
#include <memory>
#include <span>
#include <string>
#include <utility>

#include "platform/runtime_error.h"
#include "platform/textfile.h"

namespace frontpanels::testing {

class MemoryBytes : public ByteReader {
 public:
  MemoryBytes(std::string content, std::uint64_t failAtByte)
      : content_(std::move(content)), failAtByte_(failAtByte) {}

  std::size_t read(std::span<char> bytes) override {
    const std::size_t size = content_.copy(bytes.data(), bytes.size(), at_);
    if (failAtByte_ != 0 && at_ + size >= failAtByte_) raiseDeviceIoError();
    at_ += size;
    return size;
  }
  void goTo(std::uint64_t positionBytes) override {
    at_ = static_cast<std::size_t>(std::min<std::uint64_t>(positionBytes, content_.size()));
  }
  [[nodiscard]] std::uint64_t sizeBytes() const override { return content_.size(); }

 private:
  std::string content_;
  std::uint64_t failAtByte_;
  std::size_t at_ = 0;
};

class MemoryTextReader : public TextReader {
 public:
  MemoryTextReader(std::string content, std::size_t maxLineBytes, std::uint64_t failAtLine)
      : content_(std::move(content)), maxLineBytes_(maxLineBytes), failAtLine_(failAtLine) {}

  bool readLine(TextLine& line) override {
    if (at_ == content_.size()) return false;
    if (line_ + 1 == failAtLine_) raiseDeviceIoError();
    const std::size_t end = content_.find('\n', at_);
    line.ended = end != std::string::npos;
    line.text = content_.substr(at_, line.ended ? end - at_ : std::string::npos);
    at_ = line.ended ? end + 1 : content_.size();
    if (line.ended && line.text.ends_with('\r')) line.text.pop_back();
    line.cut = line.text.size() > maxLineBytes_;
    if (line.cut) line.text.resize(maxLineBytes_);
    line.number = ++line_;
    return true;
  }
  void goTo(std::uint64_t positionBytes, std::uint64_t linesBefore) override {
    at_ = static_cast<std::size_t>(std::min<std::uint64_t>(positionBytes, content_.size()));
    line_ = linesBefore;
  }
  [[nodiscard]] std::uint64_t positionBytes() const override { return at_; }
  [[nodiscard]] std::uint64_t sizeBytes() const override { return content_.size(); }

 private:
  std::string content_;
  std::size_t maxLineBytes_;
  std::uint64_t failAtLine_;
  std::size_t at_ = 0;
  std::uint64_t line_ = 0;
};

class MemoryTextFiles : public TextFiles {
 public:
  std::map<std::string, std::string> contents;
  std::uint64_t failAtLine = 0;  // reading this line fails; none when 0
  std::uint64_t failAtByte = 0;  // the same for what is read as bytes

  [[nodiscard]] std::unique_ptr<TextReader> open(const std::string& path, std::size_t maxLineBytes) override {
    const auto found = contents.find(path);
    if (found == contents.end()) raiseFileNotFound();
    return std::make_unique<MemoryTextReader>(found->second, maxLineBytes, failAtLine);
  }
  [[nodiscard]] std::unique_ptr<ByteReader> openBytes(const std::string& path) override {
    const auto found = contents.find(path);
    if (found == contents.end()) raiseFileNotFound();
    return std::make_unique<MemoryBytes>(found->second, failAtByte);
  }
};

}  // namespace frontpanels::testing
