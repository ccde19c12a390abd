// Any sequence of what a host, its container and its user can do to a panel: a byte a call, and what the call
// takes.
#include <cstdint>
#include <iterator>
#include <memory>
#include <vector>

#include "entry/host_record_list.h"
#include "framework/panel/base_vfp.h"
#include "framework/panel/hosted_panel.h"
#include "framework/support/host_codes.h"
#include "fuzz/fuzz_input.h"
#include "fuzz/fuzz_variant.h"
#include "fuzz/panel_under_test.h"
#include "painters/multi_trace_painter.h"
#include "platform/runtime_error.h"

namespace frontpanels::fuzz {
namespace {

constexpr int kMaxCalls = 96;

using Call = void (*)(PanelUnderTest& test, FuzzInput& input);

// What an entry point answers; it must not come back with anything else than one of the three.
template <class Entry>
void enter(PanelUnderTest& test, Entry entry) {
  const bool closed = test.panel().base().closing();
  const std::int32_t status = entry();
  require(status == kStatusDone || status == kStatusUnknownOperation || status == kStatusUnusableParameter,
          "a status is one of three");
  require(!closed || status == kStatusDone, "a closed panel answers 0");
  require(!closed || test.panel().base().closing(), "a closed panel stays closed");
}

// The panel's own entry points and the base's on the reverse path.
template <class Entry>
void operate(PanelUnderTest& test, Entry entry, FuzzInput& input) {
  const auto hardwareId = input.number<std::int32_t>();
  const auto operation = input.number<std::int16_t>();
  const Variant parameter = takeVariant(input);
  enter(test, [&] { return entry(hardwareId, operation, parameter); });
}

template <class Entry>
void set(PanelUnderTest& test, Entry entry, FuzzInput& input) {
  const auto hardwareId = input.number<std::int32_t>();
  const auto parameterType = input.number<std::int16_t>();
  const auto index = input.number<std::int16_t>();
  const Variant value = takeVariant(input);
  enter(test, [&] { return entry(hardwareId, parameterType, index, value); });
}

void vfpOp(PanelUnderTest& test, FuzzInput& input) {
  operate(
      test, [&](auto id, auto code, const auto& value) { return test.panel().vfpOp(id, code, value); },
      input);
}

void vfpSet(PanelUnderTest& test, FuzzInput& input) {
  set(
      test,
      [&](auto id, auto code, auto, const auto& value) { return test.panel().vfpSet(id, code, 0, value); },
      input);
}

void baseVfpOp(PanelUnderTest& test, FuzzInput& input) {
  clsBaseVFP& base = test.panel().base();
  operate(
      test, [&](auto id, auto code, const auto& value) { return base.baseVfpOp(id, code, value); }, input);
}

void baseVfpSet(PanelUnderTest& test, FuzzInput& input) {
  clsBaseVFP& base = test.panel().base();
  set(
      test,
      [&](auto id, auto code, auto index, const auto& value) {
        return base.baseVfpSet(id, code, index, value);
      },
      input);
}

// A user at any field: a click, keys, an arrow, an item of a list.
void useControl(PanelUnderTest& test, FuzzInput& input) {
  const auto controls = test.panel().controls()->controls();
  Control& control = *controls[input.number<std::uint8_t>() % controls.size()];
  const auto how = input.number<std::uint8_t>();
  ControlSet::click(control);
  for (const std::uint8_t key : input.bytes(how % 32)) control.userKey(key);
  if (auto* const spin = dynamic_cast<SpinButton*>(&control)) spin->press((how & 32) != 0);
  if (auto* const list = dynamic_cast<ItemList*>(&control);
      list != nullptr && list->usable() && list->ListCount() > 0)
    list->userChoice(how % list->ListCount());
}

// Bands and their channels, as a host names them.
void limits(PanelUnderTest& test, FuzzInput& input) {
  const auto parameterType = input.number<std::int16_t>();
  const auto order = input.number<std::int8_t>();
  const HostRecordList records(
      std::vector<HostRecordList::Record>{{order, takeVariant(input), takeVariant(input)}});
  enter(test, [&] { return test.panel().Limits(parameterType, records); });
  test.panel().channels().setChannelLookup("0", &records);
  test.panel().channels().setChannelZero(numberToText(input.number<double>()), &records);
  test.panel().channels().setChannelSpacing("30000", &records);
}

void displayData(PanelUnderTest& test, FuzzInput& input) {
  const auto buffer = input.bytes(input.number<std::uint16_t>());
  std::int32_t cursor = 0;
  auto count = static_cast<std::int32_t>(buffer.size());
  enter(test, [&] { return test.panel().displayData(Variant(), buffer, cursor, count, 0, 0); });
}

void displayParameter(PanelUnderTest& test, FuzzInput& input) {
  const auto order = input.number<std::int16_t>();
  const Variant value = takeVariant(input);
  enter(test, [&] { return test.panel().displayParameter(order, value); });
}

void PopUp_Click(PanelUnderTest& test, FuzzInput& input) {
  const auto subjectId = input.number<std::int32_t>();
  test.panel().PopUp_Click(subjectId, input.number<std::int16_t>());
}

void publish(PanelUnderTest& test, FuzzInput& input) {
  test.hub.publish(SpectrumView::kSpectrumPath, takeVariant(input));
}

void resize(PanelUnderTest& test, FuzzInput& input) {
  const auto width = input.number<std::int16_t>();
  const auto height = input.number<std::int16_t>();
  test.view.sizePx = {width % 512, height % 512};
  test.panel().Form_Resize();
}

// Positions are whole twips, or any number that a single can hold.
template <auto event, class Position>
void mouse(PanelUnderTest& test, FuzzInput& input) {
  const auto button = input.number<std::int8_t>();
  const auto shift = input.number<std::int8_t>();
  const auto x = static_cast<float>(input.number<Position>());
  const auto y = static_cast<float>(input.number<Position>());
  (test.panel().*event)(button, shift, x, y);
}

void KeyDown(PanelUnderTest& test, FuzzInput& input) {
  const auto keyCode = input.number<std::int16_t>();
  test.panel().KeyDown(keyCode, input.number<std::int8_t>());
}

template <auto member>
void call(PanelUnderTest& test, FuzzInput&) {
  (test.panel().*member)();
}

template <auto member>
void baseCall(PanelUnderTest& test, FuzzInput&) {
  static_cast<void>((test.panel().base().*member)());
}

// What automation can ask of the base and of the surface; a property may refuse its value.
void askBase(PanelUnderTest& test, FuzzInput& input) {
  clsBaseVFP& base = test.panel().base();
  const auto small = input.number<std::int16_t>();
  Variant types = takeVariant(input);
  static_cast<void>(base.initializeLinkValue(small, small));
  static_cast<void>(base.actionEnabled(small));
  base.measurementInfo(types);
  base.frontPanelLink({.linkType = small, .genericId = small});
  bool cancel = false;
  base.QueryUnload(cancel);
}

// A further trace, as panels with several kinds of results have them.
void addTraceObject(PanelUnderTest& test, FuzzInput& input) {
  test.panel().base().traceManager().addTraceObject(std::make_shared<clsMultiTracePainter>(test.gdi()),
                                                    input.number<std::int16_t>());
}

void setSurface(PanelUnderTest& test, FuzzInput& input) {
  HostedPanel& surface = test.panel();
  const auto value = input.number<std::int16_t>();
  try {
    surface.ViewDrawWidth(value);
    surface.ViewScaleMode(value);
  } catch (const RuntimeError&) {  // the documented refusal
  }
}

void setFlags(PanelUnderTest& test, FuzzInput& input) {
  clsBaseVFP& base = test.panel().base();
  const auto bits = input.number<std::uint8_t>();
  base.windowOwner = (bits & 1) == 0;
  base.warnOnUnhandledParameters = (bits & 2) != 0;
  base.captionStatus = (bits & 4) == 0;
  base.multipleMeasurementVfp = (bits & 8) != 0;
  base.rightPanelVisible((bits & 16) == 0);
  base.bottomPanelVisible((bits & 32) == 0);
  test.view.shown = (bits & 64) != 0;
  test.owner.obeys = (bits & 128) != 0 ? &test.panel() : nullptr;
}

using V = SpectrumView;
using B = clsBaseVFP;

// make_seeds writes the places of these rows.
constexpr Call kCalls[] = {
    vfpOp,
    vfpSet,
    publish,
    resize,
    call<&V::Paint>,
    mouse<&V::MouseDown, std::int16_t>,
    mouse<&V::MouseMove, std::int16_t>,
    mouse<&V::MouseUp, std::int16_t>,
    mouse<&V::MouseDown, float>,
    mouse<&V::MouseMove, float>,
    mouse<&V::MouseUp, float>,
    KeyDown,
    call<&V::addMarker>,
    call<&V::markerToMax>,
    call<&V::markerToMin>,
    setFlags,
    displayData,
    displayParameter,
    PopUp_Click,
    baseVfpOp,
    baseVfpSet,
    [](PanelUnderTest& test, FuzzInput& input) { test.owner.status = input.number<std::int32_t>(); },
    [](PanelUnderTest& test, FuzzInput& input) {
      test.windowing.captured = WindowHandle{input.number<std::uint8_t>()};
    },
    baseCall<&B::Activate>,
    baseCall<&B::closeVfp>,
    baseCall<&B::saveVfp>,
    baseCall<&B::reportHtml>,
    baseCall<&B::logIndicatorHandler>,
    askBase,
    setSurface,
    addTraceObject,
    useControl,
    limits,
    call<&V::addDeltaMarker>,
    call<&V::deleteMarker>,
    call<&V::markerToCenter>,
    call<&V::ChannelizationCombo_Change>,
    [](PanelUnderTest& test, FuzzInput& input) {
      test.panel().contextMenuClick(input.number<std::int8_t>());
    },
};

void run(FuzzInput input) {
  PanelUnderTest test;
  for (int i = 0; i < kMaxCalls && !input.empty(); ++i)
    kCalls[input.number<std::uint8_t>() % std::size(kCalls)](test, input);
}

}  // namespace
}  // namespace frontpanels::fuzz

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  frontpanels::fuzz::run(frontpanels::fuzz::FuzzInput({data, size}));
  return 0;
}
