// The fonts of a panel's fields: one that a container gave, or that of dialogs, with its variants.
#pragma once

#include <windows.h>

#include <array>
#include <memory>
#include <type_traits>

#include "platform/controls.h"

namespace frontpanels {

class FieldFonts {
 public:
  FieldFonts() = default;
  // The given font stays the caller's, at the scale that it has; without one the scale is `dpi`, dots per
  // inch.
  FieldFonts(HFONT given, int dpi);

  // Null where the system could not make it.
  [[nodiscard]] HFONT of(const Control& control) const;

 private:
  struct DeleteFont {
    void operator()(HFONT font) const noexcept { DeleteObject(font); }
  };
  using OwnFont = std::unique_ptr<std::remove_pointer_t<HFONT>, DeleteFont>;

  HFONT given_ = nullptr;
  std::array<OwnFont, 4> made_;  // by bold + 2 x italic; the first is the given one itself, if there is one
};

}  // namespace frontpanels
