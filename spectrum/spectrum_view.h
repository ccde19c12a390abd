// SpectrumView: the panel that shows power against frequency. This is the whole control except its window:
// the window side (a registered control, a headless renderer, a test) hands over an environment, forwards
// events and calls the host's entry points. Positions of mouse events are twips of the view.
#pragma once

#include <cstdint>
#include <memory>
#include <span>
#include <string>

#include "framework/panel/panel_environment.h"
#include "framework/panel/panel_host.h"
#include "platform/variant.h"

namespace frontpanels {

class clsBaseVFP;
class FrequencyPlan;
class HostedPanel;

class SpectrumView {
 public:
  SpectrumView(const PanelEnvironment& environment, PanelHost& host, PanelContainer& container);
  ~SpectrumView();
  SpectrumView(const SpectrumView&) = delete;
  SpectrumView& operator=(const SpectrumView&) = delete;

  // Entry points of the host. Each answers a status: 0 done, -1 unknown operation, -8 unusable parameter.
  std::int32_t vfpOp(std::int32_t hardwareId, std::int16_t operation, const Variant& parameter);
  std::int32_t vfpSet(std::int32_t hardwareId, std::int16_t parameterType, std::int16_t index,
                      const Variant& value);

  // Decodes a result buffer from the cursor on; cursor and bytes left end where reading ended.
  std::int32_t displayData(const Variant& vParameter, std::span<const std::uint8_t> resultData,
                           std::int32_t& dataPointer, std::int32_t& dataCount, std::int32_t resultTypeId,
                           std::int32_t resultLength);
  std::int32_t displayParameter(std::int16_t order, const Variant& newValue);
  void PopUp_Click(std::int32_t subjectId, std::int32_t buttonId);

  [[nodiscard]] std::string Caption();

  // Events of the window.
  void Form_Resize();  // also once after creation, when the view has its size
  void Paint();        // recomposes the graph and copies it to the view's device context
  void MouseDown(std::int16_t button, std::int16_t shift, float xTwips, float yTwips);
  void MouseMove(std::int16_t button, std::int16_t shift, float xTwips, float yTwips);
  void MouseUp(std::int16_t button, std::int16_t shift, float xTwips, float yTwips);
  void KeyDown(std::int16_t keyCode, std::int16_t shift);
  void Activate();

  // Marker commands. Without a trace there is nothing to mark, without a marker nothing to move: no report.
  void addMarker();
  void markerToMax();
  void markerToMin();

  // The parts behind the panel. They live as long as it does.
  [[nodiscard]] clsBaseVFP& base();
  [[nodiscard]] const FrequencyPlan& frequencyPlan() const;
  [[nodiscard]] HostedPanel& control();  // with the surface that the graph is drawn on

  static constexpr const char* kTypeName = "SpectrumView";
  static constexpr const char* kSpectrumPath = "Brantor Scanner/Spectrum/Spectrum Trace";
  static constexpr std::int16_t kSpectrumResultType = 25;
  static constexpr std::int32_t kMaxPoints = 513;

 private:
  class Implementation;
  std::unique_ptr<Implementation> implementation_;
};

}  // namespace frontpanels
