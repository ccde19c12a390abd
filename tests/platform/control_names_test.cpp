#include "platform/control_names.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <set>

#include "pilot/pilot_controls.h"
#include "spectrum/spectrum_controls.h"

namespace frontpanels {
namespace {

using Kind = ControlKind;

struct NameCase {
  const char* control;
  const char* name;
};

std::string wrongNames(const ControlSet& set, std::span<const NameCase> cases) {
  std::string wrong;
  for (const NameCase& row : cases)
    if (const std::string name = spokenName(set, set.control(row.control)); name != row.name)
      wrong += std::string(row.control) + " is called " + name + "\n";
  return wrong;
}

// By where each name comes from.
TEST(ControlNamesTest, FieldsAreCalledByWhatStandsAtThem) {
  const ControlSet spectrum(spectrumControls());
  constexpr NameCase kSpectrum[] = {
      {"CenterFrequencyTextBox", "Center"},      // its label, without the brackets
      {"CenterFrequencySpinButton", "Center"},   // its text box
      {"StopFrequencyTextBox", "Stop"},          // no other box is called so,
      {"StopSweepButton", "Stop, Measurement"},  // and a button says its frame
      {"FrequencyOption", "Frequency, Units"},   // so does an option
      {"SweepRateTextBox", "Meas. Interval"},    // the frame alone
      {"VerticalOffsetTextBox", "Ref Level"},    // without the sign of the access key
      {"VerticalScaleSpinButton", "Vertical Scale, dB/div"},
      {"AutoScaleBox", "AutoScale"},
      {"CloseButton", "Close"},  // lies in no frame
      {"MarkerFrameInvisibleButton", "Show or Hide Display Controls"},
      {"IfLabelFormatterNC", "IfLabelFormatterNC"},  // nobody sees it
  };
  EXPECT_EQ(wrongNames(spectrum, kSpectrum), "");
  const ControlSet pilot(pilotControls());
  constexpr NameCase kPilot[] = {
      {"MarkerAddButton", "Add, Markers"},       {"userPNListAddButton", "Add, User PN List"},
      {"userPNListTextBox", "PN, User PN List"}, {"userPNListListBox", "User PN List"},
      {"userListCheckBox", "User List"},         {"TopNTextBox", "Top N, Count"},
      {"CdmaUnitsPnOption", "PN, Code"},         {"CodeStopTextBox", "Stop"},
      {"ChannelizationCombo", "Channelization"}, {"I0TextBox", "Io"},
  };
  EXPECT_EQ(wrongNames(pilot, kPilot), "");
}

TEST(ControlNamesTest, NoTwoFieldsOfAPanelThatTakeTheFocusShareAName) {
  for (const auto rows : {spectrumControls(), pilotControls()}) {
    const ControlSet set(rows);
    std::set<std::string> names;
    for (const auto& control : set.controls()) {
      const std::string name = spokenName(set, *control);
      EXPECT_TRUE(!name.empty() && name.find_first_of("&<>") == std::string::npos) << control->name();
      if (facetsOf(control->kind()).takesFocus) {
        EXPECT_TRUE(names.insert(name).second) << control->name() << " is called " << name;
      }
    }
    EXPECT_GT(names.size(), 30U);
  }
}

TEST(ControlNamesTest, FieldsThatWouldShareANameSayTheirFrame) {
  constexpr ControlRow kRows[] = {
      {"A", Kind::Frame, "", "&Left", {}},         {"ALabel", Kind::Label, "A", "R&&D", {}, 0},
      {"ABox", Kind::TextBox, "A", "", {}, 1},     {"B", Kind::Frame, "", "Right&", {}},
      {"BLabel", Kind::Label, "B", "R&&D", {}, 2}, {"BBox", Kind::TextBox, "B", "", {}, 3},
      {"Other", Kind::TextBox, "", "", {}, 4},
  };
  ControlSet set(kRows);
  constexpr NameCase kShared[] = {{"ABox", "R&D, Left"}, {"BBox", "R&D, Right"}, {"Other", "Other"}};
  EXPECT_EQ(wrongNames(set, kShared), "");
  set.control("BLabel").Caption("<>");  // as the host has it now
  constexpr NameCase kOwn[] = {{"ABox", "R&D"}, {"BBox", "<>"}};
  EXPECT_EQ(wrongNames(set, kOwn), "");
}

TEST(ControlNamesTest, AccessKeysLeadSomewhereAndAreUniqueInAPanel) {
  ControlSet pilot(pilotControls());
  EXPECT_EQ(pilot.accessKeys(), U"aztufspcnidembwyohlk");  // in tab order
  for (const auto& control : pilot.controls())
    for (const auto& other : pilot.controls())
      EXPECT_TRUE(control == other || accessKeyOf(control->Caption()) == 0 ||
                  accessKeyOf(control->Caption()) != accessKeyOf(other->Caption()))
          << control->name() << " " << other->name();
  pilot.control("FormatComboBox").Enabled(false);  // the label leads on to the option behind
  pilot.control("userPNListFrame").Enabled(false);
  pilot.control("BarsFrame").Visible(false);
  EXPECT_EQ(pilot.accessKeys(), U"aztufspcnilk");
  EXPECT_EQ(ControlSet(spectrumControls()).accessKeys(), U"/ulk");
  EXPECT_EQ(spokenShortcut(pilot, pilot.control("CodeStartTextBox")), "Alt+S");
  EXPECT_EQ(spokenShortcut(pilot, pilot.control("userPNListAddButton")), "Alt+D");
  EXPECT_EQ(spokenShortcut(pilot, pilot.control("MarkerAddButton")), "");
}

}  // namespace
}  // namespace frontpanels
