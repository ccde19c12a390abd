// Records as a host delivers them, listed by a test.
#pragma once

#include <map>
#include <string>
#include <vector>

#include "entry/host_record.h"
#include "platform/runtime_error.h"

namespace frontpanels::testing {

class ListedRecords : public HostRecordSet {
 public:
  using Record = std::map<std::string, Variant, std::less<>>;
  explicit ListedRecords(std::vector<Record> records) : records_(std::move(records)) {}

  [[nodiscard]] std::size_t count() const override { return records_.size(); }
  [[nodiscard]] Variant field(std::size_t record, std::string_view name) const override {
    const auto found = records_.at(record).find(name);
    if (found == records_.at(record).end()) raiseInvalidProcedureCall();
    return found->second;
  }

 private:
  std::vector<Record> records_;
};

}  // namespace frontpanels::testing
