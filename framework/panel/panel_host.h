// The two sides of a panel's owner: the host program, which answers requests, and the container, which holds
// the panel's place on its form.
#pragma once

#include <cstdint>
#include <string_view>
#include <vector>

#include "framework/panel/panel_settings.h"
#include "platform/variant.h"

namespace frontpanels {

// Requests that a panel raises to the host. The answer is a status: 0 done, anything else failure. A host
// that nobody has connected answers 0.
class PanelHost {
 public:
  virtual ~PanelHost() = default;

  virtual std::int32_t frontPanelOp(std::int32_t hwId, std::int32_t vfpId, std::int16_t operation,
                                    const Variant& argument) = 0;
  // A setting that the user has changed.
  virtual std::int32_t frontPanelSet(std::int32_t hwId, std::int32_t vfpId, std::int16_t parameterType,
                                     std::int16_t index, const Variant& value) = 0;
  // Settings to keep for the panel, and under the id of a set-up.
  virtual std::int32_t saveDisplaySettings(std::int32_t hwId, std::int32_t vfpId,
                                           const PanelSettings& settings) = 0;
  virtual std::int32_t saveSetup(std::int32_t setUpId, std::int32_t resourceId, std::int32_t frontPanelId,
                                 const PanelSettings& settings) = 0;
};

// The panel's place in its container. Positions and lengths are in the container's units (twips).
class PanelContainer {
 public:
  virtual ~PanelContainer() = default;

  virtual void caption(std::string_view text) = 0;
  virtual void visible(bool visible) = 0;
  // 0 is the normal state.
  virtual void viewState(std::int16_t state) = 0;
  virtual void left(float position) = 0;
  virtual void top(float position) = 0;
  virtual void width(float length) = 0;
  virtual void height(float length) = 0;
  // What the view shows, as a PNG file's bytes; empty where no picture can be made.
  [[nodiscard]] virtual std::vector<std::uint8_t> picturePng() = 0;
};

}  // namespace frontpanels
