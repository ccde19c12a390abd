// The window of a panel among the others: moved, sized, minimised and maximised by the user, by its menu or
// by the panel's host.
#pragma once

#include <windows.h>

#include <string>

#include "workbench/hosted_control.h"
#include "workbench/panel_place.h"

namespace frontpanels::workbench {

// The program's window as its panels' windows see it.
class PanelFrame {
 public:
  [[nodiscard]] virtual HWND frameWindow() = 0;
  // The window that holds those of the panels.
  [[nodiscard]] virtual HWND clientWindow() = 0;
  [[nodiscard]] virtual HACCEL acceleratorTable() = 0;
  virtual void statusText(const std::wstring& text) = 0;
  virtual bool translateAccelerator(MSG& message) = 0;
  // A panel has come, gone, or got the keys.
  virtual void panelsChanged() = 0;
  // The user has placed a panel by himself.
  virtual void placedByUser() = 0;
  virtual void failed(const std::string& message) noexcept = 0;

 protected:
  ~PanelFrame() = default;
};

// Called inside a window message: whoever closes the panel does it after that.
class PanelWindowEvents {
 public:
  virtual void closeAsked() = 0;
  virtual void popUpAsked(POINT onScreen) = 0;

 protected:
  ~PanelWindowEvents() = default;
};

class PanelWindow final : public PanelPlace {
 public:
  // Raises a failure when the system refuses. Both must outlive it.
  PanelWindow(PanelFrame& frame, PanelWindowEvents& events, const std::wstring& title);
  PanelWindow(const PanelWindow&) = delete;
  PanelWindow& operator=(const PanelWindow&) = delete;
  ~PanelWindow();

  [[nodiscard]] HWND handle() const noexcept { return window_; }
  // The control that fills the window; null when there is none. It is not owned.
  void occupy(HostedControl* control);
  [[nodiscard]] HostedControl* control() const noexcept { return control_; }
  // Null for a window that is no panel's.
  [[nodiscard]] static PanelWindow* of(HWND window) noexcept;

  // PanelPlace
  [[nodiscard]] HWND parentWindow() override { return window_; }
  [[nodiscard]] RECT panelRect() override;
  [[nodiscard]] HWND frameWindow() override { return frame_.frameWindow(); }
  [[nodiscard]] HACCEL acceleratorTable() override { return frame_.acceleratorTable(); }
  void panelCaption(const std::wstring& text) override;
  void statusText(const std::wstring& text) override { frame_.statusText(text); }
  bool translateAccelerator(MSG& message) override { return frame_.translateAccelerator(message); }
  [[nodiscard]] RECT bounds() override;
  void bounds(const RECT& wanted) override;
  [[nodiscard]] bool visible() override;
  void visible(bool visible) override;
  [[nodiscard]] LONG viewState() override;
  void viewState(LONG state) override;

 private:
  static LRESULT CALLBACK windowProcedure(HWND window, UINT message, WPARAM wide, LPARAM extra) noexcept;
  LRESULT handle(UINT message, WPARAM wide, LPARAM extra);
  void activated(bool active);
  void askForPopUp(LPARAM position);

  PanelFrame& frame_;
  PanelWindowEvents& events_;
  HWND window_ = nullptr;
  HostedControl* control_ = nullptr;
  std::wstring title_;
};

}  // namespace frontpanels::workbench
