// The designer table of Tarvex: every control of the panel beside its graph.
//
// The display area (right: bars, vertical scale, markers) and the measurement area (bottom: sets of pilots,
// code window, user's list, carrier) are laid out to stand whole in a view of 12000 x 9000 twips, 800 x 600
// pixels at 96 dots an inch.
#pragma once

#include <span>

#include "platform/control_set.h"

namespace frontpanels {

[[nodiscard]] std::span<const ControlRow> pilotControls() noexcept;

}  // namespace frontpanels
