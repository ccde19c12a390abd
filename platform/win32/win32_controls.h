// The controls of a panel as real child windows of one window. Texts, choices and states go both ways; sizes
// are twips scaled by the window's dots per inch.
#pragma once

#include <windows.h>

#include <functional>
#include <memory>

#include "platform/control_set.h"

namespace frontpanels {

class FieldWindows;

class Win32Controls {
 public:
  // Runs what a message of a field causes and lets nothing thrown pass; where to report is the owner's
  // choice. Without one, failures are dropped.
  using Barrier = std::function<void(const std::function<void()>& body)>;

  // The set must outlive this. The windows go with this, also inside an event of a control.
  explicit Win32Controls(ControlSet& set, Barrier barrier = {});
  ~Win32Controls();
  Win32Controls(const Win32Controls&) = delete;
  Win32Controls& operator=(const Win32Controls&) = delete;

  // Makes the windows in `parent`, whose procedure hands its messages to parentMessage. The font stays the
  // caller's, at the parent's scale; without one it is that of dialogs. Raises "Out of memory".
  void create(HWND parent, HFONT font = nullptr);
  void destroy() noexcept;
  // Places and fonts anew, after the parent's scale or the container's font has changed.
  void rescale(HFONT font = nullptr);

  // For the parent's window procedure; false for a message that concerns no field.
  bool parentMessage(UINT message, WPARAM wide, LPARAM extra, LRESULT& result);
  // For the message loop, before a message is translated: Tab, the arrows of options, access keys. False for
  // what is not used; so is Tab on the last field (and Shift+Tab on the first), which leads out of the panel.
  bool translateKey(const MSG& message);

  // Null where there is none.
  [[nodiscard]] HWND window(const Control& control) const noexcept;

 private:
  std::shared_ptr<FieldWindows> windows_;
};

}  // namespace frontpanels
