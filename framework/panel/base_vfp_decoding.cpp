// Result buffers: the loop of clsBaseVFP that hands each record to the panel.
#include "framework/panel/base_vfp.h"
#include "framework/support/enumerated_tables.h"
#include "framework/support/error_handler.h"
#include "framework/support/guard.h"
#include "framework/support/host_codes.h"
#include "platform/result_reader.h"

namespace frontpanels {
namespace {

// What is left of the record that begins at the cursor, once `remainder` bytes are left after it.
struct RecordExtent {
  std::int32_t begin;
  std::int32_t bytesBefore;
  std::int32_t remainder;

  [[nodiscard]] bool consumed(std::int32_t cursor, std::int32_t bytesLeft) const noexcept {
    return bytesLeft <= remainder && bytesLeft >= 0 && cursor >= begin;
  }
};

// Result types have 32 bits, enumerated values 16: what does not fit has no label.
std::string resultTypeLabel(std::int32_t resultTypeId) {
  const auto value = static_cast<std::int16_t>(resultTypeId);
  return value == resultTypeId ? enumeratedLabel(kResultTypeEnumeration, value)
                               : std::to_string(resultTypeId);
}

// The record's length comes first. One that reaches beyond the buffer cannot be stepped over, whoever reads
// it.
RecordExtent readExtent(ResultReader& reader) {
  const std::int16_t length = reader.GetMeasurementInt16();
  if (length < 0 || length > reader.dataCount()) raiseSubscriptOutOfRange();
  return {reader.dataPointer(), reader.dataCount(), reader.dataCount() - length};
}

}  // namespace

std::int32_t clsBaseVFP::displayData(const Variant& /*vParameter*/, std::span<const std::uint8_t> resultData,
                                     std::int32_t& dataPointer, std::int32_t& dataCount,
                                     std::int32_t /*resultTypeId*/, std::int32_t /*resultLength*/) {
  if (closing_) return kStatusDone;
  return guarded("clsBaseVFP::displayData() ... ", kStatusUnusableParameter, [&] {
    ResultReader reader(resultData, dataPointer, dataCount);
    if (reader.GetHardwareId() != resourceId_ && resourceIdValid_) {
      errorHandler().Assert("clsBaseVFP::displayData() ... wrong resource id");
      return kStatusUnusableParameter;
    }
    while (const std::int32_t id = reader.GetMeasurementId()) {
      if (id != measurementId) errorHandler().Assert("clsBaseVFP::displayData() ... wrong measurement id");
      decodeMeasurement(reader);
    }
    return kStatusDone;
  });
}

void clsBaseVFP::decodeMeasurement(ResultReader& reader) {
  while (reader.GetSubMeasurementId() != 0)
    while (const std::int32_t resultTypeId = reader.GetMeasurementTypeId())
      decodeRecord(reader, resultTypeId);
}

void clsBaseVFP::decodeRecord(ResultReader& reader, std::int32_t resultTypeId) {
  const RecordExtent record = readExtent(reader);
  child_.resultData(resultTypeId, reader, furtherArgument());
  if (record.consumed(reader.dataPointer(), reader.dataCount())) return;
  const bool untouched = reader.dataCount() == record.bytesBefore;
  errorHandler().Assert(child_.typeName() +
                        (untouched ? "::DisplayData() ... no data read for result type "
                                   : "::DisplayData() ... partial data read for result type ") +
                        resultTypeLabel(resultTypeId));
  reader.SkipMeasurementData(reader.dataCount() - record.remainder);
}

}  // namespace frontpanels
