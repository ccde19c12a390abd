// A receiver on a drive past the sites of a CDMA network, simulated: docs/simulator.md says what and how.
#pragma once

#include <cstdint>
#include <memory>
#include <span>
#include <string>

#include "sources/drive_map.h"
#include "sources/frame_source.h"
#include "sources/tuning.h"

namespace frontpanels {

// The drive's time from frame to frame, whatever the clock of whoever plays it.
inline constexpr double kDriveStepS = 0.1;

class DriveSimulator final : public FrameSource {
 public:
  // The same seed and the same tunings at the same frames make the same drive, bit for bit.
  explicit DriveSimulator(std::uint64_t seed);
  ~DriveSimulator() override;
  DriveSimulator(const DriveSimulator&) = delete;
  DriveSimulator& operator=(const DriveSimulator&) = delete;

  // From the next frame on. What no receiver could be tuned to is moved to the nearest that one could be;
  // what is no number takes its default.
  void tune(const SpectrumTuning& tuning);
  void tune(const PilotTuning& tuning);
  [[nodiscard]] std::span<const SiteName> siteNames() const noexcept;

  // Always true; both a sweep and pilots.
  bool next(Frame& frame) override;
  // At once. The tunings stay as they are: a frame before the last change of the carrier is one of a receiver
  // that was tuned so from the first frame on.
  void seek(std::uint64_t number) override;
  [[nodiscard]] std::optional<std::uint64_t> frameCount() const override { return std::nullopt; }
  [[nodiscard]] const std::string& name() const override { return name_; }
  [[nodiscard]] const char* formatName() const override { return "simulator"; }
  [[nodiscard]] bool hasSweeps() const override { return true; }
  [[nodiscard]] bool hasPilots() const override { return true; }
  [[nodiscard]] std::string problemReport() const override { return {}; }

 private:
  class Drive;
  std::unique_ptr<Drive> drive_;
  std::string name_;
  std::uint64_t nextNumber_ = 1;
};

}  // namespace frontpanels
