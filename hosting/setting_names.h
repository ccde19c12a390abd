// What the settings of a panel are called where people read them: in a settings file, in the head of an
// export. The numbers themselves are in framework/support/host_codes.h.
#pragma once

#include <cstdint>
#include <optional>
#include <string_view>

namespace frontpanels {

enum class PanelKind { Spectrum, Pilots };

// With its unit in brackets where it has one; empty for a code that the panel does not have.
[[nodiscard]] std::string_view settingName(PanelKind panel, std::int16_t code) noexcept;

// "spectrum" or "pilots"; and the kind whose word a text begins with, alone or before a blank.
[[nodiscard]] std::string_view panelWord(PanelKind panel) noexcept;
[[nodiscard]] std::optional<PanelKind> panelOfWord(std::string_view text) noexcept;

}  // namespace frontpanels
