// clsTraceManager: the display engine behind a panel's graph. It owns the trace objects, the off-screen
// surface that they draw into, the division of the graph among them, and the routing of marker operations to
// the active one. Coordinates inside are pixels of the off-screen surface in single precision, rounded half
// to even where they are handed to the graphics interface.
#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "framework/splitters/horz_splitter_bar.h"
#include "framework/splitters/vert_splitter_bar.h"
#include "framework/support/collection.h"
#include "platform/gdi.h"
#include "platform/windowing.h"
#include "traces/label_font_set.h"
#include "traces/off_screen_surface.h"
#include "traces/pixel_surface.h"
#include "traces/result_record.h"
#include "traces/trace_form.h"
#include "traces/trace_layout.h"
#include "traces/trace_object.h"

namespace frontpanels {

using TracePointer = std::shared_ptr<TraceObject>;

// What a press with the mouse asks for.
inline constexpr std::int16_t kNewMarker = 1;
inline constexpr std::int16_t kNewDeltaMarker = 2;

// Answered by a marker command that has no marker to work on.
inline constexpr std::int32_t kNoMarkerToMove = -9;

// What the manager draws with and reads. Everything referred to must outlive it, the fonts included.
struct TraceManagerEnvironment {
  Gdi& gdi;
  Windowing& windowing;
  ScreenMetrics metrics;
  LabelFontHandles fonts{};
  bool boldLabels = true;
};

class clsTraceManager {
 public:
  static constexpr std::string_view kTypeName = "clsTraceManager";

  explicit clsTraceManager(const TraceManagerEnvironment& environment);

  // The owning panel; it must outlive the manager or be set to null before it goes.
  void setForm(TraceForm* form);
  [[nodiscard]] TraceForm* getForm() const noexcept { return form_; }

  // The graph area in twips of the panel, kept as unrounded pixels.
  void drawingArea(float leftTwips, float topTwips, float widthTwips, float heightTwips);
  [[nodiscard]] const PanelArea& drawingAreaPx() const noexcept { return area_; }
  // (Re)creates the off-screen surface for the drawing area.
  void setShadowDC();
  [[nodiscard]] DcHandle shadowDC() const noexcept { return surface_.dc(); }
  // The form stands on a screen of another scale. The surface is given up, so that no font is in use any
  // more: the drawing area is to be set anew.
  void rescale(ScreenMetrics metrics, const LabelFontHandles& fonts);

  // Trace objects, at most one per result type.
  std::int32_t addTrace(std::int32_t result);  // reserved: does nothing, answers 0
  void addTraceObject(TracePointer traceObject, std::int16_t resultType);
  // Counts a listed result among the traces: `count` is raised to the number of traces when it is lower.
  void ListTraceTypes(const ResultRecord& result, float& count);
  [[nodiscard]] TraceObject* find(std::int16_t resultType);
  void getTraceData(std::int16_t resultType, ResultData& data);
  void removeTrace(const ResultRecord& result);
  // False when no trace object has the result type.
  bool removeTraceObject(std::int16_t resultType);
  void RemoveTraceTypes(std::span<const std::int16_t> resultTypes);
  [[nodiscard]] TraceObject* activeTrace() const noexcept { return activeTrace_.get(); }
  void activeTrace(TracePointer traceObject) noexcept { activeTrace_ = std::move(traceObject); }
  // Chooses the layout: exactly 1, exactly 2, or more. Any other count paints no trace.
  [[nodiscard]] float numberOfTraces() const noexcept { return numberOfTraces_; }
  void numberOfTraces(float count) noexcept { numberOfTraces_ = count; }
  [[nodiscard]] const Collection<TracePointer>& Traces() const noexcept { return traces_; }
  // Makes the visible trace object before or behind the active one the active one, as a press into its panel
  // would. False where there is none.
  bool activateNeighbour(bool behind);

  // Composes the whole graph and copies it to the screen in one transfer. Everything is composed anew each
  // time; `forcePaint` is what callers use to say that nothing has changed but the look.
  void paintTraces(bool forcePaint);
  // Writes the labels again over what is composed and copies it.
  void labelTraces();

  // Input. Positions are twips of the panel.
  void KeyPress(std::int16_t key);
  void MouseDown(std::int16_t button, std::int16_t shift, float xTwips, float yTwips,
                 std::int16_t markerOperation);
  // A press that asks for no new marker: it drags the splitter, chooses a panel or takes hold of a marker.
  void MouseDown(std::int16_t button, std::int16_t shift, float xTwips, float yTwips);
  void MouseMove(std::int16_t button, std::int16_t shift, float xTwips, float yTwips);
  void MouseUp(std::int16_t button, std::int16_t shift, float xTwips, float yTwips);
  // A pressed button holds a marker. It can be taken back to where the press found it, and is free then.
  [[nodiscard]] bool holdsMarker() const;
  void takeMarkerBack();

