// A panel control that keeps what its base asked of it, and two side areas to place.
#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "framework/panel/panel_control.h"

namespace frontpanels::testing {

class FakeSideArea : public SideArea {
 public:
  struct Place {
    float left = 0;
    float top = 0;
    float width = 0;
    float height = 0;
    friend bool operator==(const Place&, const Place&) = default;
  };

  FakeSideArea(float width, float height) : place{0, 0, width, height} {}

  Place place;
  bool visible = true;
  frontpanels::ScaleMode scaleMode = frontpanels::ScaleMode::Twips;

  bool Visible() override { return visible; }
  void Visible(bool value) override { visible = value; }
  float Width() override { return place.width; }
  float Height() override { return place.height; }
  void Move(float left, float top, float width, float height) override { place = {left, top, width, height}; }
  frontpanels::ScaleMode ScaleMode() override { return scaleMode; }
};

class FakePanelControl : public PanelControl {
 public:
  DcHandle dc{};
  float scaleWidth = 12000;
  float scaleHeight = 9000;
  std::int16_t drawWidth = 1;
  ScaleMode scaleMode = ScaleMode::Twips;
  FakeSideArea* right = nullptr;
  FakeSideArea* bottom = nullptr;
  std::int32_t hostStatus = 0;

  std::vector<std::string> calls;
  float widthMark = 0;
  float heightMark = 0;

  SideArea* displayPanel() override { return right; }
  SideArea* controlPanel() override { return bottom; }
  void InvisibleWidthMarkX1(float x) override { widthMark = x; }
  void InvisibleHeightMarkY1(float y) override { heightMark = y; }
  ScaleMode ViewScaleMode() override { return scaleMode; }
  std::int16_t ViewDrawWidth() override { return drawWidth; }
  void ViewState(std::int16_t state) override { calls.push_back("ViewState " + std::to_string(state)); }
  void ViewVisible(bool visible) override {
    calls.emplace_back(visible ? "ViewVisible on" : "ViewVisible off");
  }
  void ViewRefresh() override { calls.emplace_back("ViewRefresh"); }
  void Caption(std::string_view text) override { calls.push_back("Caption " + std::string(text)); }
  std::int32_t frontPanelOp(std::int32_t hwId, std::int32_t vfpId, std::int16_t operation,
                            const Variant&) override {
    calls.push_back("frontPanelOp " + std::to_string(hwId) + " " + std::to_string(vfpId) + " " +
                    std::to_string(operation));
    return hostStatus;
  }
  void refreshControls() override { calls.emplace_back("refreshControls"); }
  void refreshMenuItems() override { calls.emplace_back("refreshMenuItems"); }

  std::string typeName() override { return "SpectrumView"; }
  std::int16_t winState() override { return 0; }
  void changedTraceConfiguration(TraceState, TraceObject*, std::int16_t) override {}
  void setMarkerFrameColor(Color) override {}
  void deltaMarkerButtonEnabled(bool) override {}
  float ViewScaleLeft() override { return 0; }
  float ViewScaleTop() override { return 0; }
  float ViewScaleWidth() override { return scaleWidth; }
  float ViewScaleHeight() override { return scaleHeight; }
  float ViewUseableScaleWidth() override { return scaleWidth; }
  float ViewUseableScaleHeight() override { return scaleHeight; }
  WindowHandle ViewHWnd() override { return {}; }
  DcHandle ViewHDC() override { return dc; }
  MousePointer ViewMousePointer() override { return MousePointer::Default; }
  void ViewMousePointer(MousePointer) override {}
  DrawMode ViewDrawMode() override { return DrawMode::CopyPen; }
  void ViewDrawMode(DrawMode) override {}
  PenStyle ViewDrawStyle() override { return PenStyle::Solid; }
  void ViewDrawStyle(PenStyle) override {}
  void Refresh() override {}
};

}  // namespace frontpanels::testing
