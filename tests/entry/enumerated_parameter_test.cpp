#include "entry/enumerated_parameter.h"

#include <vector>

#include "tests/support/listed_records.h"
#include "tests/support/reporting_fixture.h"

namespace frontpanels {
namespace {

using Messages = std::vector<std::string>;
using testing::ListedRecords;

// The averaging is the type at hand: Off 32, Linear 0, Exponential 1, Max Hold 2, Min Hold 3.
class EnumeratedParameterTest : public testing::ReportingTest {
 protected:
  EnumeratedParameterTest() {
    list.Click = [this] { parameter.Click(); };
  }
  void bind() {
    parameter.ComboBox(&list);
    parameter.parameterType(500);
  }
  // The items' data, the selected one in brackets.
  [[nodiscard]] std::string items() const {
    std::string all;
    for (std::int32_t index = 0; index < list.ListCount(); ++index) {
      const std::string data = std::to_string(list.item(index).data);
      all += (index == 0 ? "" : " ") + (index == list.ListIndex() ? "[" + data + "]" : data);
    }
    return all;
  }

  ItemList list{ControlKind::ComboBox, "AverageTypeCombo"};
  Label label{"AverageTypeLabel"};
  clsEnumeratedParameter parameter;
};

TEST_F(EnumeratedParameterTest, FillsTheListInTableOrderWhicheverComesFirst) {
  parameter.parameterType(500);
  parameter.value(1);
  parameter.Label(&label);
  parameter.ComboBox(&list);
  EXPECT_EQ(items(), "32 0 [1] 2 3");
  EXPECT_EQ(list.Text(), "Exponential");
  parameter.parameterType(17);
  EXPECT_EQ(items(), "0 [1]");
  parameter.value(0);
  parameter.parameterType(17);
  EXPECT_EQ(items(), "[0] 1");
  parameter.parameterType(0);
  EXPECT_EQ(items(), "");
  parameter.Enabled(false);
  parameter.Visible(false);
  EXPECT_FALSE(parameter.Enabled() || label.Enabled() || parameter.Visible() || label.Visible());
  EXPECT_EQ(messages(), Messages{});
}

TEST_F(EnumeratedParameterTest, ValueAndSelectionFollowEachOther) {
  bind();
  parameter.value(3);
  EXPECT_EQ(items(), "32 0 1 2 [3]");
  EXPECT_FALSE(parameter.newValue());  // the program's doing, though the list clicks
  list.userChoice(0);
  EXPECT_EQ(parameter.value(), 32);
  EXPECT_TRUE(parameter.newValue());
  EXPECT_TRUE(parameter.newValue());  // reading does not clear it
  list.userChoice(0);
  EXPECT_FALSE(parameter.newValue());

  parameter.value(9);
  EXPECT_EQ(items(), "[32] 0 1 2 3");
  list.AddItem("out of 16 bits", 40000);
  list.userChoice(5);
  EXPECT_EQ(parameter.value(), 9);
  list.AddItem("twice", 2);  // of two items with one value the last is selected
  parameter.value(2);
  EXPECT_EQ(items(), "32 0 1 2 3 40000 [2]");
  EXPECT_EQ(messages(), (Messages{"clsEnumeratedParameter::value() ... could not find value (9) for "
                                  "ParameterType 500\r",
                                  "clsEnumeratedParameter::Change()...\rOverflow"}));
}

TEST_F(EnumeratedParameterTest, ASubsetHoldsWhatIsAddedToIt) {
  parameter.subset(true);
  bind();
  parameter.Add(32);
  parameter.Add(7);
  parameter.Add(32);
  EXPECT_EQ(items() + " " + list.item(1).text, "32 7 7");
  parameter.Limits(ListedRecords({{{"[Order]", 0}, {"[Minimum]", 0}, {"[Maximum]", "1"}},
                                  {{"[Order]", 1}, {"[Minimum]", 6}, {"[Maximum]", 8}},
                                  {{"[Order]", 2}, {"[Minimum]", 20}, {"[Maximum]", 19}},
                                  {{"[Order]", 3}, {"[Minimum]", "low"}, {"[Maximum]", 40}}}));
  EXPECT_EQ(items(), "32 7 0 1 6 8");
  parameter.Update();  // the value is 0
  parameter.Remove(32);
  parameter.Remove(99);
  EXPECT_EQ(items(), "7 [0] 1 6 8");
  EXPECT_EQ(messages(), Messages{});
  parameter.Limits(ListedRecords({{{"[Minimum]", -32768}, {"[Maximum]", 32767}}}));
  EXPECT_EQ(list.ListCount(), 65536);
}

TEST_F(EnumeratedParameterTest, WhatCannotBeIsReportedAndChangesNothing) {
  ItemList simple(ControlKind::ComboBox, "SimpleCombo", ListStyle::SimpleCombo);
  parameter.ComboBox(&simple);
  bind();
  parameter.Limits(ListedRecords({{{"[Minimum]", 10}, {"[Maximum]", 12}}, {{"[Minimum]", 10}}}));
  parameter.Limits(ListedRecords({{{"[Minimum]", 10}, {"[Maximum]", 40000}}}));
  EXPECT_EQ(items(), "32 [0] 1 2 3");
  parameter.ComboBox(nullptr);
  parameter.Add(5);
  parameter.Remove(5);
  parameter.Update();
  parameter.Click();
  parameter.value(2);  // kept for the list to come
  parameter.ComboBox(&list);
  EXPECT_EQ(items(), "32 0 1 [2] 3");
  EXPECT_EQ(
      messages(),
      (Messages{"clsEnumeratedParameter::ComboBox() expects a drop down list\r",
                "clsEnumeratedParameter::Limits()...\rInvalid procedure call or argument",
                "clsEnumeratedParameter::Limits()...\rOverflow",
                "clsEnumeratedParameter::Add()...\rObject variable or With block variable not set",
                "clsEnumeratedParameter::Remove()...\rObject variable or With block variable not set"}));
}

}  // namespace
}  // namespace frontpanels
