#include "platform/result_reader.h"

#include "platform/result_layout.h"
#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

template <class T>
bool copyElements(const Variant& variant, std::vector<T>& values) {
  const auto* const elements = std::get_if<std::vector<T>>(&variant.value());
  if (elements == nullptr) return false;
  values = *elements;
  return true;
}

}  // namespace

ResultReader::ResultReader(std::span<const std::uint8_t> resultData, std::int32_t& dataPointer,
                           std::int32_t& dataCount)
    : resultData_(resultData), dataPointer_(dataPointer), dataCount_(dataCount) {
  static_cast<void>(bytes(0));
}

std::int32_t ResultReader::GetHardwareId() { return number<std::int32_t>(); }
std::int32_t ResultReader::GetMeasurementId() { return number<std::int32_t>(); }
std::int32_t ResultReader::GetSubMeasurementId() { return number<std::int32_t>(); }
std::int32_t ResultReader::GetMeasurementTypeId() { return number<std::int32_t>(); }

std::int32_t ResultReader::PeekMeasurementTypeId() const {
  return fromLittleEndian<std::int32_t>(bytes(kIdBytes));
}

double ResultReader::GetMeasurementFloat64() { return number<double>(); }
float ResultReader::GetMeasurementFloat32() { return number<float>(); }
std::int32_t ResultReader::GetMeasurementInt32() { return number<std::int32_t>(); }
std::int16_t ResultReader::GetMeasurementInt16() { return number<std::int16_t>(); }
std::int8_t ResultReader::GetMeasurementInt8() { return number<std::int8_t>(); }
std::uint8_t ResultReader::GetMeasurementUInt8() { return number<std::uint8_t>(); }

std::string ResultReader::GetMeasurementString() {
  const std::size_t length = announced();
  const std::uint8_t* const text = bytes(length, kCountBytes);
  std::string value(text, text + length);
  advance(kCountBytes + length);
  return value;
}

void ResultReader::SkipMeasurementData(std::int32_t byteCount) {
  if (byteCount < 0) raiseSubscriptOutOfRange();
  const auto skipped = static_cast<std::size_t>(byteCount);
  static_cast<void>(bytes(skipped));
  advance(skipped);
}

std::size_t ResultReader::GetFloat64Array(std::span<double> values) { return arrayInto(values); }
std::size_t ResultReader::GetFloat32Array(std::span<float> values) { return arrayInto(values); }
std::vector<double> ResultReader::GetFloat64Array() { return array<double>(); }
std::vector<float> ResultReader::GetFloat32Array() { return array<float>(); }

Variant ResultReader::GetMeasurementArray() {
  switch (*bytes(kCodeBytes)) {
    case kElementCode<Variant::Int16s>:
      return array<std::int16_t>(kCodeBytes);
    case kElementCode<Variant::Int32s>:
      return array<std::int32_t>(kCodeBytes);
    case kElementCode<Variant::Singles>:
      return array<float>(kCodeBytes);
    case kElementCode<Variant::Doubles>:
      return array<double>(kCodeBytes);
    case kElementCode<Variant::Bytes>:
      return array<std::uint8_t>(kCodeBytes);
    default:
      raiseTypeMismatch();
  }
}

// Cursor and count are looked at on every read, for they belong to the caller.
const std::uint8_t* ResultReader::bytes(std::size_t byteCount, std::size_t ahead) const {
  const std::int64_t cursor = dataPointer_;
  const std::int64_t left = dataCount_;
  if (cursor < 0 || left < 0 || static_cast<std::uint64_t>(cursor + left) > resultData_.size())
    raiseSubscriptOutOfRange();
  if (std::uint64_t{ahead} + byteCount > static_cast<std::uint64_t>(left)) raiseSubscriptOutOfRange();
  return resultData_.data() + cursor + ahead;
}

std::size_t ResultReader::announced(std::size_t ahead) const {
  const auto count = fromLittleEndian<std::int16_t>(bytes(kCountBytes, ahead));
  if (count < 0) raiseSubscriptOutOfRange();
  return static_cast<std::size_t>(count);
}

// No more than what `bytes` has found to be there, which fits the count.
void ResultReader::advance(std::size_t byteCount) noexcept {
  dataPointer_ += static_cast<std::int32_t>(byteCount);
  dataCount_ -= static_cast<std::int32_t>(byteCount);
}

template <class T>
T ResultReader::number() {
  const T value = fromLittleEndian<T>(bytes(sizeof(T)));
  advance(sizeof(T));
  return value;
}

template <class T>
std::size_t ResultReader::arrayInto(std::span<T> values) {
  const std::size_t count = announced();
  const std::uint8_t* const elements = bytes(count * sizeof(T), kCountBytes);
  if (count > values.size()) raiseSubscriptOutOfRange();
  fromLittleEndian(elements, values.first(count));
  advance(kCountBytes + count * sizeof(T));
  return count;
}

template <class T>
std::vector<T> ResultReader::array(std::size_t ahead) {
  const std::size_t count = announced(ahead);
  const std::uint8_t* const elements = bytes(count * sizeof(T), ahead + kCountBytes);
  std::vector<T> values(count);
  fromLittleEndian(elements, std::span(values));
  advance(ahead + kCountBytes + count * sizeof(T));
  return values;
}

bool CopyVariantToArray(const Variant& variant, std::vector<float>& values) {
  return copyElements(variant, values);
}

bool CopyVariantToArray(const Variant& variant, std::vector<double>& values) {
  return copyElements(variant, values);
}

}  // namespace frontpanels
