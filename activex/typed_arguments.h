// Arguments as typed parameters need them. Script engines pass every variable as a reference to a variant; a
// parameter by reference to a plain type takes only a reference to that type: it gets a cell of its own, and
// what the call leaves there goes back into the variable.
#pragma once

#include <windows.h>

#include <oleauto.h>

#include <deque>
#include <vector>

namespace frontpanels::activex {

class TypedArguments {
 public:
  // `given` must outlive this. Raises ComFailure when a variable does not convert; `badArgument`, which may
  // be null, then tells which one.
  TypedArguments(ITypeInfo& info, DISPID member, WORD flags, const DISPPARAMS& given, UINT* badArgument);
  TypedArguments(const TypedArguments&) = delete;
  TypedArguments& operator=(const TypedArguments&) = delete;

  [[nodiscard]] DISPPARAMS* get() noexcept { return &parameters_; }
  // After a call that succeeded. Raises ComFailure.
  void copyBack();

 private:
  struct Cell {
    explicit Cell(VARIANT* callers) noexcept : variable(callers) { VariantInit(&value); }
    ~Cell() { VariantClear(&value); }
    Cell(const Cell&) = delete;
    Cell& operator=(const Cell&) = delete;

    VARIANT* variable;  // the caller's
    VARIANT value;
  };

  void unwrap(UINT argument, const FUNCDESC* function, UINT* badArgument);

  std::vector<VARIANT> arguments_;  // borrowed copies: the caller goes on owning what they hold
  std::deque<Cell> cells_;          // the arguments refer to them: they never move
  DISPPARAMS parameters_;
};

}  // namespace frontpanels::activex
