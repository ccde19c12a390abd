// The kinds of panel that the workbench can open, in the order of its menu.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>

#include "hosting/setting_names.h"

namespace frontpanels::workbench {

struct PanelKindRow {
  PanelKind kind;
  const char* progId;
  const char* controlName;  // what the container calls the control
  const char* caption;
  std::int32_t hardwareId;  // each kind measures on a receiver of its own
  std::int32_t measurementId;
};

inline constexpr std::array<PanelKindRow, 2> kPanelKinds = {{
    {PanelKind::Spectrum, "FrontPanels.SpectrumView", "SpectrumView1", "Spectrum", 1, 1},
    {PanelKind::Pilots, "FrontPanels.Tarvex", "Tarvex1", "Pilots", 2, 2},
}};

[[nodiscard]] constexpr const PanelKindRow& panelKind(PanelKind kind) noexcept {
  return kPanelKinds[static_cast<std::size_t>(kind)];
}

}  // namespace frontpanels::workbench
