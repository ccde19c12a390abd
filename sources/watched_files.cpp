#include "sources/watched_files.h"

#include <algorithm>

namespace frontpanels {
namespace {

class WatchedBytes final : public ByteReader {
 public:
  WatchedBytes(WatchedFiles& watch, std::unique_ptr<ByteReader> bytes)
      : watch_(watch), bytes_(std::move(bytes)) {}

  std::size_t read(std::span<char> bytes) override {
    const std::size_t size = bytes_->read(bytes);
    positionBytes_ += size;
    watch_.tell(positionBytes_, sizeBytes());
    return size;
  }
  void goTo(std::uint64_t positionBytes) override {
    bytes_->goTo(positionBytes);
    positionBytes_ = positionBytes;
  }
  [[nodiscard]] std::uint64_t sizeBytes() const override { return bytes_->sizeBytes(); }

 private:
  WatchedFiles& watch_;
  std::unique_ptr<ByteReader> bytes_;
  std::uint64_t positionBytes_ = 0;
};

}  // namespace

std::unique_ptr<TextReader> WatchedFiles::open(const std::string& path, std::size_t maxLineBytes) {
  return linesOf(openBytes(path), maxLineBytes);
}

std::unique_ptr<ByteReader> WatchedFiles::openBytes(const std::string& path) {
  return std::make_unique<WatchedBytes>(*this, files_.openBytes(path));
}

// Never falls: what is opened anew begins again.
void WatchedFiles::tell(std::uint64_t positionBytes, std::uint64_t sizeBytes) {
  if (!progress_) return;
  const double share =
      sizeBytes == 0 ? 1 : static_cast<double>(positionBytes) / static_cast<double>(sizeBytes);
  percent_ = std::max(percent_, static_cast<int>(std::min(share, 1.0) * 100));
  if (!progress_(percent_)) throw ReadingEnded{};
}

}  // namespace frontpanels
