#include "fuzz/panel_under_test.h"

#include <algorithm>

#include "framework/support/error_handler.h"
#include "fuzz/fuzz_input.h"

namespace frontpanels::fuzz {
namespace {

// One for all inputs: looking for fonts takes longer than anything that a panel does.
RasterGdi& drawing() {
  static RasterGdi gdi;
  return gdi;
}

DcHandle screen() {
  static const DcHandle dc = drawing().createScreen(PanelUnderTest::kViewPx);
  return dc;
}

std::size_t objects() { return drawing().liveObjects() + drawing().liveDcs(); }

}  // namespace

PanelUnderTest::PanelUnderTest(PanelKind kind) : view(screen(), kViewPx), objectsBefore_(objects()) {
  messageLog().clear();
  const PanelEnvironment environment{drawing(), windowing, view, hub, ScreenMetrics{}, ""};
  if (kind == PanelKind::Spectrum)
    panel_ = std::make_unique<SpectrumView>(environment, owner, owner);
  else
    panel_ = std::make_unique<Tarvex>(
        environment, PilotServices{fileDialogs_, systemTextFiles(), separators_}, owner, owner);
  panel_->Form_Resize();
}

Gdi& PanelUnderTest::gdi() noexcept { return drawing(); }

PanelUnderTest::~PanelUnderTest() {
  panel_.reset();
  require(objects() == objectsBefore_, "a panel deletes what it has created");
  // By this text `guard` reports what is no run-time error.
  const auto& messages = messageLog().messages();
  require(std::none_of(messages.begin(), messages.end(),
                       [](const std::string& text) { return text.ends_with("Internal error"); }),
          "every failure is one that the run-time knows");
}

}  // namespace frontpanels::fuzz

// The font library keeps what it has read for good.
extern "C" const char* __lsan_default_suppressions() { return "leak:libfontconfig\n"; }
