// Reads the fields of a result buffer, one after the other, from the caller's cursor on. The layout is in
// docs/result-buffer.md.
#pragma once

#include <cstddef>
#include <cstdint>
#include <limits>
#include <span>
#include <string>
#include <vector>

#include "platform/variant.h"

namespace frontpanels {

// Holds the caller's cursor (index of the next byte) and count (bytes left) by reference: every read advances
// both, and what the caller writes to them in between counts. A field that does not lie wholly within the
// count and within the buffer, and a length or count below 0, raise "Subscript out of range" before anything
// is read; a read that fails leaves cursor and count as they were. Memory is asked for only when the bytes
// that shall fill it are there.
class ResultReader {
 public:
  // Raises "Subscript out of range" when cursor and count do not name a stretch of the buffer.
  ResultReader(std::span<const std::uint8_t> resultData, std::int32_t& dataPointer, std::int32_t& dataCount);

  [[nodiscard]] std::int32_t dataPointer() const noexcept { return dataPointer_; }
  [[nodiscard]] std::int32_t dataCount() const noexcept { return dataCount_; }

  std::int32_t GetHardwareId();
  std::int32_t GetMeasurementId();      // 0 ends the buffer
  std::int32_t GetSubMeasurementId();   // 0 ends the measurement
  std::int32_t GetMeasurementTypeId();  // 0 ends the sub-measurement
  // The same id without stepping over it.
  [[nodiscard]] std::int32_t PeekMeasurementTypeId() const;

  double GetMeasurementFloat64();
  float GetMeasurementFloat32();
  std::int32_t GetMeasurementInt32();
  std::int16_t GetMeasurementInt16();
  std::int8_t GetMeasurementInt8();
  std::uint8_t GetMeasurementUInt8();
  // The bytes as they stand: meant as UTF-8, not checked to be.
  std::string GetMeasurementString();

  void SkipMeasurementData(std::int32_t byteCount);

  // Into the caller's memory: answers how many values were written, the rest of `values` stays. More values
  // than it holds raise "Subscript out of range" as well.
  std::size_t GetFloat64Array(std::span<double> values);
  std::size_t GetFloat32Array(std::span<float> values);
  std::vector<double> GetFloat64Array();
  std::vector<float> GetFloat32Array();
  // An array of the element type that the buffer names; "Type mismatch" for a code that names none.
  Variant GetMeasurementArray();

 private:
  // The address of `byteCount` bytes, `ahead` of the cursor.
  [[nodiscard]] const std::uint8_t* bytes(std::size_t byteCount, std::size_t ahead = 0) const;
  // The count that stands `ahead` of the cursor.
  [[nodiscard]] std::size_t announced(std::size_t ahead = 0) const;
  void advance(std::size_t byteCount) noexcept;
  template <class T>
  T number();
  template <class T>
  std::size_t arrayInto(std::span<T> values);
  template <class T>
  std::vector<T> array(std::size_t ahead = 0);

  std::span<const std::uint8_t> resultData_;
  std::int32_t& dataPointer_;
  std::int32_t& dataCount_;
};

// Marks a value that was not measured.
[[nodiscard]] constexpr float NotANumber() noexcept { return std::numeric_limits<float>::quiet_NaN(); }

// False, and `values` as it was, when the variant is no array of exactly that element type.
[[nodiscard]] bool CopyVariantToArray(const Variant& variant, std::vector<float>& values);
[[nodiscard]] bool CopyVariantToArray(const Variant& variant, std::vector<double>& values);

}  // namespace frontpanels
