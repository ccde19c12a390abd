#include "pilot/cell_name_info.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <limits>
#include <random>

#include "tests/support/reporting_fixture.h"

namespace frontpanels {
namespace {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

class CellNameInfoTest : public testing::ReportingTest {
 protected:
  clsCellNameInfo names;
};

TEST_F(CellNameInfoTest, FindsTheFirstWithBothIdentifiersOrWithOneAlone) {
  EXPECT_EQ(names.GetCellName(0, -1), "Unknown");
  names.SetCellName(5, 7, "Town Hall");
  names.SetCellName(5, 7, "Station");
  names.SetCellName(5, 8, "Harbour");
  names.SetCellName(-0.0, 0.0, "Zero");
  names.SetCellName(kNaN, 1, "None");
  names.SetCellName(6, kNaN, "One only");
  names.SetCellName(9, -1, "Negative");
  const struct {
    double id1;
    double id2;
    std::string_view name;
  } cases[] = {
      {5, -1, "Town Hall"},  {5, 0, "Unknown"},    {5, 7, "Town Hall"}, {5, 8, "Harbour"},
      {5, -0.0, "Unknown"},  {0.0, -0.0, "Zero"},  {-0.0, -2, "Zero"},  {kNaN, 1, "Unknown"},
      {kNaN, -1, "Unknown"}, {6, kNaN, "Unknown"}, {6, -1, "One only"}, {5.0000000001, -1, "Unknown"},
      {9, -1, "Negative"},
  };
  for (const auto& [id1, id2, name] : cases)
    EXPECT_EQ(names.GetCellName(id1, id2), name) << id1 << ' ' << id2;
  names.Initialize();
  EXPECT_EQ(names.GetCellName(5, 7), "Unknown");
  names.SetCellName(6, 7, "Market");
  EXPECT_EQ(names.GetCellName(5, -1), "Unknown");
  EXPECT_EQ(names.GetCellName(6, -1), "Market");
}

TEST_F(CellNameInfoTest, KnowsTheLongestNameInCharacters) {
  names.SetCellName(1, 1, "Gr\xC3\xBC\xC3\x9F");  // four letters
  EXPECT_EQ(names.maxCellNameLength(), 4);
  names.SetCellName(2, 1, "\xF0\x9F\x93\xA1");  // one that hosts count as two
  EXPECT_EQ(names.maxCellNameLength(), 4);
  names.maxCellNameLength(-1);
  names.SetCellName(3, 1, "\xF0\x9F\x93\xA1");
  EXPECT_EQ(names.maxCellNameLength(), 2);
  names.SetCellName(4, 1, std::string(32767, 'x'));
  EXPECT_EQ(names.maxCellNameLength(), 32767);
  names.Initialize();
  EXPECT_EQ(names.maxCellNameLength(), 0);
}

TEST_F(CellNameInfoTest, RefusesWhatItsCountsCannotHold) {
  names.SetCellName(1, 1, std::string(32768, 'x'));
  EXPECT_EQ(said(), "clsCellNameInfo::SetCellName()\rOverflow");
  EXPECT_EQ(names.GetCellName(1, 1), "Unknown");
  EXPECT_EQ(names.maxCellNameLength(), 0);
  for (int i = 0; i < 32767; ++i) names.SetCellName(i, 1, "x");
  EXPECT_EQ(said(), "");
  names.SetCellName(40000, 1, "too many");
  EXPECT_EQ(said(), "clsCellNameInfo::SetCellName()\rOverflow");
  EXPECT_EQ(names.GetCellName(40000, 1), "Unknown");
  EXPECT_EQ(names.GetCellName(32766, 1), "x");
  EXPECT_EQ(names.maxCellNameLength(), 1);
}

TEST_F(CellNameInfoTest, AnswersWhatASearchFromTheFrontWould) {
  struct Entry {
    double id1;
    double id2;
    std::string name;
  };
  constexpr double kIds[] = {0.0, -0.0, 1, 2, -3, 0.5, 1e300, kNaN, std::numeric_limits<double>::infinity()};
  std::mt19937 random(7);
  const auto anyId = [&] {
    return random() % 2 == 0 ? kIds[random() % 9] : static_cast<double>(random() % 99);
  };
  std::vector<Entry> entries;
  for (int round = 0; round < 20000; ++round) {
    const double id1 = anyId();
    const double id2 = random() % 4 == 0 ? -1 : anyId();
    const auto found = std::find_if(entries.begin(), entries.end(), [&](const Entry& entry) {
      return entry.id1 == id1 && (id2 < 0 || entry.id2 == id2);
    });
    ASSERT_EQ(names.GetCellName(id1, id2), found == entries.end() ? "Unknown" : found->name)
        << id1 << ' ' << id2;
    if (random() % 3 == 0) entries.push_back({id1, id2, std::to_string(round)});
    if (!entries.empty() && entries.back().name == std::to_string(round))
      names.SetCellName(id1, id2, entries.back().name);
    if (random() % 2000 == 0) entries.clear(), names.Initialize();
  }
}

}  // namespace
}  // namespace frontpanels
