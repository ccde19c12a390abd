// The requests of a panel as events of its control, each answered in a status by reference. The numbers are
// the same for all panels.
#pragma once

#include <oaidl.h>

#include <span>
#include <vector>

#include "activex/control_core.h"
#include "framework/panel/panel_host.h"

namespace frontpanels::activex {

class PanelRequests final : public PanelHost {
 public:
  explicit PanelRequests(ControlCore& control) noexcept : control_(control) {}

  std::int32_t frontPanelOp(std::int32_t hwId, std::int32_t vfpId, std::int16_t operation,
                            const Variant& argument) override;
  std::int32_t frontPanelSet(std::int32_t hwId, std::int32_t vfpId, std::int16_t parameterType,
                             std::int16_t index, const Variant& value) override;
  std::int32_t saveDisplaySettings(std::int32_t hwId, std::int32_t vfpId,
                                   const PanelSettings& settings) override;
  // The host reads the settings from the control inside the event.
  std::int32_t saveSetup(std::int32_t setUpId, std::int32_t resourceId, std::int32_t frontPanelId,
                         const PanelSettings& settings) override;

 private:
  [[nodiscard]] std::int32_t raise(DISPID event, std::span<const Variant> arguments);

  ControlCore& control_;
};

// Code, value, code, value: a list that every script can walk.
[[nodiscard]] Variant listOf(const PanelSettings& settings);

}  // namespace frontpanels::activex
