// Caption, pop-up menu and areas of clsBaseVFP.
#include <algorithm>

#include "framework/panel/base_vfp.h"
#include "framework/support/error_handler.h"
#include "framework/support/guard.h"
#include "framework/support/host_codes.h"

namespace frontpanels {
namespace {

constexpr std::string_view kPlaybackWord = "Playback";
constexpr std::string_view kLogOnWord = "LOG ON";
constexpr std::string_view kLogOffWord = "LOG OFF";
constexpr std::string_view kUnsavedWord = "Unsaved";

constexpr float kSmallestDrawingAreaTwips = 10.0F;
constexpr double kMarginShare = 0.025;
constexpr float kMarginPenWidths = 4.0F;

// The larger of four pen widths and a fortieth of the length.
float marginTwips(float lengthTwips, std::int16_t penWidthPx, float twipsPerPixel) {
  const float byPen = kMarginPenWidths * static_cast<float>(penWidthPx) * twipsPerPixel;
  const auto byLength = static_cast<float>(kMarginShare * static_cast<double>(lengthTwips));
  return std::max(byPen, byLength);
}

}  // namespace

// --- Pop-up menu

void clsBaseVFP::decideMenuItem(std::int16_t buttonId, bool MenuItemState::*facet, bool value) {
  MenuItemState& state = menuItems_.at(buttonId);
  state.*facet = value;
  if (popUpMenu_ != nullptr) popUpMenu_->itemChanged(buttonId, state);
}

void clsBaseVFP::refreshMenuItems() {
  guard("clsBaseVFP::refreshMenuItems() ... ", [this] {
    if (child_.displayPanel() != nullptr)
      decideMenuItem(kRightPanelItem, &MenuItemState::checked, rightPanelVisible());
    if (child_.controlPanel() != nullptr)
      decideMenuItem(kBottomPanelItem, &MenuItemState::checked, bottomPanelVisible());
  });
}

void clsBaseVFP::PopUp_Click(std::int32_t /*subjectId*/, std::int32_t buttonId) {
  if (closing_) return;
  guard("clsBaseVFP::PopUp_Click() ... ", [&] {
    switch (buttonId) {
      case kCloseItem:
        if (!recordMode) child_.closeVfp();
        return;
      case kSaveItem:
        return child_.saveVfp();
      case kDisplayStateOnItem:
        return askForDisplayState(true);
      case kDisplayStateOffItem:
        return askForDisplayState(false);
      case kRightPanelItem:
        return rightPanelVisible(!rightPanelVisible());
      case kBottomPanelItem:
        return bottomPanelVisible(!bottomPanelVisible());
      default:
        return;
    }
  });
}

void clsBaseVFP::askForDisplayState(bool on) {
  reportStatus("::PopUp_Click()",
               child_.frontPanelOp(resourceId_, virtualFrontPanelId, kDisplayStateOperation, on));
}

// --- Caption

void clsBaseVFP::Caption(const std::string& text) {
  guard("clsBaseVFP::Caption() ... ", [&] {
    caption_ = text;
    if (multipleMeasurementVfp)
      child_.SetCaption(caption_, *this);
    else
      child_.Caption(caption_);
  });
}

void clsBaseVFP::applyCaption(std::string_view statusWord) {
  Caption(captionStatus ? frontPanelCaption_ + std::string(statusWord) : frontPanelCaption_);
}

void clsBaseVFP::saved(bool saved) {
  saved_ = saved;
  if (captionStatus) applyCaption(saved_ ? kLogOffWord : kUnsavedWord);
}

void clsBaseVFP::logIndicatorHandler() {
  guard("clsBaseVFP::logIndicatorHandler() ... ", [this] {
    if (playback) return showPlayback();
    if (recordMode) return showLogging();
    showIdle();
  });
}

void clsBaseVFP::showPlayback() {
  decideMenuItem(kBottomPanelItem, &MenuItemState::checked, false);
  bottomPanelEnabled(false);
  bottomPanelVisible(false);
  applyCaption(kPlaybackWord);
  if (SideArea* const area = child_.controlPanel()) area->disableControls();
}

void clsBaseVFP::showLogging() {
  decideMenuItem(kBottomPanelItem, &MenuItemState::checked, false);
  if (bottomPanelEnabled()) {
    bottomPanelEnabled(false);
    bottomPanelVisible(false);
  }
  if (Control* const button = child_.MarkerToCenterButton()) button->Enabled(false);
  if (loggingConfirmed_) applyCaption(kLogOnWord);
}

void clsBaseVFP::showIdle() {
  decideMenuItem(kBottomPanelItem, &MenuItemState::enabled, true);
  bottomPanelEnabled(true);
  if (SupportsMarkerToCenter) child_.evaluateEnablingMarkerToCenter();
  applyCaption(saved_ ? kLogOffWord : kUnsavedWord);
}

// --- Areas

// Equal ids mean the same base. A base that was closed has no common one any more and stands for itself.
bool clsBaseVFP::isCommonBase() const noexcept {
  return commonBase_ == nullptr || commonBase_ == this || commonBase_->baseVfpID == baseVfpID;
}

void clsBaseVFP::rightPanelVisible(bool visible) {
  rightPanelVisible_ = visible;
  showSideArea(child_.displayPanel(), visible);
}

void clsBaseVFP::bottomPanelVisible(bool visible) {
  if (!isCommonBase()) return commonBase_->bottomPanelVisible(visible);
  bottomPanelVisible_ = visible;
  showSideArea(child_.controlPanel(), visible);
}

void clsBaseVFP::rightPanelEnabled(bool enabled) {
  if (!isCommonBase()) return commonBase_->rightPanelEnabled(enabled);
  rightPanelEnabled_ = enabled;
  guard("clsBaseVFP::rightPanelEnabled() ... ", [&] {
    if (SideArea* const area = child_.displayPanel()) area->Enabled(enabled);
  });
}

void clsBaseVFP::bottomPanelEnabled(bool enabled) {
  if (!isCommonBase()) return commonBase_->bottomPanelEnabled(enabled);
  bottomPanelEnabled_ = enabled;
  guard("clsBaseVFP::bottomPanelEnabled() ... ", [&] {
    if (SideArea* const area = child_.controlPanel()) area->Enabled(enabled);
  });
}

void clsBaseVFP::showSideArea(SideArea* area, bool visible) {
  guard("clsBaseVFP::showSideArea() ... ", [&] {
    if (area != nullptr) area->Visible(visible);
    child_.refreshMenuItems();
    child_.Form_Resize();
  });
}

SideArea* clsBaseVFP::shownDisplayPanel() { return rightPanelVisible() ? child_.displayPanel() : nullptr; }
SideArea* clsBaseVFP::shownControlPanel() { return bottomPanelVisible() ? child_.controlPanel() : nullptr; }

void clsBaseVFP::Resize() {
  guard("clsBaseVFP::Resize() ... ", [this] {
    reportWrongScaleModes();
    placeSideAreas();
    setDrawingArea();
  });
}

void clsBaseVFP::reportWrongScaleModes() {
  const auto check = [this](ScaleMode mode, const char* where) {
    if (mode != ScaleMode::Twips)
      errorHandler().Assert("clsBaseVFP::Resize() ... " + child_.typeName() + where);
  };
  check(child_.ViewScaleMode(), ".ScaleMode should be vbTwips");
  if (SideArea* const area = child_.controlPanel())
    check(area->ScaleMode(), ".ControlPanel.ScaleMode should be vbTwips");
  if (SideArea* const area = child_.displayPanel())
    check(area->ScaleMode(), ".DisplayPanel.ScaleMode should be vbTwips");
}

// The bottom area spans the whole width, the right one ends above it.
void clsBaseVFP::placeSideAreas() {
  const float viewWidth = child_.ViewScaleWidth();
  const float viewHeight = child_.ViewScaleHeight();
  float graphHeight = viewHeight;
  if (SideArea* const bottom = shownControlPanel()) {
    graphHeight = std::max(viewHeight - bottom->Height(), 0.0F);
    bottom->Move(0, graphHeight, viewWidth, bottom->Height());
  }
  child_.InvisibleHeightMarkY1(graphHeight);
  float graphWidth = viewWidth;
  if (SideArea* const right = shownDisplayPanel()) {
    graphWidth = std::max(viewWidth - right->Width(), 0.0F);
    right->Move(graphWidth, 0, right->Width(), graphHeight);
  }
  child_.InvisibleWidthMarkX1(graphWidth);
}

void clsBaseVFP::setDrawingArea() {
  guard("clsBaseVFP::setDrawingArea() ... ", [this] {
    float height = child_.ViewScaleHeight();
    if (SideArea* const bottom = shownControlPanel()) height -= bottom->Height();
    height = std::max(height, kSmallestDrawingAreaTwips);
    float width = child_.ViewScaleWidth();
    if (SideArea* const right = shownDisplayPanel()) width -= right->Width();
    width = std::max(width, kSmallestDrawingAreaTwips);
    const float marginX = marginTwips(width, child_.ViewDrawWidth(), metrics_.twipsPerPixelX);
    const float marginY = marginTwips(height, child_.ViewDrawWidth(), metrics_.twipsPerPixelY);
    traceManager_->drawingArea(marginX, marginY, width - marginX * 2.0F, height - marginY * 2.0F);
    traceManager_->setShadowDC();
    traceManager_->paintTraces(true);
    child_.ViewRefresh();
  });
}

}  // namespace frontpanels
