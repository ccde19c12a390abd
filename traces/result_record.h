// An arriving result as the trace manager sees it: a record with named fields, and data that can be handed
// on.
#pragma once

#include <cstdint>
#include <string_view>

#include "platform/runtime_error.h"
#include "platform/variant.h"

namespace frontpanels {

class TraceObject;

inline constexpr std::string_view kResultTypeIdField = "[Result Type Id]";

class ResultRecord {
 public:
  virtual ~ResultRecord() = default;

  // Raises "Invalid procedure call or argument" for a field that the record does not have.
  [[nodiscard]] virtual Variant field(std::string_view name) const = 0;
};

// A result of which nothing but its type is known.
class ResultTypeRecord : public ResultRecord {
 public:
  explicit ResultTypeRecord(std::int32_t resultType) : resultType_(resultType) {}
  [[nodiscard]] Variant field(std::string_view name) const override {
    if (name != kResultTypeIdField) raiseInvalidProcedureCall();
    return resultType_;
  }

 private:
  std::int32_t resultType_;
};

// The data of one result, still in its buffer.
class ResultData {
 public:
  virtual ~ResultData() = default;

  virtual void handTo(TraceObject& traceObject) = 0;
  // Steps over the data, so that the next result can be read.
  virtual void SkipMeasurementData() = 0;
};

}  // namespace frontpanels
