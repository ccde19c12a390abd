#include "tests/support/recording_gdi.h"

#include <gtest/gtest.h>

#include "platform/gdi_scope.h"
#include "tests/support/fake_surface.h"

namespace frontpanels::testing {
namespace {

constexpr Color kRed = rgb(255, 0, 0);

TEST(RecordingGdi, KeepsALineWithThePenAndThePointItBeganAt) {
  RecordingGdi gdi;
  {
    const SelectedPen pen(gdi, gdi.viewDc(), PenStyle::Solid, 2, kRed);
    gdi.moveTo(gdi.viewDc(), {1, 2});
    gdi.lineTo(gdi.viewDc(), {5, 2});
  }
  const std::vector<LineValue> expected{{{1, 2}, {5, 2}, {PenStyle::Solid, 2, kRed}}};
  EXPECT_EQ(gdi.lines(), expected);
  EXPECT_EQ(gdi.liveObjects(), 0);
  EXPECT_TRUE(gdi.violations().empty());
}

TEST(RecordingGdi, DeletingASelectedPenIsAViolationAndThePenGoesWhenItIsSelectedOut) {
  RecordingGdi gdi;
  const PenHandle pen = gdi.createPen(PenStyle::Solid, 1, kRed);
  const PenHandle before = gdi.selectObject(gdi.viewDc(), pen);
  gdi.deleteObject(pen);
  EXPECT_EQ(gdi.violations(), std::vector<std::string>{"deleteObject of a pen that is selected"});
  EXPECT_EQ(gdi.liveObjects(), 1);
  gdi.selectObject(gdi.viewDc(), before);
  EXPECT_EQ(gdi.liveObjects(), 0);
}

TEST(RecordingGdi, AScopeWhoseSelectingOutFailsIsBlameless) {
  RecordingGdi gdi;
  gdi.failNth("selectObject", 2);
  { const SelectedPen pen(gdi, gdi.viewDc(), PenStyle::Solid, 1, kRed); }
  EXPECT_TRUE(gdi.violations().empty());
}

TEST(RecordingGdi, FailsTheNthCallOfANameAndTheNthCallOfAll) {
  RecordingGdi gdi;
  gdi.failNth("createSolidBrush", 2);
  EXPECT_TRUE(gdi.createSolidBrush(kRed));
  EXPECT_FALSE(gdi.createSolidBrush(kRed));
  EXPECT_TRUE(gdi.createSolidBrush(kRed));
  gdi.failNthCall(2);
  EXPECT_TRUE(gdi.createRectRgn({0, 0, 1, 1}));
  EXPECT_FALSE(gdi.moveTo(gdi.viewDc(), {1, 1}));
  EXPECT_TRUE(gdi.moveTo(gdi.viewDc(), {1, 1}));
}

TEST(RecordingGdi, UnknownHandlesAreViolationsAndDrawNothing) {
  RecordingGdi gdi;
  EXPECT_FALSE(gdi.polyline({}, {}));
  EXPECT_FALSE(gdi.fillRect(gdi.viewDc(), {0, 0, 4, 4}, BrushHandle{9}));
  EXPECT_EQ(gdi.violations().size(), 2U);
  EXPECT_TRUE(gdi.fills().empty());
}

TEST(RecordingGdi, ALetterIsEightByTwelvePixelsWhateverItsLengthInBytes) {
  RecordingGdi gdi;
  EXPECT_EQ(gdi.textExtent(gdi.viewDc(), "5 \xC2\xB5s"), (Size{32, 12}));
}

}  // namespace
}  // namespace frontpanels::testing
