#include "platform/control_set.h"

#include <gtest/gtest.h>

#include "platform/constituent.h"

namespace frontpanels {
namespace {

using Kind = ControlKind;

constexpr ControlRow kRows[] = {
    {"SideArea", Kind::Picture, "", "", {}},
    {"FrequencyFrame", Kind::Frame, "SideArea", "&Frequency", {}, 0},
    {"CenterLabel", Kind::Label, "FrequencyFrame", "&Center", {}, 1},
    {"CenterTextBox", Kind::TextBox, "FrequencyFrame", "", {}, 2},
    {"CenterSpinButton", Kind::SpinButton, "FrequencyFrame", "", {}},
    {"TimeOption", Kind::OptionButton, "SideArea", "&Time", {}, 4},
    {"UplinkOption", Kind::OptionButton, "FrequencyFrame", "&Uplink", {}, 7},
    {"DownlinkOption", Kind::OptionButton, "FrequencyFrame", "&Downlink", {}, 6},
    {"TypeCombo", Kind::ComboBox, "SideArea", "", {}, 8},
    {"AutoBox", Kind::CheckBox, "SideArea", "A&utoScale && more", {}, 9},
    {"SingleButton", Kind::PushButton, "SideArea", "&Single", {}, 10},
    {"HiddenButton", Kind::PushButton, "SideArea", "&Single", {}, 11, false},
};

class ControlSetTest : public ::testing::Test {
 protected:
  ControlSetTest() {
    for (const auto& control : set.controls()) {
      const auto log = [this, name = control->name()](const char* what) {
        return [this, name, what] { events.push_back(name + " " + what); };
      };
      control->GotFocus = log("got");
      control->LostFocus = log("lost");
      control->Click = log("click");
    }
    box.Change = [this] { events.push_back("Change " + box.Text()); };
    set.list("TypeCombo").AddItem("Off", 32);
    set.list("TypeCombo").AddItem("Linear", 0);
  }
  [[nodiscard]] std::string focus() const { return set.focused() == nullptr ? "" : set.focused()->name(); }
  std::vector<std::string> taken() { return std::exchange(events, {}); }

