// FieldPanel: what all panels with fields beside their graph share. It owns the controls of the panel's
// designer table, the two areas that they lie in and the base, and does what goes for any measurement: the
// way of a setting to the host, links, the context menu, the areas with their collapse buttons. A panel adds
// its codes, its fields and its traces. Positions of mouse events are twips of the view.
#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "framework/panel/base_vfp.h"
#include "framework/panel/hosted_panel.h"
#include "framework/panel/picture_area.h"
#include "framework/support/flag_scope.h"
#include "platform/control_set.h"

namespace frontpanels {

class FieldPanel : public HostedPanel {
 public:
  // The rows hold the pictures "displayPanel" and "controlPanel" and the push buttons
  // "MarkerFrameInvisibleButton" and "MeasurementFrameInvisibleButton", which lie along the areas' inner
  // edges and hide them; raises "Invalid procedure call or argument" where one is missing. `typeName` is a
  // literal.
  FieldPanel(const PanelEnvironment& environment, PanelHost& host, PanelContainer& container,
             const char* typeName, std::span<const ControlRow> rows);
  ~FieldPanel() override = default;
  FieldPanel(const FieldPanel&) = delete;
  FieldPanel& operator=(const FieldPanel&) = delete;

  // --- Entry points of the host. Each answers a status as in host_codes.h.
  // A panel plays nothing by itself.
  std::int32_t playbackOp(std::int32_t hardwareId, std::int16_t operation, const Variant& parameter,
                          clsBaseVFP* base) override;
  // Decodes a result buffer from the cursor on; cursor and bytes left end where reading ended.
  std::int32_t displayData(const Variant& vParameter, std::span<const std::uint8_t> resultData,
                           std::int32_t& dataPointer, std::int32_t& dataCount, std::int32_t resultTypeId,
                           std::int32_t resultLength) {
    return base_.displayData(vParameter, resultData, dataPointer, dataCount, resultTypeId, resultLength);
  }
  std::int32_t displayParameter(std::int16_t order, const Variant& newValue) {
    return base_.displayParameter(order, newValue);
  }
  void PopUp_Click(std::int32_t subjectId, std::int32_t buttonId) { base_.PopUp_Click(subjectId, buttonId); }

  // --- Events of the window
  void rescale(ScreenMetrics metrics) override;
  void Form_Resize() override;     // also once after creation, when the view has its size
  void Paint() { base_.Paint(); }  // recomposes the graph and copies it to the view's device context
  void MouseDown(std::int16_t button, std::int16_t shift, float xTwips, float yTwips) {
    base_.MouseDown(button, shift, xTwips, yTwips);
  }
  void MouseMove(std::int16_t button, std::int16_t shift, float xTwips, float yTwips) {
    base_.MouseMove(button, shift, xTwips, yTwips);
  }
  void MouseUp(std::int16_t button, std::int16_t shift, float xTwips, float yTwips) {
    base_.MouseUp(button, shift, xTwips, yTwips);
  }
  // False for a key that the graph has no use for.
  bool KeyDown(std::int16_t keyCode, std::int16_t shift) { return base_.KeyDown(keyCode, shift); }

  // --- The panel as its base sees it
  std::string typeName() override { return typeName_; }
  using HostedPanel::Caption;
  [[nodiscard]] const std::string& Caption() const noexcept { return base_.Caption(); }
  SideArea* displayPanel() override { return &displayPanel_; }
  SideArea* controlPanel() override { return &controlPanel_; }
  ControlSet* controls() override { return &controls_; }
  void refreshMenuItems() override { base_.refreshMenuItems(); }
  void closeVfp() override;
  void saveVfp() override { base_.saveVfp(); }
  // The frame "MarkerFrame" and the button "MarkerDeltaButton", where the panel has them.
  void setMarkerFrameColor(Color color) override;
  void deltaMarkerButtonEnabled(bool enable) override;
  // The button of this name, null where the panel has none.
  Control* MarkerToCenterButton() override { return controls_.find("MarkerToCenterButton"); }
  // There is an active marker, and neither logging nor playback holds the receiver where it is.
  void evaluateEnablingMarkerToCenter() override;

