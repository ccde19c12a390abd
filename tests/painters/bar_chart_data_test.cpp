#include <array>
#include <cmath>

#include "tests/painters/bar_chart_fixture.h"

namespace frontpanels {
namespace {

using testing::BarChartTest;
using testing::kNoNumber;

class BarDataTest : public BarChartTest {};

// A pilot: offset, peak, delay, aggregate, delay spread, aggregate less peak.
const Variant::Singles kPilot{12, -10, 3.5F, -8, 1.25F, 2};

TEST_F(BarDataTest, AnItemFillsTheRecordOfItsBar) {
  chart.offset(-60.0);
  chart.useOffset(true);
  update(kPilot, 1, 6);
  Bar expected;
  expected.barId = 1;
  expected.value = -70;  // -10 - 60
  expected.key = 12;
  expected.extra = -8.0F;  // element 3, of source 0
  expected.secondary = 1.25F;
  EXPECT_EQ(static_cast<const Bar&>(chart.bars()[0]), expected);

  chart.kindFlag(1);
  chart.hasCellNameLookupId2(true);
  chart.extraValueSource(2);
  update(kPilot, 1, 6);
  expected.auxiliary = 3.5F;
  expected.cellNameId2 = 3.5;
  expected.extra = 1.25F;
  EXPECT_EQ(static_cast<const Bar&>(chart.bars()[0]), expected);
  EXPECT_EQ(said(), "");
}

struct OtherCase {
  std::int16_t otherIs;
  float other;  // with an offset of -60, whether or not it is used
};

class OtherTest : public BarDataTest, public ::testing::WithParamInterface<OtherCase> {};

TEST_P(OtherTest, IsTheElementThatItsTypeNames) {
  chart.offset(-60.0);
  chart.otherIs(GetParam().otherIs);
  update(kPilot, 1, 6);
  EXPECT_EQ(chart.barOther(1), GetParam().other);
  EXPECT_EQ(chart.barValue(1), -10);
  EXPECT_EQ(chart.hasOther(), GetParam().otherIs != 0);
  EXPECT_EQ(said(), "");
}

INSTANTIATE_TEST_SUITE_P(Types, OtherTest,
                         ::testing::Values(OtherCase{0, 0}, OtherCase{1, -70}, OtherCase{2, 3.5F},
                                           OtherCase{3, -70}, OtherCase{4, -10}, OtherCase{5, -68},
                                           OtherCase{6, -8}, OtherCase{7, 1.25F}, OtherCase{8, 2},
                                           OtherCase{9, 3.5F}, OtherCase{10, -8}, OtherCase{11, 3.5F},
                                           OtherCase{12, 3.5F}));

TEST_F(BarDataTest, QuantitiesThatAnItemLacksKeepTheirDefaults) {
  chart.otherIs(8);  // only of items of six
  update({12, -10, 3.5F, -8, 1.25F}, 1, 5);
  EXPECT_EQ(others(), "0");
  chart.otherIs(2);
  chart.kindFlag(1);
  chart.extraValueMode(2);
  chart.defaultExtraValue("none");
  update({12, -10, 13, -11}, 2, 2);  // element 2 would be the next item's key
  EXPECT_EQ(others(), "0 0");
  EXPECT_EQ(chart.bars()[0].auxiliary, -1.0F);
  EXPECT_EQ(chart.bars()[0].extra, Variant("none"));
  update({12, -10, 3.5F}, 1, 3);
  EXPECT_EQ(chart.bars()[0].extra, Variant(3.5F));
  EXPECT_EQ(said(), "");
}

TEST_F(BarDataTest, AnUnknownOtherIsReportedAndTheItemsAreStillBars) {
  chart.otherIs(13);
  update({12, -10, 13, -11}, 2, 2);
  EXPECT_EQ(said(), "clsBarChartPainter::processData()  unknown type for otherSingle()\r");
  EXPECT_EQ(keys(), "12 13");
  EXPECT_EQ(others(), "0 0");
}

TEST_F(BarDataTest, OfManyItemsTheFirstFortyAreBars) {
  for (const std::int32_t items : {0, 1, 40, 41, 10000}) {
    Variant::Singles values;
    for (std::int32_t i = 0; i < items; ++i) values.insert(values.end(), {static_cast<float>(i), -1.0F});
    update(values, items, 2);
    ASSERT_EQ(chart.barArraySize(), std::min(items, 40)) << items;
    ASSERT_TRUE(items < 40 || chart.barOffset(40) == 39.0F);
  }
  chart.maxPNs(50);
  update(Items(50, {7, 1}));
  EXPECT_EQ(chart.barArraySize(), 50);
  EXPECT_EQ(said(), "");
}

TEST_F(BarDataTest, ABlockThatCannotBeReadIsReportedOnceAndTheBarsStay) {
  update({{5, -1}, {9, -2}});
  const std::array<std::pair<Variant, const char*>, 3> blocks{
      {{Variant::Singles{5, -3, 9}, "Subscript out of range"},
       {Variant::Variants{Variant(1), Variant(2), Variant(3), Variant::null()}, "Invalid use of Null"},
       {Variant::Doubles{5, -3, 9, 1e300}, "Overflow"}}};
  for (const auto& [block, why] : blocks) {
    chart.trace(block);
    chart.processData();
    chart.processData();
    EXPECT_EQ(said(), std::string("clsBarChartPainter::processData()...\r") + why);
    EXPECT_EQ(values(), "-1 -2");
  }
  chart.trace(Variant("text"));
  EXPECT_EQ(said(), "clsBarChartPainter::trace()...\rType mismatch");
  for (const Variant& block :
       {Variant(Variant::Variants{Variant("5"), Variant(-3), Variant(9), Variant(-4), Variant(8)}),
        Variant(Variant::Doubles{5, -3, 9, -4})}) {  // what is too much is ignored
    chart.trace(block);
    chart.processData();
    EXPECT_EQ(values(), "-3 -4");
  }
  EXPECT_EQ(said(), "");
}

TEST_F(BarDataTest, NothingIsAnUpdateWithoutData) {
  chart.dataChanged(true);
  chart.processData();  // nothing has ever come
  update({{5, -1}});
  chart.trace(Variant::null());
  chart.processData();
  EXPECT_EQ(keys(), "5");
  chart.addATrace(0, 5, 0, 0);
  update({});  // ignored while it holds a trace
  EXPECT_EQ(keys(), "5");
  clsBarChartPainter empty(gdi);
  empty.trace(Variant(Variant::Singles{}));
  empty.processData();
  EXPECT_EQ(empty.barArraySize(), 0);
  EXPECT_EQ(said(), "");
}

TEST_F(BarDataTest, BarsThatGoAskForAFullRedraw) {
  update({{5, -1}, {9, -2}});
  EXPECT_FALSE(chart.fullRedraw());
  update({{5, -1}});
  EXPECT_TRUE(chart.fullRedraw());
  chart.Paint(dc);
  EXPECT_FALSE(chart.fullRedraw());
  update({});
  EXPECT_EQ(chart.barArraySize(), 0);
  EXPECT_TRUE(chart.fullRedraw());
}

TEST_F(BarDataTest, IdentitiesFollowTheKeysThroughADozenUpdates) {
  const std::vector<std::pair<Items, const char*>> updates = {
      {{{5, 0}, {9, 0}, {17, 0}}, "5:1 9:2 17:3"},
      {{{17, 0}, {5, 0}, {9, 0}}, "17:3 5:1 9:2"},    // another order
      {{{17, 0}, {30, 0}, {9, 0}}, "17:3 30:1 9:2"},  // 30 takes over from 5
      {{{17, 0}, {5, 0}, {9, 0}, {30, 0}}, "17:3 5:4 9:2 30:1"},
      {{{9, 0}, {5, 0}}, "9:2 5:4"},                // 3 and 1 are free, nobody takes them
      {{{9, 0}, {5, 0}, {17, 0}}, "9:2 5:4 17:5"},  // and they are gone
      {{{1, 0}, {2, 0}, {5, 0}}, "1:5 2:2 5:4"},    // the first freed goes to the last without one
      {{{2, 0}, {2, 0}, {5, 0}}, "2:2 2:5 5:4"},    // a key twice: one keeps its own
      {{{5, 0}, {2, 0}, {2, 0}}, "5:4 2:2 2:5"},    // first come, first served
      {{{2, 0}, {2, 0}, {2, 0}}, "2:2 2:5 2:4"},
      {{{kNoNumber, 0}, {2, 0}}, "1.#QNAN:5 2:2"},  // 5 and 4 are free: the first is taken
      {{}, ""},
      {{{2, 0}, {-0.0F, 0}}, "2:6 0:7"},
  };
  for (const auto& [items, expected] : updates) {
    update(items);
    EXPECT_EQ(keysAndIds(), expected);
  }
}

TEST_F(BarDataTest, IdentitiesBeginAgainWhenTheyAreUsedUp) {
  chart.maxPNs(32766);
  update(Items(32766, {1, 0}));
  update({{1, 0}});  // keeps 1
  update({{1, 0}, {2, 0}, {3, 0}});
  EXPECT_EQ(keysAndIds(), "1:1 2:32767 3:2");
  EXPECT_EQ(said(), "");
}

TEST_F(BarDataTest, SettingsAfterTheDataFillTheBarsAnewWithoutAnUpdate) {
  chart.barSortByMode(3);
  update({5, -1, 3, 9, -2, 2}, 2, 3);
  update({9, -2, 2, 7, -9, 2, 5, -1, 3}, 3, 3);  // 7 is new
  EXPECT_EQ(keysAndIds(), "5:1 9:2 7:3");
  chart.offset(-10.0);
  chart.useOffset(true);
  chart.otherIs(2);
  EXPECT_EQ(values(), "-1 -2 -9");
  chart.Paint(dc);
  chart.Paint(dc);
  EXPECT_EQ(values(), "-11 -12 -19");
  EXPECT_EQ(others(), "3 2 2");
  EXPECT_EQ(keysAndIds(), "5:1 9:2 7:3");
  update({9, -2, 2, 7, 0, 2}, 2, 3);  // history has counted updates only
  EXPECT_EQ(keys(), "9 7");
  chart.elementsPerValue(4);
  chart.Paint(dc);
  chart.Paint(dc);
  EXPECT_EQ(said(), "clsBarChartPainter::processData()...\rSubscript out of range");
  EXPECT_EQ(values(), "-12 -10");
  chart.trace(Variant(Variant::Singles{1, 2}));  // bars do not mix with a block that is still to come
  chart.elementsPerValue(2);
  chart.Paint(dc);
  EXPECT_EQ(keys(), "9 7");
  EXPECT_EQ(said(), "");
}

TEST_F(BarDataTest, SettingsOutOfTheirRangeAreRefused) {
  chart.elementsPerValue(1);
  chart.offset("far");
  chart.barSortByMode(5);
  EXPECT_EQ(said(),
            "clsBarChartPainter::elementsPerValue()...\rInvalid procedure call or argument\n"
            "clsBarChartPainter::offset()...\rType mismatch\n"
            "clsBarChartPainter::barSortByMode()...\rInvalid procedure call or argument");
  chart.numberOfMeasurements(-1);
  chart.maxPNs(0);
  chart.BarChartStyle(2);
  chart.setFillStyle(8);
  chart.setBarLabeling(3);
  chart.suffixIs(-1);
  chart.setIncrement(-0.5);
  chart.numberOfSets(-1);
  EXPECT_EQ(messages().size(), 8U);
  const std::vector<std::int16_t> barsToPaint{0, -5, 100, -1, 41, 40, 1};
  std::string stored;
  for (const std::int16_t count : barsToPaint) {
    chart.setBarsToPaint(count);
    stored += std::to_string(chart.getBarsToPaint()) + " ";
  }
  EXPECT_EQ(stored, "1 1 40 -1 40 40 1 ");
}

TEST_F(BarDataTest, BarsAreFoundByIdentityAndReadByPosition) {
  chart.otherIs(4);
  chart.barSortByMode(1);
  update({{5, -3}, {9, -2}});
  EXPECT_EQ(chart.findBar(1), 2);
  EXPECT_EQ(chart.barOffset(1), 9);
  EXPECT_EQ(chart.barOther(2), -3);
  EXPECT_EQ(said(), "");
  EXPECT_EQ(chart.findBar(3), 0);
  EXPECT_EQ(chart.barValue(0), 0);
  EXPECT_EQ(chart.barValue(3), 0);
  EXPECT_EQ(said(),
            "clsBarChartPainter::findBar()...\rSubscript out of range\n"
            "clsBarChartPainter::barValue()...\rSubscript out of range\n"
            "clsBarChartPainter::barValue()...\rSubscript out of range");
}

TEST_F(BarDataTest, MarkersAreKeptAndNothingElse) {
  clsMarker marker;
  marker.point = 7;
  chart.findNearestPoint(1, 2, marker);
  EXPECT_EQ(marker.point, 7);
  EXPECT_EQ(chart.numberOfTraces(), 0);
  EXPECT_TRUE(chart.traceMarkerCollections(0).empty());
  EXPECT_THROW((void)chart.traceMarkerCollections(1), RuntimeError);
  EXPECT_EQ(chart.addATrace(0, 106, 0, 0), 0);
  EXPECT_EQ(chart.addATrace(0, 25, 0, 0), 1);
  EXPECT_EQ(chart.addATrace(0, 106, 0, 0), 0);
  EXPECT_EQ(chart.findATraceByPN(25), 1);
  EXPECT_EQ(chart.pnOffset(1), 25);
  EXPECT_EQ(said(), "");
}

// --- Order

TEST_F(BarDataTest, SortsKeepTheOrderOfEqualBars) {
  const Items items{{5, -3}, {9, -1}, {2, -3}, {7, kNoNumber}, {1, -2}, {9, -3}};
  struct Sorted {
    std::int16_t mode;
    std::int16_t order;
    const char* keys;
  };
  const std::vector<Sorted> cases = {
      {0, 0, "5 9 2 7 1 9"}, {0, 1, "5 9 2 7 1 9"},
      {1, 0, "9 5 2 7 1 9"},  // 7 has no value: nothing moves across it
      {1, 1, "5 2 9 7 9 1"}, {2, 0, "9 9 7 5 2 1"},
      {2, 1, "1 2 5 7 9 9"}, {2, 7, "9 9 7 5 2 1"},  // anything but 1 descends
  };
  for (const Sorted& sorted : cases) {
    chart.barSortByMode(0);
    chart.barSortOrder(sorted.order);
    update(items);
    chart.barSortByMode(sorted.mode);
    EXPECT_EQ(keys(), sorted.keys) << sorted.mode << " " << sorted.order;
    EXPECT_EQ(chart.sortFlag(), sorted.mode != 0);
  }
  chart.barSortByMode(4);  // nobody has another quantity: as they were
  EXPECT_EQ(keys(), "9 9 7 5 2 1");
  chart.barSortByMode(0);
  EXPECT_EQ(keys(), "5 9 2 7 1 9");  // as they came
}

TEST_F(BarDataTest, ByTheOtherQuantityAndBackWhenTheOrderTurns) {
  chart.otherIs(2);
  chart.barSortByMode(4);
  update({5, -1, 3, 9, -2, 7, 2, -3, 3}, 3, 3);
  EXPECT_EQ(keys(), "9 5 2");
  chart.barSortOrder(1);
  EXPECT_EQ(keys(), "5 2 9");
}

TEST_F(BarDataTest, HistoryPutsWhatHasBeenThereLongestFirst) {
  chart.barSortByMode(3);
  update({{5, -9}, {9, -8}});
  update({{5, -9}, {9, -8}, {2, -1}});
  EXPECT_EQ(keys(), "9 5 2");  // two updates each, the stronger first; then the new one
  for (int paint = 0; paint < 5; ++paint) chart.processData();
  update({{2, -1}, {5, -9}, {7, 0}, {8, kNoNumber}});  // 9 pauses
  update({{2, -1}, {9, 0}, {5, -9}, {7, -5}});
  EXPECT_EQ(keys(), "5 2 7 9");  // 4, 3, 2 and 1
  chart.barSortOrder(1);
  EXPECT_EQ(keys(), "9 7 2 5");
}

TEST_F(BarDataTest, SetsComeInTheirOrderAndInsideThemBarsStaySorted) {
  chart.barSortByMode(1);
  chart.sortBySetOrder(true);
  chart.setOrderList({{2, 5}, {7}, {5, 9}});  // 5 belongs to the first
  EXPECT_EQ(chart.numberOfSets(), 3);
  update({{1, 0}, {9, -1}, {7, -2}, {5, -3}, {2, -4}});
  EXPECT_EQ(keys(), "5 2 7 9 1");
  chart.numberOfSets(1);
  EXPECT_EQ(keys(), "5 2 1 9 7");
  chart.numberOfSets(4);
  EXPECT_EQ(said(), "clsBarChartPainter::SortBarsBySet()... \rSubscript out of range");
  EXPECT_EQ(keys(), "1 9 7 5 2");
}

}  // namespace
}  // namespace frontpanels
