// What a panel hands to its host for keeping: parameter codes with their values, in the order in which the
// host sends them back through `vfpSet` to restore the panel.
#pragma once

#include <cstdint>
#include <vector>

#include "platform/variant.h"

namespace frontpanels {

struct PanelSetting {
  std::int16_t parameterType = 0;
  Variant value;
  friend bool operator==(const PanelSetting&, const PanelSetting&) = default;
};

using PanelSettings = std::vector<PanelSetting>;

}  // namespace frontpanels
