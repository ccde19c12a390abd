// What is alike in all panel controls: the drawing surface over the view, the place in the container, and the
// requests to the host. A panel adds its data and its controls.
#pragma once

#include <cstdint>
#include <string_view>
#include <vector>

#include "framework/panel/panel_control.h"
#include "framework/panel/panel_environment.h"
#include "framework/panel/panel_host.h"
#include "framework/panel/pop_up_menu.h"
#include "platform/control_set.h"

namespace frontpanels {

class HostedPanel : public PanelControl {
 public:
  // Everything referred to must outlive the panel.
  HostedPanel(const PanelEnvironment& environment, PanelHost& host, PanelContainer& container)
      : gdi_(environment.gdi),
        view_(environment.view),
        metrics_(environment.metrics),
        host_(host),
        container_(container) {}

  // The surface: pixels of the view, measured in twips unless its scale is set to pixels.
  float ViewScaleLeft() override { return 0; }
  float ViewScaleTop() override { return 0; }
  float ViewScaleWidth() override;
  float ViewScaleHeight() override;
  float ViewUseableScaleWidth() override { return ViewScaleWidth(); }
  float ViewUseableScaleHeight() override { return ViewScaleHeight(); }
  ScaleMode ViewScaleMode() override { return scaleMode_; }
  // Raises "Invalid procedure call or argument" for any but twips and pixels.
  void ViewScaleMode(std::int16_t mode);
  WindowHandle ViewHWnd() override { return view_.hwnd(); }
  DcHandle ViewHDC() override { return view_.hdc(); }
  MousePointer ViewMousePointer() override { return view_.mousePointer(); }
  void ViewMousePointer(MousePointer pointer) override { view_.mousePointer(pointer); }
  void Refresh() override { view_.refresh(); }
  void ViewRefresh() override { view_.refresh(); }
  void tracesPainted() override { view_.painted(); }

  // How the surface is drawn on; what the graphics interface knows is set in the view's device context.
  DrawMode ViewDrawMode() override { return drawMode_; }
  void ViewDrawMode(DrawMode mode) override;
  PenStyle ViewDrawStyle() override { return drawStyle_; }
  void ViewDrawStyle(PenStyle style) override { drawStyle_ = style; }
  std::int16_t ViewDrawWidth() override { return drawWidthPx_; }
  void ViewDrawWidth(std::int16_t widthPx);  // at least 1, else "Invalid procedure call or argument"
  [[nodiscard]] std::int16_t ViewFillStyle() const noexcept { return fillStyle_; }
  void ViewFillStyle(std::int16_t style) noexcept { fillStyle_ = style; }
  [[nodiscard]] bool ViewFontTransparent() const noexcept { return fontTransparent_; }
  void ViewFontTransparent(bool transparent);
  [[nodiscard]] Color ViewForeColor() const noexcept { return foreColor_; }
  void ViewForeColor(Color color);
  // Where a drawing host went on to, in the surface's scale.
  [[nodiscard]] float ViewCurrentX() const noexcept { return currentX_; }
  void ViewCurrentX(float x) noexcept { currentX_ = x; }
  [[nodiscard]] float ViewCurrentY() const noexcept { return currentY_; }
  void ViewCurrentY(float y) noexcept { currentY_ = y; }

  // The place in the container
  [[nodiscard]] float ViewWidth();
  void ViewWidth(float width) override { container_.width(width); }
  [[nodiscard]] float ViewHeight();
  void ViewHeight(float height) override { container_.height(height); }
  void left(float position) override { container_.left(position); }
  void top(float position) override { container_.top(position); }
  std::int16_t winState() override { return winState_; }
  void ViewState(std::int16_t state) override;
  [[nodiscard]] bool ViewVisible() { return view_.visible(); }
  void ViewVisible(bool visible) override;
  void Caption(std::string_view text) override { container_.caption(text); }
  void SetCaption(std::string_view text, clsBaseVFP& /*base*/) override { Caption(text); }
  void InvisibleWidthMarkX1(float x) override { invisibleWidthMarkX1_ = x; }
  [[nodiscard]] float InvisibleWidthMarkX1() const noexcept { return invisibleWidthMarkX1_; }
  void InvisibleHeightMarkY1(float y) override { invisibleHeightMarkY1_ = y; }
  [[nodiscard]] float InvisibleHeightMarkY1() const noexcept { return invisibleHeightMarkY1_; }

  // The panel's fields; null when it has none.
  [[nodiscard]] virtual ControlSet* controls() { return nullptr; }

  // The graph's context menu as it is to be shown now; no items for none. A click on an item that is not
  // enabled does nothing.
  [[nodiscard]] virtual std::vector<PanelMenuItem> contextMenu() { return {}; }
  virtual void contextMenuClick(std::int16_t /*id*/) {}

  // Requests to the host
  std::int32_t frontPanelOp(std::int32_t hwId, std::int32_t vfpId, std::int16_t operation,
                            const Variant& argument) override {
    return host_.frontPanelOp(hwId, vfpId, operation, argument);
  }
  std::int32_t frontPanelSet(std::int32_t hwId, std::int32_t vfpId, std::int16_t parameterType,
                             std::int16_t index, const Variant& value) override {
    return host_.frontPanelSet(hwId, vfpId, parameterType, index, value);
  }
  std::int32_t saveDisplaySettings(std::int32_t hwId, std::int32_t vfpId,
                                   const PanelSettings& settings) override {
    return host_.saveDisplaySettings(hwId, vfpId, settings);
  }
  std::int32_t saveSetup(std::int32_t setUpId, std::int32_t resourceId, std::int32_t frontPanelId,
                         const PanelSettings& settings) override {
    return host_.saveSetup(setUpId, resourceId, frontPanelId, settings);
  }

  [[nodiscard]] const ScreenMetrics& metrics() const noexcept { return metrics_; }
  // The view stands on a screen of another scale.
  virtual void rescale(ScreenMetrics metrics) { metrics_ = metrics; }

 protected:
  [[nodiscard]] Gdi& gdi() const noexcept { return gdi_; }
  [[nodiscard]] GraphView& view() const noexcept { return view_; }
  [[nodiscard]] PanelContainer& container() const noexcept { return container_; }

 private:
  Gdi& gdi_;
  GraphView& view_;
  ScreenMetrics metrics_;
  PanelHost& host_;
  PanelContainer& container_;

  ScaleMode scaleMode_ = ScaleMode::Twips;
  DrawMode drawMode_ = DrawMode::CopyPen;
  PenStyle drawStyle_ = PenStyle::Solid;
  std::int16_t drawWidthPx_ = 1;
  std::int16_t fillStyle_ = 1;  // transparent
  bool fontTransparent_ = true;
  Color foreColor_{};
  float currentX_ = 0;
  float currentY_ = 0;
  std::int16_t winState_ = 0;
  float invisibleWidthMarkX1_ = 0;
  float invisibleHeightMarkY1_ = 0;
};

}  // namespace frontpanels
