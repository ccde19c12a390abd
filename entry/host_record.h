// Records that the host delivers about one of its parameters: limits, channel zeros, spacings and the like.
#pragma once

#include <cstddef>
#include <string_view>

#include "platform/variant.h"

namespace frontpanels {

inline constexpr std::string_view kOrderField = "[Order]";
inline constexpr std::string_view kMinimumField = "[Minimum]";
inline constexpr std::string_view kMaximumField = "[Maximum]";
inline constexpr std::string_view kDefaultField = "[Default]";

class HostRecordSet {
 public:
  virtual ~HostRecordSet() = default;

  // Records in the host's order.
  [[nodiscard]] virtual std::size_t count() const = 0;
  // What a named field of a record reads. Raises "Subscript out of range" for a record that is not there,
  // "Invalid procedure call or argument" for a field that the record has not.
  [[nodiscard]] virtual Variant field(std::size_t record, std::string_view name) const = 0;
};

}  // namespace frontpanels
