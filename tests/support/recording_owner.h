// The host and the container of a panel in one: notes every request and every change of place, and answers
// with the status that a test names.
#pragma once

#include <cstdint>
#include <functional>
#include <initializer_list>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "framework/panel/panel_host.h"

namespace frontpanels::testing {

class RecordingOwner : public PanelHost, public PanelContainer {
 public:
  std::int32_t status = 0;
  std::vector<std::string> calls;
  PanelSettings kept;  // as last handed over
  std::vector<std::uint8_t> png;
  // What the host does inside the request for a setting.
  std::function<void(std::int16_t parameterType, const Variant& value)> settingChanged;

  std::int32_t frontPanelOp(std::int32_t hwId, std::int32_t vfpId, std::int16_t operation,
                            const Variant& argument) override {
    return request("frontPanelOp", {hwId, vfpId, operation}, argument);
  }
  std::int32_t frontPanelSet(std::int32_t hwId, std::int32_t vfpId, std::int16_t parameterType,
                             std::int16_t index, const Variant& value) override {
    const std::int32_t answer = request("frontPanelSet", {hwId, vfpId, parameterType, index}, value);
    if (settingChanged) settingChanged(parameterType, value);
    return answer;
  }
  std::int32_t saveDisplaySettings(std::int32_t hwId, std::int32_t vfpId,
                                   const PanelSettings& settings) override {
    kept = settings;
    return request("saveDisplaySettings", {hwId, vfpId}, {});
  }
  std::int32_t saveSetup(std::int32_t setUpId, std::int32_t resourceId, std::int32_t frontPanelId,
                         const PanelSettings& settings) override {
    kept = settings;
    return request("saveSetup", {setUpId, resourceId, frontPanelId}, {});
  }

  void caption(std::string_view text) override { calls.push_back("caption " + std::string(text)); }
  void visible(bool visible) override { calls.emplace_back(visible ? "visible on" : "visible off"); }
  void viewState(std::int16_t state) override { calls.push_back("viewState " + std::to_string(state)); }
  void left(float position) override { place("left", position); }
  void top(float position) override { place("top", position); }
  void width(float length) override { place("width", length); }
  void height(float length) override { place("height", length); }
  std::vector<std::uint8_t> picturePng() override { return png; }

  // What came since the last time.
  std::vector<std::string> take() { return std::exchange(calls, {}); }

 private:
  void place(const char* what, float twips) {
    calls.push_back(std::string(what) + " " + numberToText(twips));
  }
  std::int32_t request(std::string text, std::initializer_list<std::int32_t> numbers,
                       const Variant& argument) {
    for (const std::int32_t number : numbers) text += " " + std::to_string(number);
    if (!argument.isEmpty()) text += " " + argument.toText();
    calls.push_back(text);
    return status;
  }
};

}  // namespace frontpanels::testing
