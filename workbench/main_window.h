// The program's window: menu, the panels' windows in it, the strip with the place in time, the list of
// messages and the status bar.
#pragma once

#include <windows.h>

#include <chrono>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "workbench/message_list.h"
#include "workbench/panel_window.h"
#include "workbench/time_strip.h"

namespace frontpanels::workbench {

// What the window tells the program. Whatever a handler throws is handed to `failed`.
class MainWindowEvents {
 public:
  virtual void command(UINT id) = 0;
  virtual void menuOpening(HMENU menu) = 0;
  virtual void tick() = 0;
  // The user has moved the slider.
  virtual void seek(std::uint64_t frame) = 0;
  virtual void failed(const std::string& message) noexcept = 0;

 protected:
  ~MainWindowEvents() = default;
};

enum class StatusPart { Source, Sweep, Rate, Message };
// How the panels' windows are laid out when there is more or less room, or another one; not at all once the
// user has placed one by himself.
enum class Arrangement { SideBySide, Stacked, ByUser };

class MainWindow final : public PanelFrame {
 public:
  explicit MainWindow(MainWindowEvents& events);
  MainWindow(const MainWindow&) = delete;
  MainWindow& operator=(const MainWindow&) = delete;
  ~MainWindow();

  [[nodiscard]] HWND handle() const noexcept { return window_; }
  void show(int showCommand);
  void status(StatusPart part, const std::string& text);
  [[nodiscard]] MessageList& messages() noexcept { return messages_; }
  [[nodiscard]] bool messagesShown() const noexcept { return messages_.shown(); }
  void showMessages(bool shown);
  // The strip below the panels; see TimeStrip.
  void showPlace(std::uint64_t frame, std::optional<std::uint64_t> frames);
  void showProgress(const std::string& what, int percent);
  void endProgress();

  [[nodiscard]] Arrangement arrangement() const noexcept { return arrangement_; }
  void arrange(Arrangement arrangement);
  // Null without one.
  [[nodiscard]] PanelWindow* activePanel() const;
  void nextPanel();
  void focusPanel();
  void focusPlace();

  // Ticks until told otherwise.
  void startTicking(std::chrono::milliseconds period);
  void stopTicking() noexcept;
  // Until the program ends; answers its exit code.
  int runMessageLoop();
  // What has come in meanwhile; false once the program is to end.
  bool pumpMessages();

  // PanelFrame
  [[nodiscard]] HWND frameWindow() override { return window_; }
  [[nodiscard]] HWND clientWindow() override { return client_; }
  [[nodiscard]] HACCEL acceleratorTable() override { return accelerators_; }
  void statusText(const std::wstring& text) override;
  bool translateAccelerator(MSG& message) override;
  void panelsChanged() override;
  void placedByUser() override { arrangement_ = Arrangement::ByUser; }
  void failed(const std::string& message) noexcept override { events_.failed(message); }

 private:
  static LRESULT CALLBACK windowProcedure(HWND window, UINT message, WPARAM wide, LPARAM extra) noexcept;
  LRESULT handle(UINT message, WPARAM wide, LPARAM extra);
  void layOut();
  [[nodiscard]] HWND createWindow();
  [[nodiscard]] HWND createClient();
  [[nodiscard]] HWND createStatusBar();
  bool deliver(MSG& message);
  bool leavesOwnField(const MSG& message);
  [[nodiscard]] std::vector<HWND> panelWindows() const;
  void placePanels();
  void paintHint();

  MainWindowEvents& events_;
  HWND window_ = nullptr;
  HACCEL accelerators_ = nullptr;
  HWND client_ = nullptr;
  HWND statusBar_ = nullptr;
  TimeStrip timeStrip_;
  MessageList messages_;
  Arrangement arrangement_ = Arrangement::SideBySide;
};

}  // namespace frontpanels::workbench
