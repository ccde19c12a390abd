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
  // Resource of a control's picture for the toolboxes of designers; 0 for a plain object.
  int toolboxBitmap;
  Aggregable* (*create)(IUnknown* outer);  // the new object has one reference
};
[[nodiscard]] std::span<const ClassRow> classes() noexcept;

}  // namespace frontpanels::activex
