#include "platform/control_set.h"

#include <gtest/gtest.h>

#include "platform/constituent.h"
#include "tests/support/sample_panel.h"

namespace frontpanels {
namespace {

using Kind = ControlKind;

int errorNumber(const std::function<void()>& action) {
  try {
    action();
  } catch (const RuntimeError& error) {
    return error.number();
  }
  return 0;
}

TEST(ControlSetTest, PlaysTheScriptOnModelsAlone) {
  testing::SamplePanel panel;
  for (const testing::Step& step : testing::kScript)
    EXPECT_EQ(panel.play(step), std::pair(std::string(step.events), std::string(step.value))) << step.actions;
  panel.set.picture("Area").Enabled(false);
  EXPECT_EQ(panel.set.focused(), &panel.set.control("Single"));
  panel.set.control("Single").LostFocus = [&] { panel.set.control("Single").Enabled(false); };
  panel.set.control("Single").Visible(false);  // Close is all that is left
  EXPECT_EQ(panel.set.focused(), &panel.set.control("Close"));
  panel.set.control("Close").Enabled(false);
  EXPECT_EQ(panel.set.focused(), nullptr);
  panel.set.control("Close").SetFocus();
  EXPECT_FALSE(panel.set.tab(true) || panel.set.accessKey(U'l') || panel.set.accessKey(0));
}

TEST(ControlSetTest, WhatIsLeftMaySendTheFocusElsewhere) {
  ControlSet set(testing::kSampleRows);
  set.control("Span").SetFocus();
  set.control("Span").LostFocus = [&] { set.control("Auto").SetFocus(); };
  set.control("Center").SetFocus();
  EXPECT_EQ(set.focused(), &set.control("Auto"));
  set.control("Chan").SetFocus();  // of the group without a choice, but not the one that it is entered by
  EXPECT_TRUE(set.tab(true) && set.control("Time").hasFocus());
}

TEST(ControlSetTest, ReadsTheTableAndRefusesAFaultyOne) {
  const ControlSet set(testing::kSampleRows);
  EXPECT_EQ(&set.spinButton("CENTERSPIN"), &set.control("CenterSpin"));
  EXPECT_EQ(set.find("Stopp"), nullptr);
  EXPECT_EQ(set.spinButton("CenterSpin").buddy(), &set.textBox("Center"));
  EXPECT_EQ(set.label("CenterLabel").parent(), &set.frame("FrequencyFrame"));
  const ControlRow twice[] = {{"A", Kind::Label, "", "", {}}, {"a", Kind::Label, "", "", {}}};
  const ControlRow orphan[] = {{"A", Kind::Label, "B", "", {}}};
  const ControlRow inLabel[] = {{"A", Kind::Label, "", "", {}}, {"B", Kind::TextBox, "A", "", {}}};
  const ControlRow alone[] = {{"A", Kind::SpinButton, "", "", {}}};
  const std::pair<int, std::function<void()>> faults[] = {
      {5, [&] { static_cast<void>(set.textBox("Stopp")); }},
      {13, [&] { static_cast<void>(set.textBox("Auto")); }},
      {457, [&] { ControlSet{twice}; }},
      {5, [&] { ControlSet{orphan}; }},
      {5, [&] { ControlSet{inLabel}; }},
      {5, [&] { ControlSet{alone}; }},
  };
  for (const auto& [number, action] : faults) EXPECT_EQ(errorNumber(action), number);
}

TEST(ItemListTest, TellsItsWindowWhichItemCameOrWent) {
  struct : ControlPeer {
    std::string heard;
    void changed(ControlChange what) override { heard += what == ControlChange::Items ? " all" : " ?"; }
    void itemAdded(std::int32_t index) override { heard += " +" + std::to_string(index); }
    void itemRemoved(std::int32_t index) override { heard += " -" + std::to_string(index); }
    void takeFocus() override {}
    void beep() override {}
  } window;
  ItemList list(ControlKind::ListBox, "Pn");
  list.peer(&window);
  for (const char* text : {"a", "b"}) list.AddItem(text, 0);
  list.AddItem("c", 0, 1);
  list.RemoveItem(2);
  list.Clear();
  EXPECT_EQ(window.heard, " +0 +1 +1 -2 all");
}

TEST(ConstituentTest, TypesOverWhatIsSelectedUnlessAKeyIsConsumed) {
  ControlSet set(testing::kSampleRows);
  TextBox& box = set.textBox("Span");
  std::string keys;
  box.GotFocus = [&] { box.selectAll(); };
  box.KeyDown = [&](std::int16_t keyCode, std::int16_t) { keys += std::to_string(keyCode) + " "; };
  box.KeyPress = [](std::int16_t& character) {
    character = character == 'x' ? 0 : character == 'y' ? 'Y' : character;
  };
  box.Text("old");
  for (const char16_t character : std::u16string(u"9xy\r\u20AC"))
    Constituent(box).KeyPress(static_cast<std::int16_t>(character));
  EXPECT_EQ(box.Text(), "9Y\xE2\x82\xAC");
  EXPECT_EQ(keys, "57 88 89 13 0 ");
  Constituent(box).KeyPress(8);
  EXPECT_EQ(box.Text(), "9Y");
  EXPECT_EQ(errorNumber([&] { Constituent(box).KeyPress(static_cast<std::int16_t>(0xD800)); }), 5);
  box.selectAll();
  for (int i = 0; i < 2; ++i) Constituent(box).KeyPress(8);
  EXPECT_EQ(box.Text(), "");
}

TEST(ConstituentTest, ActsAsAUserCouldAndHasTheMembersOfItsKind) {
  testing::SamplePanel panel;
  const auto of = [&](const char* name) { return Constituent(panel.set.control(name)); };
  of("Type").Text("Off");
  EXPECT_EQ(of("Type").List(of("Type").ListIndex()), "Off");
  EXPECT_EQ(of("Auto").Caption(), "AutoScale & more");
  of("Auto").Value(true);  // is so already
  of("Auto").Click();
  EXPECT_EQ(of("Auto").Value(), Variant(std::int16_t{0}));
  of("Chan").Value(true);
  EXPECT_EQ(of("Freq").Value(), Variant(false));
  of("SpanSpin").SpinUp();
  EXPECT_EQ(panel.events, "!Type +Auto !Auto !Chan ^SpanSpin");

  panel.set.picture("Area").Enabled(false);  // and the rest of what is out of reach
  panel.events.clear();
  of("SpanSpin").SpinDown();
  of("Name").Text("7");
  of("Name").KeyPress('7');
  of("Freq").Value(true);
  of("Type").ListIndex(3);
  of("Hidden").Click();
  EXPECT_EQ(panel.events + of("Name").Text(), "Gr\xC3\xBC\xC3\x9F");
  EXPECT_TRUE(!of("Name").Enabled() && of("Name").Visible() && !of("Hidden").Visible());

  const std::pair<int, std::function<void()>> faults[] = {
      {438, [&] { of("CenterLabel").Click(); }},      {438, [&] { of("Area").KeyPress('a'); }},
      {438, [&] { (void)of("CenterLabel").Text(); }}, {438, [&] { (void)of("Single").Value(); }},
      {438, [&] { of("Center").SpinUp(); }},          {438, [&] { (void)of("Center").Caption(); }},
      {438, [&] { (void)of("Name").ListCount(); }},   {9, [&] { (void)of("Pn").List(4); }},
  };
  for (const auto& [number, action] : faults) EXPECT_EQ(errorNumber(action), number);
}

}  // namespace
}  // namespace frontpanels
