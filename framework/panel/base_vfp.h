// clsBaseVFP: what every panel shares. It keeps the panel's identity, periods and states, answers the host's
// common codes, decodes result buffers, decides caption, pop-up menu and side areas, and fits the graph
// between the areas. Lengths are twips in single precision.
//
// After a close every entry point answers 0 and does nothing.
#pragma once

#include <cstdint>
#include <memory>
#include <span>
#include <string>
#include <string_view>

#include "framework/panel/panel_control.h"
#include "framework/panel/panel_environment.h"
#include "framework/panel/panel_settings.h"
#include "framework/panel/pop_up_menu.h"
#include "platform/variant.h"
#include "traces/label_font_set.h"
#include "traces/marker.h"
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
  ~clsBaseVFP() = default;
  clsBaseVFP(const clsBaseVFP&) = delete;
  clsBaseVFP& operator=(const clsBaseVFP&) = delete;

  // --- The host's entry points; statuses as in host_codes.h
  std::int32_t vfpOp(std::int32_t hardwareId, std::int16_t operation, const Variant& parameter);
  std::int32_t vfpSet(std::int32_t hardwareId, std::int16_t parameterType, std::int16_t index,
                      const Variant& value);
  // Decodes the results between the cursor and the bytes left, which both end where reading ended. The other
  // arguments say how the host came by the buffer and have no say.
  std::int32_t displayData(const Variant& vParameter, std::span<const std::uint8_t> resultData,
                           std::int32_t& dataPointer, std::int32_t& dataCount, std::int32_t resultTypeId,
                           std::int32_t resultLength);
  // A value of the host's to be shown: the parameter of the code `order` in the panel's own vfpSet.
  std::int32_t displayParameter(std::int16_t order, const Variant& newValue);
  void PopUp_Click(std::int32_t subjectId, std::int32_t buttonId);
  // The reverse path, into the panel's own vfpOp and vfpSet; playback operations into its playbackOp.
  std::int32_t baseVfpOp(std::int32_t hardwareId, std::int16_t operation, const Variant& parameter);
  std::int32_t baseVfpSet(std::int32_t hardwareId, std::int16_t parameterType, std::int16_t index,
                          const Variant& value);

  // --- Requests to the host
  // Asks the host to close the panel, or to save it: the user wants it so.
  void closeVfp();
  void saveVfp();
  // Hands over the panel's settings, to be kept for the panel or under the id of a set-up.
  void saveBase();
  void saveSetup(std::int32_t setUpId);
  // The common settings and behind them the panel's own.
  [[nodiscard]] PanelSettings settings();
  std::int32_t frontPanelOp(std::int32_t hwId, std::int32_t vfpId, std::int16_t operation,
                            const Variant& argument);
  std::int32_t frontPanelSet(std::int32_t hwId, std::int32_t vfpId, std::int16_t parameterType,
                             std::int16_t index, const Variant& value);

  // --- Passed on to the control's members of the same names
  void frontPanelLink(const FrontPanelLink& link);
  std::int32_t measurementInfo(Variant& measurementTypes);
  [[nodiscard]] std::string activeControlLink();
  [[nodiscard]] Variant initializeLinkValue(std::int16_t linkType, std::int32_t genericId);
  [[nodiscard]] bool actionEnabled(std::int16_t action);
  // A fragment that needs no other file; empty after a failure.
  [[nodiscard]] std::string reportHtml();
  [[nodiscard]] std::string linkSourceName();

  // --- Events that the control passes on. Positions are twips of the view.
  void MouseDown(std::int16_t button, std::int16_t shift, float xTwips, float yTwips);
  void MouseMove(std::int16_t button, std::int16_t shift, float xTwips, float yTwips);
  void MouseUp(std::int16_t button, std::int16_t shift, float xTwips, float yTwips);
  // Keys of the graph; key codes and `shift` as in plot_keys.h. Whether the graph has a use for the key now,
  // and the key itself, which answers the same: one that it has no use for is the container's.
  [[nodiscard]] bool usesKey(std::int16_t keyCode, std::int16_t shift);
  bool KeyDown(std::int16_t keyCode, std::int16_t shift);
  void KeyUp(std::int16_t keyCode, std::int16_t shift);
  void Activate();
  // A window that the user closes stays until the host has closed the panel: `cancel` is set.
  void QueryUnload(bool& cancel);
  void Paint();

  // --- Pop-up menu. The host owns the menu: what is added to it, or checked and enabled from outside, is
  // accepted and has no effect. What the base decides is in menuItem().
  void addMenuItem(std::int16_t /*buttonId*/, std::string_view /*text*/) noexcept {}
  void insertMenuItem(std::int16_t /*buttonId*/, std::string_view /*text*/,
                      std::int16_t /*before*/) noexcept {}
  void deleteMenuItem(std::int16_t /*buttonId*/) noexcept {}
  void checkMenuItem(std::int16_t /*buttonId*/, bool /*checked*/) noexcept {}
  void enableMenuItem(std::int16_t /*buttonId*/, bool /*enabled*/) noexcept {}
  void addDefaultMenuItems() noexcept {}
  // Checks the items of the two areas, as far as the control has them.
  void refreshMenuItems();
  [[nodiscard]] MenuItemState menuItem(std::int16_t buttonId) const { return menuItems_.state(buttonId); }
  [[nodiscard]] PopUpMenu* popUpMenu() const noexcept { return popUpMenu_; }
  void popUpMenu(PopUpMenu* menu);

  // --- Caption and states
  // Stores the text and applies it to the control.
  void Caption(const std::string& text);
  [[nodiscard]] const std::string& Caption() const noexcept { return caption_; }
  [[nodiscard]] const std::string& frontPanelCaption() const noexcept { return frontPanelCaption_; }
  void frontPanelCaption(std::string text) { frontPanelCaption_ = std::move(text); }
  // Brings caption, menu and areas in line with playback, logging and saving.
  void logIndicatorHandler();
  [[nodiscard]] bool saved() const noexcept { return saved_; }
  void saved(bool saved);
  [[nodiscard]] bool loggingConfirmed() const noexcept { return loggingConfirmed_; }
  [[nodiscard]] std::int16_t displayState() const noexcept { return displayState_; }
  [[nodiscard]] bool closing() const noexcept { return closing_; }
  void closing(bool closing) noexcept { closing_ = closing; }

  // --- Areas. Panels of one window share the bottom area, and whether the areas are enabled, through the
  // common base; whether the right area is visible each panel decides for itself.
  [[nodiscard]] bool rightPanelVisible() const noexcept { return rightPanelVisible_; }
  void rightPanelVisible(bool visible);
  [[nodiscard]] bool bottomPanelVisible() const noexcept { return shared().bottomPanelVisible_; }
  void bottomPanelVisible(bool visible);
  [[nodiscard]] bool rightPanelEnabled() const noexcept { return shared().rightPanelEnabled_; }
  void rightPanelEnabled(bool enabled);
  [[nodiscard]] bool bottomPanelEnabled() const noexcept { return shared().bottomPanelEnabled_; }
  void bottomPanelEnabled(bool enabled);
  // Places the two areas against the right and bottom edges of the view and lays out the graph.
  void Resize();
  // Gives the graph what the shown areas leave, inside margins, and repaints.
  void setDrawingArea();

  // --- Identity and what belongs to the panel
  [[nodiscard]] PanelControl& child() const noexcept { return child_; }
  // The panel stands on a screen of another scale; Resize is to follow.
  void rescale(ScreenMetrics metrics);
  [[nodiscard]] clsTraceManager& traceManager() noexcept { return *traceManager_; }
  // Reported: nothing replaces a panel's traces by the way.
  void traceManager(std::shared_ptr<clsTraceManager> manager);
  [[nodiscard]] std::int32_t resourceId() const noexcept { return resourceId_; }
  void resourceId(std::int32_t id) noexcept;  // from now on result buffers must carry it
  [[nodiscard]] bool resourceIdValid() const noexcept { return resourceIdValid_; }
  void resourceIdValid(bool valid) noexcept { resourceIdValid_ = valid; }
  // Null after a close.
  [[nodiscard]] clsBaseVFP* commonBaseVfp() const noexcept { return commonBase_; }
  void commonBaseVfp(clsBaseVFP* base) noexcept { commonBase_ = base; }

  std::int32_t measurementId = 0;
  std::int32_t virtualFrontPanelId = 0;  // the host's id of this panel, passed back in its requests
  // The periods are in the host's unit, kept as sent.
  double measurementPeriod = 0;
  double databasePeriod = 0;
  double displayPeriod = 0;
  bool windowOwner = true;  // whether position, size, state and visibility are the panel's to change
  bool warnOnUnhandledParameters = false;
  bool captionStatus = true;  // whether captions end in a status word
  bool recordMode = false;    // logging
  bool playback = false;
  bool AttachToExistingForm = false;
  bool SupportsMarkerToCenter = false;
  bool multipleMeasurementVfp = false;
  bool CellNamingEnabled = true;
  std::int16_t baseVfpID = 0;  // equal ids mean the same base
  // Kept for the control.
  std::int16_t resourceType = 0;
  std::int16_t frontPanelType = 0;
  std::int16_t winState = 0;
  float hSplitter = 0;
  float vSplitter = 0;
  ObjectReference rightPanelExtender;
  ObjectReference bottomPanelExtender;

 private:
  struct OperationRow;
  struct ParameterRow;
  static const OperationRow kOperations[];
  static const ParameterRow kParameters[];
  [[nodiscard]] static const ParameterRow* findParameter(std::int16_t code) noexcept;

  // Operations
  [[nodiscard]] std::int32_t vfpClose();
  [[nodiscard]] std::int32_t show();
  [[nodiscard]] std::int32_t addTrace(const Variant& parameter);
  [[nodiscard]] std::int32_t removeTrace(const Variant& parameter);
  [[nodiscard]] std::int32_t saveSetupUnder(const Variant& parameter);
  [[nodiscard]] std::int32_t confirmLogging();
  [[nodiscard]] std::int32_t startPlayback(const Variant& parameter);
  [[nodiscard]] std::int32_t setDisplayState(const Variant& parameter);

  // Parameters
  [[nodiscard]] std::int32_t apply(const ParameterRow& row, const Variant& value);
  void reportUnhandled(std::int16_t parameterType);
  void reportStatus(std::string_view routine, std::int32_t status);
  void placeWindow(void (PanelControl::*place)(float), const Variant& value);
  [[nodiscard]] TraceObject& activePainter();
  void addTraceOfPn(double value);
  void selectTrace(std::int16_t resultType);
  void startMarker(std::int32_t number);
  void flagMarker(bool delta);
  [[nodiscard]] clsMarker& pendingMarker();
  [[nodiscard]] MarkerPointer deltaPartner(TraceObject& painter);
  void attachMarker(std::int16_t pn);
  void activateMarker();

  // Settings
  void appendCommonSettings(PanelSettings& settings);
  void appendTraceSettings(PanelSettings& settings);

  // Result buffers
  void decodeMeasurement(ResultReader& reader);
  void decodeRecord(ResultReader& reader, std::int32_t resultTypeId);

  // Caption and menu
  void applyCaption(std::string_view statusWord);
  void showPlayback();
  void showLogging();
  void showIdle();
  void decideMenuItem(std::int16_t buttonId, bool MenuItemState::*facet, bool value);
  void askForDisplayState(bool on);

  // Areas
  [[nodiscard]] bool isCommonBase() const noexcept;
  [[nodiscard]] const clsBaseVFP& shared() const noexcept { return isCommonBase() ? *this : *commonBase_; }
  [[nodiscard]] clsBaseVFP* furtherArgument() noexcept { return multipleMeasurementVfp ? this : nullptr; }
  void showSideArea(SideArea* area, bool visible);
  void reportWrongScaleModes();
  void placeSideAreas();
  [[nodiscard]] SideArea* shownDisplayPanel();
  [[nodiscard]] SideArea* shownControlPanel();

  PanelControl& child_;
  ScreenMetrics metrics_;
  LabelFontSet fonts_;
  std::shared_ptr<clsTraceManager> traceManager_;
  PopUpMenu* popUpMenu_ = nullptr;
  MenuItemStates menuItems_;
  clsBaseVFP* commonBase_ = this;

  bool closing_ = false;
  std::int32_t resourceId_ = 0;
  bool resourceIdValid_ = false;
  std::string frontPanelCaption_;
  std::string caption_;
  bool saved_ = false;
  bool loggingConfirmed_ = false;
  std::int16_t displayState_ = 1;
  bool rightPanelVisible_ = true;
  bool bottomPanelVisible_ = true;
  bool rightPanelEnabled_ = true;
  bool bottomPanelEnabled_ = true;

  // Sent ahead of the code that uses them.
  std::int16_t nextTracePn_ = 0;
  std::int32_t markerNumber_ = 0;
  MarkerPointer marker_;
};

}  // namespace frontpanels
