// The picture that the panels are measured with: 800 x 600 pixels, a grid of 10 by 10 divisions with its 11 +
// 3 labels, four markers with their ids, `traces` traces of `points` points, and the copy of the surface.
#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <vector>

#include "bench/bench_scene.h"
#include "bench/captured_picture.h"
#include "painters/multi_trace_painter.h"
#include "traces/label_font_set.h"
#include "traces/trace_manager.h"

namespace frontpanels::bench {

struct SceneSize {
  std::int16_t traces;
  std::int32_t points;
};
inline constexpr SceneSize kSceneSizes[] = {{1, 513}, {5, 513}, {5, 3001}};

// A form that is nothing but a device context.
class BenchForm : public TraceForm {
 public:
  explicit BenchForm(DcHandle dc) : dc_(dc) {}

  std::string typeName() override { return "SpectrumView"; }
  std::int16_t winState() override { return 0; }
  void changedTraceConfiguration(TraceState, TraceObject*, std::int16_t) override {}
  void setMarkerFrameColor(Color) override {}
  void deltaMarkerButtonEnabled(bool) override {}
  float ViewScaleLeft() override { return 0; }
  float ViewScaleTop() override { return 0; }
  float ViewScaleWidth() override { return kScenePx.width * 15.0F; }
  float ViewScaleHeight() override { return kScenePx.height * 15.0F; }
  float ViewUseableScaleWidth() override { return ViewScaleWidth(); }
  float ViewUseableScaleHeight() override { return ViewScaleHeight(); }
  WindowHandle ViewHWnd() override { return {}; }
  DcHandle ViewHDC() override { return dc_; }
  MousePointer ViewMousePointer() override { return MousePointer::Default; }
  void ViewMousePointer(MousePointer) override {}
  DrawMode ViewDrawMode() override { return DrawMode::CopyPen; }
  void ViewDrawMode(DrawMode) override {}
  PenStyle ViewDrawStyle() override { return PenStyle::Solid; }
  void ViewDrawStyle(PenStyle) override {}
  void Refresh() override {}

 private:
  DcHandle dc_;
};

// Mouse capture plays no part in painting.
class NoWindowing : public Windowing {
 public:
  WindowHandle setCapture(WindowHandle) override { return {}; }
  WindowHandle getCapture() override { return {}; }
  void releaseCapture() override {}
  bool setTopmost(WindowHandle, bool) override { return true; }
};

// The scene drawn by trace manager and painter, and the same scene as bare graphics calls.
class PaintTracesScene final : public BenchScene {
 public:
  PaintTracesScene(Gdi& gdi, DcHandle view, SceneSize size);

  [[nodiscard]] std::string name() const override;
  void drawFramework() override { paint(++panelFrame_ % kFrames); }
  void drawBare() override { paintBare(++bareFrame_ % kFrames); }
  void drawFrameworkAgain() override { paint(0); }
  void drawBareAgain() override { paintBare(0); }

 private:
  static constexpr std::size_t kFrames = 8;

  void makeFrames();
  void setUp();
  void paint(std::size_t frame);
  void paintBare(std::size_t frame);

  SceneSize size_;
  CapturingGdi gdi_;
  BenchForm form_;
  NoWindowing windowing_;
  LabelFontSet fonts_;
  clsTraceManager manager_;
  std::shared_ptr<clsMultiTracePainter> painter_;
  std::vector<std::vector<Variant>> frames_;                 // [frame][trace]
  std::vector<std::vector<std::span<const float>>> values_;  // the same, as spans
  PlotMapping mapping_;
  std::size_t panelFrame_ = 0;
  std::size_t bareFrame_ = 0;
};

}  // namespace frontpanels::bench
