#include "activex/constituent_object.h"

#include <gtest/gtest.h>
#include <oleauto.h>

#include "platform/control_set.h"
#include "platform/win32/utf16.h"
#include "tests/wine/com_client.h"

namespace frontpanels::activex {
namespace {

using testing::call;
using testing::put;

constexpr ControlRow kRows[] = {
    {"SpanLabel", ControlKind::Label, "", "S&pan", {}},
    {"SpanTextBox", ControlKind::TextBox, "", "", {}, 0},
    {"SpanSpinButton", ControlKind::SpinButton, "", "", {}, 1},
    {"AverageCombo", ControlKind::ComboBox, "", "", {}, 2},
};

class ConstituentObjectTest : public ::testing::Test {
 protected:
  ComPointer<IDispatch> field(const char* name) {
    ComPointer<IDispatch> object;
    *object.receive() = new ConstituentObject(nullptr, controls.control(name));
    return object;
  }
  // The run-time error that a read of the member ends in, 0 for none.
  static int errorOf(IDispatch& object, const wchar_t* member) {
    DISPPARAMS none{};
    EXCEPINFO exception{};
    object.Invoke(testing::memberOf(object, member), IID_NULL, LOCALE_USER_DEFAULT, DISPATCH_PROPERTYGET,
                  &none, nullptr, &exception, nullptr);
    SysFreeString(exception.bstrDescription);
    SysFreeString(exception.bstrSource);
    return exception.scode & 0xFFFF;
  }

  ControlSet controls{kRows};
};

TEST_F(ConstituentObjectTest, ScriptsReadTypeStepAndChooseByName) {
  const auto text = field("SpanTextBox");
  EXPECT_EQ(put(*text.get(), L"text", L"900k"), S_OK);
  EXPECT_EQ(controls.textBox("SpanTextBox").Text(), "900k");
  EXPECT_EQ(call(*text.get(), L"Text").text(), L"900k");
  int steps = 0;
  controls.spinButton("SpanSpinButton").SpinUp = [&] { ++steps; };
  call(*field("spanspinbutton").get(), L"SpinUp");
  EXPECT_EQ(steps, 1);
  EXPECT_EQ(call(*field("SpanLabel").get(), L"Caption").text(), L"Span");

  ItemList& list = controls.list("AverageCombo");
  list.AddItem("Off", 32);
  list.AddItem("Linear", 4);
  const auto combo = field("AverageCombo");
  EXPECT_EQ(put(*combo.get(), L"ListIndex", 1), S_OK);
  EXPECT_EQ(call(*combo.get(), L"List", {0}).text(), L"Off");
  EXPECT_EQ(call(*combo.get(), L"ItemData", {1}).number(), 4);
  EXPECT_EQ(call(*combo.get(), L"ListCount").number(), 2);
  EXPECT_EQ(list.ListIndex(), 1);
}

TEST_F(ConstituentObjectTest, WhatAKindHasNotIsError438AndAnUnknownMemberNotFound) {
  EXPECT_EQ(errorOf(*field("SpanLabel").get(), L"ListCount"), 438);
  EXPECT_EQ(errorOf(*field("SpanTextBox").get(), L"Enabled"), 0);
  EXPECT_EQ(put(*field("SpanTextBox").get(), L"ListCount", 1), DISP_E_MEMBERNOTFOUND);
}

}  // namespace
}  // namespace frontpanels::activex
