#include "activex/spectrum_control.h"

#include <string>
#include <utility>
#include <vector>

#include "activex/services.h"
#include "entry/host_record_list.h"

namespace frontpanels::activex {
namespace {

constexpr ControlClass kClass{&CLSID_SpectrumView, &IID_ISpectrumView, &DIID__ISpectrumViewEvents,
                              L"Front Panels SpectrumView"};

HostRecordList oneRecord(HostRecordList::Record record) {
  return HostRecordList(std::vector<HostRecordList::Record>{std::move(record)});
}

// Order, minimum and maximum of each range in turn.
constexpr std::size_t kNumbersOfRange = 3;

HostRecordList rangesOf(const Variant& list) {
  const std::size_t count = list.elementCount();
  if (count % kNumbersOfRange != 0) raiseInvalidProcedureCall();
  std::vector<HostRecordList::Record> records;
  for (std::size_t at = 0; at < count; at += kNumbersOfRange)
    records.push_back({list.element(at).toInt16(), list.element(at + 1), list.element(at + 2)});
  return HostRecordList(std::move(records));
}

}  // namespace

SpectrumControl::SpectrumControl(IUnknown* outer) : FrontPanelControl(outer, kClass) {
  Services& shared = services();
  panel_.emplace(PanelEnvironment{shared.gdi, shared.windowing, window(), shared.hub, readScreenMetrics(),
                                  toUtf8(GetCommandLineW())},
                 requests(), *this);
  window().events(this);
  window().fields(panel_->controls());
  panel_->Form_Resize();
}

SpectrumControl::~SpectrumControl() {
  window().fields(nullptr);
  window().events(nullptr);
}

void* SpectrumControl::findInterface(REFIID id) noexcept {
  if (id == IID_ISpectrumView || id == IID_IDispatch) return static_cast<ISpectrumView*>(this);
  return findPart(id);
}

HRESULT SpectrumControl::addMarker() {
  return perform([&] { panel_->addMarker(); });
}

HRESULT SpectrumControl::markerToMax() {
  return perform([&] { panel_->markerToMax(); });
}

HRESULT SpectrumControl::markerToMin() {
  return perform([&] { panel_->markerToMin(); });
}

HRESULT SpectrumControl::deleteMarker() {
  return perform([&] { panel_->deleteMarker(); });
}

HRESULT SpectrumControl::addDeltaMarker() {
  return perform([&] { panel_->addDeltaMarker(); });
}

HRESULT SpectrumControl::markerToCenter() {
  return perform([&] { panel_->markerToCenter(); });
}

HRESULT SpectrumControl::updateMarkerButtons() {
  return perform([&] { panel_->updateMarkerButtons(); });
}

HRESULT SpectrumControl::evaluateEnablingMarkerToCenter() {
  return perform([&] { panel_->evaluateEnablingMarkerToCenter(); });
}

HRESULT SpectrumControl::deltaMarkerButtonEnabled(VARIANT_BOOL enable) {
  return perform([&] { panel_->deltaMarkerButtonEnabled(enable != VARIANT_FALSE); });
}

HRESULT SpectrumControl::Limits(short parameterType, VARIANT ranges, LONG* status) {
  return give(status, [&] {
    return static_cast<LONG>(panel_->Limits(parameterType, rangesOf(fromAutomation(ranges))));
  });
}

HRESULT SpectrumControl::ChannelZero(short order, double frequencyHz) {
  return perform([&] {
    const HostRecordList band = oneRecord({order, {}, {}});
    panel_->channels().setChannelZero(numberToText(frequencyHz), &band);
  });
}

HRESULT SpectrumControl::ChannelSpacing(short order, double spacingHz) {
  return perform([&] {
    const HostRecordList band = oneRecord({order, {}, {}});
    panel_->channels().setChannelSpacing(numberToText(spacingHz), &band);
  });
}

HRESULT SpectrumControl::ChannelDiscontinuity(short order, double channel, double lowest, double highest) {
  return perform([&] {
    const HostRecordList band = oneRecord({order, lowest, highest});
    panel_->channels().setChannelDiscontinuity(numberToText(channel), &band);
  });
}

HRESULT SpectrumControl::ChannelLookup(short channelization, short lowestOrder, short highestOrder) {
  return perform([&] {
    const HostRecordList bands = oneRecord({0, lowestOrder, highestOrder});
    panel_->channels().setChannelLookup(std::to_string(channelization), &bands);
  });
}

HRESULT SpectrumControl::ClearChannels() {
  return perform([&] {
    panel_->channels().reinitialize();
    panel_->ChannelizationCombo_Change();
  });
}

}  // namespace frontpanels::activex
