// Working fakes of what surrounds a panel: its form, the window system and the picture box of its graph.
#pragma once

#include <cstdint>
#include <string>
#include <utility>
#include <vector>

#include "platform/windowing.h"
#include "traces/trace_form.h"

namespace frontpanels::testing {

// A form of which a test sets what it wants; the scale is 800 x 600 pixels at the origin.
class FakeTraceForm : public TraceForm {
 public:
  struct Configuration {
    TraceState state = TraceState::Added;
    TraceObject* activeTrace = nullptr;
    std::int16_t resultType = 0;
    friend bool operator==(const Configuration&, const Configuration&) = default;
  };

  float scaleLeft = 0;
  float scaleTop = 0;
  float scaleWidth = 800;
  float scaleHeight = 600;
  float useableWidth = 800;
  float useableHeight = 600;
  DcHandle dc{};
  WindowHandle window{77};
  MousePointer pointer = MousePointer::Default;
  DrawMode drawMode = DrawMode::CopyPen;
  PenStyle drawStyle = PenStyle::Solid;
  std::string name = "SpectrumView";
  std::int16_t state = 0;

  // What was called, in order.
  std::vector<Configuration> configurations;
  std::vector<Color> frameColors;
  std::vector<bool> deltaButtonStates;
  std::vector<MousePointer> pointers;
  std::vector<DrawMode> drawModes;
  int refreshes = 0;

  float ViewScaleLeft() override { return scaleLeft; }
  float ViewScaleTop() override { return scaleTop; }
  float ViewScaleWidth() override { return scaleWidth; }
  float ViewScaleHeight() override { return scaleHeight; }
  float ViewUseableScaleWidth() override { return useableWidth; }
  float ViewUseableScaleHeight() override { return useableHeight; }
  WindowHandle ViewHWnd() override { return window; }
  DcHandle ViewHDC() override { return dc; }
  MousePointer ViewMousePointer() override { return pointer; }
  void ViewMousePointer(MousePointer value) override { pointers.push_back(pointer = value); }
  DrawMode ViewDrawMode() override { return drawMode; }
  void ViewDrawMode(DrawMode mode) override { drawModes.push_back(drawMode = mode); }
  PenStyle ViewDrawStyle() override { return drawStyle; }
  void ViewDrawStyle(PenStyle style) override { drawStyle = style; }
  void Refresh() override { ++refreshes; }

  std::string typeName() override { return name; }
  std::int16_t winState() override { return state; }
  void changedTraceConfiguration(TraceState change, TraceObject* activeTrace,
                                 std::int16_t resultType) override {
    configurations.push_back({change, activeTrace, resultType});
  }
  void setMarkerFrameColor(Color color) override { frameColors.push_back(color); }
  void deltaMarkerButtonEnabled(bool enable) override { deltaButtonStates.push_back(enable); }
};

// Mouse capture as one owner at a time. A container takes the capture on every press before it forwards the
// press: `captured` starts as its window; make it null for a press that nobody captured.
class FakeWindowing : public Windowing {
 public:
  WindowHandle captured{77};
  bool topmostWorks = true;
  std::vector<WindowHandle> captures;
  std::vector<std::pair<WindowHandle, bool>> topmostCalls;
  int releases = 0;

  WindowHandle setCapture(WindowHandle window) override {
    captures.push_back(window);
    return std::exchange(captured, window);
  }
  WindowHandle getCapture() override { return captured; }
  void releaseCapture() override {
    ++releases;
    captured = {};
  }
  bool setTopmost(WindowHandle window, bool topmost) override {
    topmostCalls.emplace_back(window, topmost);
    return topmostWorks;
  }
};

class FakeGraphView : public GraphView {
 public:
  DcHandle dc{};
  WindowHandle window{77};
  Size sizePx{800, 600};
  MousePointer pointer = MousePointer::Default;
  bool shown = true;
  int refreshes = 0;
  int paintings = 0;

  DcHandle hdc() override { return dc; }
  WindowHandle hwnd() override { return window; }
  Size clientSizePx() override { return sizePx; }
  MousePointer mousePointer() override { return pointer; }
  void mousePointer(MousePointer value) override { pointer = value; }
  bool visible() override { return shown; }
  void visible(bool value) override { shown = value; }
  void refresh() override { ++refreshes; }
  void painted() override { ++paintings; }
};

}  // namespace frontpanels::testing
