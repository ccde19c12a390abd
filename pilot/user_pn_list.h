// The user's list of PN offsets: the entry that a new one is typed into, the list box, and the edits that a
// host makes in it. An item shows its PN offset as the entry would and carries it as item data.
#pragma once

#include <cstdint>
#include <optional>
#include <string_view>
#include <vector>

#include "entry/numeric_entry.h"
#include "pilot/code_entries.h"
#include "platform/controls.h"

namespace frontpanels {

class UserPnList {
 public:
  // Places in the list travel as 16-bit indices.
  static constexpr std::int32_t kMostItems = 32768;

  // The list must outlive this.
  explicit UserPnList(ItemList& list);

  clsNumericEntry entry;  // a PN offset, whole, 0 to 511

  [[nodiscard]] std::int32_t count() const noexcept { return list_.ListCount(); }
  // Raises "Subscript out of range".
  [[nodiscard]] std::int32_t pn(std::int32_t position) const { return list_.item(position).data; }
  [[nodiscard]] std::int32_t selected() const noexcept { return list_.ListIndex(); }

  // The units that entry and items show, for a format with `chipsPerPn`.
  void units(CodeUnits units, std::int32_t chipsPerPn);
  // The distance of the PN offsets that a click on the arrows goes.
  void increment(double pn) noexcept { entry.step(pn); }

  // A host's edit: a position from 0 inserts the PN offset there, -1 deletes the first item, -2 the second.
  // What cannot be done is reported in the words of the host's call, and changes nothing. True when the list
  // has changed.
  bool edit(std::int16_t index, const Variant& value);
  void append(std::int32_t pn);
  void insert(std::int32_t pn, std::int32_t position);
  // Also moves the selection on: to the item that took the place, or the last one.
  void remove(std::int32_t position);

  // The PN offset that a text means in the units shown; nothing where it means none of the 512.
  [[nodiscard]] std::optional<std::int32_t> read(std::string_view text) const;

 private:
  [[nodiscard]] bool insertFromHost(std::int32_t position, const Variant& value);
  [[nodiscard]] bool removeForHost(std::int32_t position, const Variant& value);

  ItemList& list_;
};

}  // namespace frontpanels
