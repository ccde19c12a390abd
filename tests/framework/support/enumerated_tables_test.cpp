#include "framework/support/enumerated_tables.h"

#include <gtest/gtest.h>

namespace frontpanels {
namespace {

TEST(EnumeratedTablesTest, LabelsAValueOrWritesItInDecimal) {
  struct LabelCase {
    std::int32_t parameterType;
    std::int16_t value;
    const char* label;
  };
  const LabelCase cases[] =
      {
          {310, 14, "All Pilots"},  {310, 18, "Zoomed Pilots"}, {310, 25, "Spectrum"},
          {310, 200, "User List"},  {310, 201, "Top N"},        {310, 701, "701"},  // a type without a name
          {310, -1, "-1"},          {500, 32, "Off"},           {731, 5, "Ag. Ec (dBm)"},
          {17, 1, "Narrowband"},    {3900, 1, "Log Power"},     {231, 2, "CDMA2000 3X"},
          {9999, -32768, "-32768"},  // a type that nobody knows
      };
  for (const LabelCase& c : cases) EXPECT_EQ(enumeratedLabel(c.parameterType, c.value), c.label);
  EXPECT_EQ(enumeratedValues(17).size(), 2U);
  EXPECT_EQ(enumeratedValues(3900).size(), 2U);
  EXPECT_TRUE(enumeratedValues(9999).empty());
}

TEST(EnumeratedTablesTest, AHostAddsRelabelsAndReplacesValuesInTheirOrder) {
  using Values = std::vector<EnumeratedValue>;
  const auto valuesOf = [](const EnumeratedTables& tables, std::int32_t type) {
    return Values(tables.values(type).begin(), tables.values(type).end());
  };
  EnumeratedTables tables;
  tables.add(9999, {7, "Seven"});
  tables.add(9999, {-2, "Minus two"});
  tables.add(9999, {7, "Sieben"});
  EXPECT_EQ(valuesOf(tables, 9999), (Values{{7, "Sieben"}, {-2, "Minus two"}}));

  tables.replace(17, Values{{3, "Wide"}, {1, "Narrow"}, {3, "Wider"}});
  EXPECT_EQ(valuesOf(tables, 17), (Values{{3, "Wider"}, {1, "Narrow"}}));
  EXPECT_EQ(tables.label(17, 0), "0");
  EXPECT_EQ(tables.label(3900, 0), "Power");  // other types stay

  tables.replace(17, {});
  EXPECT_TRUE(tables.values(17).empty());
}

}  // namespace
}  // namespace frontpanels
