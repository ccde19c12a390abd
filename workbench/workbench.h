// The program: plays a recording into its panel at the user's command, or by itself and unattended.
#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>

#include "platform/textfile.h"
#include "sources/receiver.h"
#include "sources/sweep_player.h"
#include "workbench/main_window.h"
#include "workbench/options.h"
#include "workbench/panel_messages.h"
#include "workbench/rates.h"
#include "workbench/spectrum_panel.h"

namespace frontpanels::workbench {

class Workbench final : private MainWindowEvents, private PanelRequests {
 public:
  // `files` must outlive the program.
  Workbench(Options options, TextFiles& files);
  Workbench(const Workbench&) = delete;
  Workbench& operator=(const Workbench&) = delete;
  ~Workbench();

  // Until the user or the unattended play ends it.
  [[nodiscard]] ExitCode run(int showCommand);

 private:
  struct Command;
  static const Command kCommands[];

  // MainWindowEvents
  void command(UINT id) override;
  void menuOpening(HMENU menu) override;
  void tick() override;
  void failed(const std::string& message) noexcept override;
  // PanelRequests
  std::int32_t frontPanelOp(std::int32_t hardwareId, std::int32_t panelId, std::int16_t operation) override;
  std::int32_t frontPanelSet(std::int32_t hardwareId, std::int32_t panelId, std::int16_t parameterType,
                             std::int16_t index, double value) override;

  bool start();
  void askForRecording();
  void openRecording(const std::string& path);
  void openPanel();
  void closePanel();
  void togglePanel();
  void play();
  void pause();
  void step();
  void single();
  void restart();
  void rate(std::size_t index);
  void about();

  void applyState();
  bool takeSweep();
  void showSweep();
  void answerPanel();
  void showMessages();
  void takeScreenshots();
  void finishUnattended();
  void end(ExitCode code) noexcept;
  void showStatus();
  void report(const std::string& message, bool withBox);
  void box(const std::string& message, UINT icon);

  Options options_;
  SweepPlayer player_;
  Receiver receiver_;
  std::size_t rate_ = kFirstRate;
  std::uint64_t sweepsTaken_ = 0;
  ExitCode exitCode_ = ExitCode::Done;
  MainWindow window_;
  std::optional<PanelMessages> messages_;
  std::unique_ptr<SpectrumPanel> panel_;
};

}  // namespace frontpanels::workbench