  ControlSet set{kRows};
  TextBox& box = set.textBox("CenterTextBox");
  std::vector<std::string> events;
};

using Events = std::vector<std::string>;

int errorNumber(const std::function<void()>& action) {
  try {
    action();
  } catch (const RuntimeError& error) {
    return error.number();
  }
  return 0;
}

TEST_F(ControlSetTest, ReadsTheTableAndRefusesAFaultyOne) {
  EXPECT_EQ(&set.spinButton("CENTERSPINBUTTON"), &set.control("CenterSpinButton"));
  EXPECT_EQ(set.spinButton("CenterSpinButton").buddy(), &box);
  EXPECT_EQ(box.parent(), &set.frame("FrequencyFrame"));
  EXPECT_EQ(set.label("CenterLabel").Caption(), "&Center");
  EXPECT_FALSE(set.pushButton("HiddenButton").Visible());
  EXPECT_EQ(errorNumber([this] { static_cast<void>(set.textBox("StopTextBox")); }), 5);
  EXPECT_EQ(errorNumber([this] { static_cast<void>(set.textBox("AutoBox")); }), 13);

  const ControlRow twice[] = {{"A", Kind::Label, "", "", {}}, {"a", Kind::Label, "", "", {}}};
  const ControlRow orphan[] = {{"A", Kind::Label, "B", "", {}}};
  const ControlRow inLabel[] = {{"A", Kind::Label, "", "", {}}, {"B", Kind::TextBox, "A", "", {}}};
  const ControlRow alone[] = {{"A", Kind::SpinButton, "", "", {}}};
  EXPECT_EQ(errorNumber([&] { ControlSet{twice}; }), 457);
  EXPECT_EQ(errorNumber([&] { ControlSet{orphan}; }), 5);
  EXPECT_EQ(errorNumber([&] { ControlSet{inLabel}; }), 5);
  EXPECT_EQ(errorNumber([&] { ControlSet{alone}; }), 5);
}

TEST_F(ControlSetTest, TabStopsAtUsableControlsAndOnceInAnOptionGroup) {
  const auto walk = [this](bool forward) {
    Events names;
    while (names.size() < 9 && set.tab(forward)) names.push_back(focus());
    return names;
  };
  EXPECT_EQ(walk(true), (Events{"CenterTextBox", "TimeOption", "UplinkOption", "TypeCombo", "AutoBox",
                                "SingleButton"}));  // nothing chosen: the group's first in the table
  set.control("DownlinkOption").SetFocus();         // not the one that the group is entered by
  EXPECT_EQ(walk(true), (Events{"TypeCombo", "AutoBox", "SingleButton"}));
  set.optionButton("DownlinkOption").Value(true);
  set.list("TypeCombo").Enabled(false);
  EXPECT_EQ(walk(false), (Events{"AutoBox", "DownlinkOption", "TimeOption", "CenterTextBox"}));
  EXPECT_FALSE(set.tab(false));
  EXPECT_EQ(focus(), "CenterTextBox");

  set.frame("FrequencyFrame").Visible(false);  // takes the focused box with it
  EXPECT_EQ(focus(), "TimeOption");
  box.SetFocus();
  EXPECT_EQ(focus(), "TimeOption");
  EXPECT_EQ(walk(true), (Events{"AutoBox", "SingleButton"}));
  set.picture("SideArea").Enabled(false);
  EXPECT_EQ(focus(), "");
}

TEST_F(ControlSetTest, AFieldLosesTheFocusBeforeTheNextOneHasIt) {
  box.SetFocus();
  ControlSet::click(set.pushButton("SingleButton"));
  EXPECT_EQ(taken(),
            (Events{"CenterTextBox got", "CenterTextBox lost", "SingleButton got", "SingleButton click"}));

  set.control("SingleButton").LostFocus = [this] { set.control("AutoBox").SetFocus(); };
  box.SetFocus();  // what is left behind sends the focus elsewhere
  EXPECT_EQ(taken(), Events{"AutoBox got"});
}

TEST_F(ControlSetTest, OptionsAreExclusiveWithinTheirFrame) {
  OptionButton& uplink = set.optionButton("UplinkOption");
  OptionButton& downlink = set.optionButton("DownlinkOption");
  set.optionButton("TimeOption").Value(true);
  uplink.Value(true);
  ControlSet::click(downlink);
  downlink.userClick();  // is chosen already
  EXPECT_EQ(taken(),
            (Events{"TimeOption click", "UplinkOption click", "DownlinkOption got", "DownlinkOption click"}));
  EXPECT_TRUE(downlink.Value() && !uplink.Value() && set.optionButton("TimeOption").Value());

  EXPECT_TRUE(set.arrow(true));  // round the end
  EXPECT_TRUE(uplink.Value() && uplink.hasFocus());
  downlink.Enabled(false);
  EXPECT_FALSE(set.arrow(false));
  EXPECT_TRUE(uplink.Value());
}

TEST_F(ControlSetTest, AccessKeysLeadOnFromLabelsAndClickButtons) {
  struct KeyCase {
    char32_t key;
    Events events;
  };
  set.control("AutoBox").SetFocus();
  taken();
  const KeyCase cases[] = {
      {U'C', {"AutoBox lost", "CenterTextBox got"}},
      {U'u', {"CenterTextBox lost", "UplinkOption got"}},  // shared: walks and clicks nothing
      {U'u', {"UplinkOption lost", "AutoBox got"}},
      {U'u', {"AutoBox lost", "UplinkOption got"}},
      {U'd', {"UplinkOption lost", "DownlinkOption got", "DownlinkOption click"}},
      {U's', {"DownlinkOption lost", "SingleButton got", "SingleButton click"}},
      {U'f', {"SingleButton lost", "CenterTextBox got"}},
  };
  for (const KeyCase& c : cases) {
    EXPECT_TRUE(set.accessKey(c.key));
    EXPECT_EQ(taken(), c.events);
  }
  EXPECT_FALSE(set.accessKey(U'x') || set.accessKey(U'&') || set.accessKey(0));
  box.Enabled(false);
  EXPECT_TRUE(set.accessKey(U'c'));  // on to the next that can be used
  EXPECT_EQ(focus(), "TimeOption");
}

TEST_F(ControlSetTest, TypingReplacesWhatIsSelectedAndMayBeConsumed) {
  const Constituent field(box);
  std::vector<std::int16_t> keys;
  box.GotFocus = [this] { box.selectAll(); };
  box.KeyDown = [&](std::int16_t keyCode, std::int16_t /*shift*/) { keys.push_back(keyCode); };
  box.KeyPress = [](std::int16_t& character) {
    if (character == 'x') character = 0;
    if (character == 'y') character = 'Y';
  };
  box.Text("old");
  for (const char c : std::string("9xy\r")) field.KeyPress(c);
  field.KeyPress(0x20AC);
  EXPECT_EQ(box.Text(), "9Y\xE2\x82\xAC");
  EXPECT_EQ(keys, (std::vector<std::int16_t>{'9', 'X', 'Y', 13, 0}));
  field.KeyPress(8);
  EXPECT_EQ(taken(), (Events{"Change old", "Change 9", "Change 9Y", "Change 9Y\xE2\x82\xAC", "Change 9Y"}));
  EXPECT_EQ(errorNumber([&] { field.KeyPress(static_cast<std::int16_t>(0xD800)); }), 5);
  box.selectAll();
  field.KeyPress(8);
  field.KeyPress(8);
  EXPECT_EQ(box.Text(), "");
}

TEST_F(ControlSetTest, AConstituentActsAsAUserCould) {
  const Constituent combo(set.control("TypeCombo"));
  combo.Text("Linear");
  EXPECT_EQ(combo.ListIndex(), 1);
  EXPECT_EQ(combo.List(0), "Off");
  EXPECT_EQ(combo.ItemData(0), 32);
  EXPECT_EQ(errorNumber([&] { combo.Text("linear"); }), 5);
  EXPECT_EQ(errorNumber([&] { combo.ListIndex(2); }), 9);

  const Constituent check(set.control("AutoBox"));
  EXPECT_EQ(check.Caption(), "AutoScale & more");
  check.Click();
  check.Value(true);  // is so already
  EXPECT_EQ(check.Value(), Variant(std::int16_t{1}));
  check.KeyPress(' ');
  EXPECT_EQ(check.Value(), Variant(std::int16_t{0}));
  EXPECT_EQ(errorNumber([this] { set.checkBox("AutoBox").Value(2); }), 5);
  Constituent(set.control("SingleButton")).KeyPress(13);
  EXPECT_EQ(taken(), (Events{"TypeCombo click", "AutoBox got", "AutoBox click", "AutoBox click",
                             "AutoBox lost", "SingleButton got", "SingleButton click"}));

  const Constituent option(set.control("UplinkOption"));
  option.Value(true);
  EXPECT_EQ(errorNumber([&] { option.Value(false); }), 5);
  EXPECT_EQ(option.Value(), Variant(true));
}

TEST_F(ControlSetTest, AConstituentOutOfReachDoesNothingAndAMissingMemberIsAnError) {
  const Constituent field(box);
  const Constituent spin(set.control("CenterSpinButton"));
  int steps = 0;
  set.spinButton("CenterSpinButton").SpinUp = [&] { ++steps; };
  set.spinButton("CenterSpinButton").SpinDown = [&] { steps += 10; };
  spin.SpinUp();
  spin.SpinDown();
  set.frame("FrequencyFrame").Enabled(false);
  EXPECT_TRUE(!field.Enabled() && field.Visible());
  spin.SpinUp();
  field.Text("7");
  field.KeyPress('7');
  Constituent(set.control("UplinkOption")).Value(true);
  Constituent(set.control("HiddenButton")).Click();
  EXPECT_EQ(steps, 11);
  EXPECT_EQ(taken(), Events{});

  const Constituent label(set.control("CenterLabel"));
  const std::function<void()> missing[] = {
      [&] { label.Click(); },
      [&] { label.KeyPress('a'); },
      [&] { static_cast<void>(label.Text()); },
      [&] { static_cast<void>(label.Value()); },
      [&] { label.SpinUp(); },
      [&] { static_cast<void>(field.Caption()); },
      [&] { static_cast<void>(field.ListIndex()); },
      [&] { field.SpinDown(); },
      [&] { spin.Click(); },
  };
  for (const auto& action : missing) EXPECT_EQ(errorNumber(action), 438);
  EXPECT_EQ(label.Caption(), "Center");
}

}  // namespace
}  // namespace frontpanels
