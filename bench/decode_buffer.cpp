// What decoding a sweep of 513 levels costs beside a plain copy of the same bytes.
#include <benchmark/benchmark.h>

#include <algorithm>
#include <array>
#include <chrono>
#include <cstdint>
#include <cstdio>
#include <cstring>
#include <span>
#include <vector>

#include "bench/allocation_count.h"
#include "platform/result_reader.h"
#include "platform/result_writer.h"

namespace frontpanels::bench {
namespace {

constexpr std::size_t kPoints = 513;
constexpr std::int32_t kArrayAt = 4 + 4 + 4 + 4 + 2;  // hardware id, two ids, type and length stand before
constexpr std::int32_t kSweep = 25;
constexpr double kLargestRatio = 4;
constexpr int kRounds = 501;
constexpr int kDecodesARound = 1000;

using Levels = std::array<float, kPoints>;

Levels sweep() {
  Levels levels{};
  for (std::size_t i = 0; i < levels.size(); ++i) levels[i] = -120 + static_cast<float>(i) / 8;
  return levels;
}

std::vector<std::uint8_t> bufferOf(const Levels& levels) {
  ResultWriter writer;
  writer.HardwareId(7);
  writer.BeginMeasurement(100);
  writer.BeginSubMeasurement(1);
  writer.BeginRecord(kSweep);
  writer.Float32Array(levels);
  writer.EndRecord();
  writer.EndSubMeasurement();
  writer.EndMeasurement();
  return writer.Bytes();
}

// The record alone, from its count on.
std::size_t decodeArray(std::span<const std::uint8_t> buffer, std::span<float> levels) {
  std::int32_t cursor = kArrayAt;
  std::int32_t left = static_cast<std::int32_t>(buffer.size()) - cursor;
  return ResultReader(buffer, cursor, left).GetFloat32Array(levels);
}

// As a decoding loop reads it: ids, type and length before, the ends behind.
std::size_t decodeWhole(std::span<const std::uint8_t> buffer, std::span<float> levels) {
  std::int32_t cursor = 0;
  auto left = static_cast<std::int32_t>(buffer.size());
  ResultReader reader(buffer, cursor, left);
  std::size_t points = 0;
  static_cast<void>(reader.GetHardwareId());
  while (reader.GetMeasurementId() != 0) {
    while (reader.GetSubMeasurementId() != 0) {
      while (const std::int32_t type = reader.GetMeasurementTypeId()) {
        const std::int16_t length = reader.GetMeasurementInt16();
        if (type == kSweep)
          points += reader.GetFloat32Array(levels);
        else
          reader.SkipMeasurementData(length);
      }
    }
  }
  return points;
}

std::size_t copyBytes(std::span<const std::uint8_t> buffer, std::span<float> levels) {
  std::memcpy(levels.data(), buffer.data() + kArrayAt + sizeof(std::int16_t), levels.size_bytes());
  return levels.size();
}

using Decode = std::size_t (*)(std::span<const std::uint8_t>, std::span<float>);

double nanosecondsADecode(Decode decode, std::span<const std::uint8_t> buffer, std::span<float> levels) {
  const auto start = std::chrono::steady_clock::now();
  for (int i = 0; i < kDecodesARound; ++i) {
    benchmark::DoNotOptimize(decode);  // neither known to the loop nor done only once
    benchmark::DoNotOptimize(decode(buffer, levels));
    benchmark::ClobberMemory();
  }
  const std::chrono::duration<double, std::nano> taken = std::chrono::steady_clock::now() - start;
  return taken.count() / kDecodesARound;
}

double median(std::vector<double> values) {
  std::nth_element(values.begin(), values.begin() + values.size() / 2, values.end());
  return values[values.size() / 2];
}

// Both in turn, so that what else the machine does falls on them alike. False when it decodes something else
// or costs too much.
bool report(const char* name, Decode decode) {
  const Levels written = sweep();
  const std::vector<std::uint8_t> buffer = bufferOf(written);
  Levels read{};
  const bool right = decode(buffer, read) == kPoints && read == written;
  std::vector<double> decoded;
  std::vector<double> copied;
  std::uint64_t allocations = 0;
  for (int round = 0; round < kRounds; ++round) {
    const std::uint64_t before = allocationCount();
    decoded.push_back(nanosecondsADecode(decode, buffer, read));
    allocations = allocationCount() - before;
    copied.push_back(nanosecondsADecode(copyBytes, buffer, read));
  }
  const double ratio = median(decoded) / median(copied);
  std::printf("%-16s %12.1f %12.1f %8.3f %12.2f%s\n", name, median(decoded), median(copied), ratio,
              static_cast<double>(allocations) / kDecodesARound, right ? "" : "  decoded wrongly");
  return right && ratio < kLargestRatio;
}

}  // namespace
}  // namespace frontpanels::bench

int main() {
  using namespace frontpanels::bench;
  std::printf("%-16s %12s %12s %8s %12s\n", "513 levels", "decode, ns", "memcpy, ns", "ratio", "allocations");
  const bool array = report("array", decodeArray);
  const bool whole = report("whole buffer", decodeWhole);
  return array && whole ? 0 : 1;
}
