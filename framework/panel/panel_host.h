// The two sides of a panel's owner: the host program, which answers requests, and the container, which holds
// the panel's place on its form.
#pragma once

#include <cstdint>
#include <string_view>

#include "platform/variant.h"

namespace frontpanels {

// Requests that a panel raises to the host. The answer is a status: 0 done, anything else failure. A host
// that nobody has connected answers 0.
class PanelHost {
 public:
  virtual ~PanelHost() = default;

  virtual std::int32_t frontPanelOp(std::int32_t hwId, std::int32_t vfpId, std::int16_t operation,
                                    const Variant& argument) = 0;
};

// The panel's place in its container. Positions are in the container's units (twips).
class PanelContainer {
 public:
  virtual ~PanelContainer() = default;

  virtual void caption(std::string_view text) = 0;
  virtual void visible(bool visible) = 0;
  // 0 is the normal state.
  virtual void viewState(std::int16_t state) = 0;
};

}  // namespace frontpanels
