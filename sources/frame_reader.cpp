#include "sources/frame_reader.h"

#include <array>

#include "sources/capture_reader.h"
#include "sources/named_files.h"
#include "sources/sweep_recording.h"

namespace frontpanels {
namespace {

class SweepReader final : public FrameReader {
 public:
  SweepReader(TextFiles& files, const std::string& path) : recording_(SweepRecording::open(files, path)) {}

  bool next(Frame& frame) override {
    if (!frame.sweep) frame.sweep.emplace();
    frame.pilots.reset();
    if (!recording_->next(*frame.sweep)) return false;
    frame.time = frame.sweep->time;
    return true;
  }
  [[nodiscard]] FramePlace place() const override { return recording_->place(); }
  void goTo(const FramePlace& place) override { recording_->goTo(place); }

  [[nodiscard]] std::uint64_t sizeBytes() const override { return recording_->sizeBytes(); }
  [[nodiscard]] const std::string& path() const override { return recording_->path(); }
  [[nodiscard]] const char* formatName() const override { return sweepFormatName(recording_->format()); }
  [[nodiscard]] std::string problemReport() const override { return recording_->problemReport(); }

 private:
  std::unique_ptr<SweepRecording> recording_;
};

}  // namespace

std::unique_ptr<FrameReader> openFrameReader(TextFiles& files, const std::string& path) {
  std::array<char, kCaptureHeaderBytes> head{};
  const std::size_t size = namingFile(path, [&] { return files.openBytes(path)->read(head); });
  if (CaptureReader::recognises({head.data(), size})) return std::make_unique<CaptureReader>(files, path);
  return std::make_unique<SweepReader>(files, path);
}

}  // namespace frontpanels
