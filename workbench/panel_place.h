// What the container's objects need to know of the window that gives a panel its place, and what a panel asks
// of its host.
#pragma once

#include <windows.h>

#include <oaidl.h>

#include <cstdint>
#include <string>

namespace frontpanels::workbench {

// How a panel's window stands in the program's, as the container's interfaces count it.
enum ViewState : LONG { kViewNormal = 0, kViewMinimised = 1, kViewMaximised = 2 };

class PanelPlace {
 public:
  // The window that the panel's own becomes a child of, and the place in it, in pixels.
  [[nodiscard]] virtual HWND parentWindow() = 0;
  [[nodiscard]] virtual RECT panelRect() = 0;
  // The program's window.
  [[nodiscard]] virtual HWND frameWindow() = 0;
  [[nodiscard]] virtual HACCEL acceleratorTable() = 0;
  // The text that the panel gives its container, and one that it wants to be seen for a while.
  virtual void panelCaption(const std::wstring& text) = 0;
  virtual void statusText(const std::wstring& text) = 0;
  // True when the key was one of the program's own and has been dealt with.
  virtual bool translateAccelerator(MSG& message) = 0;
  // The panel's place among the others, in pixels, while it is neither minimised nor maximised.
  [[nodiscard]] virtual RECT bounds() = 0;
  virtual void bounds(const RECT& wanted) = 0;
  [[nodiscard]] virtual bool visible() = 0;
  virtual void visible(bool visible) = 0;
  [[nodiscard]] virtual LONG viewState() = 0;
  virtual void viewState(LONG state) = 0;

 protected:
  ~PanelPlace() = default;
};

// By what a panel is known to its host.
struct PanelIds {
  std::int32_t hardware = 0;
  std::int32_t panel = 0;
};

// Requests of a panel to its host. The answer is a status: 0 done, anything else failure.
class PanelRequests {
 public:
  // `argument` is true where the panel sent none or something else than a number: operations are switched on.
  virtual std::int32_t frontPanelOp(PanelIds ids, std::int16_t operation, std::int32_t argument) = 0;
  // The user has changed a setting; `value` is not-a-number where the panel sent something else.
  virtual std::int32_t frontPanelSet(PanelIds ids, std::int16_t parameterType, std::int16_t index,
                                     double value) = 0;
  // Settings to keep: code, value, code, value, ...
  virtual std::int32_t saveDisplaySettings(PanelIds ids, const VARIANT& list) = 0;
  // The panel's settings are to be kept under the id of a set-up; they can be read inside the call.
  virtual std::int32_t saveSetup(std::int32_t setUpId, PanelIds ids) = 0;

 protected:
  ~PanelRequests() = default;
};

}  // namespace frontpanels::workbench
