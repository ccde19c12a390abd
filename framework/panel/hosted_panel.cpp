#include "framework/panel/hosted_panel.h"

#include "platform/runtime_error.h"

namespace frontpanels {

float HostedPanel::ViewWidth() {
  return static_cast<float>(view_.clientSizePx().width) * metrics_.twipsPerPixelX;
}

float HostedPanel::ViewHeight() {
  return static_cast<float>(view_.clientSizePx().height) * metrics_.twipsPerPixelY;
}

float HostedPanel::ViewScaleWidth() {
  return scaleMode_ == ScaleMode::Pixels ? static_cast<float>(view_.clientSizePx().width) : ViewWidth();
}

float HostedPanel::ViewScaleHeight() {
  return scaleMode_ == ScaleMode::Pixels ? static_cast<float>(view_.clientSizePx().height) : ViewHeight();
}

void HostedPanel::ViewScaleMode(std::int16_t mode) {
  const auto scale = static_cast<ScaleMode>(mode);
  if (scale != ScaleMode::Twips && scale != ScaleMode::Pixels) raiseInvalidProcedureCall();
  scaleMode_ = scale;
}

void HostedPanel::ViewDrawMode(DrawMode mode) {
  drawMode_ = mode;
  gdi_.setRop2(view_.hdc(), mode);
}

void HostedPanel::ViewDrawWidth(std::int16_t widthPx) {
  if (widthPx < 1) raiseInvalidProcedureCall();
  drawWidthPx_ = widthPx;
}

void HostedPanel::ViewFontTransparent(bool transparent) {
  fontTransparent_ = transparent;
  gdi_.setBkMode(view_.hdc(), transparent ? BackgroundMode::Transparent : BackgroundMode::Opaque);
}

void HostedPanel::ViewForeColor(Color color) {
  foreColor_ = color;
  gdi_.setTextColor(view_.hdc(), color);
}

void HostedPanel::ViewState(std::int16_t state) {
  winState_ = state;
  container_.viewState(state);
}

void HostedPanel::ViewVisible(bool visible) {
  view_.visible(visible);
  container_.visible(visible);
}

}  // namespace frontpanels
