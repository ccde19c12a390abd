#include "traces/trace_manager.h"

#include <algorithm>
#include <cmath>

#include "framework/support/error_handler.h"
#include "framework/support/guard.h"
#include "framework/support/numeric.h"
#include "platform/gdi_scope.h"
#include "traces/plot_colors.h"
#include "traces/result_types.h"

namespace frontpanels {
namespace {

constexpr std::string_view kMultiTracePainter = "clsMultiTracePainter";
constexpr std::string_view kMultiBufferedTracePainter = "clsMultiBufferedTracePainter";
constexpr std::string_view kEmptyEntry = "Empty";
constexpr std::string_view kPhonePanel = "frmPhoneVfp";

// A point this far away, in pixels of summed distance, is never chosen.
constexpr std::int16_t kOutOfReachPx = 10000;
constexpr std::int32_t kMarkerMoved = 0;
// Pixels round a marker's glyph that still count as the marker: fingers and pens are not exact.
constexpr double kHitMarginPx = 2.0;

std::string keyOf(std::int16_t resultType) { return std::to_string(resultType); }

std::int16_t resultTypeIdOf(const ResultRecord& result) { return result.field(kResultTypeIdField).toInt16(); }

bool paintsLines(const TraceObject& traceObject) {
  const std::string_view name = traceObject.typeName();
  return name == kMultiTracePainter || name == kMultiBufferedTracePainter;
}

std::int16_t markerNumber(const clsMarker& marker) {
  double number = 0;
  return textToNumber(marker.id, number) ? toInt16(number) : std::int16_t{0};
}

MarkerPointer markerWithId(const MarkerCollection& markers, const std::string& id) {
  for (const MarkerPointer& marker : markers)
    if (marker->id == id) return marker;
  return nullptr;
}

std::size_t positionOf(const MarkerCollection& markers, const std::string& id) {
  std::size_t position = 1;
  while (markers.item(position)->id != id) ++position;
  return position;
}

// Drawn markers show which of them is the active one; the one before stops being it.
void activate(TraceObject& traceObject, const MarkerPointer& marker) {
  marker->active = true;
  traceObject.activeMarker(marker);
}

bool hits(const clsMarker& marker, float x, float y) {
  const bool twoEnded = marker.multiMarker || marker.stripChartMarker;
  const double halfWidth = static_cast<double>(marker.width) / 2.0 + kHitMarginPx;
  const double upper = std::min(marker.positionY, twoEnded ? marker.positionY2 : marker.positionY);
  const double lower = std::max(marker.positionY, twoEnded ? marker.positionY2 : marker.positionY);
  const double reach = static_cast<double>(marker.height) + kHitMarginPx;
  return std::abs(static_cast<double>(x) - static_cast<double>(marker.positionX)) <= halfWidth &&
         static_cast<double>(y) >= upper - reach &&
         static_cast<double>(y) <= lower + (twoEnded ? reach : kHitMarginPx);
}

// Clips to a panel for the time of its drawing.
class PanelClip {
 public:
  PanelClip(TraceObject& traceObject, const PanelArea& area, DcHandle dc)
      : traceObject_(traceObject), dc_(dc) {
    traceObject_.createClippingRegion(area.left, area.top, area.left + area.width, area.top + area.height,
                                      dc_);
  }
  ~PanelClip() {
    guard("paintTraces() failed ...", [this] { traceObject_.destroyClippingRegion(dc_); });
  }
  PanelClip(const PanelClip&) = delete;
  PanelClip& operator=(const PanelClip&) = delete;

 private:
  TraceObject& traceObject_;
  DcHandle dc_;
};

// Marks a stretch of a routine as entered, whichever way it is left.
class EntryFlag {
 public:
  explicit EntryFlag(bool& flag) : flag_(flag) { flag_ = true; }
  ~EntryFlag() { flag_ = false; }
  EntryFlag(const EntryFlag&) = delete;
  EntryFlag& operator=(const EntryFlag&) = delete;

