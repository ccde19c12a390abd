// The host's part for a spectrum panel: identity, periods, caption, trace, show; then the sweeps.
#pragma once

#include <windows.h>

#include <cstdint>
#include <string>

#include "sources/receiver.h"
#include "workbench/automation.h"
#include "workbench/hosted_control.h"

namespace frontpanels::workbench {

class SpectrumPanel {
 public:
  static constexpr const char* kProgId = "FrontPanels.SpectrumView";

  // Raises `NotRegistered`, or a failure that says what the panel refused.
  SpectrumPanel(PanelPlace& place, PanelRequests& requests);
  SpectrumPanel(const SpectrumPanel&) = delete;
  SpectrumPanel& operator=(const SpectrumPanel&) = delete;
  ~SpectrumPanel();

  // Tells it what the receiver is set to.
  void set(const ReceiverSetting& setting);
  // Retunes the panel when the range is another, and hands it the levels.
  void show(const DisplaySweep& sweep);
  // What the graph shows, as PNG.
  void savePicture(const std::string& path);

  [[nodiscard]] HostedControl& control() noexcept { return control_; }

 private:
  void set(std::int16_t parameter, const char* meaning, const Value& value);
  void operate(std::int16_t operation, const char* meaning, const Value& parameter);

  HostedControl control_;
  Automation panel_;
  Automation hub_;
  FrequencyRange told_;
};

}  // namespace frontpanels::workbench
