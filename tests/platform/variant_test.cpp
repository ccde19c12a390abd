#include "platform/variant.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <optional>

#include "tests/support/raised.h"

namespace frontpanels {
namespace {

using testing::raised;
constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kNan = std::numeric_limits<double>::quiet_NaN();

std::optional<double> numberOf(std::string_view text) {
  double number = -12345;
  if (textToNumber(text, number)) return number;
  EXPECT_EQ(number, -12345) << "changed by " << text;
  return std::nullopt;
}

TEST(TextToNumber, ReadsDigitsSignPointAndExponentWithBlanksAround) {
  const struct {
    const char* text;
    double number;
  } rows[] = {{"0", 0},           {"12", 12},        {"+12", 12},  {"-12", -12},  {" 7 ", 7},
              {"\t7\r\n", 7},     {"5.", 5},         {".5", 0.5},  {"-.5", -0.5}, {"1e3", 1000},
              {"1E+3", 1000},     {"007", 7},        {"0.1", 0.1}, {"1e-400", 0}, {"1e308", 1e308},
              {"5e-324", 5e-324}, {"2.5e-3", 0.0025}};
  for (const auto& row : rows) EXPECT_EQ(numberOf(row.text), row.number) << row.text;
}

TEST(TextToNumber, RefusesEverythingElse) {
  for (const char* text :
       {"",    " ",   ".",   "-",        "+",    "e5",  "1e", "1e+",   "1e1.5", "- 5",   "--5", "1 2",
        "1,5", "inf", "nan", "infinity", "0x10", "12a", "3d", "1.2.3", "$5",    "1e309", "١"})
    EXPECT_EQ(numberOf(text), std::nullopt) << text;
}

TEST(TextToNumber, WeighsDigitsAgainstTheExponentWhereNoDoubleHoldsTheNumber) {
  for (const char* zero : {"0.0e99999", "0e-99999999999", "1e-99999999999999999999"})
    EXPECT_EQ(numberOf(zero), 0) << zero;
  EXPECT_EQ(numberOf("0.00001e310"), 1e305);
  EXPECT_EQ(numberOf("0." + std::string(400, '0') + "1e50"), 0);
  EXPECT_EQ(numberOf(std::string(400, '9') + "e-50"), std::nullopt);
  EXPECT_EQ(numberOf("1e99999999999999999999"), std::nullopt);
}

// Each number as text, a blank behind it.
template <class... Numbers>
std::string texts(Numbers... numbers) {
  return ((numberToText(numbers) + " ") + ...);
}

TEST(NumberToText, WritesTheGeneralFormOfFifteenDigits) {
  EXPECT_EQ(texts(0.0, -0.0, -3.0, 0.1, 0.1 + 0.2, 100.0), "0 0 -3 0.1 0.3 100 ");
  EXPECT_EQ(texts(1.0 / 3, 2.0 / 3, 1.0 / 3e5), "0.333333333333333 0.666666666666667 3.33333333333333E-06 ");
  EXPECT_EQ(texts(999999999999999.0, 1e15, 1e20, -1.25e100), "999999999999999 1E+15 1E+20 -1.25E+100 ");
  EXPECT_EQ(texts(9999999999999995.0), "1E+16 ");  // the sixteenth digit rounds all the way up
  EXPECT_EQ(texts(0.00001, 1e-15, 1e-16), "0.00001 0.000000000000001 1E-16 ");
  EXPECT_EQ(texts(1.5e-15), "1.5E-15 ");  // would need sixteen places
  EXPECT_EQ(texts(kInfinity, -kInfinity, kNan), "1.#INF -1.#INF 1.#QNAN ");
}

TEST(NumberToText, WritesSinglesInTheGeneralFormOfSevenDigits) {
  EXPECT_EQ(texts(0.1F, 1.0F / 3, -82.5F, 1234567.0F), "0.1 0.3333333 -82.5 1234567 ");
  EXPECT_EQ(texts(12345678.0F, 1e10F, 1e-7F, 1e-8F), "1.234568E+07 1E+10 0.0000001 1E-08 ");
}

TEST(VariantConversion, RoundsHalvesToTheEvenNeighbourAndOverflowsOutsideTheWidth) {
  EXPECT_EQ(Variant(0.5).toInt16(), 0);
  EXPECT_EQ(Variant(1.5).toInt16(), 2);
  EXPECT_EQ(Variant(-2.5).toInt32(), -2);
  EXPECT_EQ(Variant(" 2.5 ").toInt32(), 2);
  EXPECT_EQ(Variant(32767.4).toInt16(), 32767);
  EXPECT_EQ(Variant(-32768.5).toInt16(), -32768);
  EXPECT_EQ(Variant(2147483647.4).toInt32(), 2147483647);
  for (const Variant& value : {Variant(32767.5), Variant(-32768.6), Variant("40000"), Variant(kNan)})
    EXPECT_EQ(raised([&] { return value.toInt16(); }), "Overflow");
  for (const Variant& value : {Variant(2147483647.5), Variant(std::int64_t{1} << 40), Variant(kInfinity)})
    EXPECT_EQ(raised([&] { return value.toInt32(); }), "Overflow");
}

TEST(VariantConversion, ToSingleOverflowsForFiniteNumbersOnly) {
  EXPECT_EQ(Variant(0.1).toSingle(), 0.1F);
  EXPECT_EQ(Variant(3.4028235e38).toSingle(), std::numeric_limits<float>::max());
  EXPECT_EQ(raised([] { return Variant(3.41e38).toSingle(); }), "Overflow");
  EXPECT_EQ(Variant(-kInfinity).toSingle(), -std::numeric_limits<float>::infinity());
  EXPECT_TRUE(std::isnan(Variant(kNan).toSingle()));
}

TEST(VariantConversion, EachKindReadsAsNumberTextAndBooleanOrSaysWhyNot) {
  const Variant object = ObjectReference(std::make_shared<int>(1));
  const struct {
    Variant value;
    const char* typeName;
    bool numeric;
    const char* number;  // the number as text, or the error
    const char* text;
    const char* boolean;
  } rows[] = {
      {Variant(), "Empty", true, "0", "", "False"},
      {Variant::null(), "Null", false, "Invalid use of Null", "Invalid use of Null", "Invalid use of Null"},
      {true, "Boolean", true, "-1", "True", "True"},
      {std::uint8_t{200}, "Byte", true, "200", "200", "True"},
      {std::int16_t{-5}, "Integer", true, "-5", "-5", "True"},
      {std::int32_t{0}, "Long", true, "0", "0", "False"},
      {std::int64_t{9007199254740993}, "LongLong", true, "9.00719925474099E+15", "9007199254740993", "True"},
      {2.5F, "Single", true, "2.5", "2.5", "True"},
      {0.25, "Double", true, "0.25", "0.25", "True"},
      {DateValue{0.5}, "Date", false, "0.5", "1899-12-30 12:00:00", "True"},
      {ErrorValue{5}, "Error", false, "Type mismatch", "Type mismatch", "Type mismatch"},
      {"1e2", "String", true, "100", "1e2", "True"},
      {"no", "String", false, "Type mismatch", "no", "Type mismatch"},
      {" tRUE ", "String", false, "Type mismatch", " tRUE ", "True"},
      {"False", "String", false, "Type mismatch", "False", "False"},
      {object, "Object", false, "Type mismatch", "Type mismatch", "Type mismatch"},
      {ObjectReference(), "Nothing", false, "Type mismatch", "Type mismatch", "Type mismatch"},
      {Variant::Singles{1, 2}, "Single()", false, "Type mismatch", "Type mismatch", "Type mismatch"}};
  // What a conversion to text answers or raises.
  const auto outcome = [](auto convert) {
    std::string text;
    const std::string error = raised([&] { text = convert(); });
    return error.empty() ? text : error;
  };
  for (const auto& row : rows) {
    EXPECT_EQ(row.value.typeName(), row.typeName);
    EXPECT_EQ(row.value.isNumeric(), row.numeric) << row.typeName;
    EXPECT_EQ(outcome([&] { return numberToText(row.value.toDouble()); }), row.number) << row.typeName;
    EXPECT_EQ(outcome([&] { return row.value.toText(); }), row.text) << row.typeName;
    EXPECT_EQ(outcome([&] { return std::string(row.value.toBoolean() ? "True" : "False"); }), row.boolean)
        << row.typeName;
  }
}

TEST(VariantConversion, DatesCountTheirTimeForwardFromMidnightOnBothSidesOfTheFirstDay) {
  EXPECT_EQ(Variant(DateValue{45413}).toText(), "2024-05-01");
  EXPECT_EQ(Variant(DateValue{45413.5625}).toText(), "2024-05-01 13:30:00");
  EXPECT_EQ(Variant(DateValue{-1.25}).toText(), "1899-12-29 06:00:00");
  EXPECT_EQ(Variant(DateValue{45413.9999999}).toText(), "2024-05-02");  // within half a second of midnight
  EXPECT_EQ(raised([] { return Variant(DateValue{1e7}).toText(); }), "Overflow");
}

TEST(VariantArray, AnswersItsElementsAsVariants) {
  const Variant mixed = Variant::Variants{Variant("a"), Variant::Int16s{1, 2}, Variant()};
  EXPECT_TRUE(mixed.isArray());
  EXPECT_EQ(mixed.typeName(), "Variant()");
  EXPECT_EQ(mixed.elementCount(), 3U);
  EXPECT_EQ(mixed.element(0), Variant("a"));
  EXPECT_EQ(mixed.element(1).element(1), Variant(std::int16_t{2}));
  EXPECT_EQ(Variant(Variant::Bytes{9}).element(0).typeName(), "Byte");
  EXPECT_EQ(raised([&] { return mixed.element(3); }), "Subscript out of range");
  EXPECT_EQ(raised([] { return Variant(5.0).element(0); }), "Type mismatch");
  EXPECT_EQ(raised([] { return Variant("abc").elementCount(); }), "Type mismatch");
}

}  // namespace
}  // namespace frontpanels
