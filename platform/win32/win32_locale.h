// The regional settings of the Windows user.
#pragma once

#include "platform/locale.h"

namespace frontpanels {

class Win32Locale final : public Locale {
 public:
  [[nodiscard]] std::string info(LocaleItem item, std::int32_t maxChars) const override;
};

}  // namespace frontpanels
