#include "framework/support/enumerated_tables.h"

#include <gtest/gtest.h>

namespace frontpanels {
namespace {

TEST(EnumeratedTablesTest, LabelsAValueOrWritesItInDecimal) {
  const std::pair<std::string, const char*> cases[] = {
      {enumeratedLabel(310, 14), "All Pilots"},  {enumeratedLabel(310, 18), "Zoomed Pilots"},
      {enumeratedLabel(310, 25), "Spectrum"},    {enumeratedLabel(310, 200), "User List"},
      {enumeratedLabel(310, 201), "Top N"},      {enumeratedLabel(310, 701), "701"},  // has no name
      {enumeratedLabel(500, 32), "Off"},         {enumeratedLabel(731, 5), "Ag. Ec (dBm)"},
      {enumeratedLabel(17, 1), "Narrowband"},    {enumeratedLabel(3900, 1), "Log Power"},
      {enumeratedLabel(9999, -32768), "-32768"},
  };
  for (const auto& [label, wanted] : cases) EXPECT_EQ(label, wanted);
  EXPECT_EQ(enumeratedValues(17).size() + enumeratedValues(3900).size() + enumeratedValues(9999).size(), 4U);
}

TEST(EnumeratedTablesTest, AHostAddsRelabelsAndReplacesValuesInTheirOrder) {
  EnumeratedTables tables;
  tables.add(17, {7, "Seven"});
  tables.add(17, {0, "Wide"});
  tables.replace(500, std::vector<EnumeratedValue>{{3, "a"}, {1, "b"}, {3, "c"}});
  std::string all;
  for (const std::int32_t type : {17, 500})
    for (const EnumeratedValue& row : tables.values(type)) all += std::to_string(row.value) + row.label + " ";
  EXPECT_EQ(all, "0Wide 1Narrowband 7Seven 3c 1b ");
  tables.replace(17, {});
  EXPECT_EQ(tables.label(17, 7), "7");
}

}  // namespace
}  // namespace frontpanels
