#include "activex/spectrum_control.h"

#include <string>
#include <utility>
#include <vector>

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

SpectrumControl::SpectrumControl(IUnknown* outer) : FrontPanelControl(outer, kClass) {}

HRESULT SpectrumControl::markerToCenter() {
  return perform([&] { panel().markerToCenter(); });
}

HRESULT SpectrumControl::updateMarkerButtons() {
  return perform([&] { panel().updateMarkerButtons(); });
}

HRESULT SpectrumControl::evaluateEnablingMarkerToCenter() {
  return perform([&] { panel().evaluateEnablingMarkerToCenter(); });
}

HRESULT SpectrumControl::deltaMarkerButtonEnabled(VARIANT_BOOL enable) {
  return perform([&] { panel().deltaMarkerButtonEnabled(enable != VARIANT_FALSE); });
}

HRESULT SpectrumControl::Limits(short parameterType, VARIANT ranges, LONG* status) {
  return give(status, [&] {
    return static_cast<LONG>(panel().Limits(parameterType, rangesOf(fromAutomation(ranges))));
  });
}

HRESULT SpectrumControl::ChannelZero(short order, double frequencyHz) {
  return perform([&] {
    const HostRecordList band = oneRecord({order, {}, {}});
    panel().channels().setChannelZero(numberToText(frequencyHz), &band);
  });
}

HRESULT SpectrumControl::ChannelSpacing(short order, double spacingHz) {
  return perform([&] {
    const HostRecordList band = oneRecord({order, {}, {}});
    panel().channels().setChannelSpacing(numberToText(spacingHz), &band);
  });
}

HRESULT SpectrumControl::ChannelDiscontinuity(short order, double channel, double lowest, double highest) {
  return perform([&] {
    const HostRecordList band = oneRecord({order, lowest, highest});
    panel().channels().setChannelDiscontinuity(numberToText(channel), &band);
  });
}

HRESULT SpectrumControl::ChannelLookup(short channelization, short lowestOrder, short highestOrder) {
  return perform([&] {
    const HostRecordList bands = oneRecord({0, lowestOrder, highestOrder});
    panel().channels().setChannelLookup(std::to_string(channelization), &bands);
  });
}

HRESULT SpectrumControl::ClearChannels() {
  return perform([&] {
    panel().channels().reinitialize();
    panel().ChannelizationCombo_Change();
  });
}

}  // namespace frontpanels::activex
