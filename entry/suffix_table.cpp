#include "entry/suffix_table.h"

#include <utility>

namespace frontpanels {

bool SuffixTable::add(SuffixRecord record) {
  if (count_ == kCapacity) return false;
  records_[count_++] = std::move(record);
  return true;
}

const SuffixRecord* SuffixTable::find(double number) const noexcept {
  for (const SuffixRecord* record = end(); record != begin();) {
    --record;
    if (number >= record->lowerLimit && number < record->upperLimit) return record;
  }
  return count_ == 0 ? nullptr : begin();
}

}  // namespace frontpanels