  // Commands of keys. One that a button or spin button stands for does what that does, while it is enabled;
  // it need not be in sight.
  bool canRun(PlotCommand command) override;
  void run(PlotCommand command) override;

  // The two areas, the panel's own items, properties and close; ids count from 1 in that order.
  std::vector<PanelMenuItem> contextMenu() override;
  void contextMenuClick(std::int16_t id) override;

  // --- Links
  void frontPanelLink(const FrontPanelLink& link) override;
  // A parameter as its field has it, else as the panel's settings do.
  Variant initializeLinkValue(std::int16_t linkType, std::int32_t genericId) override;
  // The name, in upper case, of the field that the user is at, where a host may link to it.
  std::string activeControlLink() override;
  // Save at any time, close unless logging or playback goes on; another action is the panel's.
  bool actionEnabled(std::int16_t action) override;
  std::string linkSourceName() override;

  // The part behind the panel. It lives as long as the panel does.
  [[nodiscard]] clsBaseVFP& base() noexcept { return base_; }

 protected:
  // An item of the context menu with what a click does.
  struct MenuCommand {
    const char* caption = "";
    bool checked = false;
    bool enabled = true;
    std::function<void()> run;
  };
  [[nodiscard]] virtual std::vector<MenuCommand> ownMenuCommands() { return {}; }

  // What runs the commands that no button stands for.
  [[nodiscard]] virtual PlotCommands& plotCommands() = 0;

  // False for what nothing on the panel goes by; it is reported then.
  [[nodiscard]] virtual bool linkAction(const FrontPanelLink& /*link*/) { return false; }
  [[nodiscard]] virtual bool linkParameter(const FrontPanelLink& /*link*/) { return false; }
  // The value of the entry that a parameter links to.
  [[nodiscard]] virtual std::optional<double> linkedValue(std::int32_t /*parameterType*/) { return {}; }
  // Names of the controls that a host may link to by name.
  [[nodiscard]] virtual std::span<const char* const> linkedByName() const { return {}; }
  static void showLink(Control& control, const FrontPanelLink& link);

  // The routine's name as reports have it, and a report of what went wrong in it.
  [[nodiscard]] std::string named(std::string_view routine) const;
  void report(std::string_view what) const;

  // For events of controls: nothing happens in a closed panel.
  template <class Handler>
  [[nodiscard]] std::function<void()> whileOpen(Handler handler) {
    return [this, handler = std::move(handler)] {
      if (!base_.closing()) handler();
    };
  }

  // Requests to the host; false, after a report in the routine's name, for one that is refused, and without
  // one in a panel that the host has closed meanwhile. A number goes without an index.
  bool request(std::string_view routine, std::int16_t parameterType, double value) {
    return request(routine, parameterType, 0, value);
  }
  bool request(std::string_view routine, std::int16_t parameterType, std::int16_t index,
               const Variant& value);
  bool operate(std::string_view routine, std::int16_t operation, const Variant& argument = {});
  bool accepted(std::string_view routine, std::int32_t status) const;

  // Chooses an option for the host: the click that it raises must not go back to whoever made it.
  void select(std::string_view option);
  // The program changes an option, a list or a box for as long as the scope lives.
  [[nodiscard]] FlagScope changeOption() noexcept { return FlagScope(optionChangeInProgress_); }
  [[nodiscard]] bool optionChangeInProgress() const noexcept { return optionChangeInProgress_; }

  // Logging and playback keep the measurement area away.
  void toggleMeasurementArea() {
    if (base_.bottomPanelEnabled()) base_.bottomPanelVisible(!base_.bottomPanelVisible());
  }
  void toggleDisplayArea() { base_.rightPanelVisible(!base_.rightPanelVisible()); }

  // Composes the graph anew where it can be seen, then lets the panel follow it.
  void refreshTraces();
  virtual void tracesRefreshed() {}
  // What is kept in pixels follows the new scale; the areas are laid out next.
  virtual void rescaled() {}

  [[nodiscard]] bool mayCenterMarker();

 private:
  [[nodiscard]] std::vector<MenuCommand> menuCommands();

  const char* typeName_;
  ControlSet controls_;
  PictureArea displayPanel_;
  PictureArea controlPanel_;
  clsBaseVFP base_;
  bool optionChangeInProgress_ = false;
};

}  // namespace frontpanels
