// What reader and writer of result buffers share: how a number stands in bytes, and the codes by which an
// array names its elements. The layout as a whole is in docs/result-buffer.md.
#pragma once

#include <bit>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <limits>
#include <span>

#include "platform/variant.h"

namespace frontpanels {

// Of the arrays that a buffer can hold, by the usual codes of variant types; 0 for a type that it cannot.
template <class T>
inline constexpr std::uint8_t kElementCode = 0;
template <>
inline constexpr std::uint8_t kElementCode<Variant::Int16s> = 2;
template <>
inline constexpr std::uint8_t kElementCode<Variant::Int32s> = 3;
template <>
inline constexpr std::uint8_t kElementCode<Variant::Singles> = 4;
template <>
inline constexpr std::uint8_t kElementCode<Variant::Doubles> = 5;
template <>
inline constexpr std::uint8_t kElementCode<Variant::Bytes> = 17;

inline constexpr std::size_t kIdBytes = sizeof(std::int32_t);
inline constexpr std::size_t kCodeBytes = sizeof(std::uint8_t);
inline constexpr std::size_t kCountBytes = sizeof(std::int16_t);
// The largest length that its 16 bits can announce.
inline constexpr std::size_t kMaxRecordBytes = std::numeric_limits<std::int16_t>::max();

// The lowest byte first, whatever the host's order and the alignment of the bytes.
template <class T>
[[nodiscard]] T fromLittleEndian(const std::uint8_t* bytes) noexcept {
  std::uint8_t inHostOrder[sizeof(T)];
  for (std::size_t i = 0; i < sizeof(T); ++i)
    inHostOrder[std::endian::native == std::endian::little ? i : sizeof(T) - 1 - i] = bytes[i];
  T value;
  std::memcpy(&value, inHostOrder, sizeof(T));
  return value;
}

template <class T>
void toLittleEndian(T value, std::uint8_t* bytes) noexcept {
  std::uint8_t inHostOrder[sizeof(T)];
  std::memcpy(inHostOrder, &value, sizeof(T));
  for (std::size_t i = 0; i < sizeof(T); ++i)
    bytes[i] = inHostOrder[std::endian::native == std::endian::little ? i : sizeof(T) - 1 - i];
}

// Values one after the other; an empty span has no address to copy to or from.
template <class T>
void fromLittleEndian(const std::uint8_t* bytes, std::span<T> values) noexcept {
  if (values.empty()) return;
  if constexpr (std::endian::native == std::endian::little) {
    std::memcpy(values.data(), bytes, values.size_bytes());
  } else {
    for (std::size_t i = 0; i < values.size(); ++i) values[i] = fromLittleEndian<T>(bytes + i * sizeof(T));
  }
}

template <class T>
void toLittleEndian(std::span<const T> values, std::uint8_t* bytes) noexcept {
  if (values.empty()) return;
  if constexpr (std::endian::native == std::endian::little) {
    std::memcpy(bytes, values.data(), values.size_bytes());
  } else {
    for (std::size_t i = 0; i < values.size(); ++i) toLittleEndian(values[i], bytes + i * sizeof(T));
  }
}

}  // namespace frontpanels