 private:
  bool& flag_;
};

}  // namespace

clsTraceManager::clsTraceManager(const TraceManagerEnvironment& environment)
    : gdi_(environment.gdi),
      windowing_(environment.windowing),
      metrics_(environment.metrics),
      fonts_(environment.fonts),
      boldLabels_(environment.boldLabels),
      surface_(environment.gdi) {}

void clsTraceManager::setForm(TraceForm* form) {
  form_ = form;
  pixelSurface_.reset();
  if (form_ != nullptr) pixelSurface_.emplace(*form_, metrics_);
  PixelSurface* const surface = form_ != nullptr ? &*pixelSurface_ : nullptr;
  if (horizontalBar_) horizontalBar_->DrawingSurface(surface);
  for (const auto& bar : verticalBars_) bar->DrawingSurface(surface);
}

TraceForm& clsTraceManager::requireForm() const {
  if (form_ == nullptr) raiseObjectVariableNotSet();
  return *form_;
}

void clsTraceManager::drawingArea(float leftTwips, float topTwips, float widthTwips, float heightTwips) {
  area_ = {leftTwips / metrics_.twipsPerPixelX, topTwips / metrics_.twipsPerPixelY,
           widthTwips / metrics_.twipsPerPixelX, heightTwips / metrics_.twipsPerPixelY};
}

void clsTraceManager::rescale(ScreenMetrics metrics, const LabelFontHandles& fonts) {
  surface_.release();
  metrics_ = metrics;
  fonts_ = fonts;
  if (form_ != nullptr) pixelSurface_.emplace(*form_, metrics_);
  for (const auto& bar : verticalBars_) bar->rescale(metrics_);
}

void clsTraceManager::setShadowDC() {
  guard("clsTraceManager::setShadowDC failed ...", [this] {
    TraceForm& form = requireForm();
    if (insideSetShadowDC_)
      errorHandler().Assert("clsTraceManager::setShadowDC function entered twice without an exit");
    const EntryFlag inside(insideSetShadowDC_);
    const DcHandle viewDC = form.ViewHDC();  // may come back here: what that made is released next
    surface_.release();
    if (!surface_.createDC(viewDC))
      errorHandler().Assert("clsTraceManager::setShadowDC CreateCompatibleDC failed");
    const Size sizePx{toInt32(area_.width), toInt32(area_.height)};
    surface_.createBitmap(viewDC, sizePx);
    // Asks for the device context once more: a bitmap that could not be made goes unreported, and the next
    // paint makes the surface anew.
    if (!surface_.dc()) errorHandler().Assert("clsTraceManager::setShadowDC CreateCompatibleBitmap failed");
    gdi_.setBkMode(surface_.dc(), BackgroundMode::Opaque);
    const PlotColors colors(gdi_);
    gdi_.setBkColor(surface_.dc(), colors.background());
    surface_.selectOwn(fonts_[static_cast<std::size_t>(LabelFont::SmallAxis)]);
    gdi_.fillRect(surface_.dc(), {0, 0, sizePx.width, sizePx.height}, colors.backgroundBrush());
    measureLabelFonts();
  });
}

void clsTraceManager::measureLabelFonts() {
  maxFontWidth_ = 0;
  maxFontHeight_ = 0;
  for (const FontHandle font : fonts_) {
    const SelectedFont selected(gdi_, surface_.dc(), font);
    const Size cell = gdi_.textExtent(surface_.dc(), "0");
    maxFontWidth_ = std::max(maxFontWidth_, static_cast<float>(cell.width));
    maxFontHeight_ = std::max(maxFontHeight_, static_cast<float>(cell.height));
  }
}

// --- Trace objects

std::int32_t clsTraceManager::addTrace(std::int32_t /*result*/) { return 0; }

void clsTraceManager::addTraceObject(TracePointer traceObject, std::int16_t resultType) {
  guard("addTraceObject() failed ...", [&] {
    if (!traceObject) raiseObjectVariableNotSet();
    TraceForm& form = requireForm();
    traceObject->resultType(resultType);
    traces_.add(traceObject, keyOf(resultType));
    numberOfTraces_ += 1.0F;
    activeTrace_ = std::move(traceObject);
    form.changedTraceConfiguration(TraceState::Added, activeTrace_.get(), resultType);
    if (numberOfTraces_ == 2.0F) createHorizontalBar();
  });
}

void clsTraceManager::createHorizontalBar() {
  requireForm();
  horizontalBar_ = std::make_unique<clsHorzSplitterBar>(gdi_, windowing_);
  horizontalBar_->DrawingSurface(&*pixelSurface_);
}

// Told as an addition although a trace goes: the panel sets its display up anew on it.
void clsTraceManager::clearActiveTrace(std::int16_t resultType) {
  TraceForm& form = requireForm();
  activeTrace_.reset();
  form.changedTraceConfiguration(TraceState::Added, nullptr, resultType);
}

void clsTraceManager::ListTraceTypes(const ResultRecord& result, float& count) {
  guard("ListTraceTypes() failed ...", [&] {
    const std::int16_t resultType = resultTypeIdOf(result);
    switch (listedAs(resultType)) {
      case ListedAs::Ignored:
        return;
      case ListedAs::ClearsActive:
        return clearActiveTrace(resultType);
      case ListedAs::Counted:
        break;
    }
    if (!(count < numberOfTraces_)) return;
    count = numberOfTraces_;
    if (count == 2.0F) createHorizontalBar();
  });
}

TraceObject* clsTraceManager::find(std::int16_t resultType) {
  const std::string key = keyOf(resultType);
  return traces_.contains(key) ? traces_.item(key).get() : nullptr;
}

void clsTraceManager::getTraceData(std::int16_t resultType, ResultData& data) {
  guard("TraceData() failed ...", [&] {
    if (TraceObject* const traceObject = find(resultType))
      data.handTo(*traceObject);
    else
      data.SkipMeasurementData();
  });
}

void clsTraceManager::removeTrace(const ResultRecord& result) {
  guard("removeTrace() failed ...", [&] {
    if (!removeTraceObject(resultTypeIdOf(result)))
      errorHandler().Assert("Trace Object not found.clsTraceManager");
  });
}

bool clsTraceManager::removeTraceObject(std::int16_t resultType) {
  return guarded("removeTraceObject() failed ...", false, [&] {
    TraceForm& form = requireForm();
    const std::string key = keyOf(resultType);
    if (!traces_.contains(key)) {
      form.changedTraceConfiguration(TraceState::Removed, activeTrace_.get(), resultType);
      errorHandler().Assert("clsTraceManager::removeTraceObject() received unknown result type");
      return false;
    }
    const TracePointer removed = traces_.item(key);
    traces_.remove(key);
    numberOfTraces_ -= 1.0F;
    if (numberOfTraces_ < 2.0F) horizontalBar_.reset();  // its band would take presses meant for the trace
    if (activeTrace_ && activeTrace_->resultType() == removed->resultType())
      activeTrace_ = numberOfTraces_ <= 0.0F ? nullptr : traces_.item(std::size_t{1});
    form.changedTraceConfiguration(TraceState::Removed, activeTrace_.get(), resultType);
    return true;
  });
}

void clsTraceManager::RemoveTraceTypes(std::span<const std::int16_t> resultTypes) {
  for (const std::int16_t resultType : resultTypes) removeTraceObject(resultType);
}

TraceObject& clsTraceManager::requireActive() const {
  if (!activeTrace_) raiseObjectVariableNotSet();
  return *activeTrace_;
}

// A trace object that is alone has the whole surface, chosen or not.
bool clsTraceManager::isActive(const TraceObject& traceObject) const {
  return numberOfTraces_ == 1.0F || requireActive().resultType() == traceObject.resultType();
}

// --- Painting

void clsTraceManager::paintTraces(bool /*forcePaint*/) {
  if (form_ == nullptr) return;
  guard("paintTraces() failed ...", [this] {
    if (!surface_.complete()) setShadowDC();
    gdi_.fillRect(surface_.dc(), {0, 0, toInt32(area_.width), toInt32(area_.height)},
                  PlotColors(gdi_).backgroundBrush());
    paintPanels();
    showMarkerFrameColor();
    paintSplitters();
    copyToScreen();
    form_->tracesPainted();
  });
}

void clsTraceManager::paintPanels() {
  if (!(numberOfTraces_ == 1.0F || numberOfTraces_ >= 2.0F)) return;
  std::int16_t smallPanel = 0;
  for (const TracePointer& traceObject : traces_) {
    if (traceObject->typeName() == kEmptyEntry) continue;
    PanelArea panel = activePanelArea(numberOfTraces_, area_.width, area_.height);
    if (!isActive(*traceObject)) {
      panel = smallPanelArea(smallPanel, numberOfTraces_, area_.width, area_.height);
      if (numberOfTraces_ > 2.0F) placeVerticalBar(smallPanel, panel);
      ++smallPanel;
    }
    if (traceObject->traceIsVisible()) paintPanel(*traceObject, panel);
  }
}

void clsTraceManager::paintPanel(TraceObject& traceObject, const PanelArea& panel) {
  const DcHandle dc = surface_.dc();
  traceObject.drawingArea(form_);
  if (numberOfTraces_ != 1.0F || traceObject.dataChanged()) traceObject.processData();
  traceObject.scaleLeft(panel.left);
  traceObject.scaleTop(panel.top);
  traceObject.scaleWidth(panel.width);
  traceObject.scaleHeight(panel.height);
  {
    const PanelClip clip(traceObject, panel, dc);
    traceObject.Paint(dc);
    traceObject.drawMarkers(dc);
  }
  const LabelFonts fonts = fontsOf(traceObject);
  traceObject.Label(dc, fonts);
  traceObject.updateMarkerDisplay(dc, fonts);
}

LabelFonts clsTraceManager::fontsOf(const TraceObject& traceObject) const {
  const bool active = isActive(traceObject);
  const auto font = [this](LabelFont which) { return fonts_[static_cast<std::size_t>(which)]; };
  return {font(active ? LabelFont::ActiveAxis : LabelFont::SmallAxis),
          font(active ? LabelFont::ActiveCorner : LabelFont::SmallCorner), maxFontWidth_, maxFontHeight_};
}

void clsTraceManager::placeVerticalBar(std::int16_t index, const PanelArea& panel) {
  const auto slot = static_cast<std::size_t>(index);
  if (verticalBars_.size() <= slot) verticalBars_.resize(slot + 1);
  std::unique_ptr<clsVertSplitterBar>& bar = verticalBars_[slot];
  if (!bar) {
    bar = std::make_unique<clsVertSplitterBar>(gdi_, windowing_, metrics_);
    bar->DrawingSurface(&*pixelSurface_);
  }
  bar->SplitterBarLeft(panel.left + panel.width);
  bar->SplitterBarTop(panel.top);
  bar->SplitterBarHeight(panel.height);
}

void clsTraceManager::showMarkerFrameColor() {
  if (!activeTrace_) return;
  if (form_->typeName() == kPhonePanel || paintsLines(*activeTrace_))
    form_->setMarkerFrameColor(activeTrace_->activeTraceColor());
}

void clsTraceManager::paintSplitters() {
  if (!(numberOfTraces_ > 2.0F)) return;
  if (horizontalBar_) horizontalBar_->SplitterBarTop(smallRowHeight(area_.height) + area_.top);
  float panelsToItsLeft = 1;
  for (const auto& bar : verticalBars_) {
    if (panelsToItsLeft > numberOfTraces_ - 1.0F) return;  // of a row that was longer
    bar->Paint(surface_.dc());
    panelsToItsLeft += 1.0F;
  }
}

void clsTraceManager::copyToScreen() {
  const std::int32_t left = toInt32(area_.left);
  const std::int32_t top = toInt32(area_.top);
  gdi_.bitBlt(form_->ViewHDC(), {left, top, left + toInt32(area_.width), top + toInt32(area_.height)},
              surface_.dc(), {0, 0}, RasterOp::SourceCopy);
}

void clsTraceManager::labelTraces() {
  if (form_ == nullptr) return;
  guard("labelTraces() failed ...", [this] {
    for (const TracePointer& traceObject : traces_)
      if (traceObject->traceIsVisible()) traceObject->Label(surface_.dc(), fontsOf(*traceObject));
    copyToScreen();
  });
}

// --- In words

GraphItems clsTraceManager::graphItems() {
  GraphItems items;
  guard("graphItems() failed ...", [&] {
    for (const TracePointer& traceObject : traces_) {
      const std::size_t first = items.all().size();
      traceObject->describe(items);
      nameAfterChart(std::span(items.all()).subspan(first), *traceObject);
    }
    const std::int32_t left = toInt32(area_.left);
    const std::int32_t top = toInt32(area_.top);
    for (GraphItem& item : items.all())
      if (Rect& at = item.placePx; !at.empty())
        at = {at.left + left, at.top + top, at.right + left, at.bottom + top};
  });
  return items;
}

// The trace object is the first one.
void clsTraceManager::nameAfterChart(std::span<GraphItem> ofOne, const TraceObject& traceObject) const {
  const bool active = &traceObject == activeTrace_.get();
  for (GraphItem& item : ofOne) {
    if (&item != &ofOne.front() && traces_.count() > 1) (item.name += ", ") += ofOne.front().name;
    item.selected = active && (item.selected || item.kind == GraphItemKind::Chart);
    item.visible = item.visible && traceObject.traceIsVisible();
    if (!item.visible) item.placePx = {};
  }
}

GraphState clsTraceManager::graphState() const noexcept {
  GraphState state;
  for (const TracePointer& traceObject : traces_) state.items += traceObject->itemCount();
  state.items = std::min(state.items, GraphItems::kMost);
  state.activeTrace = activeTrace_.get();
  if (activeTrace_ == nullptr) return state;
  const MarkerPointer marker = activeTrace_->activeMarker();
  state.activeMarker = marker.get();
  if (marker != nullptr) state.point = marker->point;
  return state;
}

// --- Input

clsTraceManager::SurfacePoint clsTraceManager::toSurface(float xTwips, float yTwips) const {
  return {xTwips / metrics_.twipsPerPixelX - area_.left, yTwips / metrics_.twipsPerPixelY - area_.top};
}

void clsTraceManager::KeyPress(std::int16_t key) {
  guard("KeyPress() failed ...", [&] {
    if (activeTrace_ && paintsLines(*activeTrace_)) activeTrace_->KeyPress(key);
  });
}

bool clsTraceManager::pressOnSplitter(std::int16_t button, std::int16_t shift, float xTwips, float yTwips) {
  if (!horizontalBar_) return false;
  const float x = xTwips / metrics_.twipsPerPixelX;
  const float y = yTwips / metrics_.twipsPerPixelY;
  if (!horizontalBar_->MouseOver(x, y)) return false;
  horizontalBar_->MouseDown(button, shift, x, y);
  return true;
}

void clsTraceManager::activateTraceAt(SurfacePoint at) {
  if (!(numberOfTraces_ > 1.0F)) return;
  for (const TracePointer& traceObject : traces_) {
    const PanelArea panel{traceObject->scaleLeft(), traceObject->scaleTop(), traceObject->scaleWidth(),
                          traceObject->scaleHeight()};
    if (panel.contains(at.x, at.y)) return makeActive(traceObject);
  }
}

void clsTraceManager::makeActive(const TracePointer& traceObject) {
  TraceForm& form = requireForm();
  activeTrace_ = traceObject;
  form.changedTraceConfiguration(TraceState::Added, activeTrace_.get(), activeTrace_->resultType());
  paintTraces(true);
}

bool clsTraceManager::activateNeighbour(bool behind) {
  return guarded("activateNeighbour() failed ...", false, [&] {
    TracePointer found;
    bool passed = false;
    for (const TracePointer& traceObject : traces_) {
      if (traceObject == activeTrace_) passed = true;
      if (traceObject == activeTrace_ || !traceObject->traceIsVisible() || passed != behind) continue;
      found = traceObject;
      if (behind) break;
    }
    if (!found) return false;
    makeActive(found);
    return true;
  });
}

void clsTraceManager::MouseDown(std::int16_t button, std::int16_t shift, float xTwips, float yTwips,
                                std::int16_t markerOperation) {
  guard("MouseDown() failed ...", [&] {
    if (pressOnSplitter(button, shift, xTwips, yTwips)) return;
    const SurfacePoint at = toSurface(xTwips, yTwips);
    activateTraceAt(at);
    switch (markerOperation) {
      case kNewMarker:
        newMarkerAt(at);
        break;
      case kNewDeltaMarker:
        newDeltaMarkerAt(at);
        break;
      default:
        return errorHandler().Assert("clsTraceManager::MouseDown() ... unknown marker operation");
    }
    holdMarker();
  });
}

void clsTraceManager::MouseDown(std::int16_t button, std::int16_t shift, float xTwips, float yTwips) {
  guard("MouseDown() failed ...", [&] {
    if (pressOnSplitter(button, shift, xTwips, yTwips)) return;
    const SurfacePoint at = toSurface(xTwips, yTwips);
    activateTraceAt(at);
    selectAMarker(at);
    holdMarker();
  });
}

void clsTraceManager::holdMarker() {
  held_.marker = activeTrace_ ? activeTrace_->mouseActiveMarker() : nullptr;
  if (held_.marker) held_.point = held_.marker->point;
}

bool clsTraceManager::holdsMarker() const {
  return held_.marker && activeTrace_ && activeTrace_->mouseActiveMarker() == held_.marker;
}

// The trace may have become shorter in the meantime.
void clsTraceManager::takeMarkerBack() {
  guard("takeMarkerBack() failed ...", [this] {
    if (!holdsMarker()) return;
    held_.marker->point = std::min(held_.point, activeTrace_->traceSize());
    held_.marker.reset();
    activeTrace_->mouseActiveMarker(nullptr);
    paintTraces(true);
  });
}

void clsTraceManager::MouseMove(std::int16_t button, std::int16_t shift, float xTwips, float yTwips) {
  guard("MouseMove() failed ...", [&] {
    const bool drags = trackMarkers_ && activeTrace_ && activeTrace_->mouseActiveMarker() &&
                       !activeTrace_->markerCollection().empty();
    if (!drags) {
      if (horizontalBar_)
        horizontalBar_->MouseMove(button, shift, xTwips / metrics_.twipsPerPixelX,
                                  yTwips / metrics_.twipsPerPixelY);
      return;
    }
    const SurfacePoint at = toSurface(xTwips, yTwips);
    activeTrace_->findNearestPoint(at.x, at.y, *activeTrace_->mouseActiveMarker());
    paintTraces(true);
  });
}

void clsTraceManager::MouseUp(std::int16_t button, std::int16_t shift, float xTwips, float yTwips) {
  guard("MouseUp() failed ...", [&] {
    held_.marker.reset();
    if (activeTrace_) activeTrace_->mouseActiveMarker(nullptr);
    if (horizontalBar_)
      horizontalBar_->MouseUp(button, shift, xTwips / metrics_.twipsPerPixelX,
                              yTwips / metrics_.twipsPerPixelY);
  });
}

// --- Markers

void clsTraceManager::markerToMax() {
  guard("markerToMax() failed ...", [this] {
    requireActive().markerToMax();
    paintTraces(true);
  });
}

void clsTraceManager::markerToMin() {
  guard("markerToMin() failed ...", [this] {
    requireActive().markerToMin();
    paintTraces(true);
  });
}

std::int32_t clsTraceManager::moveMarkerLeft() { return moveMarker(-1); }
std::int32_t clsTraceManager::moveMarkerRight() { return moveMarker(+1); }

std::int32_t clsTraceManager::moveMarker(std::int32_t step) {
  return guarded("moveMarker() failed ...", kNoMarkerToMove, [&] {
    if (!activeTrace_ || activeTrace_->markerCollection().empty()) return kNoMarkerToMove;
    const MarkerPointer marker = activeTrace_->activeMarker();
    if (!marker) raiseObjectVariableNotSet();
    const std::int32_t point = toInt32(static_cast<double>(marker->point) + step);
    if (step < 0 ? point >= 0 : point <= activeTrace_->traceSize()) marker->point = point;
    paintTraces(true);
    return kMarkerMoved;
  });
}

std::int16_t clsTraceManager::findHighestId() {
  return guarded("findHighestId() failed ...", std::int16_t{0}, [this] {
    std::int16_t highest = 0;
    for (const MarkerPointer& marker : requireActive().markerCollection())
      if (!marker->DELTA) highest = std::max(highest, markerNumber(*marker));
    return highest;
  });
}

void clsTraceManager::numberMarker(clsMarker& marker) {
  const std::int16_t number = addInt16(findHighestId(), 1);
  requireActive().markerCount(number);
  marker.id = std::to_string(number);
}

// In pixels of the panel's view, not of the surface: the new marker sits that much right of and below the
// middle.
clsTraceManager::SurfacePoint clsTraceManager::centre() const noexcept {
  return {area_.width / 2 + area_.left, area_.height / 2 + area_.top};
}

void clsTraceManager::addMarker(std::int16_t traceId) {
  guard("addMarker() failed ...", [&] {
    TraceObject& traceObject = requireActive();
    const auto marker = std::make_shared<clsMarker>();
    const SurfacePoint at = centre();
    traceObject.findNearestPoint(at.x, at.y, *marker);
    numberMarker(*marker);
    activate(traceObject, marker);
    traceObject.addMarkerToTrace(marker, traceId);
    makeFirstMarker(marker);
    traceObject.mouseActiveMarker(marker);
    paintTraces(true);
  });
}

void clsTraceManager::addDeltaMarker() {
  guard("addDeltaMarker() failed ...", [this] { newDeltaMarkerAt(centre()); });
}

void clsTraceManager::newMarkerAt(SurfacePoint at) {
  TraceObject& traceObject = requireActive();
  const auto marker = std::make_shared<clsMarker>();
  traceObject.findNearestPoint(at.x, at.y, *marker);
  numberMarker(*marker);
  traceObject.markerCollection().add(marker, marker->id);
  makeFirstMarker(marker);
  activate(traceObject, marker);
  traceObject.mouseActiveMarker(marker);
  paintTraces(true);
}

void clsTraceManager::newDeltaMarkerAt(SurfacePoint at) {
  TraceForm& form = requireForm();
  TraceObject& traceObject = requireActive();
  const MarkerPointer partner = traceObject.activeMarker();
  if (!partner) raiseObjectVariableNotSet();
  const auto marker = std::make_shared<clsMarker>();
  traceObject.findNearestPoint(at.x, at.y, *marker);
  marker->DELTA = true;
  marker->id = deltaMarkerId(partner->id);
  marker->deltaPartner = partner->id;
  traceObject.markerCollection().add(marker, marker->id);
  partner->deltaPartner = marker->id;
  traceObject.mouseActiveMarker(marker);
  form.deltaMarkerButtonEnabled(false);
  paintTraces(true);
}

// By value: the marker may be named by its place in the very collection that is reordered.
void clsTraceManager::makeFirstMarker(MarkerPointer marker, TraceObject* trace) {
  guard("makeFirstMarker() failed ...", [&] {
    if (!marker) raiseObjectVariableNotSet();
    MarkerCollection& markers = (trace != nullptr ? *trace : requireActive()).markerCollection();
    if (!markerWithId(markers, marker->id)) markers.add(marker, marker->id);
    if (markers.item(std::size_t{1})->id == marker->id) return;
    markers.remove(positionOf(markers, marker->id));
    markers.addBefore(marker, marker->id, 1);
  });
}

void clsTraceManager::addMarkerToMainCollection(const MarkerPointer& /*marker*/) {}

void clsTraceManager::selectAMarker(SurfacePoint at) {
  guard("selectAMarker() failed ...", [&] {
    if (!activeTrace_) return;
    const std::int16_t index = findNearestTrace(at.x, at.y);
    if (index < 0) return;
    const MarkerPointer marker = findNearestMarker(at.x, at.y, index);
    if (!marker) return;
    activeTrace_->selectedTraceIndex(index);
    activate(*activeTrace_, marker);
    activeTrace_->mouseActiveMarker(marker);
    makeFirstMarker(marker);
    paintTraces(true);
  });
}

MarkerPointer clsTraceManager::findNearestMarker(float x, float y, std::int16_t traceIndex) {
  return guarded("findNearestMarker() failed ...", MarkerPointer{}, [&]() -> MarkerPointer {
    TraceObject& traceObject = requireActive();
    // One marker for all sub-traces: it is filed with the first.
    const bool shared = traceObject.typeName() == kMultiBufferedTracePainter && traceObject.multiMarker();
    for (const MarkerPointer& marker :
         traceObject.traceMarkerCollections(shared ? std::int16_t{0} : traceIndex))
      if (hits(*marker, x, y)) return marker;
    return nullptr;
  });
}

std::int16_t clsTraceManager::findNearestTrace(float x, float y) {
  constexpr std::int16_t kNone = -1;
  return guarded("findNearestTrace() failed ...", kNone, [&] {
    TraceObject& traceObject = requireActive();
    const std::int16_t candidates = traceObject.numberOfTraces();
    for (std::int16_t index = 0; index < candidates; ++index)
      if (findNearestMarker(x, y, index)) return index;
    std::int16_t best = kNone;
    std::int16_t shortest = kOutOfReachPx;
    for (std::int16_t index = 0; index < candidates; ++index) {
      clsMarker scratch;
      scratch.point = kNone;
      traceObject.findNearestPoint(x, y, scratch, index);
      if (scratch.point == kNone) continue;  // no point was near
      const std::int16_t distance =
          toInt16(std::abs(static_cast<double>(scratch.positionY) - static_cast<double>(y)) +
                  std::abs(static_cast<double>(scratch.positionX) - static_cast<double>(x)));
      if (distance >= shortest) continue;
      shortest = distance;
      best = index;
    }
    return best;
  });
}

}  // namespace frontpanels
