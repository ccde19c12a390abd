#include "platform/win32/win32_locale.h"

#include <windows.h>

#include <algorithm>
#include <array>

#include "platform/win32/utf16.h"

namespace frontpanels {

static_assert(static_cast<LCTYPE>(LocaleItem::ListSeparator) == LOCALE_SLIST);
static_assert(static_cast<LCTYPE>(LocaleItem::DecimalSeparator) == LOCALE_SDECIMAL);

std::string Win32Locale::info(LocaleItem item, std::int32_t maxChars) const {
  std::array<wchar_t, 100> buffer{};
  const int size = std::clamp(maxChars, 1, static_cast<std::int32_t>(buffer.size()));
  // The answer counts the terminating zero; 0 is a failure.
  const int length = GetLocaleInfoW(LOCALE_USER_DEFAULT, static_cast<LCTYPE>(item), buffer.data(), size);
  return length <= 1 ? std::string() : toUtf8({buffer.data(), static_cast<std::size_t>(length - 1)});
}

}  // namespace frontpanels
