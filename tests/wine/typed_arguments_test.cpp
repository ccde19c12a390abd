#include "activex/typed_arguments.h"

#include <gtest/gtest.h>
#include <oleauto.h>

#include "activex/barrier.h"
#include "platform/win32/com_pointer.h"

namespace frontpanels::activex {
namespace {

constexpr DISPID kMember = 7;

// Describes member 7: (long byValue, [in, out] long* number, VARIANT* anything).
class TypedArgumentsTest : public ::testing::Test {
 protected:
  void SetUp() override {
    ASSERT_HRESULT_SUCCEEDED(
        CreateTypeLib2(sizeof(void*) == 8 ? SYS_WIN64 : SYS_WIN32, L"described.tlb", library_.receive()));
    OLECHAR name[] = L"IDescribed";
    ASSERT_HRESULT_SUCCEEDED(library_->CreateTypeInfo(name, TKIND_INTERFACE, maker_.receive()));
    TYPEDESC number{};
    number.vt = VT_I4;
    TYPEDESC anything{};
    anything.vt = VT_VARIANT;
    ELEMDESC parameters[3] = {};
    parameters[0].tdesc.vt = VT_I4;
    parameters[1].tdesc.vt = VT_PTR;
    parameters[1].tdesc.lptdesc = &number;
    parameters[2].tdesc.vt = VT_PTR;
    parameters[2].tdesc.lptdesc = &anything;
    FUNCDESC function{};
    function.memid = kMember;
    function.funckind = FUNC_PUREVIRTUAL;
    function.invkind = INVOKE_FUNC;
    function.callconv = CC_STDCALL;
    function.cParams = 3;
    function.lprgelemdescParam = parameters;
    function.elemdescFunc.tdesc.vt = VT_HRESULT;
    ASSERT_HRESULT_SUCCEEDED(maker_->AddFuncDesc(0, &function));
    info_ = maker_.query<ITypeInfo>();
    // Variables as a script host passes them, the last parameter first.
    for (int i = 0; i < 3; ++i) {
      VariantInit(&variables_[i]);
      V_VT(&given_[i]) = VT_BYREF | VT_VARIANT;
      V_VARIANTREF(&given_[i]) = &variables_[i];
    }
  }
  void TearDown() override {
    for (VARIANT& variable : variables_) VariantClear(&variable);
  }
  void text(VARIANT& variable, const wchar_t* value) {
    V_VT(&variable) = VT_BSTR;
    V_BSTR(&variable) = SysAllocString(value);
  }

  ComPointer<ICreateTypeLib2> library_;
  ComPointer<ICreateTypeInfo> maker_;
  ComPointer<ITypeInfo> info_;
  VARIANT variables_[3];
  VARIANT given_[3] = {};
  VARIANT& anything_ = variables_[0];
  VARIANT& number_ = variables_[1];
  VARIANT& byValue_ = variables_[2];
  DISPPARAMS parameters_{given_, nullptr, 3, 0};
};

TEST_F(TypedArgumentsTest, VariablesOfAnyTypeReachATypedReferenceAndComeBackInIts) {
  text(byValue_, L"5");
  text(number_, L"12");
  V_VT(&anything_) = VT_I2;
  V_I2(&anything_) = 3;

  TypedArguments arguments(*info_.get(), kMember, DISPATCH_METHOD, parameters_, nullptr);
  const VARIANT* const seen = arguments.get()->rgvarg;
  EXPECT_EQ(V_VT(&seen[2]), VT_BSTR) << "by value the variable's own value is handed on";
  ASSERT_EQ(V_VT(&seen[1]), VT_BYREF | VT_I4);
  EXPECT_EQ(*V_I4REF(&seen[1]), 12);
  EXPECT_EQ(V_VT(&seen[0]), VT_BYREF | VT_VARIANT) << "a parameter of any type takes the variable itself";
  EXPECT_EQ(V_VARIANTREF(&seen[0]), &anything_);

  *V_I4REF(&seen[1]) = 70000;
  EXPECT_EQ(V_VT(&number_), VT_BSTR) << "nothing is written before the call has succeeded";
  arguments.copyBack();
  ASSERT_EQ(V_VT(&number_), VT_I4);
  EXPECT_EQ(V_I4(&number_), 70000);
}

TEST_F(TypedArgumentsTest, AVariableWithoutAValueIsZero) {
  TypedArguments arguments(*info_.get(), kMember, DISPATCH_METHOD, parameters_, nullptr);
  ASSERT_EQ(V_VT(&arguments.get()->rgvarg[1]), VT_BYREF | VT_I4);
  EXPECT_EQ(*V_I4REF(&arguments.get()->rgvarg[1]), 0);
}

TEST_F(TypedArgumentsTest, AVariableThatDoesNotConvertIsNamedAndUntouched) {
  text(number_, L"many");
  UINT bad = 99;
  EXPECT_THROW(TypedArguments(*info_.get(), kMember, DISPATCH_METHOD, parameters_, &bad), ComFailure);
  EXPECT_EQ(bad, 1U);
  EXPECT_STREQ(V_BSTR(&number_), L"many");
}

TEST_F(TypedArgumentsTest, ArgumentsThatAreNoVariablesStayWhatTheyAre) {
  VARIANT values[3] = {};
  DISPPARAMS plain{values, nullptr, 3, 0};
  TypedArguments arguments(*info_.get(), kMember, DISPATCH_METHOD, plain, nullptr);
  EXPECT_EQ(arguments.get()->rgvarg, values);
}

}  // namespace
}  // namespace frontpanels::activex
