// The version of the data that the host delivers, one for the whole library: it says which fields its records
// have.
#pragma once

namespace frontpanels {

// From this version on a record names the band that it belongs to.
inline constexpr double kHostDataWithOrders = 0.04;

// The newest, until the host's data say otherwise.
[[nodiscard]] double hostDataVersion() noexcept;
void hostDataVersion(double version) noexcept;

}  // namespace frontpanels
