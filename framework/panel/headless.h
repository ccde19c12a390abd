// What surrounds a panel where nobody looks on: a picture box over a device context, no pointer and no other
// windows, a host that takes every request and measures nothing.
#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "framework/panel/panel_host.h"
#include "platform/windowing.h"

namespace frontpanels {

// Painted when the picture is taken. The size is what it says of itself, whatever lies behind it.
class HeadlessView : public GraphView {
 public:
  Size sizePx;
  bool shown = true;

  HeadlessView(DcHandle dc, Size size) : sizePx(size), dc_(dc) {}

  [[nodiscard]] DcHandle hdc() override { return dc_; }
  [[nodiscard]] WindowHandle hwnd() override { return {}; }
  [[nodiscard]] Size clientSizePx() override { return sizePx; }
  [[nodiscard]] MousePointer mousePointer() override { return pointer_; }
  void mousePointer(MousePointer pointer) override { pointer_ = pointer; }
  [[nodiscard]] bool visible() override { return shown; }
  void visible(bool visible) override { shown = visible; }
  void refresh() override {}

 private:
  DcHandle dc_;
  MousePointer pointer_ = MousePointer::Default;
};

class HeadlessWindowing : public Windowing {
 public:
  WindowHandle setCapture(WindowHandle) override { return {}; }
  [[nodiscard]] WindowHandle getCapture() override { return {}; }
  void releaseCapture() override {}
  bool setTopmost(WindowHandle, bool) override { return true; }
};

class HeadlessOwner : public PanelHost, public PanelContainer {
 public:
  std::int32_t frontPanelOp(std::int32_t, std::int32_t, std::int16_t, const Variant&) override { return 0; }
  std::int32_t frontPanelSet(std::int32_t, std::int32_t, std::int16_t, std::int16_t,
                             const Variant&) override {
    return 0;
  }
  std::int32_t saveDisplaySettings(std::int32_t, std::int32_t, const PanelSettings&) override { return 0; }
  std::int32_t saveSetup(std::int32_t, std::int32_t, std::int32_t, const PanelSettings&) override {
    return 0;
  }
  void caption(std::string_view text) override { caption_ = text; }
  void visible(bool) override {}
  void viewState(std::int16_t) override {}
  void left(float) override {}
  void top(float) override {}
  void width(float) override {}
  void height(float) override {}
  [[nodiscard]] std::vector<std::uint8_t> picturePng() override { return {}; }

  [[nodiscard]] const std::string& captionText() const noexcept { return caption_; }

 private:
  std::string caption_;
};

}  // namespace frontpanels
