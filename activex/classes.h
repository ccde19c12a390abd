// The classes that hosts can create: one row each, read by the factory and by the registration.
#pragma once

#include <unknwn.h>

#include <span>

#include "activex/aggregable.h"

namespace frontpanels::activex {

struct ClassRow {
  const CLSID* id;
  const wchar_t* name;  // of the ProgID, after "FrontPanels."
  const wchar_t* title;
  bool control;                            // otherwise a plain object
  Aggregable* (*create)(IUnknown* outer);  // the new object has one reference
};
[[nodiscard]] std::span<const ClassRow> classes() noexcept;

}  // namespace frontpanels::activex
