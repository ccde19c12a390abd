// Values of every kind that a host can pass, made from the fuzzer's bytes.
#pragma once

#include "fuzz/fuzz_input.h"
#include "platform/variant.h"

namespace frontpanels::fuzz {

// A byte for the type, and what the type needs: see the table.
[[nodiscard]] Variant takeVariant(FuzzInput& input);

}  // namespace frontpanels::fuzz
