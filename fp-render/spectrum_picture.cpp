// The spectrum panel without a window.
#include "entry/host_record_list.h"
#include "fp-render/panel_picture.h"
#include "framework/support/host_codes.h"
#include "sources/receiver.h"
#include "sources/resample.h"
#include "spectrum/spectrum_view.h"

namespace frontpanels {
namespace {

// Receivers go beyond what a panel takes by itself.
constexpr double kHighestHz = 1e12;

static_assert(kDisplayValues == SpectrumView::kMaxPoints);

class SpectrumPicture final : public PanelPicture {
 public:
  explicit SpectrumPicture(const PictureLook& look)
      : PanelPicture(look), panel_(environment(), owner_, owner_) {
    open();
  }

  void tune(DriveSimulator& drive) override {
    Receiver receiver;
    for (const StoredSetting& setting : settings())
      if (setting.value.isNumeric())
        static_cast<void>(receiver.request(setting.code, setting.value.toDouble()));
    drive.tune(receiver.tuning({}));
  }

  void survey(const Frame& frame) override {
    if (!frame.sweep || frame.sweep->levelsDb.empty()) return;
    resample(*frame.sweep);
    levels(SpectrumView::kSpectrumResultType, display_.shown());
  }

  std::string missingLevels() override {
    if (!isSet(kCenterFrequencyParameter) && !isSet(kSpanParameter)) return PanelPicture::missingLevels();
    const FrequencyEntries& tuned = panel_.fields().frequency;
    return "every level from " + tuned.start.text() + " to " + tuned.stop.text() + " is missing";
  }

  bool show(const Frame& frame) override {
    if (!frame.sweep || frame.sweep->levelsDb.empty()) return false;
    resample(*frame.sweep);
    LevelRange range;
    range.add(display_.shown());
    if (range.isEmpty()) return false;
    hub_.publish(SpectrumView::kSpectrumPath, display_.shown());
    // Markers read the frequency at which they are drawn: behind the last cell there is one more value.
    markedTrace()->xPerPoint(display_.range.spanHz / (static_cast<double>(display_.count) - 2));
    placeMarkers();
    return true;
  }

 protected:
  FieldPanel& panel() override { return panel_; }
  bool ownScaleWhereItFits() const override { return false; }
  clsMultiTracePainter* markedTrace() override {
    return dynamic_cast<clsMultiTracePainter*>(
        panel_.base().traceManager().find(SpectrumView::kSpectrumResultType));
  }

 private:
  void open() {
    const HostRecordList limits({{0, 0.0, kHighestHz}});
    for (const std::int16_t code : {kCenterFrequencyParameter, kSpanParameter})
      if (panel_.Limits(code, limits) != kStatusDone) raiseInvalidProcedureCall();
    if (panel_.vfpOp(0, kAddTraceOperation, kAddTraceOperation) != kStatusDone) raiseInvalidProcedureCall();
    setOwn(kAutoScaleParameter, false);
    PanelPicture::open();
  }

  // The panel is tuned to the sweep, as far as no setting has tuned it.
  void resample(const Sweep& sweep) {
    const FrequencyRange whole = rangeOf(sweep);
    if (!isSet(kCenterFrequencyParameter)) setOwn(kCenterFrequencyParameter, whole.centerHz);
    if (!isSet(kSpanParameter)) setOwn(kSpanParameter, whole.spanHz);
    if (!isSet(kCenterFrequencyParameter) && !isSet(kSpanParameter))
      return frontpanels::resample(sweep, display_);
    const FrequencyEntries& tuned = panel_.fields().frequency;
    frontpanels::resample(sweep, {tuned.center.value(), tuned.span.value()}, display_);
  }

  SpectrumView panel_;
  DisplaySweep display_;
};

}  // namespace

std::unique_ptr<PanelPicture> makeSpectrumPicture(const PictureLook& look) {
  return std::make_unique<SpectrumPicture>(look);
}

}  // namespace frontpanels
