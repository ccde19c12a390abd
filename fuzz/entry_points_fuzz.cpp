// Any sequence of what a host, its container and its user can do to a panel: a byte for the panel, then a
// byte a call, and what the call takes.
#include <cstdint>
#include <iterator>
#include <memory>
#include <string>
#include <vector>

#include "entry/host_record_list.h"
#include "framework/panel/base_vfp.h"
#include "framework/panel/hosted_panel.h"
#include "framework/support/host_codes.h"
#include "fuzz/fuzz_input.h"
#include "fuzz/fuzz_variant.h"
#include "fuzz/panel_under_test.h"
#include "painters/multi_trace_painter.h"
#include "pilot/cell_name_info.h"
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
      test,
      [&](auto id, auto code, const auto& value) { return test.panel().vfpOp(id, code, value, nullptr); },
      input);
}

void vfpSet(PanelUnderTest& test, FuzzInput& input) {
  set(
      test,
      [&](auto id, auto code, auto index, const auto& value) {
        return test.panel().vfpSet(id, code, index, value, nullptr);
      },
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
  SpectrumView* const panel = test.spectrum();
  if (panel == nullptr) return;
  enter(test, [&] { return panel->Limits(parameterType, records); });
  panel->channels().setChannelLookup("0", &records);
  panel->channels().setChannelZero(numberToText(input.number<double>()), &records);
  panel->channels().setChannelSpacing("30000", &records);
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

std::vector<std::string> pathsOf(const Tarvex& panel, FuzzInput& input) {
  const auto server = static_cast<PilotServer>(input.number<std::uint8_t>() % kPilotServers);
  std::vector<std::string> paths(1);
  for (const char letter : panel.paths(server)) {
    if (letter == DataServer::kPathSeparator)
      paths.emplace_back();
    else
      paths.back().push_back(letter);
  }
  return paths;
}

void publish(PanelUnderTest& test, FuzzInput& input) {
  if (test.pilots() == nullptr) return test.hub.publish(SpectrumView::kSpectrumPath, takeVariant(input));
  const std::vector<std::string> paths = pathsOf(*test.pilots(), input);
  test.hub.publish(paths[input.number<std::uint8_t>() % paths.size()], takeVariant(input));
}

// All paths of a server in their order: as many values for each, or for one of them another number or kind.
void publishFrame(PanelUnderTest& test, FuzzInput& input) {
  if (test.pilots() == nullptr) return;
  const std::vector<std::string> paths = pathsOf(*test.pilots(), input);
  const auto pilots = input.number<std::uint8_t>();
  const std::size_t strange = input.number<std::uint8_t>() % (2 * paths.size());
  for (std::size_t path = 0; path < paths.size(); ++path) {
    if (path == strange) {
      test.hub.publish(paths[path], takeVariant(input));
      continue;
    }
    std::vector<float> values(pilots);
    for (float& value : values) value = input.number<std::int8_t>();
    test.hub.publish(paths[path], std::span<const float>(values));
  }
}

void nameCells(PanelUnderTest& test, FuzzInput& input) {
  if (test.pilots() == nullptr) return;
  const auto names = std::make_shared<clsCellNameInfo>();
  const auto text = input.bytes(input.number<std::uint8_t>());
  names->SetCellName(input.number<std::int8_t>(), input.number<std::int8_t>(),
                     std::string(text.begin(), text.end()));
  test.pilots()->CellNameInfo(names);
}

void subscribe(PanelUnderTest& test, FuzzInput& input) {
  if (test.pilots() == nullptr) return;
  const auto server = static_cast<PilotServer>(input.number<std::uint8_t>() % kPilotServers);
  const auto text = input.bytes(input.number<std::uint8_t>() % 16);
  test.pilots()->paths(server, std::string(text.begin(), text.end()));
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

// What both panels have under one name, and what the spectrum panel alone has.
template <auto ofSpectrum, auto ofPilots>
void call(PanelUnderTest& test, FuzzInput&) {
  if (SpectrumView* const panel = test.spectrum()) (panel->*ofSpectrum)();
  if (Tarvex* const panel = test.pilots()) (panel->*ofPilots)();
}

template <auto member>
void call(PanelUnderTest& test, FuzzInput&) {
  if (SpectrumView* const panel = test.spectrum()) (panel->*member)();
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
using T = Tarvex;
using B = clsBaseVFP;

// make_seeds writes the places of these rows.
constexpr Call kCalls[] = {
    vfpOp,
    vfpSet,
    publish,
    resize,
    [](PanelUnderTest& test, FuzzInput&) { test.panel().Paint(); },
    mouse<&FieldPanel::MouseDown, std::int16_t>,
    mouse<&FieldPanel::MouseMove, std::int16_t>,
    mouse<&FieldPanel::MouseUp, std::int16_t>,
    mouse<&FieldPanel::MouseDown, float>,
    mouse<&FieldPanel::MouseMove, float>,
    mouse<&FieldPanel::MouseUp, float>,
    KeyDown,
    call<&V::addMarker, &T::addMarker>,
    call<&V::markerToMax, &T::markerToMax>,
    call<&V::markerToMin, &T::markerToMin>,
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
    call<&V::addDeltaMarker, &T::addDeltaMarker>,
    call<&V::deleteMarker, &T::deleteMarker>,
    call<&V::markerToCenter>,
    call<&V::ChannelizationCombo_Change>,
    [](PanelUnderTest& test, FuzzInput& input) {
      test.panel().contextMenuClick(input.number<std::int8_t>());
    },
    publishFrame,
    nameCells,
    subscribe,
};

void run(FuzzInput input) {
  PanelUnderTest test((input.number<std::uint8_t>() & 1) == 0 ? PanelKind::Spectrum : PanelKind::Pilots);
  for (int i = 0; i < kMaxCalls && !input.empty(); ++i)
    kCalls[input.number<std::uint8_t>() % std::size(kCalls)](test, input);
}

}  // namespace
}  // namespace frontpanels::fuzz

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  frontpanels::fuzz::run(frontpanels::fuzz::FuzzInput({data, size}));
  return 0;
}
