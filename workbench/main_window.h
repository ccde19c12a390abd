// The program's window: menu, status bar, and the panel between them.
#pragma once

#include <windows.h>

#include <chrono>
#include <string>

#include "workbench/hosted_control.h"
#include "workbench/panel_place.h"

namespace frontpanels::workbench {

// What the window tells the program. Whatever a handler throws is handed to `failed`.
class MainWindowEvents {
 public:
  virtual void command(UINT id) = 0;
  virtual void menuOpening(HMENU menu) = 0;
  virtual void tick() = 0;
  virtual void failed(const std::string& message) noexcept = 0;

 protected:
  ~MainWindowEvents() = default;
};

enum class StatusPart { Source, Sweep, Rate, Message };

class MainWindow final : public PanelPlace {
 public:
  explicit MainWindow(MainWindowEvents& events);
  MainWindow(const MainWindow&) = delete;
  MainWindow& operator=(const MainWindow&) = delete;
  ~MainWindow();

  [[nodiscard]] HWND handle() const noexcept { return window_; }
  void show(int showCommand);
  // The control that fills the window; null when there is none. It is not owned.
  void occupy(HostedControl* control);
  void status(StatusPart part, const std::string& text);
  // Ticks until told otherwise.
  void startTicking(std::chrono::milliseconds period);
  void stopTicking() noexcept;
  // Until the program ends; answers its exit code.
  int runMessageLoop();

  // PanelPlace
  [[nodiscard]] HWND parentWindow() override { return window_; }
  [[nodiscard]] RECT panelRect() override;
  [[nodiscard]] HACCEL acceleratorTable() override { return accelerators_; }
  void panelCaption(const std::wstring& text) override;
  void statusText(const std::wstring& text) override;
  bool translateAccelerator(MSG& message) override;

 private:
  static LRESULT CALLBACK windowProcedure(HWND window, UINT message, WPARAM wide, LPARAM extra) noexcept;
  LRESULT handle(UINT message, WPARAM wide, LPARAM extra);
  void createStatusBar();
  void layOut();
  void paintHint();

  MainWindowEvents& events_;
  HWND window_ = nullptr;
  HWND statusBar_ = nullptr;
  HACCEL accelerators_ = nullptr;
  HostedControl* control_ = nullptr;
};

}  // namespace frontpanels::workbench
