// Where keys take a marker along the values of a trace. Values that are not finite are gaps, in which no
// marker comes to stand. Each answers a point's index, or the one that the marker has where there is none to
// go to.
#pragma once

#include <cstdint>
#include <span>

namespace frontpanels {

// How far above the valley towards a higher peak a value has to stand to be a peak, in dB.
inline constexpr double kPeakExcursionDb = 6;

enum class TraceEnd : std::uint8_t { First, Last };
[[nodiscard]] std::int32_t endPoint(std::span<const double> values, std::int32_t from, TraceEnd end);

// A tenth of the points, at least one, as far as there are values.
enum class Towards : std::int8_t { Left = -1, Right = 1 };
[[nodiscard]] std::int32_t pointATenthOn(std::span<const double> values, std::int32_t from, Towards side);

// The peak that comes next when all are put in order, the highest first and of equal ones the left one.
enum class PeakOrder : std::uint8_t { Lower, Higher };
[[nodiscard]] std::int32_t nextPeak(std::span<const double> values, std::int32_t from, PeakOrder order);

}  // namespace frontpanels
