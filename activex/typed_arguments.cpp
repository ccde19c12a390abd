#include "activex/typed_arguments.h"

#include <oleauto.h>

#include <algorithm>

#include "activex/barrier.h"

namespace frontpanels::activex {
namespace {

bool isVariable(const VARIANT& argument) noexcept { return V_VT(&argument) == (VT_BYREF | VT_VARIANT); }

// A member's description, given back to its library at the end; null for an unknown member.
class FunctionDescription {
 public:
  FunctionDescription(ITypeInfo& info, DISPID member, WORD flags) : info_(info) {
    for (UINT index = 0; SUCCEEDED(info_.GetFuncDesc(index, &function_)); ++index) {
      if (function_->memid == member && (function_->invkind & flags) != 0) return;
      info_.ReleaseFuncDesc(function_);
    }
    function_ = nullptr;
  }
  ~FunctionDescription() {
    if (function_ != nullptr) info_.ReleaseFuncDesc(function_);
  }
  FunctionDescription(const FunctionDescription&) = delete;
  FunctionDescription& operator=(const FunctionDescription&) = delete;
  [[nodiscard]] const FUNCDESC* get() const noexcept { return function_; }

 private:
  ITypeInfo& info_;
  FUNCDESC* function_ = nullptr;
};

// What a parameter by reference refers to; VT_EMPTY for one by value.
VARTYPE referredType(const FUNCDESC* function, UINT position) noexcept {
  if (function == nullptr || position >= static_cast<UINT>(function->cParams)) return VT_EMPTY;
  const TYPEDESC& type = function->lprgelemdescParam[position].tdesc;
  return type.vt == VT_PTR ? type.lptdesc->vt : static_cast<VARTYPE>(VT_EMPTY);
}

}  // namespace

TypedArguments::TypedArguments(ITypeInfo& info, DISPID member, WORD flags, const DISPPARAMS& given,
                               UINT* badArgument)
    : parameters_(given) {
  if (std::none_of(given.rgvarg, given.rgvarg + given.cArgs, isVariable)) return;
  const FunctionDescription function(info, member, flags);
  arguments_.assign(given.rgvarg, given.rgvarg + given.cArgs);
  parameters_.rgvarg = arguments_.data();
  for (UINT argument = given.cNamedArgs; argument < given.cArgs; ++argument)
    if (isVariable(arguments_[argument])) unwrap(argument, function.get(), badArgument);
}

void TypedArguments::unwrap(UINT argument, const FUNCDESC* function, UINT* badArgument) {
  VARIANT& given = arguments_[argument];
  VARIANT* const variable = V_VARIANTREF(&given);
  const VARTYPE type =
      referredType(function, parameters_.cArgs - 1 - argument);  // the last argument comes first
  if (type == VT_VARIANT || type == VT_USERDEFINED || type == VT_PTR) return;
  if (type == VT_EMPTY) {
    given = *variable;
    return;
  }
  VARIANT& cell = cells_.emplace_back(variable).value;
  const HRESULT converted = VariantChangeType(&cell, variable, 0, type);
  if (FAILED(converted)) {
    if (badArgument != nullptr) *badArgument = argument;
    throw ComFailure(converted);
  }
  V_VT(&given) = static_cast<VARTYPE>(VT_BYREF | type);
  V_BYREF(&given) = &V_UI1(&cell);  // all members of the value begin at the same place
}

void TypedArguments::copyBack() {
  for (Cell& cell : cells_) check(VariantCopy(cell.variable, &cell.value));
}

}  // namespace frontpanels::activex