  // Marker commands; each ends with a repaint.
  void markerToMax();
  void markerToMin();
  // 0, or -9 when there is no active trace or it has no marker.
  std::int32_t moveMarkerLeft();
  std::int32_t moveMarkerRight();
  void addMarker(std::int16_t traceId);
  void addDeltaMarker();
  // Makes the marker item 1 of the trace's collection, of the active trace without one.
  void makeFirstMarker(MarkerPointer marker, TraceObject* trace = nullptr);
  [[nodiscard]] std::int16_t findHighestId();
  void addMarkerToMainCollection(const MarkerPointer& marker);  // reserved: does nothing

  // Positions are pixels of the off-screen surface. Null, or -1, when nothing is near.
  [[nodiscard]] MarkerPointer findNearestMarker(float x, float y, std::int16_t traceIndex);
  [[nodiscard]] std::int16_t findNearestTrace(float x, float y);

  // Largest cell of a label's digit among the four fonts, measured when the surface is made.
  [[nodiscard]] float maxFontHeight() const noexcept { return maxFontHeight_; }
  void maxFontHeight(float px) noexcept { maxFontHeight_ = px; }
  [[nodiscard]] float maxFontWidth() const noexcept { return maxFontWidth_; }
  void maxFontWidth(float px) noexcept { maxFontWidth_ = px; }
  [[nodiscard]] bool boldLabelStyle() const noexcept { return boldLabels_; }

  // --- In words
  // Trace object by trace object; places are pixels of the panel's view. Where there are several trace
  // objects, names end in that of theirs. Only what belongs to the active trace is selected.
  [[nodiscard]] GraphItems graphItems();
  [[nodiscard]] GraphState graphState() const noexcept;

  // Layout values kept for the panel.
  float offset = 0;
  float bottomPanel = 0;
  float rightPanel = 0;

 private:
  struct SurfacePoint {
    float x;
    float y;
  };

  TraceForm& requireForm() const;
  [[nodiscard]] TraceObject& requireActive() const;
  [[nodiscard]] bool isActive(const TraceObject& traceObject) const;
  [[nodiscard]] SurfacePoint toSurface(float xTwips, float yTwips) const;
  void createHorizontalBar();
  void clearActiveTrace(std::int16_t resultType);
  [[nodiscard]] bool pressOnSplitter(std::int16_t button, std::int16_t shift, float xTwips, float yTwips);
  void measureLabelFonts();
  void paintPanels();
  void paintPanel(TraceObject& traceObject, const PanelArea& area);
  void placeVerticalBar(std::int16_t index, const PanelArea& area);
  void paintSplitters();
  void showMarkerFrameColor();
  void copyToScreen();
  void nameAfterChart(std::span<GraphItem> ofOne, const TraceObject& traceObject) const;
  [[nodiscard]] LabelFonts fontsOf(const TraceObject& traceObject) const;
  void makeActive(const TracePointer& traceObject);
  void activateTraceAt(SurfacePoint at);
  void holdMarker();
  void selectAMarker(SurfacePoint at);
  void newMarkerAt(SurfacePoint at);
  void newDeltaMarkerAt(SurfacePoint at);
  void numberMarker(clsMarker& marker);
  [[nodiscard]] SurfacePoint centre() const noexcept;
  std::int32_t moveMarker(std::int32_t step);

  Gdi& gdi_;
  Windowing& windowing_;
  ScreenMetrics metrics_;
  LabelFontHandles fonts_;
  bool boldLabels_;
  float maxFontHeight_ = 0;
  float maxFontWidth_ = 0;

  TraceForm* form_ = nullptr;
  std::optional<PixelSurface> pixelSurface_;  // the form as the splitter bars see it
  PanelArea area_;
  OffScreenSurface surface_;
  bool insideSetShadowDC_ = false;

  Collection<TracePointer> traces_;
  TracePointer activeTrace_;
  float numberOfTraces_ = 0;
  bool trackMarkers_ = true;
  struct HeldMarker {
    MarkerPointer marker;
    std::int32_t point = 0;  // where the press found it
  };
  HeldMarker held_;

  std::unique_ptr<clsHorzSplitterBar> horizontalBar_;
  std::vector<std::unique_ptr<clsVertSplitterBar>> verticalBars_;
};

}  // namespace frontpanels
