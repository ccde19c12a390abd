// The colours of a graph. As a rule they are the painters' own on the system's button face; in the system's
// high contrast mode they are the scheme's, and what keeps a colour of its own stands out against the window.
// Whoever draws asks here and nowhere else.
#pragma once

#include <cstddef>

#include "platform/gdi.h"

namespace frontpanels {

// From 1 for equal colours to 21 for black and white: (lighter + 0.05) / (darker + 0.05) of their luminances.
[[nodiscard]] double contrastRatio(Color one, Color other) noexcept;
// What parts of a graph need against their neighbours to be told from them.
inline constexpr double kGraphContrast = 3;
// The colour itself where it reaches that against the background, else the first on its way to black or
// white, whichever is farther from the background, that does.
[[nodiscard]] Color standingOut(Color own, Color background) noexcept;

// As the system has it at construction: made for a step of painting, not kept.
class PlotColors {
 public:
  // `gdi` must outlive the colours.
  explicit PlotColors(Gdi& gdi) : gdi_(gdi), highContrast_(gdi.highContrast()) {}

  // Whether the scheme's colours hold instead of the painters' own.
  [[nodiscard]] bool byScheme() const noexcept { return highContrast_; }
  [[nodiscard]] Color background() const { return gdi_.sysColor(backgroundName()); }
  [[nodiscard]] BrushHandle backgroundBrush() const { return gdi_.sysColorBrush(backgroundName()); }
  // Of labels, borders and whatever else is written.
  [[nodiscard]] Color text() const {
    return gdi_.sysColor(highContrast_ ? SystemColor::WindowText : SystemColor::ButtonText);
  }
  [[nodiscard]] Color grid(Color own) const {
    return highContrast_ ? gdi_.sysColor(SystemColor::GrayText) : own;
  }
  // Some schemes have a grey that outshines the traces: in them the grid steps back as dots.
  [[nodiscard]] PenStyle gridStyle(PenStyle own) const noexcept {
    return highContrast_ ? PenStyle::Dot : own;
  }
  // The active marker.
  [[nodiscard]] Color selected(Color own) const {
    return highContrast_ ? line(gdi_.sysColor(SystemColor::Highlight)) : own;
  }
  // Traces, bars and markers.
  [[nodiscard]] Color line(Color own) const { return highContrast_ ? standingOut(own, background()) : own; }
  // Of a text on a bar of this colour.
  [[nodiscard]] Color textOn(Color bar, Color own) const;
  // By trace index: in high contrast the colour is not the only thing that tells traces apart.
  [[nodiscard]] PenStyle traceStyle(std::size_t index) const noexcept;

 private:
  [[nodiscard]] SystemColor backgroundName() const noexcept {
    return highContrast_ ? SystemColor::Window : SystemColor::ButtonFace;
  }

  Gdi& gdi_;
  bool highContrast_;
};

}  // namespace frontpanels
