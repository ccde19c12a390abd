// What the container's objects need to know of the window that gives a panel its place.
#pragma once

#include <windows.h>

#include <cstdint>
#include <string>
#include <string_view>

namespace frontpanels::workbench {

class PanelPlace {
 public:
  // The window that the panel's own becomes a child of, and the place in it, in pixels.
  [[nodiscard]] virtual HWND parentWindow() = 0;
  [[nodiscard]] virtual RECT panelRect() = 0;
  [[nodiscard]] virtual HACCEL acceleratorTable() = 0;
  // The text that the panel gives its container, and one that it wants to be seen for a while.
  virtual void panelCaption(const std::wstring& text) = 0;
  virtual void statusText(const std::wstring& text) = 0;
  // True when the key was one of the program's own and has been dealt with.
  virtual bool translateAccelerator(MSG& message) = 0;

 protected:
  ~PanelPlace() = default;
};

// Requests of a panel to its host. The answer is a status: 0 done, anything else failure.
class PanelRequests {
 public:
  virtual std::int32_t frontPanelOp(std::int32_t hardwareId, std::int32_t panelId,
                                    std::int16_t operation) = 0;
  // The user has changed a setting; `value` is not-a-number where the panel sent something else.
  virtual std::int32_t frontPanelSet(std::int32_t hardwareId, std::int32_t panelId,
                                     std::int16_t parameterType, std::int16_t index, double value) = 0;

 protected:
  ~PanelRequests() = default;
};

}  // namespace frontpanels::workbench
