#include "pilot/code_units.h"

#include "framework/support/enumerated_tables.h"
#include "framework/support/guard.h"
#include "framework/support/numeric.h"

namespace frontpanels {

std::int32_t CurrentToIS95BChips(std::int16_t codeFormat, std::int32_t chips) noexcept {
  if (codeFormat != kTripleRateCodeFormat) return chips;
  return guarded("Tarvex::CurrentToIS95BChips()", 0, [chips] {
    return toInt32(static_cast<double>(chips) / kTripleRateChipsPerPn * kIs95BChipsPerPn);
  });
}

std::int32_t IS95BToCurrentChips(std::int16_t codeFormat, std::int32_t is95BChips) noexcept {
  if (codeFormat != kTripleRateCodeFormat) return is95BChips;
  return guarded("Tarvex::IS95BToCurrentChips()", 0, [is95BChips] {
    return toInt32(static_cast<double>(is95BChips) / kIs95BChipsPerPn * kTripleRateChipsPerPn);
  });
}

std::int32_t chipsPerPn(std::int16_t codeFormat) noexcept {
  return codeFormat == kTripleRateCodeFormat ? kTripleRateChipsPerPn : kIs95BChipsPerPn;
}

}  // namespace frontpanels
