// Composes a result buffer, field by field, as ResultReader reads it. The layout is in docs/result-buffer.md.
#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <string_view>
#include <vector>

#include "platform/variant.h"

namespace frontpanels {

// Calls come in the order of the layout: the hardware id, then measurements, in each its sub-measurements, in
// each its records, in each the fields. A call out of order, or an id of 0, which would read as an end,
// raises "Invalid procedure call or argument"; what does not fit a 16-bit length or count, "Overflow". A
// refused call changes nothing.
class ResultWriter {
 public:
  void HardwareId(std::int32_t id);
  void BeginMeasurement(std::int32_t id);
  void BeginSubMeasurement(std::int32_t id);
  void BeginRecord(std::int32_t resultType);

  void Int8(std::int8_t value);
  void UInt8(std::uint8_t value);
  void Int16(std::int16_t value);
  void Int32(std::int32_t value);
  void Float32(float value);
  void Float64(double value);
  void Float32Array(std::span<const float> values);
  void Float64Array(std::span<const double> values);
  // An array of bytes, 16- or 32-bit integers, singles or doubles, as GetMeasurementArray reads it; anything
  // else raises "Type mismatch".
  void Array(const Variant& values);
  void Text(std::string_view text);

  void EndRecord();
  void EndSubMeasurement();
  void EndMeasurement();

  // The whole buffer with its end, once nothing is open. Writing may go on afterwards.
  [[nodiscard]] std::vector<std::uint8_t> Bytes() const;
  void Clear() noexcept;

 private:
  // What is open, each within the one before.
  enum class Level : std::uint8_t { Nothing, Buffer, Measurement, SubMeasurement, Record };

  void begin(Level outer, Level level, std::int32_t id, std::size_t bytesBehindId = 0);
  void end(Level level, Level outer);
  void requireOpen(Level level) const;
  // Room for one more field in the record, and for anything within a limit to the whole: its address.
  [[nodiscard]] std::uint8_t* field(std::size_t byteCount);
  [[nodiscard]] std::uint8_t* grow(std::size_t byteCount, std::size_t limit);
  template <class T>
  void number(T value);
  template <class T>
  void counted(std::span<const T> values);

  std::vector<std::uint8_t> bytes_;
  std::size_t recordStart_ = 0;  // of the data in the open record
  Level level_ = Level::Nothing;
};

}  // namespace frontpanels
