// Arbitrary bytes as a capture. The input is a byte, and the file behind the header of it: where the byte is
// odd, the checks of its blocks are made right first, so that what is in them is read.
#include <cstring>
#include <string_view>
#include <vector>

#include "fuzz/fuzz_files.h"
#include "sources/capture_format.h"
#include "sources/crc32c.h"

namespace frontpanels::fuzz {
namespace {

constexpr std::size_t kLengthAt = 8;
constexpr std::size_t kBlockCheckAt = 12;
constexpr std::size_t kHeaderCheckAt = 16;

// From block to block, as far as their lengths lie in the file.
void makeChecksRight(std::vector<std::uint8_t>& file) {
  char* const bytes = reinterpret_cast<char*>(file.data());
  for (std::size_t at = kCaptureHeaderBytes; at + kBlockHeaderBytes <= file.size();) {
    std::uint32_t length = 0;
    std::memcpy(&length, bytes + at + kLengthAt, sizeof length);
    const std::size_t room = file.size() - at - kBlockHeaderBytes;
    const std::size_t payload = std::min<std::size_t>(length, room);
    const std::uint32_t check = blockCheck(kFrameBlock, {bytes + at + kBlockHeaderBytes, payload});
    std::memcpy(bytes + at + kBlockCheckAt, &check, sizeof check);
    const std::uint32_t headerCheck = crc32c({bytes + at, kHeaderCheckAt});
    std::memcpy(bytes + at + kHeaderCheckAt, &headerCheck, sizeof headerCheck);
    at += kBlockHeaderBytes + payload;
  }
}

void run(FuzzInput input) {
  const bool right = (input.number<std::uint8_t>() & 1) != 0;
  const std::vector<char> header = captureHeader();
  std::vector<std::uint8_t> file(header.begin(), header.end());
  const auto rest = input.rest();
  file.insert(file.end(), rest.begin(), rest.end());
  if (right) makeChecksRight(file);
  FuzzFiles files(file);
  require(playEverything(files) != nullptr, "whatever follows the header of a capture, it is opened");
}

}  // namespace
}  // namespace frontpanels::fuzz

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  frontpanels::fuzz::run(frontpanels::fuzz::FuzzInput({data, size}));
  return 0;
}
