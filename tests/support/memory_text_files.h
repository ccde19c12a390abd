// Text files that exist in a test only.
#pragma once

#include <cstddef>
#include <cstdint>
#include <limits>
#include <map>
#include <memory>
#include <string>
#include <utility>

#include "platform/runtime_error.h"
#include "platform/textfile.h"

namespace frontpanels::testing {

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

  [[nodiscard]] std::unique_ptr<TextReader> open(const std::string& path, std::size_t maxLineBytes) override {
    const auto found = contents.find(path);
    if (found == contents.end()) raiseFileNotFound();
    return std::make_unique<MemoryTextReader>(found->second, maxLineBytes, failAtLine);
  }
};

}  // namespace frontpanels::testing
