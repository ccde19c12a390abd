// Frames of multipath pilots, put together from the paths of a data server: six values a pilot (PN offset,
// peak Ec/Io in dB, delay in chips, aggregate Ec/Io in dB, delay spread in chips, aggregate minus peak Ec/Io
// in dB), a path each. The PN offsets begin a frame, the last path closes it.
#pragma once

#include <array>
#include <cstdint>
#include <span>
#include <vector>

namespace frontpanels {

inline constexpr std::int32_t kValuesPerPilot = 6;

class MultipathFrame {
 public:
  // Pilot records of the last whole frame, one behind the other.
  [[nodiscard]] std::span<const float> records() const noexcept { return records_; }

  // One path of a frame: 0 the PN offsets to 5 aggregate minus peak, a value for each pilot. True when it
  // has closed a frame. Raises "Subscript out of range" for a closing path to which another one is missing,
  // or has another number of pilots; the last whole frame then stays.
  bool take(std::int32_t column, std::span<const float> values);
  // A whole frame at once. Raises "Subscript out of range" for values that are no whole number of records.
  void takeRecords(std::span<const float> records);
  // A path of the frame could not be read: the frame is passed over.
  void spoil() noexcept { spoiled_ = true; }

 private:
  [[nodiscard]] bool whole(std::size_t pilots) const noexcept;

  struct Column {
    std::vector<float> values;
    bool arrived = false;
  };
  std::array<Column, kValuesPerPilot> columns_;
  bool spoiled_ = true;  // until a first frame begins
  std::vector<float> records_;
};

}  // namespace frontpanels
