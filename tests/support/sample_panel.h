// A panel with fields of every kind and a script that is played on it: natively on the models, under Windows
// on the real windows, with the same outcome.
#pragma once

#include <sstream>
#include <string>
#include <utility>
#include <vector>

#include "entry/entry_binding.h"
#include "platform/control_set.h"

namespace frontpanels::testing {

inline constexpr float kPanelWidthTwips = 7200;
inline constexpr float kPanelHeightTwips = 4350;

inline constexpr ControlRow kSampleRows[] = {
    {"Area", ControlKind::Picture, "", "", {0, 0, 7200, 3600}},
    {"FrequencyFrame", ControlKind::Frame, "Area", "Frequency", {120, 60, 3420, 1980}},
    {"CenterLabel", ControlKind::Label, "FrequencyFrame", "&Center", {120, 360, 900, 240}, 0},
    {"Center", ControlKind::TextBox, "FrequencyFrame", "", {1080, 330, 1800, 285}, 1},
    {"CenterSpin", ControlKind::SpinButton, "FrequencyFrame", "", {2880, 330, 270, 285}},
    {"SpanLabel", ControlKind::Label, "FrequencyFrame", "S&pan", {120, 765, 900, 240}, 2},
    {"Span", ControlKind::TextBox, "FrequencyFrame", "", {1080, 735, 1800, 285}, 3},
    {"SpanSpin", ControlKind::SpinButton, "FrequencyFrame", "", {2880, 735, 270, 285}},
    {"RbwLabel", ControlKind::Label, "FrequencyFrame", "RBW", {120, 1170, 900, 240}, 4},
    {"Rbw", ControlKind::TextBox, "FrequencyFrame", "", {1080, 1140, 1800, 285}, 5},
    {"RbwSpin", ControlKind::SpinButton, "FrequencyFrame", "", {2880, 1140, 270, 285}},
    {"NameLabel", ControlKind::Label, "FrequencyFrame", "&Name", {120, 1575, 900, 240}, 6},
    {"Name", ControlKind::TextBox, "FrequencyFrame", "", {1080, 1545, 2070, 285}, 7},
    {"TraceFrame", ControlKind::Frame, "Area", "Trace", {3660, 60, 3420, 1980}},
    {"TypeLabel", ControlKind::Label, "TraceFrame", "A&veraging", {120, 375, 1020, 240}, 8},
    {"Type", ControlKind::ComboBox, "TraceFrame", "", {1200, 330, 2100, 315}, 9},
    {"Pn", ControlKind::ListBox, "TraceFrame", "", {1200, 750, 2100, 840}, 10},
    {"Auto", ControlKind::CheckBox, "TraceFrame", "A&utoScale && more", {1200, 1650, 2100, 255}, 11},
    {"UnitsFrame", ControlKind::Frame, "Area", "U&nits", {120, 2130, 3420, 1260}, 12},
    {"Chan", ControlKind::OptionButton, "UnitsFrame", "C&hannel", {240, 660, 2700, 255}, 14},
    {"Freq", ControlKind::OptionButton, "UnitsFrame", "F&requency", {240, 330, 2700, 255}, 13},
    {"IntervalFrame", ControlKind::Frame, "Area", "Meas. Interval", {3660, 2130, 3420, 1260}},
    {"Time", ControlKind::OptionButton, "IntervalFrame", "&Time", {240, 330, 2700, 255}, 15},
    {"Dist", ControlKind::OptionButton, "IntervalFrame", "&Distance", {240, 660, 2700, 255}, 16},
    {"Single", ControlKind::PushButton, "", "&Single", {120, 3780, 1200, 375}, 17},
    {"Stop", ControlKind::PushButton, "", "St&op", {1440, 3780, 1200, 375}, 18},
    {"Hidden", ControlKind::PushButton, "", "&Single", {2760, 3780, 1200, 375}, 19, false},
    {"Close", ControlKind::PushButton, "", "C&lose", {5880, 3780, 1200, 375}, 20},
};

// What a user does; then the events: +got, -lost, !click, ^up and vdown of a spin button, =the new value of
// the entry "Center"; then a field and what it holds.
struct Step {
  const char* actions;
  const char* events;
  const char* value = "";
};

inline constexpr Step kScript[] = {
    {"focus Center, Tab, Tab, Tab, Tab", "+Center -Center +Span -Span +Name -Name +Type -Type +Pn"},
    {"Tab, Tab, Tab, Tab, Tab", "-Pn +Auto -Auto +Freq -Freq +Dist -Dist +Single -Single +Close"},
    {"Tab", "", "Close C&lose"},  // past the last field the key is the container's
    {"Shift+Tab, Shift+Tab, Shift+Tab", "-Close +Single -Single +Dist -Dist +Freq"},
    // Options: the focus alone chooses none; their frame keeps others out
    {"Down", "-Freq +Chan !Chan", "Freq 0"},
    {"Down", "-Chan +Freq !Freq", "Dist 1"},
    {"click Time", "-Freq +Time !Time", "Dist 0"},
    {"click Time", "", "Time 1"},
    {"focus Dist", "-Time +Dist", "Dist 0"},
    {"Space", "!Dist", "Dist 1"},
    // Access keys
    {"Alt+P", "-Dist +Span"},
    {"Alt+U", "-Span +Auto !Auto", "Auto 0"},
    {"Alt+N, Alt+N, Alt+N", "-Auto +Name -Name +Freq -Freq +Name"},  // of two: walks and clicks nothing
    {"Alt+S, Enter, Space, click Single", "-Name +Single !Single !Single !Single !Single"},
    {"Alt+O", "", "Stop St&op disabled"},
    // Numbers
    {"click Center, type 900k", "-Single +Center !Center =900000", "Center 900 kHz"},
    {"type 1.6, Enter", "=1600", "Center 1.6 kHz"},
    {"Up, click CenterSpin 75, click CenterSpin 25", "=101600 =1600 =101600", "Center 101.6 kHz"},
    {"type abc, Enter", "", "Center abc"},  // to be put right
    {"click Span", "-Center +Span !Span", "Center 101.6 kHz"},
    {"click SpanSpin 25, click SpanSpin 75, click RbwSpin 25", "^SpanSpin vSpanSpin", "Rbw  disabled"},
    {"focus Auto, disable Center, Alt+C", "-Span +Auto -Auto +Span"},
    // The focus goes on from what is disabled or hidden
    {"disable FrequencyFrame", "-Span +Type", "Name Gr\xC3\xBC\xC3\x9F disabled"},
    {"hide TraceFrame", "-Type +Freq", "Type 1 hidden"},
};

class SamplePanel {
 public:
  SamplePanel();
  virtual ~SamplePanel() = default;
  SamplePanel(const SamplePanel&) = delete;
  SamplePanel& operator=(const SamplePanel&) = delete;

  // Does a step; answers what came of it, as the step has it.
  [[nodiscard]] std::pair<std::string, std::string> play(const Step& step);

  ControlSet set{kSampleRows};
  clsNumericEntry center;
  std::string events;

 protected:
  virtual void key(const std::string& name);
  virtual void type(const std::string& text);
  virtual void click(Control& control, int downPercent);
  virtual void wheel(Control& /*control*/, int /*delta*/) {}
  [[nodiscard]] virtual std::string value(Control& control);

 private:
  void act(const std::string& action);
  void log(const std::string& event) { events += (events.empty() ? "" : " ") + event; }
};

}  // namespace frontpanels::testing
