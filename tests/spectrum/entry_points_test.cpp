// Every entry point of the panel takes every code and every kind of value: a status, never a crash, and what
// fails leaves the panel as it was.
#include <gtest/gtest.h>

#include <cstdint>
#include <limits>
#include <sstream>

#include "framework/panel/base_vfp.h"
#include "painters/multi_trace_painter.h"
#include "spectrum/spectrum_view.h"
#include "tests/support/fake_surface.h"
#include "tests/support/recording_gdi.h"
#include "tests/support/recording_owner.h"
#include "tests/support/reporting_fixture.h"

namespace frontpanels::testing {
namespace {

std::vector<Variant> everyKindOfValue() {
  const auto object = std::make_shared<int>(0);
  return {Variant(),
          Variant::null(),
          Variant(ErrorValue{-2147352572}),
          Variant(true),
          Variant(std::uint8_t{255}),
          Variant(std::int16_t{-32768}),
          Variant(std::int32_t{2147483647}),
          Variant(std::int64_t{1} << 62),
          Variant(-0.5F),
          Variant(1e300),
          Variant(std::numeric_limits<double>::quiet_NaN()),
          Variant(-std::numeric_limits<double>::infinity()),
          Variant("25"),
          Variant(" 1e400 "),
          Variant("True"),
          Variant("\xFF" + std::string(5000, 'x')),
          Variant(DateValue{45000.5}),
          Variant(ObjectReference(object)),
          Variant(ObjectReference()),
          Variant(Variant::Singles{}),
          Variant(Variant::Doubles{1, 2, 3}),
          Variant(Variant::Bytes(9)),
          Variant(Variant::Variants{Variant(Variant::Int32s{1}), Variant::null()})};
}

class EntryPointsTest : public ReportingTest {
 public:  // the entries are named by the tests
  EntryPointsTest() {
    reporting().dialogs = nullptr;
    view.dc = gdi.viewDc();
    view.shown = false;
    panel.Form_Resize();
    panel.vfpOp(0, 10, 10);
  }

  // All that a code could have changed.
  std::string state() {
    std::ostringstream text;
    clsBaseVFP& base = panel.base();
    for (const PanelSetting& setting : base.settings())
      text << setting.parameterType << '=' << setting.value.toText() << ' ';
    text << base.measurementId << ' ' << base.resourceId() << base.resourceIdValid() << base.recordMode
         << base.loggingConfirmed() << base.playback << base.saved() << base.displayState() << base.closing()
         << base.frontPanelCaption() << '|' << base.Caption() << base.traceManager().Traces().count();
    return text.str();
  }
  using Entry = std::int32_t (EntryPointsTest::*)(std::int16_t code, const Variant& value);
  std::int32_t vfpOp(std::int16_t code, const Variant& value) { return panel.vfpOp(0, code, value); }
  std::int32_t vfpSet(std::int16_t code, const Variant& value) { return panel.vfpSet(0, code, -1, value); }
  std::int32_t displayParameter(std::int16_t code, const Variant& value) {
    return panel.displayParameter(code, value);
  }
  std::int32_t baseVfpSet(std::int16_t code, const Variant& value) {
    return panel.base().baseVfpSet(0, code, 32767, value);
  }

  RecordingGdi gdi;
  FakeWindowing windowing;
  FakeGraphView view;
  DataHub hub;
  RecordingOwner owner;
  SpectrumView panel{PanelEnvironment{gdi, windowing, view, hub, {15, 15}, ""}, owner, owner};
};

TEST_F(EntryPointsTest, ListedCodesTakeEveryKindOfValueAndAFailureChangesNothing) {
  const std::vector<std::int16_t> codes = {9,   10,  11,  12,  13,  14,  15,  16,  17,  18,  21,  43,  44,
                                           45,  312, 314, 315, 322, 700, 701, 702, 703, 704, 705, 706, 714,
                                           716, 717, 719, 722, 726, 727, 735, 736, 737, 740, 741, 742, 743,
                                           744, 799, 810, 94,  333, 500, 502, 750, 803, 804, 3900};
  int failures = 0;
  for (const Entry entry : {&EntryPointsTest::vfpSet, &EntryPointsTest::displayParameter,
                            &EntryPointsTest::baseVfpSet, &EntryPointsTest::vfpOp}) {
    std::string before = state();
    for (const std::int16_t code : codes) {
      for (const Variant& value : everyKindOfValue()) {
        const std::int32_t status = (this->*entry)(code, value);
        const std::string after = state();
        ASSERT_TRUE(status == 0 || status == -1 || status == -8) << code << ' ' << value.typeName();
        if (status != 0) {
          ++failures;
          ASSERT_EQ(after, before) << code << ' ' << value.typeName();
        }
        before = after;
      }
    }
  }
  EXPECT_GT(failures, 500);
}

TEST_F(EntryPointsTest, EveryOtherCodeAnswersAndChangesNothing) {
  const auto listed = [](int code) {
    return (code >= 9 && code <= 21) || (code >= 43 && code <= 45) || (code >= 312 && code <= 322) ||
           code == 94 || code == 333 || code == 500 || code == 502 || (code >= 700 && code <= 810) ||
           code == 3900;
  };
  const std::string before = state();
  for (int code = -32768; code <= 32767; ++code) {
    if (listed(code) || code == 1) continue;
    ASSERT_EQ(vfpSet(static_cast<std::int16_t>(code), "1"), 0) << code;
    ASSERT_EQ(vfpOp(static_cast<std::int16_t>(code), "1"), -1) << code;
    panel.PopUp_Click(code, code == 900 || code == 901 ? 0 : code);
  }
  EXPECT_EQ(state(), before);
}

}  // namespace
}  // namespace frontpanels::testing
