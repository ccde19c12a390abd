#include "pilot/user_pn_list.h"

#include <algorithm>
#include <string>

#include "entry/entry_text.h"
#include "framework/support/error_handler.h"
#include "framework/support/numeric.h"
#include "pilot/code_units.h"

namespace frontpanels {
namespace {

constexpr std::int32_t kLastPn = kPilotOffsets - 1;

void report(std::string_view text, const Variant& value) {
  errorHandler().Assert(std::string("Tarvex").append(text).append(value.typeName()));
}

void report(std::string_view text) { errorHandler().Assert(std::string("Tarvex").append(text)); }

}  // namespace

UserPnList::UserPnList(ItemList& list) : list_(list) {
  entry.formatString("0.####");
  entry.Arbitrary(true);
  entry.resolution(1);
  entry.MINIMUM(0);
  entry.MAXIMUM(kLastPn);
  entry.step(1);
  entry.valueNoUpdate(0);
}

void UserPnList::units(CodeUnits units, std::int32_t chipsPerPn) {
  const Variant step = entry.step();
  showCodeUnits(entry, units, chipsPerPn, chipsPerPn);
  entry.step(step);
  std::vector<std::int32_t> offsets;
  offsets.reserve(static_cast<std::size_t>(count()));
  for (std::int32_t i = 0; i < count(); ++i) offsets.push_back(pn(i));
  const std::int32_t chosen = selected();
  list_.Clear();
  for (const std::int32_t offset : offsets) append(offset);
  list_.ListIndex(chosen);
}

void UserPnList::append(std::int32_t pn) { list_.AddItem(entry.formatter(pn), pn); }

void UserPnList::insert(std::int32_t pn, std::int32_t position) {
  list_.AddItem(entry.formatter(pn), pn, position);
}

void UserPnList::remove(std::int32_t position) {
  const std::int32_t chosen = selected();
  list_.RemoveItem(position);
  if (chosen == position) list_.ListIndex(std::min(position, count() - 1));
}

bool UserPnList::edit(std::int16_t index, const Variant& value) {
  return index < 0 ? removeForHost(-1 - index, value) : insertFromHost(index, value);
}

bool UserPnList::insertFromHost(std::int32_t position, const Variant& value) {
  if (position > count()) {
    report(
        "::vfpSet() attempt to add an item at an index past the end of the List Box list/CDMA_CODE_OFFSET, ");
    return false;
  }
  if (count() >= kMostItems) raiseOverflow();
  const auto offset = static_cast<std::int32_t>(
      roundHalfEven(std::clamp(value.toDouble(), 0.0, static_cast<double>(kLastPn))));
  insert(offset, position);
  if (pn(position) == value.toDouble()) return true;
  report("::vfpSet()...CDMA_CODE_OFFSET not added at the correct index");
  list_.RemoveItem(position);
  return false;
}

bool UserPnList::removeForHost(std::int32_t position, const Variant& value) {
  if (position >= count()) {
    report("::vfpSet() attempt to delete an invalid index/CDMA_CODE_OFFSET, ", value);
    return false;
  }
  if (pn(position) != value.toDouble()) {
    report("::vfpSet()...CDMA_CODE_OFFSET to delete is inconsistent with the index");
    return false;
  }
  remove(position);
  return true;
}

std::optional<std::int32_t> UserPnList::read(std::string_view text) const {
  const std::optional<double> value =
      parseEntryText(text, entry.suffixes(), entry.formatScale(), entry.decimalSeparator());
  if (!value || !(*value >= 0 && *value <= kLastPn) || *value != roundHalfEven(*value)) return std::nullopt;
  return static_cast<std::int32_t>(*value);
}

}  // namespace frontpanels
