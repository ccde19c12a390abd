#include "platform/result_writer.h"

#include <limits>
#include <variant>

#include "platform/result_layout.h"
#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

constexpr std::int32_t kEnd = 0;  // where an id is expected

// The reader's cursor has 32 bits, and what is open must still find room for its ends.
constexpr std::size_t kMaxBytes = std::numeric_limits<std::int32_t>::max();
constexpr std::size_t kMaxOpenBytes = kMaxBytes - 3 * kIdBytes;

// A count fits whenever its values fit a record.
template <class T>
void putCounted(std::span<const T> values, std::uint8_t* place) noexcept {
  toLittleEndian(static_cast<std::int16_t>(values.size()), place);
  toLittleEndian(values, place + kCountBytes);
}

}  // namespace

void ResultWriter::HardwareId(std::int32_t id) {
  requireOpen(Level::Nothing);
  toLittleEndian(id, grow(kIdBytes, kMaxOpenBytes));
  level_ = Level::Buffer;
}

void ResultWriter::BeginMeasurement(std::int32_t id) { begin(Level::Buffer, Level::Measurement, id); }
void ResultWriter::BeginSubMeasurement(std::int32_t id) {
  begin(Level::Measurement, Level::SubMeasurement, id);
}

void ResultWriter::BeginRecord(std::int32_t resultType) {
  begin(Level::SubMeasurement, Level::Record, resultType, kCountBytes);  // EndRecord fills in the length
  recordStart_ = bytes_.size();
}

void ResultWriter::Int8(std::int8_t value) { number(value); }
void ResultWriter::UInt8(std::uint8_t value) { number(value); }
void ResultWriter::Int16(std::int16_t value) { number(value); }
void ResultWriter::Int32(std::int32_t value) { number(value); }
void ResultWriter::Float32(float value) { number(value); }
void ResultWriter::Float64(double value) { number(value); }
void ResultWriter::Float32Array(std::span<const float> values) { counted(values); }
void ResultWriter::Float64Array(std::span<const double> values) { counted(values); }

void ResultWriter::Array(const Variant& values) {
  std::visit(
      [this]<class T>(const T& elements) {
        if constexpr (kElementCode<T> != 0) {
          const std::span<const typename T::value_type> all(elements);
          std::uint8_t* const place = field(kCodeBytes + kCountBytes + all.size_bytes());
          *place = kElementCode<T>;
          putCounted(all, place + kCodeBytes);
        } else {
          raiseTypeMismatch();
        }
      },
      values.value());
}

void ResultWriter::Text(std::string_view text) { counted(std::span<const char>(text)); }

void ResultWriter::EndRecord() {
  requireOpen(Level::Record);
  toLittleEndian(static_cast<std::int16_t>(bytes_.size() - recordStart_),
                 bytes_.data() + recordStart_ - kCountBytes);
  level_ = Level::SubMeasurement;
}

void ResultWriter::EndSubMeasurement() { end(Level::SubMeasurement, Level::Measurement); }
void ResultWriter::EndMeasurement() { end(Level::Measurement, Level::Buffer); }

std::vector<std::uint8_t> ResultWriter::Bytes() const {
  requireOpen(Level::Buffer);
  std::vector<std::uint8_t> bytes = bytes_;
  bytes.resize(bytes_.size() + kIdBytes);
  toLittleEndian(kEnd, bytes.data() + bytes_.size());
  return bytes;
}

void ResultWriter::Clear() noexcept {
  bytes_.clear();
  level_ = Level::Nothing;
}

void ResultWriter::requireOpen(Level level) const {
  if (level_ != level) raiseInvalidProcedureCall();
}

void ResultWriter::begin(Level outer, Level level, std::int32_t id, std::size_t bytesBehindId) {
  requireOpen(outer);
  if (id == kEnd) raiseInvalidProcedureCall();
  toLittleEndian(id, grow(kIdBytes + bytesBehindId, kMaxOpenBytes));
  level_ = level;
}

void ResultWriter::end(Level level, Level outer) {
  requireOpen(level);
  toLittleEndian(kEnd, grow(kIdBytes, kMaxBytes));
  level_ = outer;
}

std::uint8_t* ResultWriter::field(std::size_t byteCount) {
  requireOpen(Level::Record);
  if (byteCount > kMaxRecordBytes - (bytes_.size() - recordStart_)) raiseOverflow();
  return grow(byteCount, kMaxOpenBytes);
}

std::uint8_t* ResultWriter::grow(std::size_t byteCount, std::size_t limit) {
  const std::size_t before = bytes_.size();
  if (before + byteCount > limit) raiseOverflow();
  bytes_.resize(before + byteCount);
  return bytes_.data() + before;
}

template <class T>
void ResultWriter::number(T value) {
  toLittleEndian(value, field(sizeof(T)));
}

template <class T>
void ResultWriter::counted(std::span<const T> values) {
  putCounted(values, field(kCountBytes + values.size_bytes()));
}

}  // namespace frontpanels
