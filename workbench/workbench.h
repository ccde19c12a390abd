// The program: plays a recording or a simulated drive into its panels at the user's command, or by itself and
// unattended; keeps what the panels hand back; exports what they show.
#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "hosting/csv_export.h"
#include "hosting/settings_file.h"
#include "platform/textfile.h"
#include "sources/capture_writer.h"
#include "sources/drive_simulator.h"
#include "sources/frame_player.h"
#include "workbench/main_window.h"
#include "workbench/options.h"
#include "workbench/panel.h"
#include "workbench/panel_messages.h"
#include "workbench/rates.h"

namespace frontpanels::workbench {

class Workbench final : private MainWindowEvents, private PanelListener {
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
  struct Numbered;
  static const Numbered kNumbered[];

  // MainWindowEvents
  void command(UINT id) override;
  void menuOpening(HMENU menu) override;
  void tick() override;
  void seek(std::uint64_t frame) override;
  void failed(const std::string& message) noexcept override;
  // PanelListener
  void closeAsked(PanelKind kind) override;
  bool operationAsked(PanelKind kind, std::int16_t operation) override;
  void answerWanted(PanelKind kind) override;
  void settingsHanded(PanelKind kind, std::optional<std::int32_t> setUp,
                      std::vector<StoredSetting> settings) override;
  void popUpAsked(PanelKind kind, POINT onScreen) override;

  // Beginning and ending
  bool start();
  void openFirstSource();
  [[nodiscard]] std::vector<PanelKind> firstPanels() const;
  void finishUnattended();
  void quit();
  void end(ExitCode code) noexcept;

  // Panels
  [[nodiscard]] Panel* panel(PanelKind kind) const;
  [[nodiscard]] Panel* activePanel() const;
  void openPanel(PanelKind kind);
  void closePanel(PanelKind kind);
  void togglePanel(int number);
  void closeActive();
  void sideBySide() { window_.arrange(Arrangement::SideBySide); }
  void stacked() { window_.arrange(Arrangement::Stacked); }
  void nextPanel() { window_.nextPanel(); }
  void toggleMessages();
  void clearMessages();
  void playbackOnly();
  void popUpOfActive();
  void popUpClick(int item);
  void answer(PanelKind kind);

  // Sources and playing
  void askForRecording();
  // False when the user has cancelled.
  bool openRecording(const std::string& path);
  void simulate(std::uint64_t seed);
  void simulateAgain();
  void simulateOther();
  void open(std::unique_ptr<FrameSource> source, DriveSimulator* simulator);
  void tune();
  void receiveAnew();
  void play();
  void pause();
  void step();
  void stepBack();
  void single();
  void restart();
  void toggleLoop();
  void goTo();
  void rate(int index);
  void applyState();
  void playOn();
  bool takeFrame();
  void showFrame();
  void toggleRecording();
  void record(const std::string& path);
  void stopRecording();
  void tellLogging(bool on);
  void reportProblems();
  void appendToCapture();

  // What is kept
  void loadSettings();
  // False where there is no file that may be written.
  bool saveSettings();
  void saveSettingsNow();
  void restoreSettings();
  void saveSetUp(int number);
  void restoreSetUp(int number);
  [[nodiscard]] bool hasSetUp(int number) const;
  [[nodiscard]] std::optional<StoredPanel> storedPanel(PanelKind kind) const;
  [[nodiscard]] std::optional<StoredPanel> storedPanel(const std::string& section) const;
  [[nodiscard]] bool sourceIsKept() const;
  void keepPanel(Panel& panel);
  void keepWindow();
  void keepSource();
  void placeWindow();
  void importCells();

  // Exports
  void exportPicture();
  void exportWindow();
  void exportValues();
  void exportReport();
  [[nodiscard]] std::optional<std::string> exportName(std::string_view stem, const wchar_t* extension,
                                                      const wchar_t* filter) const;
  void exported(const std::string& path);
  [[nodiscard]] ExportHeader exportHeader(Panel& panel) const;

  // Telling the user
  void showMessages();
  void takeScreenshots();
  void showStatus();
  void report(const std::string& message, const char* source = "Workbench");
  void about();
  void keys();
  void box(const std::string& message, UINT icon);
  // Runs what may fail without keeping the rest from being done.
  void attempt(const std::function<void()>& body);
  // After the event or message that is being dealt with.
  void later(std::function<void()> work);
  void doLater();

  Options options_;
  TextFiles& files_;
  FramePlayer player_;
  DriveSimulator* simulator_ = nullptr;  // the player's source, while that is one
  std::uint64_t seed_ = kUsualSeed;
  std::optional<CaptureWriter> capture_;
  std::size_t rate_ = kFirstRate;
  std::uint64_t framesTaken_ = 0;
  std::string openedPath_;
  std::string problemsTold_;
  bool showMaximised_ = false;
  bool ticking_ = false;
  bool reading_ = false;  // a long recording; nothing else is begun meanwhile
  bool cancelled_ = false;
  ExitCode exitCode_ = ExitCode::Done;
  std::string settingsPath_;
  SettingsFile settings_;
  bool settingsMayBeReplaced_ = true;
  std::vector<std::function<void()>> later_;
  MainWindow window_;
  std::optional<PanelMessages> messages_;
  std::vector<std::unique_ptr<Panel>> panels_;
};

}  // namespace frontpanels::workbench
