// The window of the code that zoomed pilots are measured in (start, stop, centre and span), the increment
// between the PN offsets of a network, and how they follow each other. The window is held in whole chips of
// the current code format, the increment in PN offsets. What is written here is no news to the entries'
// owner.
#pragma once

#include <cstdint>

#include "entry/numeric_entry.h"

namespace frontpanels {

// What code positions are shown and typed in.
enum class CodeUnits : std::uint8_t { Pn, Chips };

// Sets an entry that holds `chipsPerUnit` chips a unit to show its value in PN offsets or in chips of a
// format with `chipsPerPn`.
void showCodeUnits(clsNumericEntry& entry, CodeUnits units, double chipsPerUnit, std::int32_t chipsPerPn);

class CodeEntries {
 public:
  // The whole short code in IS-95B chips, shown in PN offsets; increment 1.
  CodeEntries();

  clsNumericEntry start;
  clsNumericEntry stop;
  clsNumericEntry center;
  clsNumericEntry span;
  clsNumericEntry pnIncrement;

  [[nodiscard]] std::int16_t format() const noexcept { return format_; }
  // Every position is expressed in the new format; the units shown stay.
  void format(std::int16_t format) noexcept;
  [[nodiscard]] CodeUnits units() const noexcept { return units_; }
  void units(CodeUnits units) noexcept;

  // A host's start keeps the span, which is cut at the end of the code; its span keeps the start. So the two
  // restore a window in this order.
  void startFromHost(double chips) noexcept;
  void spanFromHost(double chips) noexcept;
  // The window moves as far as the code allows.
  void centerFromHost(double chips) noexcept;

  // After the user has changed one of them. The window gives way at the ends of the code; a start above the
  // stop drags the other edge along.
  void fitCenter() noexcept;
  void fitSpan() noexcept;
  void joinEdges(bool startChanged) noexcept;
  // The edges round the centre, after one of them was changed in vain.
  void placeEdges() noexcept;

  // Where the window begins, in PN offsets.
  [[nodiscard]] double startPn() const noexcept;

 private:
  // A window in whole chips round its centre, moved so that it lies inside the code.
  void place(double from, double chips, double around) noexcept;
  void place(double from, double chips) noexcept { place(from, chips, from + chips * 0.5); }
  void show() noexcept;

  std::int16_t format_ = 0;
  CodeUnits units_ = CodeUnits::Pn;
  double lastChip_ = 0;  // of the code, in the current format
  double start_ = 0;     // chips of the current format, whole
  double span_ = 0;
  double center_ = 0;  // as it was entered: of an odd span the edges lie half a chip off
};

}  // namespace frontpanels
