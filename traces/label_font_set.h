// The four fonts that a panel's labels are written with, and the style they are made in.
#pragma once

#include <array>
#include <string_view>

#include "platform/gdi.h"
#include "platform/windowing.h"

namespace frontpanels {

// Bold unless the process was started with "NormalLabels"; "BoldLabels" is the default said aloud, and loses
// to the other when both are given. The case counts.
[[nodiscard]] bool boldLabels(std::string_view commandLine) noexcept;

// In the order in which the trace manager uses them.
enum class LabelFont : std::uint8_t { SmallAxis, ActiveAxis, SmallCorner, ActiveCorner };
using LabelFontHandles = std::array<FontHandle, 4>;

// Owns the fonts. A font that could not be made stays null: its labels appear in the surface's own font.
class LabelFontSet {
 public:
  LabelFontSet(Gdi& gdi, ScreenMetrics metrics, bool bold);
  ~LabelFontSet();
  LabelFontSet(const LabelFontSet&) = delete;
  LabelFontSet& operator=(const LabelFontSet&) = delete;

  [[nodiscard]] const LabelFontHandles& handles() const noexcept { return handles_; }
  // The same style at another scale.
  [[nodiscard]] LabelFontSet scaledTo(ScreenMetrics metrics) const { return {gdi_, metrics, bold_}; }
  // Of the same graphics interface.
  void swap(LabelFontSet& other) noexcept { handles_.swap(other.handles_); }

 private:
  Gdi& gdi_;
  bool bold_;
  LabelFontHandles handles_;
};

}  // namespace frontpanels
