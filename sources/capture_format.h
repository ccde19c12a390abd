// The bytes of a capture, as docs/capture-format.md has them: little-endian and packed.
#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>
#include <string_view>
#include <vector>

#include "sources/frame.h"

namespace frontpanels {

// No text begins with the first byte; a transfer that touches line ends breaks the last two.
inline constexpr std::string_view kCaptureMagic =
    "\x93"
    "FPCAP\r\n";
inline constexpr std::uint32_t kCaptureVersion = 1;
inline constexpr std::size_t kCaptureHeaderBytes = 16;

inline constexpr std::string_view kBlockMarker =
    "\xb7"
    "BLK";
inline constexpr std::size_t kBlockHeaderBytes = 20;
// A sweep of kMaxSweepBins takes half of it. What says that it is longer is no block.
inline constexpr std::size_t kMaxPayloadBytes = std::size_t{32} << 20;

inline constexpr std::uint32_t kFrameBlock = 1;  // the kind

struct CaptureHeader {
  std::uint32_t version = 0;
  bool intact = false;  // by its check
};

[[nodiscard]] std::vector<char> captureHeader();
// `bytes` are kCaptureHeaderBytes and begin with the magic.
[[nodiscard]] CaptureHeader parseCaptureHeader(std::span<const char> bytes);

struct BlockHeader {
  std::uint32_t kind = 0;
  std::uint32_t payloadBytes = 0;
  std::uint32_t check = 0;  // over kind and payload
};

// Nothing for what is no header: marker, check or length are wrong. `bytes` are kBlockHeaderBytes.
[[nodiscard]] std::optional<BlockHeader> parseBlockHeader(std::span<const char> bytes);
[[nodiscard]] std::uint32_t blockCheck(std::uint32_t kind, std::span<const char> payload);

// The whole block of a frame into `block`, whose capacity is reused. False for a frame that no capture takes:
// longer than a payload may be, or with a sweep whose bins have no place (see the document).
[[nodiscard]] bool encodeFrame(const Frame& frame, std::vector<char>& block);
// Into `frame`, whose number stays and whose room is used again. False when the payload is no frame; `frame`
// is then unspecified.
[[nodiscard]] bool decodeFrame(std::span<const char> payload, Frame& frame);

}  // namespace frontpanels
