#include "activex/access_keys.h"

#include <new>
#include <utility>
#include <vector>

namespace frontpanels::activex {
namespace {

// Containers compare the character that Alt and the key type, in either case, or the key itself.
void append(std::vector<ACCEL>& table, char32_t key) {
  const bool letter = key >= U'a' && key <= U'z';
  const auto code = static_cast<WORD>(key);
  const auto upper = static_cast<WORD>(letter ? key - U'a' + U'A' : key);
  table.push_back({FALT, code, 0});
  if (letter) table.push_back({FALT, upper, 0});
  if (letter || (key >= U'0' && key <= U'9')) table.push_back({FALT | FVIRTKEY, upper, 0});
}

}  // namespace

void AccessKeys::give(const std::u32string& keys, CONTROLINFO& info) {
  std::vector<ACCEL> entries;
  for (const char32_t key : keys) append(entries, key);
  HACCEL made = nullptr;
  if (!entries.empty()) {
    made = CreateAcceleratorTableW(entries.data(), static_cast<int>(entries.size()));
    if (made == nullptr) throw std::bad_alloc();
  }
  given_ = keys;
  release();
  table_ = made;
  info.hAccel = made;
  info.cAccel = static_cast<USHORT>(entries.size());
}

void AccessKeys::release() noexcept {
  if (const HACCEL table = std::exchange(table_, nullptr)) DestroyAcceleratorTable(table);
}

}  // namespace frontpanels::activex
