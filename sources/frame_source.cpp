#include "sources/frame_source.h"

#include "sources/indexed_recording.h"
#include "sources/watched_files.h"

namespace frontpanels {

std::unique_ptr<FrameSource> openRecording(TextFiles& files, const std::string& path,
                                           const Progress& progress, std::size_t maxBookmarks) {
  try {
    return std::make_unique<IndexedRecording>(files, path, progress, maxBookmarks);
  } catch (const ReadingEnded&) {
    return nullptr;
  }
}

}  // namespace frontpanels
