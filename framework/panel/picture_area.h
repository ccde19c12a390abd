// An area beside the graph that a picture of the panel's controls table stands for.
#pragma once

#include "framework/panel/panel_control.h"
#include "platform/control_set.h"

namespace frontpanels {

class PictureArea final : public SideArea {
 public:
  // Both must outlive the area.
  PictureArea(const ControlSet& controls, Picture& picture) noexcept
      : controls_(controls), picture_(picture) {}

  [[nodiscard]] bool Visible() override { return picture_.Visible(); }
  void Visible(bool visible) override { picture_.Visible(visible); }
  void Enabled(bool enabled) override { picture_.Enabled(enabled); }
  void disableControls() override {
    for (const auto& control : controls_.controls())
      if (control->liesIn(picture_)) control->Enabled(false);
  }
  [[nodiscard]] float Width() override { return picture_.place().widthTwips; }
  [[nodiscard]] float Height() override { return picture_.place().heightTwips; }
  void Move(float left, float top, float width, float height) override {
    picture_.Move({left, top, width, height});
  }
  [[nodiscard]] frontpanels::ScaleMode ScaleMode() override { return frontpanels::ScaleMode::Twips; }

 private:
  const ControlSet& controls_;
  Picture& picture_;
};

}  // namespace frontpanels
