// Host records that a caller has at hand as numbers.
#pragma once

#include <cstdint>
#include <utility>
#include <vector>

#include "entry/host_record.h"
#include "platform/runtime_error.h"

namespace frontpanels {

class HostRecordList final : public HostRecordSet {
 public:
  struct Record {
    std::int16_t order = 0;
    Variant minimum;
    Variant maximum;
  };
  explicit HostRecordList(std::vector<Record> records) : records_(std::move(records)) {}

  [[nodiscard]] std::size_t count() const override { return records_.size(); }
  [[nodiscard]] Variant field(std::size_t record, std::string_view name) const override {
    if (record >= records_.size()) raiseSubscriptOutOfRange();
    const Record& found = records_[record];
    if (name == kOrderField) return found.order;
    if (name == kMinimumField) return found.minimum;
    if (name == kMaximumField) return found.maximum;
    if (name == kDefaultField) return {};
    raiseInvalidProcedureCall();
  }

 private:
  std::vector<Record> records_;
};

}  // namespace frontpanels
