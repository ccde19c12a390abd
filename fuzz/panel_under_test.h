// A SpectrumView with everything round it in memory, which looks at its end whether it kept its promises.
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string_view>
#include <vector>

#include "framework/panel/panel_host.h"
#include "platform/data_server.h"
#include "platform/raster/raster_gdi.h"
#include "platform/windowing.h"
#include "spectrum/spectrum_view.h"

namespace frontpanels::fuzz {

// The picture box. The pixels behind it stay as many, whatever size it says it has.
class FuzzView : public GraphView {
 public:
  Size sizePx;
  bool shown = false;

  FuzzView(DcHandle dc, Size size) : sizePx(size), dc_(dc) {}

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

// Host and container, answering every request with the same status.
class FuzzOwner : public PanelHost, public PanelContainer {
 public:
  std::int32_t status = 0;

  std::int32_t frontPanelOp(std::int32_t, std::int32_t, std::int16_t, const Variant&) override {
    return status;
  }
  std::int32_t frontPanelSet(std::int32_t, std::int32_t, std::int16_t, std::int16_t,
                             const Variant&) override {
    return status;
  }
  std::int32_t saveDisplaySettings(std::int32_t, std::int32_t, const PanelSettings&) override {
    return status;
  }
  std::int32_t saveSetup(std::int32_t, std::int32_t, std::int32_t, const PanelSettings&) override {
    return status;
  }
  void caption(std::string_view) override {}
  void visible(bool) override {}
  void viewState(std::int16_t) override {}
  void left(float) override {}
  void top(float) override {}
  void width(float) override {}
  void height(float) override {}
  std::vector<std::uint8_t> picturePng() override { return {}; }
};

// One window, which may or may not get the capture.
class FuzzWindowing : public Windowing {
 public:
  WindowHandle captured{77};

  WindowHandle setCapture(WindowHandle) override { return captured; }
  [[nodiscard]] WindowHandle getCapture() override { return captured; }
  void releaseCapture() override {}
  bool setTopmost(WindowHandle, bool) override { return static_cast<bool>(captured); }
};

class PanelUnderTest {
 public:
  static constexpr Size kViewPx{240, 180};

  PanelUnderTest();
  // Ends the program when the panel met a failure that nobody foresaw or left graphics objects behind.
  ~PanelUnderTest();
  PanelUnderTest(const PanelUnderTest&) = delete;
  PanelUnderTest& operator=(const PanelUnderTest&) = delete;

  [[nodiscard]] SpectrumView& panel() noexcept { return *panel_; }

  FuzzView view;
  FuzzOwner owner;
  FuzzWindowing windowing;
  DataHub hub;

 private:
  std::size_t objectsBefore_;
  std::unique_ptr<SpectrumView> panel_;
};

}  // namespace frontpanels::fuzz
