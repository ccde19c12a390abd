// A panel control that keeps in one list what its base asked of it, its owner included, and two side areas to
// place.
#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "framework/panel/base_vfp.h"
#include "framework/panel/hosted_panel.h"
#include "tests/support/recording_owner.h"

namespace frontpanels::testing {

class FakeSideArea : public SideArea {
 public:
  struct Place {
    float left = 0;
    float top = 0;
    float width = 0;
    float height = 0;
    friend bool operator==(const Place&, const Place&) = default;
  };

  FakeSideArea(float width, float height) : place{0, 0, width, height} {}

  Place place;
  bool visible = true;
  bool enabled = true;
  bool controlsEnabled = true;
  frontpanels::ScaleMode scaleMode = frontpanels::ScaleMode::Twips;

  bool Visible() override { return visible; }
  void Visible(bool value) override { visible = value; }
  void Enabled(bool value) override { enabled = value; }
  void disableControls() override { controlsEnabled = false; }
  float Width() override { return place.width; }
  float Height() override { return place.height; }
  void Move(float left, float top, float width, float height) override { place = {left, top, width, height}; }
  frontpanels::ScaleMode ScaleMode() override { return scaleMode; }
};

class FakePanelControl : public HostedPanel {
 public:
  // The view's size decides the scale: 15 twips a pixel.
  explicit FakePanelControl(const PanelEnvironment& environment)
      : FakePanelControl(environment, std::make_unique<RecordingOwner>()) {}

  clsBaseVFP* form = nullptr;  // whose Resize is the control's Form_Resize
  FakeSideArea* right = nullptr;
  FakeSideArea* bottom = nullptr;
  Control* markerToCenter = nullptr;
  std::string className = "SpectrumView";
  std::int32_t answer = 0;  // of what the base passes on
  std::function<void(std::int32_t resultTypeId, ResultReader& reader)> readResult;

  RecordingOwner& owner() noexcept { return *owner_; }
  std::vector<std::string>& calls() noexcept { return owner_->calls; }

  std::int32_t vfpOp(std::int32_t hardwareId, std::int16_t operation, const Variant& parameter,
                     clsBaseVFP* base) override {
    return passed("vfpOp", hardwareId, operation, parameter, base);
  }
  std::int32_t vfpSet(std::int32_t hardwareId, std::int16_t parameterType, std::int16_t index,
                      const Variant& value, clsBaseVFP* base) override {
    return passed("vfpSet[" + std::to_string(index) + "]", hardwareId, parameterType, value, base);
  }
  std::int32_t playbackOp(std::int32_t hardwareId, std::int16_t operation, const Variant& parameter,
                          clsBaseVFP* base) override {
    return passed("playbackOp", hardwareId, operation, parameter, base);
  }
  void resultData(std::int32_t resultTypeId, ResultReader& reader, clsBaseVFP* base) override {
    calls().push_back("resultData " + std::to_string(resultTypeId) + (base != nullptr ? " base" : ""));
    if (readResult) readResult(resultTypeId, reader);
  }
  SideArea* displayPanel() override { return right; }
  SideArea* controlPanel() override { return bottom; }
  Control* MarkerToCenterButton() override { return markerToCenter; }
  void evaluateEnablingMarkerToCenter() override { calls().emplace_back("evaluateEnablingMarkerToCenter"); }
  void ViewRefresh() override { calls().emplace_back("ViewRefresh"); }
  void SetCaption(std::string_view text, clsBaseVFP&) override {
    calls().push_back("SetCaption " + std::string(text));
  }
  void Form_Resize() override {
    if (form != nullptr) form->Resize();
  }
  void refreshControls() override { calls().emplace_back("refreshControls"); }
  void refreshMenuItems() override { calls().emplace_back("refreshMenuItems"); }
  void closeVfp() override { calls().emplace_back("closeVfp"); }
  void saveVfp() override { calls().emplace_back("saveVfp"); }
  void appendSettings(PanelSettings& settings) override { settings.push_back({9000, "own"}); }
  void frontPanelLink(const FrontPanelLink& link) override {
    calls().push_back("frontPanelLink " + std::to_string(link.genericId));
  }
  std::int32_t measurementInfo(Variant& types) override {
    types = Variant::Int32s{25};
    return answer;
  }
  std::string activeControlLink() override { return "SPAN"; }
  Variant initializeLinkValue(std::int16_t, std::int32_t) override { return 7; }
  bool actionEnabled(std::int16_t action) override { return action == 9; }
  std::string reportHtml() override { return "<p>"; }
  std::string linkSourceName() override { return "source"; }

  bool canRun(PlotCommand) override { return false; }
  void run(PlotCommand) override {}

  std::string typeName() override { return className; }
  void changedTraceConfiguration(TraceState, TraceObject*, std::int16_t) override {}
  void setMarkerFrameColor(Color) override {}
  void deltaMarkerButtonEnabled(bool enable) override {
    calls().emplace_back(enable ? "delta on" : "delta off");
  }

 private:
  FakePanelControl(const PanelEnvironment& environment, std::unique_ptr<RecordingOwner> owner)
      : HostedPanel(environment, *owner, *owner), owner_(std::move(owner)) {}
  std::int32_t passed(const std::string& what, std::int32_t hardwareId, std::int16_t code,
                      const Variant& value, clsBaseVFP* base) {
    calls().push_back(what + " " + std::to_string(hardwareId) + " " + std::to_string(code) + " " +
                      value.toText() + (base != nullptr ? " base" : ""));
    return answer;
  }

  std::unique_ptr<RecordingOwner> owner_;
};

}  // namespace frontpanels::testing
