// The panel on a recording surface, with a host that answers what a test names.
#pragma once

#include <algorithm>
#include <memory>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "spectrum/spectrum_view.h"
#include "tests/support/fake_surface.h"
#include "tests/support/recording_gdi.h"
#include "tests/support/recording_owner.h"
#include "tests/support/reporting_fixture.h"

namespace frontpanels::testing {

using Messages = std::vector<std::string>;

// A view of 800 x 600 pixels with both areas hidden: the graph is 760 x 570 at (20, 15).
class SpectrumViewTest : public ReportingTest {
 protected:
  SpectrumViewTest() {
    view.dc = gdi.viewDc();
    panel = std::make_unique<SpectrumView>(PanelEnvironment{gdi, windowing, view, hub, {15, 15}, ""}, owner,
                                           owner);
    panel->Form_Resize();
    panel->base().rightPanelVisible(false);
    panel->base().bottomPanelVisible(false);
    gdi.clear();
  }
  ~SpectrumViewTest() override {
    panel.reset();
    EXPECT_EQ(gdi.liveObjects(), 0);
    EXPECT_EQ(gdi.liveDcs(), 0);
    EXPECT_EQ(gdi.violations(), std::vector<std::string>{});
  }

  void publish(const std::vector<float>& levels) {
    hub.publish(SpectrumView::kSpectrumPath, std::span(levels));
  }
  [[nodiscard]] bool shows(std::string_view text) const {
    const std::vector<Call> all = gdi.texts();
    return std::any_of(all.begin(), all.end(), [text](const Call& call) { return call.text == text; });
  }
  // The trace's poly-lines: in the colour of trace 0.
  [[nodiscard]] std::vector<Call> traceLines() const {
    std::vector<Call> lines = gdi.polylines();
    std::erase_if(lines, [](const Call& line) { return line.pen.color != rgb(50, 156, 50); });
    return lines;
  }

  RecordingGdi gdi;
  FakeWindowing windowing;
  FakeGraphView view;
  DataHub hub;
  RecordingOwner owner;
  std::unique_ptr<SpectrumView> panel;
};

}  // namespace frontpanels::testing
