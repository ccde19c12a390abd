// Reading and changing the values of a trace.
#pragma once

#include <span>
#include <string_view>
#include <variant>
#include <vector>

#include "framework/support/error_handler.h"
#include "painters/trace_store.h"

namespace frontpanels {

// Calls `use` with the values that exist, as a span of singles or doubles, where they lie. An array of
// another type is reported with `slowMessage` and converted into `scratch` first, which raises what the
// conversion raises. Nothing is called for a slot without values.
template <class Use>
void withValues(const TraceSlot& slot, std::vector<double>& scratch, std::string_view slowMessage,
                Use&& use) {
  if (!slot.data.isArray()) return;
  const std::size_t count = slot.valueCount();
  if (const auto* const singles = std::get_if<Variant::Singles>(&slot.data.value())) {
    use(std::span(*singles).first(count));
  } else if (const auto* const doubles = std::get_if<Variant::Doubles>(&slot.data.value())) {
    use(std::span(*doubles).first(count));
  } else {
    errorHandler().Assert(slowMessage);
    scratch.resize(count);
    for (std::size_t i = 0; i < count; ++i) scratch[i] = slot.valueAt(i);
    use(std::span<const double>(scratch));
  }
}

// Replaces the values of points 0 to size by themselves plus `amount`; what lies behind them goes. Singles
// stay singles and doubles doubles; another array becomes one of doubles.
void addToValues(TraceSlot& slot, double amount);

}  // namespace frontpanels
