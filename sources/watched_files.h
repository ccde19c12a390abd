// Files whose reading somebody watches and can end.
#pragma once

#include <memory>
#include <string>
#include <utility>

#include "platform/textfile.h"
#include "sources/frame_source.h"

namespace frontpanels {

// What a read throws once the watcher has said so: it leaves whatever reads, however deep.
struct ReadingEnded {};

class WatchedFiles final : public TextFiles {
 public:
  // `files` must outlive this, and this the readers that it opens.
  WatchedFiles(TextFiles& files, Progress progress) : files_(files), progress_(std::move(progress)) {}

  [[nodiscard]] std::unique_ptr<TextReader> open(const std::string& path, std::size_t maxLineBytes) override;
  // Whoever watches hears of each piece that is read and is asked at least every 64 KiB.
  [[nodiscard]] std::unique_ptr<ByteReader> openBytes(const std::string& path) override;

  void stopWatching() noexcept { progress_ = nullptr; }
  void tell(std::uint64_t positionBytes, std::uint64_t sizeBytes);

 private:
  TextFiles& files_;
  Progress progress_;
  int percent_ = 0;
};

}  // namespace frontpanels
