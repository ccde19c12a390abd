// The controls of a panel as real child windows of one window. Texts, choices and states go both ways; sizes
// are twips scaled by the window's dots per inch.
#pragma once

#include <windows.h>

#include <functional>
#include <memory>

#include "platform/control_set.h"

namespace frontpanels {

class FieldWindows;

// The window round the fields.
class FieldsOwner {
 public:
  virtual ~FieldsOwner() = default;

  // Runs what a message of a field causes and lets nothing thrown pass; where to report is the owner's
  // choice.
  virtual void run(const std::function<void()>& body) noexcept = 0;
  // The keyboard focus comes to a field, or leaves one for another window, which may be null.
  virtual void focusMoved(HWND /*to*/) {}
  // While not in use, as in a designer, the mouse passes through the fields.
  [[nodiscard]] virtual bool inUse() const { return true; }
  // A field's window is asked for what to read aloud of it (WM_GETOBJECT for its client); false leaves the
  // answer to the system.
  virtual bool readAloud(const Control& /*control*/, HWND /*window*/, WPARAM /*flags*/, LRESULT& /*result*/) {
    return false;
  }
  // A field was shown, hidden, enabled, disabled or renamed: access keys may lead elsewhere.
  virtual void accessKeysChanged() {}
};

class Win32Controls {
 public:
  // Both must outlive this. The windows go with this, also inside an event of a control.
  Win32Controls(ControlSet& set, FieldsOwner& owner);
  ~Win32Controls();
  Win32Controls(const Win32Controls&) = delete;
  Win32Controls& operator=(const Win32Controls&) = delete;

  // Makes the windows in `parent`, whose procedure hands its messages to parentMessage. The font stays the
  // caller's, at the same scale; without one it is that of dialogs. The scale is in dots per inch, 0 for the
  // parent's own. Raises "Out of memory".
  void create(HWND parent, HFONT font = nullptr, int dpi = 0);
  void destroy() noexcept;
  // Places and fonts anew, after the parent's scale or the container's font has changed.
  void rescale(HFONT font = nullptr, int dpi = 0);

  // For the parent's window procedure; false for a message that concerns no field.
  bool parentMessage(UINT message, WPARAM wide, LPARAM extra, LRESULT& result);
  // For the message loop, before a message is translated: Tab, the arrows of options, access keys. False for
  // what is not used; so is Tab on the last field (and Shift+Tab on the first), which leads out of the panel.
  bool translateKey(const MSG& message);
  // The focus comes to the first field, or to the last; false when there is none that could have it.
  bool enter(bool forward);
  // For a key that reaches the parent without having been translated: as translateKey, but Tab that leads out
  // of the panel goes on to the next window of the dialog.
  bool untranslatedKey(UINT message, WPARAM key);

  // Null where there is none.
  [[nodiscard]] HWND window(const Control& control) const noexcept;

 private:
  std::shared_ptr<FieldWindows> windows_;
};

}  // namespace frontpanels
