// A recording that was read once: it knows its frames and, with a bounded number of bookmarks, where they
// begin.
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "sources/frame_reader.h"
#include "sources/frame_source.h"
#include "sources/watched_files.h"

namespace frontpanels {

class IndexedRecording final : public FrameSource {
 public:
  // Reads all of it and keeps at most `maxBookmarks`, at least 2. Raises what `openRecording` does, and
  // ReadingEnded.
  IndexedRecording(TextFiles& files, const std::string& path, const Progress& progress,
                   std::size_t maxBookmarks);

  bool next(Frame& frame) override;
  void seek(std::uint64_t number) override;

  [[nodiscard]] std::optional<std::uint64_t> frameCount() const override { return frames_; }
  [[nodiscard]] const std::string& name() const override { return reader_->path(); }
  [[nodiscard]] const char* formatName() const override { return reader_->formatName(); }
  [[nodiscard]] bool hasSweeps() const override { return hasSweeps_; }
  [[nodiscard]] bool hasPilots() const override { return hasPilots_; }
  // Of the reading on opening, whatever is read again since; and whether the file has changed since then.
  [[nodiscard]] std::string problemReport() const override;

 private:
  void addBookmark(std::size_t maxBookmarks);
  [[nodiscard]] bool isWhereItWas() const;

  WatchedFiles files_;
  std::unique_ptr<FrameReader> reader_;
  std::uint64_t frames_ = 0;
  std::uint64_t sizeBytes_;
  bool hasSweeps_ = false;
  bool hasPilots_ = false;
  std::string report_;
  bool hasChanged_ = false;

  std::uint64_t passed_ = 0;           // frames before the place where the reader stands
  std::vector<FramePlace> bookmarks_;  // of frames 1, 1 + stride, 1 + 2 strides and so on
  std::uint64_t stride_ = 1;
  Frame skipped_;
};

}  // namespace frontpanels
