#include "pilot/cell_name_info.h"

#include <algorithm>
#include <bit>
#include <cmath>
#include <limits>

#include "framework/support/guard.h"
#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

constexpr std::string_view kUnknown = "Unknown";
constexpr std::size_t kMost = std::numeric_limits<std::int16_t>::max();  // entries, and characters of a name
constexpr std::uint16_t kFree = 0xFFFF;
constexpr std::size_t kFewestPlaces = 64;

// As texts are measured by hosts: what UTF-8 writes in four bytes are two units of UTF-16.
std::size_t utf16Length(std::string_view utf8) {
  std::size_t units = 0;
  for (const char c : utf8) {
    const auto byte = static_cast<unsigned char>(c);
    units += (byte & 0xC0U) != 0x80U ? 1U : 0U;
    units += byte >= 0xF0U ? 1U : 0U;
  }
  return units;
}

// Spreads each bit over all of them, so that identifiers in steps do not crowd.
std::uint64_t mixed(std::uint64_t bits) noexcept {
  bits = (bits ^ (bits >> 30U)) * 0xBF58476D1CE4E5B9U;
  bits = (bits ^ (bits >> 27U)) * 0x94D049BB133111EBU;
  return bits ^ (bits >> 31U);
}

// The same for 0 and -0, which are equal.
std::uint64_t hashOf(double id) noexcept { return mixed(std::bit_cast<std::uint64_t>(id == 0 ? 0.0 : id)); }
std::uint64_t hashOf(double id1, double id2) noexcept {
  return mixed(hashOf(id1) + std::rotl(hashOf(id2), 1));
}

template <class Predicate>
std::size_t firstPlace(const std::vector<std::uint16_t>& places, std::uint64_t hash,
                       Predicate isWanted) noexcept {
  const std::size_t mask = places.size() - 1;
  auto place = static_cast<std::size_t>(hash) & mask;
  while (places[place] != kFree && !isWanted(places[place])) place = (place + 1) & mask;
  return place;
}

}  // namespace

void clsCellNameInfo::Initialize() noexcept {
  entries_.clear();
  std::fill(byFirst_.begin(), byFirst_.end(), kFree);
  std::fill(byBoth_.begin(), byBoth_.end(), kFree);
  maxCellNameLength_ = 0;
}

void clsCellNameInfo::SetCellName(double id1, double id2, std::string_view name) noexcept {
  const auto message = [] { return std::string(kTypeName) + "::SetCellName()"; };
  guard(message, [&] { add(id1, id2, name); });
}

void clsCellNameInfo::add(double id1, double id2, std::string_view name) {
  const std::size_t length = utf16Length(name);
  if (entries_.size() == kMost || length > kMost) raiseOverflow();
  if (2 * (entries_.size() + 1) > byFirst_.size()) growPlaces();
  entries_.push_back({id1, id2, std::string(name)});
  enter(static_cast<std::uint16_t>(entries_.size() - 1));
  maxCellNameLength_ = std::max(maxCellNameLength_, static_cast<std::int16_t>(length));
}

// Both tables are there before the first changes, as memory may run out between them.
void clsCellNameInfo::growPlaces() {
  const std::size_t size = std::max(kFewestPlaces, 2 * byFirst_.size());
  Places first(size, kFree);
  Places both(size, kFree);
  byFirst_.swap(first);
  byBoth_.swap(both);
  for (std::size_t entry = 0; entry < entries_.size(); ++entry) enter(static_cast<std::uint16_t>(entry));
}

// Where an earlier entry has the key already, that one stays. What is not a number is never looked for.
void clsCellNameInfo::enter(std::uint16_t entry) noexcept {
  const double id1 = entries_[entry].id1;
  const double id2 = entries_[entry].id2;
  if (std::isnan(id1)) return;
  std::uint16_t& first = byFirst_[placeOf(id1)];
  if (first == kFree) first = entry;
  if (std::isnan(id2)) return;
  std::uint16_t& both = byBoth_[placeOf(id1, id2)];
  if (both == kFree) both = entry;
}

std::size_t clsCellNameInfo::placeOf(double id1) const noexcept {
  return firstPlace(byFirst_, hashOf(id1), [&](std::uint16_t entry) { return entries_[entry].id1 == id1; });
}

std::size_t clsCellNameInfo::placeOf(double id1, double id2) const noexcept {
  return firstPlace(byBoth_, hashOf(id1, id2), [&](std::uint16_t entry) {
    return entries_[entry].id1 == id1 && entries_[entry].id2 == id2;
  });
}

std::string_view clsCellNameInfo::GetCellName(double id1, double id2) const noexcept {
  if (entries_.empty()) return kUnknown;
  const std::uint16_t entry = id2 < 0 ? byFirst_[placeOf(id1)] : byBoth_[placeOf(id1, id2)];
  return entry == kFree ? kUnknown : std::string_view(entries_[entry].name);
}

}  // namespace frontpanels
