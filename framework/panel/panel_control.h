// The panel control as its base sees it.
#pragma once

#include <cstdint>
#include <string>
#include <string_view>

#include "framework/panel/panel_host.h"
#include "framework/panel/panel_settings.h"
#include "platform/controls.h"
#include "platform/result_reader.h"
#include "platform/variant.h"
#include "traces/plot_keys.h"
#include "traces/trace_form.h"

namespace frontpanels {

class clsBaseVFP;

// One of the two areas beside the graph. Sizes are in the area's own scale, positions in the control's.
class SideArea {
 public:
  virtual ~SideArea() = default;

  [[nodiscard]] virtual bool Visible() = 0;
  virtual void Visible(bool visible) = 0;
  virtual void Enabled(bool enabled) = 0;
  // Every control inside the area; the area itself stays as it is.
  virtual void disableControls() = 0;
  [[nodiscard]] virtual float Width() = 0;
  [[nodiscard]] virtual float Height() = 0;
  virtual void Move(float left, float top, float width, float height) = 0;
  [[nodiscard]] virtual frontpanels::ScaleMode ScaleMode() = 0;
};

// A link of the host to something on the panel, and how the host wants it shown.
struct FrontPanelLink {
  std::int16_t linkType = 0;
  std::int32_t genericId = 0;
  bool bold = false;
  bool italic = false;
  bool enable = false;
};

// Its base makes requests to the host through it.
class PanelControl : public TraceForm, public PanelHost, public PlotCommands {
 public:
  // Entry points and what the base calls back. `base` is null unless the panel shows several measurements
  // through bases of their own; then it says which of them calls.
  virtual std::int32_t vfpOp(std::int32_t hardwareId, std::int16_t operation, const Variant& parameter,
                             clsBaseVFP* base) = 0;
  virtual std::int32_t vfpSet(std::int32_t hardwareId, std::int16_t parameterType, std::int16_t index,
                              const Variant& value, clsBaseVFP* base) = 0;
  virtual std::int32_t playbackOp(std::int32_t hardwareId, std::int16_t operation, const Variant& parameter,
                                  clsBaseVFP* base) = 0;
  // Reads one result record. What it leaves unread is stepped over; a record that it cannot use it leaves.
  virtual void resultData(std::int32_t resultTypeId, ResultReader& reader, clsBaseVFP* base) = 0;

  // The right and the bottom area; null when the control has none.
  [[nodiscard]] virtual SideArea* displayPanel() = 0;
  [[nodiscard]] virtual SideArea* controlPanel() = 0;
  // Null when the control has no such button.
  [[nodiscard]] virtual Control* MarkerToCenterButton() = 0;
  virtual void evaluateEnablingMarkerToCenter() = 0;
  // Where a hidden area would begin, for the control's collapse buttons.
  virtual void InvisibleWidthMarkX1(float x) = 0;
  virtual void InvisibleHeightMarkY1(float y) = 0;

  [[nodiscard]] virtual ScaleMode ViewScaleMode() = 0;
  [[nodiscard]] virtual std::int16_t ViewDrawWidth() = 0;  // of the view's pen, in pixels
  virtual void ViewState(std::int16_t state) = 0;          // 0 is the normal state
  virtual void ViewVisible(bool visible) = 0;
  virtual void ViewRefresh() = 0;
  virtual void Caption(std::string_view text) = 0;
  // In place of Caption for a panel that shows several measurements: that of the measurement's base.
  virtual void SetCaption(std::string_view text, clsBaseVFP& base) = 0;
  // The panel's place in its container, in the container's units (twips).
  virtual void left(float position) = 0;
  virtual void top(float position) = 0;
  virtual void ViewWidth(float width) = 0;
  virtual void ViewHeight(float height) = 0;
  virtual void Form_Resize() = 0;
  virtual void refreshControls() = 0;
  virtual void refreshMenuItems() = 0;

  // The user's wish to close or to save: asks the host.
  virtual void closeVfp() = 0;
  virtual void saveVfp() = 0;
  // The panel's own settings, behind the common ones.
  virtual void appendSettings(PanelSettings& settings) = 0;
  // What a host asks of a panel as one of many.
  virtual void frontPanelLink(const FrontPanelLink& link) = 0;
  virtual std::int32_t measurementInfo(Variant& measurementTypes) = 0;
  virtual std::string activeControlLink() = 0;
  virtual Variant initializeLinkValue(std::int16_t linkType, std::int32_t genericId) = 0;
  virtual bool actionEnabled(std::int16_t action) = 0;
  virtual std::string reportHtml() = 0;
  virtual std::string linkSourceName() = 0;
};

}  // namespace frontpanels
