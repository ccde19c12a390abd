// A panel with everything round it in memory, which looks at its end whether it kept its promises.
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "framework/panel/headless.h"
#include "framework/support/utility.h"
#include "pilot/tarvex.h"
#include "platform/data_server.h"
#include "platform/dialogs.h"
#include "platform/locale.h"
#include "platform/raster/raster_gdi.h"
#include "spectrum/spectrum_view.h"

namespace frontpanels::fuzz {

// Has a window, and is hidden until it is shown.
class FuzzView : public HeadlessView {
 public:
  FuzzView(DcHandle dc, Size size) : HeadlessView(dc, size) { shown = false; }
  [[nodiscard]] WindowHandle hwnd() override { return WindowHandle{77}; }
};

// Host and container. It answers every request with the same status, and may first do to the panel what the
// panel has asked for, as hosts do.
class FuzzOwner : public HeadlessOwner {
 public:
  std::int32_t status = 0;
  FieldPanel* obeys = nullptr;  // the panel, while the host does as it asks

  std::int32_t frontPanelOp(std::int32_t hwId, std::int32_t, std::int16_t operation,
                            const Variant& argument) override {
    if (obeys != nullptr) obeys->vfpOp(hwId, operation, argument, nullptr);
    return status;
  }
  std::int32_t frontPanelSet(std::int32_t hwId, std::int32_t, std::int16_t parameterType, std::int16_t index,
                             const Variant& value) override {
    if (obeys != nullptr) obeys->vfpSet(hwId, parameterType, index, value, nullptr);
    return status;
  }
  std::int32_t saveDisplaySettings(std::int32_t hwId, std::int32_t, const PanelSettings& settings) override {
    return restored(hwId, settings);
  }
  std::int32_t saveSetup(std::int32_t, std::int32_t resourceId, std::int32_t,
                         const PanelSettings& settings) override {
    return restored(resourceId, settings);
  }
  std::vector<std::uint8_t> picturePng() override { return {0x89, 'P', 'N', 'G'}; }

 private:
  std::int32_t restored(std::int32_t hwId, const PanelSettings& settings) {
    for (const PanelSetting& setting : settings)
      if (obeys != nullptr) obeys->vfpSet(hwId, setting.parameterType, 0, setting.value, nullptr);
    return status;
  }
};

// The capture is the view's window's, another's or nobody's.
class FuzzWindowing : public Windowing {
 public:
  WindowHandle captured{77};

  WindowHandle setCapture(WindowHandle) override { return captured; }
  [[nodiscard]] WindowHandle getCapture() override { return captured; }
  void releaseCapture() override {}
  bool setTopmost(WindowHandle, bool) override { return static_cast<bool>(captured); }
};

// Nobody chooses a file.
class FuzzFileDialogs : public FileDialogs {
 public:
  std::optional<std::string> openFile(std::string_view) override { return std::nullopt; }
  bool cancelPressed() noexcept override { return false; }
};

enum class PanelKind : std::uint8_t { Spectrum, Pilots };

class PanelUnderTest {
 public:
  static constexpr Size kViewPx{240, 180};

  explicit PanelUnderTest(PanelKind kind = PanelKind::Spectrum);
  // Ends the program when the panel met a failure that nobody foresaw or left graphics objects behind.
  ~PanelUnderTest();
  PanelUnderTest(const PanelUnderTest&) = delete;
  PanelUnderTest& operator=(const PanelUnderTest&) = delete;

  [[nodiscard]] FieldPanel& panel() noexcept { return *panel_; }
  // Null for a panel of the other kind.
  [[nodiscard]] SpectrumView* spectrum() noexcept { return dynamic_cast<SpectrumView*>(panel_.get()); }
  [[nodiscard]] Tarvex* pilots() noexcept { return dynamic_cast<Tarvex*>(panel_.get()); }
  [[nodiscard]] Gdi& gdi() noexcept;

  FuzzView view;
  FuzzOwner owner;
  FuzzWindowing windowing;
  DataHub hub;

 private:
  FuzzFileDialogs fileDialogs_;
  FixedLocale locale_;
  RegionalSeparators separators_{locale_};
  std::size_t objectsBefore_;
  std::unique_ptr<FieldPanel> panel_;
};

}  // namespace frontpanels::fuzz
