// The whole spectrum panel, from a published sweep to the finished copy, beside the same picture as bare
// graphics calls: 800 x 600 pixels, both areas hidden, 513 points and four markers.
#pragma once

#include <cstdint>
#include <vector>

#include "bench/bench_scene.h"
#include "bench/captured_picture.h"
#include "framework/panel/headless.h"
#include "spectrum/spectrum_view.h"

namespace frontpanels::bench {

class SpectrumPanelScene final : public BenchScene {
 public:
  SpectrumPanelScene(Gdi& gdi, DcHandle view);

  [[nodiscard]] std::string name() const override { return "panel"; }
  void drawFramework() override { publish(++panelFrame_ % kFrames); }
  void drawBare() override { drawBare(++bareFrame_ % kFrames); }
  void drawFrameworkAgain() override { publish(0); }
  void drawBareAgain() override { drawBare(0); }

 private:
  static constexpr std::size_t kFrames = 8;

  void setUp();
  void publish(std::size_t frame);
  void drawBare(std::size_t frame);

  CapturingGdi gdi_;
  HeadlessView view_;
  HeadlessWindowing windowing_;
  HeadlessOwner owner_;
  DataHub hub_;
  SpectrumView panel_;
  std::vector<std::vector<float>> frames_;
  PlotMapping mapping_;
  std::size_t panelFrame_ = 0;
  std::size_t bareFrame_ = 0;
};

}  // namespace frontpanels::bench
