// Any text as a settings file: it is refused with a reason, or what it says is written and read again.
#include <optional>
#include <string>

#include "fuzz/fuzz_input.h"
#include "hosting/settings_file.h"
#include "platform/runtime_error.h"

namespace frontpanels::fuzz {
namespace {

std::optional<SettingsFile> parsed(std::string_view text) {
  constexpr int kInvalidFileFormat = 321;
  try {
    return SettingsFile::parse(text);
  } catch (const RuntimeError& error) {
    require(error.number() == kInvalidFileFormat && !error.description().empty(), "a refusal has its reason");
    return std::nullopt;
  }
}

void run(std::string_view text) {
  const std::optional<SettingsFile> file = parsed(text);
  if (!file) return;
  const std::string written = file->text();
  const std::optional<SettingsFile> back = parsed(written);
  require(back.has_value(), "what was written can be read");
  require(!back->changedByHand(), "what was written has its checksum");
  require(back->text() == written, "nothing changes on the way");
  require(!parsed(written.substr(0, written.size() / 2)), "half a file is none");
}

}  // namespace
}  // namespace frontpanels::fuzz

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  frontpanels::fuzz::run({reinterpret_cast<const char*>(data), size});
  return 0;
}
