#include "sources/frame_source.h"

#include "sources/sweep_recording.h"

namespace frontpanels {
namespace {

class SweepFrames final : public FrameSource {
 public:
  explicit SweepFrames(std::unique_ptr<SweepRecording> recording) : recording_(std::move(recording)) {}

  // Reads all of it; false when `progress` ended that.
  bool count(const Progress& progress) {
    Sweep sweep;
    while (recording_->next(sweep)) {
      ++frames_;
      if (progress && !progress(percent())) return false;
    }
    recording_->rewind();
    return true;
  }

  bool next(Frame& frame) override {
    if (!frame.sweep) frame.sweep.emplace();
    frame.pilots.reset();
    if (!recording_->next(*frame.sweep)) return false;
    frame.number = frame.sweep->number;
    frame.time = frame.sweep->time;
    return true;
  }

  void seek(std::uint64_t number) override {
    recording_->rewind();
    Sweep passed;
    for (std::uint64_t before = 1; before < number && recording_->next(passed); ++before) {
    }
  }

  [[nodiscard]] std::optional<std::uint64_t> frameCount() const override { return frames_; }
  [[nodiscard]] const std::string& name() const override { return recording_->path(); }
  [[nodiscard]] const char* formatName() const override { return sweepFormatName(recording_->format()); }
  [[nodiscard]] bool hasSweeps() const override { return true; }
  [[nodiscard]] bool hasPilots() const override { return false; }
  [[nodiscard]] std::string problemReport() const override { return recording_->problemReport(); }

 private:
  [[nodiscard]] int percent() const {
    const auto size = static_cast<double>(recording_->sizeBytes());
    return size > 0 ? static_cast<int>(static_cast<double>(recording_->positionBytes()) / size * 100.0) : 100;
  }

  std::unique_ptr<SweepRecording> recording_;
  std::uint64_t frames_ = 0;
};

}  // namespace

std::unique_ptr<FrameSource> openRecording(TextFiles& files, const std::string& path,
                                           const Progress& progress) {
  auto frames = std::make_unique<SweepFrames>(SweepRecording::open(files, path));
  if (!frames->count(progress)) return nullptr;
  return frames;
}

}  // namespace frontpanels
