// The designer table of SpectrumView: every control of the panel beside its graph.
//
// The display area (right: trace, vertical scale, markers) and the measurement area (bottom: frequency,
// sweep, units, band, interval, IF bandwidth) are laid out to stand whole in a view of 12000 x 9000 twips,
// 800 x 600 pixels at 96 dots an inch. The two buttons without a caption lie along the inner edges of the
// areas.
#pragma once

#include <span>

#include "platform/control_set.h"

namespace frontpanels {

// Texts in angle brackets are shown with them.
[[nodiscard]] std::span<const ControlRow> spectrumControls() noexcept;

}  // namespace frontpanels
