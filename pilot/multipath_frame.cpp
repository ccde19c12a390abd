#include "pilot/multipath_frame.h"

#include <algorithm>

#include "platform/runtime_error.h"

namespace frontpanels {

bool MultipathFrame::take(std::int32_t column, std::span<const float> values) {
  if (column == 0) {
    for (Column& one : columns_) one.arrived = false;
    spoiled_ = false;
  }
  if (spoiled_) return false;
  Column& taken = columns_.at(static_cast<std::size_t>(column));
  taken.values.assign(values.begin(), values.end());
  taken.arrived = true;
  if (column != kValuesPerPilot - 1) return false;
  spoiled_ = true;  // what comes before the next PN offsets belongs to no frame
  if (!whole(values.size())) raiseSubscriptOutOfRange();
  records_.resize(values.size() * kValuesPerPilot);
  float* record = records_.data();
  for (std::size_t pilot = 0; pilot < values.size(); ++pilot)
    for (const Column& one : columns_) *record++ = one.values[pilot];
  return true;
}

void MultipathFrame::takeRecords(std::span<const float> records) {
  if (records.size() % kValuesPerPilot != 0) raiseSubscriptOutOfRange();
  records_.assign(records.begin(), records.end());
}

bool MultipathFrame::whole(std::size_t pilots) const noexcept {
  return std::all_of(columns_.begin(), columns_.end(), [pilots](const Column& column) {
    return column.arrived && column.values.size() == pilots;
  });
}

}  // namespace frontpanels
