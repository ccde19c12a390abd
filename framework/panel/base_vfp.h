// clsBaseVFP: what every panel shares. It keeps the panel's identity and periods, answers the host's common
// codes, and fits the graph between the panel's side areas. Lengths are twips in single precision.
#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <string_view>

#include "framework/panel/panel_control.h"
#include "framework/panel/panel_environment.h"
#include "platform/variant.h"
#include "traces/label_font_set.h"
#include "traces/trace_manager.h"

namespace frontpanels {

// State that all panels of the process share.
struct SharedPanelState {
  bool dirty = false;  // something was closed or changed since the host last stored it
};
[[nodiscard]] SharedPanelState& sharedPanelState() noexcept;

class clsBaseVFP {
 public:
  static constexpr std::string_view kTypeName = "clsBaseVFP";

  // `child` is the panel control; both references must outlive the base.
  clsBaseVFP(const PanelEnvironment& environment, PanelControl& child);

  // The host's common codes; statuses as in host_codes.h. After a close every entry point answers 0 and does
  // nothing.
  std::int32_t vfpOp(std::int32_t hardwareId, std::int16_t operation, const Variant& parameter);
  std::int32_t vfpSet(std::int32_t hardwareId, std::int16_t parameterType, std::int16_t index,
                      const Variant& value);

  // Asks the host to close the panel: the user wants it gone.
  void closeVfp();

  // Places the two areas against the right and bottom edges of the view and lays out the graph.
  void Resize();
  // Gives the graph what the shown areas leave, inside margins, and repaints.
  void setDrawingArea();

  [[nodiscard]] clsTraceManager& traceManager() noexcept { return traceManager_; }
  [[nodiscard]] bool closing() const noexcept { return closing_; }
  [[nodiscard]] std::int32_t resourceId() const noexcept { return resourceId_; }
  [[nodiscard]] bool resourceIdValid() const noexcept { return resourceIdValid_; }
  [[nodiscard]] std::int32_t measurementId() const noexcept { return measurementId_; }
  // The periods are in the host's unit, stored as sent.
  [[nodiscard]] double measurementPeriod() const noexcept { return measurementPeriod_; }
  [[nodiscard]] double databasePeriod() const noexcept { return databasePeriod_; }
  [[nodiscard]] double displayPeriod() const noexcept { return displayPeriod_; }
  [[nodiscard]] const std::string& frontPanelCaption() const noexcept { return frontPanelCaption_; }
  [[nodiscard]] const std::string& Caption() const noexcept { return caption_; }
  void Caption(const std::string& text);
  [[nodiscard]] bool saved() const noexcept { return saved_; }
  [[nodiscard]] bool rightPanelVisible() const noexcept { return rightPanelVisible_; }
  void rightPanelVisible(bool visible);
  [[nodiscard]] bool bottomPanelVisible() const noexcept { return bottomPanelVisible_; }
  void bottomPanelVisible(bool visible);

  bool windowOwner = true;
  std::int32_t virtualFrontPanelId = 0;  // the host's id of this panel, passed back in its requests
  bool warnOnUnhandledParameters = false;

 private:
  struct ParameterRow;
  static const ParameterRow kParameters[];

  [[nodiscard]] std::int32_t vfpClose();
  [[nodiscard]] std::int32_t show();
  [[nodiscard]] std::int32_t addTrace(const Variant& parameter);
  [[nodiscard]] std::int32_t removeTrace(const Variant& parameter);
  [[nodiscard]] TraceObject& activePainter();
  void reportUnhandled(std::int16_t parameterType);
  void reportWrongScaleModes();
  void placeSideAreas();
  void showSideArea(SideArea* area, bool visible);
  [[nodiscard]] SideArea* shownDisplayPanel();
  [[nodiscard]] SideArea* shownControlPanel();

  PanelControl& child_;
  ScreenMetrics metrics_;
  LabelFontSet fonts_;
  clsTraceManager traceManager_;

  bool closing_ = false;
  std::int32_t resourceId_ = 0;
  bool resourceIdValid_ = false;
  std::int32_t measurementId_ = 0;
  double measurementPeriod_ = 0;
  double databasePeriod_ = 0;
  double displayPeriod_ = 0;
  std::string frontPanelCaption_;
  std::string caption_;
  bool saved_ = false;
  bool rightPanelVisible_ = true;
  bool bottomPanelVisible_ = true;
};

}  // namespace frontpanels
