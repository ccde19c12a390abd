// The spectrum panel without a window: a picture in memory with the panel's caption above its graph.
#pragma once

#include <cstdint>
#include <string>

#include "framework/panel/panel_host.h"
#include "platform/data_server.h"
#include "platform/raster/raster_gdi.h"
#include "platform/windowing.h"
#include "sources/resample.h"
#include "sources/vertical_scale.h"
#include "spectrum/spectrum_view.h"

namespace frontpanels {

// The picture box of the graph: pixels of its own, always visible, painted when the picture is taken.
class HeadlessView : public GraphView {
 public:
  HeadlessView(RasterGdi& gdi, Size sizePx) : sizePx_(sizePx), dc_(gdi.createScreen(sizePx)) {}

  [[nodiscard]] DcHandle hdc() override { return dc_; }
  [[nodiscard]] WindowHandle hwnd() override { return {}; }
  [[nodiscard]] Size clientSizePx() override { return sizePx_; }
  [[nodiscard]] MousePointer mousePointer() override { return pointer_; }
  void mousePointer(MousePointer pointer) override { pointer_ = pointer; }
  [[nodiscard]] bool visible() override { return visible_; }
  void visible(bool visible) override { visible_ = visible; }
  void refresh() override {}

 private:
  Size sizePx_;
  DcHandle dc_;
  MousePointer pointer_ = MousePointer::Default;
  bool visible_ = true;
};

// No pointer, no other windows.
class HeadlessWindowing : public Windowing {
 public:
  WindowHandle setCapture(WindowHandle) override { return {}; }
  [[nodiscard]] WindowHandle getCapture() override { return {}; }
  void releaseCapture() override {}
  bool setTopmost(WindowHandle, bool) override { return true; }
};

class HeadlessContainer : public PanelContainer {
 public:
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

// Sends requests nowhere: nothing measures.
class HeadlessHost : public PanelHost {
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
};

class HeadlessPanel {
 public:
  static constexpr Size kPicturePx = {800, 600};

  // Every picture has this vertical scale. Raises a run-time error when there is no memory for the picture.
  explicit HeadlessPanel(const VerticalScale& scale);
  ~HeadlessPanel();
  HeadlessPanel(const HeadlessPanel&) = delete;
  HeadlessPanel& operator=(const HeadlessPanel&) = delete;

  void show(const DisplaySweep& sweep, const std::string& caption);
  // What is shown. Valid until the next call of anything here.
  [[nodiscard]] PixelView picture();

 private:
  void set(std::int16_t parameterType, const Variant& value);
  void drawCaption();

  RasterGdi gdi_;
  HeadlessView view_;
  DcHandle picture_;
  FontHandle captionFont_;
  HeadlessWindowing windowing_;
  HeadlessContainer container_;
  HeadlessHost host_;
  DataHub hub_;
  SpectrumView panel_;
};

}  // namespace frontpanels
