#include "entry/enumerated_parameter.h"

#include <string>
#include <vector>

#include "framework/support/enumerated_tables.h"
#include "framework/support/error_handler.h"
#include "framework/support/guard.h"
#include "framework/support/numeric.h"
#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

auto messageOf(std::string_view routine) {
  return [routine] {
    return std::string(clsEnumeratedParameter::kTypeName).append("::").append(routine).append("()...");
  };
}

}  // namespace

void clsEnumeratedParameter::ComboBox(ItemList* list) noexcept {
  guard(messageOf("ComboBox"), [&] {
    list_ = list;
    if (list == nullptr) return;
    if (list->Style() != ListStyle::DropDownList)
      errorHandler().Assert("clsEnumeratedParameter::ComboBox() expects a drop down list");
    if (parameterType_ != 0) fill();
  });
}

void clsEnumeratedParameter::Enabled(bool enabled) noexcept {
  guard(messageOf("Enabled"), [&] {
    if (list_ != nullptr) list_->Enabled(enabled);
    if (label_ != nullptr) label_->Enabled(enabled);
  });
}

void clsEnumeratedParameter::Visible(bool visible) noexcept {
  guard(messageOf("Visible"), [&] {
    if (list_ != nullptr) list_->Visible(visible);
    if (label_ != nullptr) label_->Visible(visible);
  });
}

void clsEnumeratedParameter::parameterType(std::int32_t type) noexcept {
  guard(messageOf("parameterType"), [&] {
    parameterType_ = type;
    if (list_ != nullptr) fill();
  });
}

void clsEnumeratedParameter::value(std::int16_t value) noexcept {
  guard(messageOf("value"), [&] {
    value_ = value;
    if (list_ == nullptr) return;
    const std::int32_t index = itemOf(value);
    if (index >= 0) {
      list_->ListIndex(index);
    } else {
      errorHandler().Assert("clsEnumeratedParameter::value() ... could not find value (" +
                            std::to_string(value) + ") for ParameterType " + std::to_string(parameterType_));
    }
  });
}

void clsEnumeratedParameter::Add(std::int16_t value) noexcept {
  guard(messageOf("Add"), [&] {
    static_cast<void>(list());
    if (itemOf(value) < 0) addItem(value);
  });
}

void clsEnumeratedParameter::Remove(std::int16_t value) noexcept {
  guard(messageOf("Remove"), [&] {
    ItemList& items = list();
    const std::int32_t index = itemOf(value);
    if (index >= 0) items.RemoveItem(index);
  });
}

void clsEnumeratedParameter::Update() noexcept {
  guard(messageOf("Update"), [&] {
    if (list_ != nullptr) select();
  });
}

void clsEnumeratedParameter::Limits(const HostRecordSet& records) noexcept {
  struct Range {
    std::int16_t minimum;
    std::int16_t maximum;
  };
  guard(messageOf("Limits"), [&] {
    const ItemList& items = list();
    std::vector<Range> ranges;
    for (std::size_t record = 0; record < records.count(); ++record) {
      const Variant minimum = records.field(record, kMinimumField);
      const Variant maximum = records.field(record, kMaximumField);
      if (minimum.isNumeric() && maximum.isNumeric())
        ranges.push_back({minimum.toInt16(), maximum.toInt16()});
    }
    // A host may name all 65536 values: each is looked up in one step.
    std::vector<bool> listed(1U << 16U);
    for (std::int32_t index = 0; index < items.ListCount(); ++index)
      if (const std::int32_t data = items.item(index).data; data == static_cast<std::int16_t>(data))
        listed[static_cast<std::uint16_t>(data)] = true;
    for (const Range& range : ranges)
      for (std::int32_t value = range.minimum; value <= range.maximum; ++value) {
        const auto slot = static_cast<std::uint16_t>(value);
        if (!listed[slot]) addItem(static_cast<std::int16_t>(value));
        listed[slot] = true;
      }
  });
}

void clsEnumeratedParameter::Click() noexcept {
  guard(messageOf("Change"), [&] {
    newValue_ = false;
    if (list_ == nullptr || list_->ListIndex() < 0) return;
    const std::int16_t clicked = toInt16(list_->item(list_->ListIndex()).data);
    newValue_ = clicked != value_;
    value_ = clicked;
  });
}

ItemList& clsEnumeratedParameter::list() const {
  if (list_ == nullptr) raiseObjectVariableNotSet();
  return *list_;
}

std::int32_t clsEnumeratedParameter::itemOf(std::int16_t value) const {
  std::int32_t index = list_->ListCount() - 1;
  while (index >= 0 && list_->item(index).data != value) --index;
  return index;
}

void clsEnumeratedParameter::addItem(std::int16_t value) const {
  list_->AddItem(enumeratedLabel(parameterType_, value), value);
}

void clsEnumeratedParameter::fill() const {
  list_->Clear();
  if (!subset_)
    for (const EnumeratedValue& row : enumeratedValues(parameterType_)) list_->AddItem(row.label, row.value);
  select();
}

void clsEnumeratedParameter::select() const {
  const std::int32_t index = itemOf(value_);
  if (index >= 0) list_->ListIndex(index);
}

}  // namespace frontpanels
