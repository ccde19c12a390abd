#include "activex/panel_requests.h"

#include "activex/connections_part.h"
#include "activex/variants.h"

namespace frontpanels::activex {
namespace {

enum Event : DISPID { kFrontPanelOp = 1, kFrontPanelSet = 2, kSaveDisplaySettings = 3, kSaveSetup = 4 };

// Arguments of a call, cleared after it.
class Arguments {
 public:
  Arguments() = default;
  // By way of the empty list, which clears what it has got when a value is too much for the memory.
  explicit Arguments(std::span<const Variant> values) : Arguments() {
    list_.reserve(values.size());
    for (const Variant& value : values) list_.push_back(toAutomation(value));
  }
  ~Arguments() {
    for (VARIANT& argument : list_) VariantClear(&argument);
  }
  Arguments(const Arguments&) = delete;
  Arguments& operator=(const Arguments&) = delete;
  [[nodiscard]] std::span<const VARIANT> get() const noexcept { return list_; }

 private:
  std::vector<VARIANT> list_;
};

}  // namespace

Variant listOf(const PanelSettings& settings) {
  Variant::Variants list;
  list.reserve(settings.size() * 2);
  for (const PanelSetting& setting : settings) {
    list.emplace_back(setting.parameterType);
    list.push_back(setting.value);
  }
  return list;
}

std::int32_t PanelRequests::raise(DISPID event, std::span<const Variant> arguments) {
  const Arguments list(arguments);
  return static_cast<std::int32_t>(control_.connections().raiseForStatus(event, list.get()));
}

std::int32_t PanelRequests::frontPanelOp(std::int32_t hwId, std::int32_t vfpId, std::int16_t operation,
                                         const Variant& argument) {
  const Variant arguments[] = {hwId, vfpId, operation, argument};
  return raise(kFrontPanelOp, arguments);
}

std::int32_t PanelRequests::frontPanelSet(std::int32_t hwId, std::int32_t vfpId, std::int16_t parameterType,
                                          std::int16_t index, const Variant& value) {
  const Variant arguments[] = {hwId, vfpId, parameterType, index, value};
  return raise(kFrontPanelSet, arguments);
}

std::int32_t PanelRequests::saveDisplaySettings(std::int32_t hwId, std::int32_t vfpId,
                                                const PanelSettings& settings) {
  const Variant arguments[] = {hwId, vfpId, listOf(settings)};
  return raise(kSaveDisplaySettings, arguments);
}

std::int32_t PanelRequests::saveSetup(std::int32_t setUpId, std::int32_t resourceId,
                                      std::int32_t frontPanelId, const PanelSettings& /*settings*/) {
  const Variant arguments[] = {setUpId, resourceId, frontPanelId};
  return raise(kSaveSetup, arguments);
}

}  // namespace frontpanels::activex
