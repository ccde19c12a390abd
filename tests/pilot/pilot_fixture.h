// The pilot panel on a recording surface, with a host that answers what a test names and files that exist in
// memory.
#pragma once

#include <memory>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "framework/support/utility.h"
#include "pilot/tarvex.h"
#include "platform/locale.h"
#include "tests/support/fake_surface.h"
#include "tests/support/memory_text_files.h"
#include "tests/support/recording_gdi.h"
#include "tests/support/recording_owner.h"
#include "tests/support/reporting_fixture.h"

namespace frontpanels::testing {

using Messages = std::vector<std::string>;
using Calls = std::vector<std::string>;

inline const std::string kAllPilotsPath = "Brantor Scanner/CDMA All Pilots/";
inline const std::string kZoomedPath = "Brantor Scanner/Cdma Zoomed Pilot/";
inline const std::string kTopNPath = "Brantor Scanner/Cdma Pilot Top N Multipath/";
inline const std::string kListPath = "Brantor Scanner/Cdma Pilot List Multipath Frame/";
inline const std::string kCarrierPath = "Brantor Scanner/Cdma Carrier Frame/";

class FakeFileDialogs : public FileDialogs {
 public:
  std::optional<std::string> chosen;
  std::string filter;      // as last asked with
  int looksToCancel = -1;  // the user presses Escape before this look; never below 0

  std::optional<std::string> openFile(std::string_view asked) override {
    filter = asked;
    return chosen;
  }
  bool cancelPressed() noexcept override {
    return looksToCancel == 0 || (looksToCancel > 0 && --looksToCancel == 0);
  }
};

// A view of 800 x 600 pixels with both areas hidden: the graph is 760 x 570 at (20, 15).
class PilotTest : public ReportingTest {
 protected:
  PilotTest() {
    view.dc = gdi.viewDc();
    panel = std::make_unique<Tarvex>(PanelEnvironment{gdi, windowing, view, hub, {15, 15}, ""},
                                     PilotServices{dialogs, files, separators}, owner, owner);
    panel->Form_Resize();
    panel->base().rightPanelVisible(false);
    panel->base().bottomPanelVisible(false);
    gdi.clear();
  }
  ~PilotTest() override {
    panel.reset();
    EXPECT_EQ(gdi.liveObjects(), 0);
    EXPECT_EQ(gdi.liveDcs(), 0);
    EXPECT_EQ(gdi.violations(), std::vector<std::string>{});
  }

  // A pilot of a frame: PN offset, peak Ec/Io; the rest of the record follows from them.
  struct Pilot {
    float pn;
    float ecIo;
  };
  // The seven paths of a multipath frame in their order, all or the first of them.
  void publishFrame(const std::string& set, const std::vector<Pilot>& pilots, double ioDbm = -70,
                    std::size_t paths = 7) {
    constexpr const char* kNames[] = {"Io",        "Pn",           "Peak EcIo",           "Delay",
                                      "Aggr EcIo", "Delay Spread", "Aggr Minus Peak EcIo"};
    for (std::size_t path = 0; path < paths; ++path) {
      if (path == 0) {
        hub.publish(set + kNames[0], Variant(ioDbm));
        continue;
      }
      std::vector<float> column;
      for (const Pilot& pilot : pilots)
        column.push_back(path == 1 ? pilot.pn : path == 2 ? pilot.ecIo : pilot.pn + static_cast<float>(path));
      hub.publish(set + kNames[path], std::span<const float>(column));
    }
  }
  void publishLevels(const std::string& path, const std::vector<float>& levels) {
    hub.publish(path, std::span(levels));
  }
  [[nodiscard]] clsMultiTracePainter* trace(std::int16_t id) {
    return dynamic_cast<clsMultiTracePainter*>(panel->base().traceManager().find(id));
  }
  [[nodiscard]] clsBarChartPainter* bars(std::int16_t id) {
    return dynamic_cast<clsBarChartPainter*>(panel->base().traceManager().find(id));
  }
  // "12:-7 30:-9": key and value of each bar, in the order on display.
  [[nodiscard]] std::string barsOf(std::int16_t id) {
    const clsBarChartPainter* const chart = bars(id);
    if (chart == nullptr) return "none";
    std::string text;
    for (std::int16_t i = 1; i <= chart->barArraySize(); ++i)
      text +=
          (i == 1 ? "" : " ") + numberToText(chart->barOffset(i)) + ":" + numberToText(chart->barValue(i));
    return text;
  }
  [[nodiscard]] Control& control(std::string_view name) { return panel->controls()->control(name); }
  [[nodiscard]] std::string text(std::string_view box) { return panel->controls()->textBox(box).Text(); }
  // What the list box shows.
  [[nodiscard]] std::string listed() {
    const ItemList& list = panel->controls()->list("userPNListListBox");
    std::string text;
    for (std::int32_t i = 0; i < list.ListCount(); ++i) text += (i == 0 ? "" : " ") + list.item(i).text;
    return text;
  }
  void type(std::string_view box, std::string_view entered) {
    Control& field = control(box);
    field.SetFocus();
    for (const char c : entered) field.userKey(c);
    field.userKey(13);
  }
  void click(std::string_view name) { ControlSet::click(control(name)); }
  void choose(std::string_view list, std::int32_t index) { panel->controls()->list(list).userChoice(index); }
  std::int32_t set(std::int16_t code, const Variant& value, std::int16_t index = 0) {
    return panel->vfpSet(0, code, index, value);
  }
  // What the panel asked of the host since the last time.
  [[nodiscard]] Calls asked() { return owner.take(); }

  RecordingGdi gdi;
  FakeWindowing windowing;
  FakeGraphView view;
  DataHub hub;
  RecordingOwner owner;
  FakeFileDialogs dialogs;
  MemoryTextFiles files;
  FixedLocale locale{".", ";"};
  RegionalSeparators separators{locale};
  std::unique_ptr<Tarvex> panel;
};

}  // namespace frontpanels::testing
