// Any sequence of reads on any bytes, from any cursor and count. The input is the number of reads, a byte a
// read, how the cursor stands, and the buffer.
#include <array>
#include <cstdint>
#include <limits>
#include <optional>
#include <string>
#include <vector>

#include "fuzz/fuzz_input.h"
#include "platform/result_reader.h"
#include "platform/runtime_error.h"

namespace frontpanels::fuzz {
namespace {

// Answers how many bytes the read has taken memory for.
using Read = std::size_t (*)(ResultReader& reader, std::uint8_t argument);

template <class T>
std::size_t sizeOf(const T& values) {
  return values.size() * sizeof(values[0]);
}

template <auto read>
std::size_t number(ResultReader& reader, std::uint8_t) {
  static_cast<void>((reader.*read)());
  return 0;
}

std::size_t text(ResultReader& reader, std::uint8_t) { return sizeOf(reader.GetMeasurementString()); }
std::size_t skip(ResultReader& reader, std::uint8_t argument) {
  reader.SkipMeasurementData(static_cast<std::int8_t>(argument));
  return 0;
}
std::size_t skipTooFar(ResultReader& reader, std::uint8_t argument) {
  reader.SkipMeasurementData(std::numeric_limits<std::int32_t>::max() - argument);
  return 0;
}
std::size_t singles(ResultReader& reader, std::uint8_t) { return sizeOf(reader.GetFloat32Array()); }
std::size_t doubles(ResultReader& reader, std::uint8_t) { return sizeOf(reader.GetFloat64Array()); }

// Into memory of exactly the room that the argument says, for the sanitizer to watch.
std::size_t singlesInto(ResultReader& reader, std::uint8_t argument) {
  std::vector<float> values(argument);
  return reader.GetFloat32Array(std::span(values)) * sizeof(float);
}
std::size_t doublesInto(ResultReader& reader, std::uint8_t argument) {
  std::vector<double> values(argument);
  return reader.GetFloat64Array(std::span(values)) * sizeof(double);
}

std::size_t array(ResultReader& reader, std::uint8_t) {
  const Variant values = reader.GetMeasurementArray();
  std::vector<float> asSingles;
  std::vector<double> asDoubles;
  const bool copied = CopyVariantToArray(values, asSingles) || CopyVariantToArray(values, asDoubles);
  require(!copied || asSingles.size() + asDoubles.size() == values.elementCount(), "a copy is whole");
  return values.elementCount();
}

using R = ResultReader;
constexpr auto kReads = std::to_array<Read>(
    {number<&R::GetHardwareId>, number<&R::GetMeasurementId>, number<&R::GetSubMeasurementId>,
     number<&R::GetMeasurementTypeId>, number<&R::PeekMeasurementTypeId>, number<&R::GetMeasurementFloat64>,
     number<&R::GetMeasurementFloat32>, number<&R::GetMeasurementInt32>, number<&R::GetMeasurementInt16>,
     number<&R::GetMeasurementInt8>, number<&R::GetMeasurementUInt8>, text, skip, skipTooFar, singles,
     doubles, singlesInto, doublesInto, array});

struct Cursor {
  std::int32_t pointer = 0;
  std::int32_t count = 0;
  friend bool operator==(const Cursor&, const Cursor&) = default;
};

bool liesIn(const Cursor& cursor, std::size_t size) {
  return cursor.pointer >= 0 && cursor.count >= 0 &&
         std::int64_t{cursor.pointer} + cursor.count <= static_cast<std::int64_t>(size);
}

// The run-time error that a call raises; anything else that it throws ends the program.
template <class Call>
std::optional<int> errorOf(Call call) {
  try {
    call();
    return std::nullopt;
  } catch (const RuntimeError& error) {
    return error.number();
  }
}

void read(ResultReader& reader, Cursor& cursor, std::uint8_t step, std::uint8_t argument) {
  constexpr int kSubscript = 9;
  constexpr int kTypeMismatch = 13;
  const Cursor before = cursor;
  std::size_t taken = 0;
  const auto error = errorOf([&] { taken = kReads[step % kReads.size()](reader, argument); });
  if (error) {
    require(*error == kSubscript || *error == kTypeMismatch, "an error of the two documented ones");
    require(cursor == before, "a failed read leaves the cursor");
    return;
  }
  require(cursor.pointer >= before.pointer, "the cursor never goes back");
  require(cursor.pointer - before.pointer == before.count - cursor.count, "cursor and count go together");
  require(static_cast<std::int64_t>(taken) <= before.count - cursor.count, "no memory without its bytes");
}

void run(FuzzInput input) {
  const auto script = input.bytes(input.number<std::uint8_t>());
  const bool placed = (input.number<std::uint8_t>() & 1) != 0;
  Cursor cursor;
  if (placed) cursor = {input.number<std::int32_t>(), input.number<std::int32_t>()};
  const auto rest = input.rest();
  const std::vector<std::uint8_t> buffer(rest.begin(), rest.end());  // of exactly this size
  if (!placed) cursor.count = static_cast<std::int32_t>(buffer.size());

  std::optional<ResultReader> reader;
  const auto refused = errorOf([&] { reader.emplace(buffer, cursor.pointer, cursor.count); });
  require(refused.has_value() != liesIn(cursor, buffer.size()), "a cursor is refused when it lies outside");
  if (!reader) return;
  for (std::size_t i = 0; i < script.size(); ++i) {
    read(*reader, cursor, script[i], script[script.size() - 1 - i]);
    require(liesIn(cursor, buffer.size()), "cursor and count stay inside the buffer");
  }
}

}  // namespace
}  // namespace frontpanels::fuzz

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  frontpanels::fuzz::run(frontpanels::fuzz::FuzzInput({data, size}));
  return 0;
}
