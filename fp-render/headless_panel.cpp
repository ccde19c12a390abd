#include "fp-render/headless_panel.h"

#include "framework/support/host_codes.h"
#include "platform/gdi_scope.h"
#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

constexpr std::int32_t kHardwareId = 1;
constexpr std::int32_t kCaptionHeightPx = 24;
constexpr std::int32_t kCaptionIndentPx = 8;
constexpr Size kPicture = HeadlessPanel::kPicturePx;
constexpr Size kGraph = {kPicture.width, kPicture.height - kCaptionHeightPx};

static_assert(kDisplayValues == SpectrumView::kMaxPoints);

void require(std::int32_t status) {
  if (status != kStatusDone) raiseInvalidProcedureCall();
}

}  // namespace

HeadlessPanel::HeadlessPanel(const VerticalScale& scale)
    : view_(gdi_.createScreen(kGraph), kGraph),
      picture_(gdi_.createScreen(kPicture)),
      captionFont_(gdi_.createFont({"Arial", 13, 700})),
      panel_({gdi_, windowing_, view_, hub_, ScreenMetrics{}, ""}, owner_, owner_) {
  if (!view_.hdc() || !picture_) raiseOutOfMemory();
  // The panel leaves margins round its graph, where a window has its background.
  gdi_.fillRect(view_.hdc(), {0, 0, kGraph.width, kGraph.height},
                gdi_.sysColorBrush(SystemColor::ButtonFace));
  panel_.Form_Resize();
  // A picture has no use for fields: all of it is graph.
  set(kRightPanelParameter, false);
  set(kBottomPanelParameter, false);
  require(panel_.vfpOp(kHardwareId, kAddTraceOperation, kAddTraceOperation));
  set(kAutoScaleParameter, false);
  set(kVerticalResolutionParameter, scale.dbPerDivision);
  set(kGridTopParameter, scale.topDb);
  require(panel_.vfpOp(kHardwareId, kShowOperation, Variant()));
}

HeadlessPanel::~HeadlessPanel() {
  if (captionFont_) gdi_.deleteObject(captionFont_);
}

void HeadlessPanel::set(std::int16_t parameterType, const Variant& value) {
  require(panel_.vfpSet(kHardwareId, parameterType, 0, value));
}

void HeadlessPanel::show(const DisplaySweep& sweep, const std::string& caption) {
  set(kCaptionParameter, caption);
  set(kCenterFrequencyParameter, sweep.range.centerHz);
  set(kSpanParameter, sweep.range.spanHz);
  hub_.publish(SpectrumView::kSpectrumPath, sweep.shown());
}

void HeadlessPanel::drawCaption() {
  gdi_.fillRect(picture_, {0, 0, kPicture.width, kCaptionHeightPx},
                gdi_.sysColorBrush(SystemColor::ButtonFace));
  const SelectedFont font(gdi_, picture_, captionFont_);
  const TextStyleScope style(gdi_, picture_, gdi_.sysColor(SystemColor::ButtonText),
                             BackgroundMode::Transparent);
  const std::string& caption = owner_.captionText();
  const Size textPx = gdi_.textExtent(picture_, caption);
  gdi_.textOut(picture_, {kCaptionIndentPx, (kCaptionHeightPx - textPx.height) / 2}, caption);
}

PixelView HeadlessPanel::picture() {
  panel_.Paint();
  drawCaption();
  const Rect graph = {0, kCaptionHeightPx, kPicture.width, kPicture.height};
  gdi_.bitBlt(picture_, graph, view_.hdc(), {0, 0}, RasterOp::SourceCopy);
  return gdi_.pixels(picture_);
}

}  // namespace frontpanels
