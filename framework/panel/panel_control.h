// The panel control as its base sees it.
#pragma once

#include <cstdint>
#include <string_view>

#include "platform/variant.h"
#include "traces/trace_form.h"

namespace frontpanels {

// One of the two areas beside the graph. Sizes are in the area's own scale, positions in the control's.
class SideArea {
 public:
  virtual ~SideArea() = default;

  [[nodiscard]] virtual bool Visible() = 0;
  virtual void Visible(bool visible) = 0;
  [[nodiscard]] virtual float Width() = 0;
  [[nodiscard]] virtual float Height() = 0;
  virtual void Move(float left, float top, float width, float height) = 0;
  [[nodiscard]] virtual frontpanels::ScaleMode ScaleMode() = 0;
};

class PanelControl : public TraceForm {
 public:
  // The right and the bottom area; null when the control has none.
  [[nodiscard]] virtual SideArea* displayPanel() = 0;
  [[nodiscard]] virtual SideArea* controlPanel() = 0;
  // Where a hidden area would begin, for the control's collapse buttons.
  virtual void InvisibleWidthMarkX1(float x) = 0;
  virtual void InvisibleHeightMarkY1(float y) = 0;

  [[nodiscard]] virtual ScaleMode ViewScaleMode() = 0;
  [[nodiscard]] virtual std::int16_t ViewDrawWidth() = 0;  // of the view's pen, in pixels
  virtual void ViewState(std::int16_t state) = 0;          // 0 is the normal state
  virtual void ViewVisible(bool visible) = 0;
  virtual void ViewRefresh() = 0;
  virtual void Caption(std::string_view text) = 0;
  // A request to the host; its answer is a status.
  virtual std::int32_t frontPanelOp(std::int32_t hwId, std::int32_t vfpId, std::int16_t operation,
                                    const Variant& argument) = 0;
  virtual void refreshControls() = 0;
  virtual void refreshMenuItems() = 0;
};

}  // namespace frontpanels
