#include "activex/dispatch.h"

#include <oleauto.h>

#include <algorithm>
#include <vector>

#include "activex/module.h"

namespace frontpanels::activex {
namespace {

constexpr WORD kPropertyPuts = DISPATCH_PROPERTYPUT | DISPATCH_PROPERTYPUTREF;

bool isWrappedVariable(const VARIANT& argument) { return V_VT(&argument) == (VT_BYREF | VT_VARIANT); }

// Script hosts pass every variable as a reference to a variant, which a parameter of a plain by-reference
// type does not take. Such an argument is handed on as the value inside, by reference to its own cell.
class UnwrappedArguments {
 public:
  explicit UnwrappedArguments(const DISPPARAMS& parameters)
      : arguments_(parameters.rgvarg, parameters.rgvarg + parameters.cArgs), parameters_(parameters) {
    for (VARIANT& argument : arguments_)
      if (isWrappedVariable(argument) && isPlain(*V_VARIANTREF(&argument))) unwrap(argument);
    parameters_.rgvarg = arguments_.data();
  }
  [[nodiscard]] DISPPARAMS* get() noexcept { return &parameters_; }

 private:
  static bool isPlain(const VARIANT& value) noexcept {
    switch (V_VT(&value)) {
      case VT_I2:
      case VT_I4:
      case VT_R4:
      case VT_R8:
      case VT_BSTR:
      case VT_BOOL:
        return true;
      default:
        return false;
    }
  }
  static void unwrap(VARIANT& argument) noexcept {
    VARIANT* const variable = V_VARIANTREF(&argument);
    V_VT(&argument) = static_cast<VARTYPE>(VT_BYREF | V_VT(variable));
    V_BYREF(&argument) = &V_UI1(variable);
  }

  std::vector<VARIANT> arguments_;
  DISPPARAMS parameters_;
};

}  // namespace

ComPointer<ITypeLib> ownTypeLibrary() {
  ComPointer<ITypeLib> library;
  check(LoadTypeLibEx(modulePath().c_str(), REGKIND_NONE, library.receive()));
  return library;
}

ComPointer<ITypeInfo> typeInfoOf(const GUID& id) {
  ComPointer<ITypeInfo> info;
  check(ownTypeLibrary()->GetTypeInfoOfGuid(id, info.receive()));
  return info;
}

HRESULT invokeByTypeInfo(ITypeInfo& info, void* object, DISPID member, WORD flags, DISPPARAMS* parameters,
                         VARIANT* result, EXCEPINFO* exception, UINT* badArgument) {
  if (parameters == nullptr) return E_POINTER;
  // Some hosts put by value and by reference in one call: the members have plain puts only.
  if ((flags & kPropertyPuts) == kPropertyPuts) flags = static_cast<WORD>(flags & ~DISPATCH_PROPERTYPUTREF);
  SetErrorInfo(0, nullptr);
  const HRESULT plain = info.Invoke(object, member, flags, parameters, result, exception, badArgument);
  const bool wrapped =
      parameters->cArgs > 0 &&
      std::any_of(parameters->rgvarg, parameters->rgvarg + parameters->cArgs, isWrappedVariable);
  if (plain != DISP_E_TYPEMISMATCH || !wrapped) return plain;
  UnwrappedArguments unwrapped(*parameters);
  return info.Invoke(object, member, flags, unwrapped.get(), result, exception, badArgument);
}

}  // namespace frontpanels::activex
