// The strip between the panels and the status bar: where in its recording the play is, or how far a long work
// is, with a button that ends it.
#pragma once

#include <windows.h>

#include <cstdint>
#include <optional>
#include <string>

namespace frontpanels::workbench {

class TimeStrip {
 public:
  // Its windows are children of `parent`, which gets their messages. Raises a failure when the system
  // refuses.
  explicit TimeStrip(HWND parent);
  TimeStrip(const TimeStrip&) = delete;
  TimeStrip& operator=(const TimeStrip&) = delete;
  ~TimeStrip() = default;  // the parent takes its children with it

  // In pixels; 0 while nothing is shown.
  [[nodiscard]] LONG heightPx() const noexcept;
  void layOut(const RECT& place);

  // A play without frames, or without an end, has no place in time: nothing is shown then.
  void showPlace(std::uint64_t frame, std::optional<std::uint64_t> frames);
  void showProgress(const std::string& what, int percent);
  void endProgress();

  // The frame that the user has moved to, when `extra` is that of a message from the slider.
  [[nodiscard]] std::optional<std::uint64_t> movedTo(LPARAM extra) const;
  void focus() const;
  [[nodiscard]] bool hasFocus() const { return GetFocus() == slider_; }

 private:
  enum class Shown { Nothing, Place, Progress };
  void show(Shown what);

  Shown shown_ = Shown::Nothing;
  std::optional<std::uint64_t> frames_;
  HWND slider_ = nullptr;
  HWND text_ = nullptr;
  HWND bar_ = nullptr;
  HWND cancel_ = nullptr;
};

}  // namespace frontpanels::workbench
