#include "platform/win32/field_fonts.h"

#include <cwchar>

namespace frontpanels {
namespace {

// The font that dialogs are laid out for, as panels are: the one of message boxes is wider on some systems
// and would not find room in places that are fixed.
LOGFONTW dialogFont(int dpi) {
  constexpr int kPoints = 8;
  constexpr int kPointsPerInch = 72;
  LOGFONTW font{};
  font.lfHeight = -MulDiv(kPoints, dpi, kPointsPerInch);
  font.lfWeight = FW_NORMAL;
  font.lfCharSet = DEFAULT_CHARSET;
  std::wcscpy(font.lfFaceName, L"MS Shell Dlg 2");
  return font;
}

}  // namespace

FieldFonts::FieldFonts(HFONT given, int dpi) : given_(given) {
  LOGFONTW plain{};
  if (given == nullptr || GetObjectW(given, sizeof plain, &plain) == 0) plain = dialogFont(dpi);
  for (std::size_t variant = given == nullptr ? 0 : 1; variant < made_.size(); ++variant) {
    LOGFONTW font = plain;
    if ((variant & 1U) != 0) font.lfWeight = FW_BOLD;
    if ((variant & 2U) != 0) font.lfItalic = TRUE;
    made_[variant].reset(CreateFontIndirectW(&font));
  }
}

HFONT FieldFonts::of(const Control& control) const {
  const std::size_t variant = (control.Bold() ? 1U : 0U) + (control.Italic() ? 2U : 0U);
  return variant == 0 && given_ != nullptr ? given_ : made_[variant].get();
}

}  // namespace frontpanels
