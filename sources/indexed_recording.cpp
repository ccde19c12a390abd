#include "sources/indexed_recording.h"

#include <algorithm>

namespace frontpanels {

IndexedRecording::IndexedRecording(TextFiles& files, const std::string& path, const Progress& progress,
                                   std::size_t maxBookmarks)
    : files_(files, progress), reader_(openFrameReader(files_, path)), sizeBytes_(reader_->sizeBytes()) {
  addBookmark(maxBookmarks);
  while (reader_->next(skipped_)) {
    ++frames_;
    hasSweeps_ = hasSweeps_ || skipped_.sweep;
    hasPilots_ = hasPilots_ || skipped_.pilots;
    addBookmark(maxBookmarks);
  }
  files_.stopWatching();
  report_ = reader_->problemReport();
  seek(1);
}

// Of the frame to come. When there are too many every second one goes.
void IndexedRecording::addBookmark(std::size_t maxBookmarks) {
  if (frames_ % stride_ != 0) return;
  if (bookmarks_.size() == maxBookmarks) {
    for (std::size_t i = 0; 2 * i < bookmarks_.size(); ++i) bookmarks_[i] = bookmarks_[2 * i];
    bookmarks_.resize((bookmarks_.size() + 1) / 2);
    stride_ *= 2;
    if (frames_ % stride_ != 0) return;
  }
  bookmarks_.push_back(reader_->place());
}

bool IndexedRecording::next(Frame& frame) {
  if (passed_ >= frames_) return false;
  hasChanged_ = hasChanged_ || !isWhereItWas();
  if (!reader_->next(frame)) {
    hasChanged_ = true;
    passed_ = frames_;
    return false;
  }
  frame.number = ++passed_;
  if (frame.sweep) frame.sweep->number = frame.number;
  return true;
}

// As far as there is a bookmark to tell.
bool IndexedRecording::isWhereItWas() const {
  const std::uint64_t bookmark = passed_ / stride_;
  return passed_ % stride_ != 0 || bookmark >= bookmarks_.size() ||
         bookmarks_[static_cast<std::size_t>(bookmark)] == reader_->place();
}

void IndexedRecording::seek(std::uint64_t number) {
  passed_ = frames_;  // unless the file can be opened again
  if (number > frames_) return;
  const std::uint64_t before = std::max<std::uint64_t>(number, 1) - 1;
  const std::uint64_t bookmark = std::min<std::uint64_t>(before / stride_, bookmarks_.size() - 1);
  reader_->goTo(bookmarks_[static_cast<std::size_t>(bookmark)]);
  hasChanged_ = hasChanged_ || reader_->sizeBytes() < sizeBytes_;
  passed_ = bookmark * stride_;
  while (passed_ < before && next(skipped_)) {
  }
}

std::string IndexedRecording::problemReport() const {
  if (!hasChanged_) return report_;
  constexpr const char* kChanged = "the file has changed since it was opened";
  return report_.empty() ? name() + ": " + kChanged : report_ + "\n  " + kChanged;
}

}  // namespace frontpanels
