#include "painters/trace_values.h"

#include <utility>

namespace frontpanels {

void addToValues(TraceSlot& slot, double amount) {
  if (!slot.data.isArray()) return;
  const std::size_t count = slot.valueCount();
  slot.minMaxCurrent = false;
  if (auto* const singles = std::get_if<Variant::Singles>(&slot.data.value())) {
    singles->resize(count);
    for (float& value : *singles) value = static_cast<float>(value + amount);
  } else if (auto* const doubles = std::get_if<Variant::Doubles>(&slot.data.value())) {
    doubles->resize(count);
    for (double& value : *doubles) value += amount;
  } else {
    Variant::Doubles sums(count);
    for (std::size_t i = 0; i < count; ++i) sums[i] = slot.valueAt(i) + amount;
    slot.data = Variant(std::move(sums));
  }
}

}  // namespace frontpanels
