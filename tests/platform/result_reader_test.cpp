#include "platform/result_reader.h"

#include <gtest/gtest.h>

#include <array>
#include <cmath>
#include <functional>
#include <limits>

#include "platform/result_writer.h"
#include "tests/support/raised.h"

namespace frontpanels {
namespace {

using testing::raised;
using Bytes = std::vector<std::uint8_t>;
using R = ResultReader;
using W = ResultWriter;

constexpr std::int32_t kLargest = std::numeric_limits<std::int32_t>::max();
constexpr std::int32_t kSmallest = std::numeric_limits<std::int32_t>::min();
constexpr const char* kOutOfRange = "Subscript out of range";
constexpr const char* kInvalidCall = "Invalid procedure call or argument";

using Cursor = std::pair<std::int32_t, std::int32_t>;  // next byte, bytes left

// A field as it stands in the buffer, what is read from it, and the call that writes it, if only one does.
struct Field {
  Bytes bytes;
  Variant value;
  std::function<Variant(R&)> read;
  std::function<void(W&)> write = nullptr;
};

// The values that a span of three takes, and what stood in it behind them.
template <class T>
Variant intoThree(R& reader, std::size_t (R::*read)(std::span<T>)) {
  std::array<T, 3> values{T{9}, T{9}, T{9}};
  const std::size_t count = (reader.*read)(values);
  EXPECT_EQ(values.back(), T{9});
  return std::vector<T>(values.begin(), values.begin() + static_cast<std::ptrdiff_t>(count));
}

Field coded(const Bytes& bytes, const Variant& array) {
  return {bytes, array, &R::GetMeasurementArray, [array](W& w) { w.Array(array); }};
}

const auto kSingles = std::to_array({-80.0F, 0.5F});
const Bytes kSingleBytes{2, 0, 0, 0, 0xA0, 0xC2, 0, 0, 0, 0x3F};
const Bytes kDoubleBytes{1, 0, 0, 0, 0, 0, 0, 0, 0x54, 0xC0};
const Variant kSinglesRead = Variant::Singles{-80, 0.5F};
const Variant kDoublesRead = Variant::Doubles{-80};
const auto kInt8 = [](R& r) { return std::int32_t{r.GetMeasurementInt8()}; };
const auto kSkipThree = [](R& r) { return r.SkipMeasurementData(3), Variant("skipped"); };
const auto kNewSingles = [](R& r) { return Variant(r.GetFloat32Array()); };
const auto kNewDoubles = [](R& r) { return Variant(r.GetFloat64Array()); };
const auto kIntoSingles = [](R& r) { return intoThree<float>(r, &R::GetFloat32Array); };
const auto kIntoDoubles = [](R& r) { return intoThree<double>(r, &R::GetFloat64Array); };
const Field kFields[] = {
    {{4, 3, 2, 0x81}, -2130574588, &R::GetMeasurementTypeId},
    {{4, 3, 2, 0x81}, -2130574588, &R::GetMeasurementInt32, [](W& w) { w.Int32(-2130574588); }},
    {{2, 0x81}, std::int16_t{-32510}, &R::GetMeasurementInt16, [](W& w) { w.Int16(-32510); }},
    {{0x81}, -127, kInt8, [](W& w) { w.Int8(-127); }},
    {{0x81}, std::uint8_t{129}, &R::GetMeasurementUInt8, [](W& w) { w.UInt8(129); }},
    {{0, 0, 0xA0, 0xC2}, -80.0F, &R::GetMeasurementFloat32, [](W& w) { w.Float32(-80); }},
    {{0, 0, 0, 0, 0, 0, 0x54, 0xC0}, -80.0, &R::GetMeasurementFloat64, [](W& w) { w.Float64(-80); }},
    {{3, 0, 'd', 0xC2, 0xB5}, "dµ", &R::GetMeasurementString, [](W& w) { w.Text("dµ"); }},
    {{7, 7, 7}, "skipped", kSkipThree},
    {kSingleBytes, kSinglesRead, kNewSingles, [](W& w) { w.Float32Array(kSingles); }},
    {kSingleBytes, kSinglesRead, kIntoSingles},
    {kDoubleBytes, kDoublesRead, kNewDoubles, [](W& w) { w.Float64Array(std::array{-80.0}); }},
    {kDoubleBytes, kDoublesRead, kIntoDoubles},
    coded({2, 2, 0, 1, 0, 0xFF, 0xFF}, Variant::Int16s{1, -1}),
    coded({3, 1, 0, 4, 3, 2, 1}, Variant::Int32s{0x01020304}),
    coded({4, 1, 0, 0, 0, 0xA0, 0xC2}, Variant::Singles{-80}),
    coded({5, 1, 0, 0, 0, 0, 0, 0, 0, 0x54, 0xC0}, Variant::Doubles{-80}),
    coded({17, 2, 0, 1, 255}, Variant::Bytes{1, 255}),
};

TEST(ResultReader, ReadsAFieldUpToTheLastByteAndNoneThatIsCutShortByCountOrBuffer) {
  for (const Field& field : kFields) {
    SCOPED_TRACE(&field - kFields);
    const auto size = static_cast<std::int32_t>(field.bytes.size());
    Bytes buffer{0xEE};
    buffer.insert(buffer.end(), field.bytes.begin(), field.bytes.end());
    Cursor cursor{1, size};
    R whole(buffer, cursor.first, cursor.second);
    EXPECT_EQ(field.read(whole), field.value);
    EXPECT_EQ(cursor, Cursor(1 + size, 0));
    for (std::int32_t left = size - 1; left >= 0; --left) {
      cursor = {1, left};
      EXPECT_EQ(raised([&] { field.read(whole); }), kOutOfRange) << left;  // the count ends
      const Bytes given(buffer.begin(), buffer.begin() + 1 + left);        // the sanitizer watches its end
      R reader(given, cursor.first, cursor.second);
      EXPECT_EQ(raised([&] { field.read(reader); }), kOutOfRange) << left;  // and so does the buffer
      EXPECT_EQ(cursor, Cursor(1, left));
    }
  }
}

TEST(ResultReader, RefusesWhatTheBufferLiesAboutAndLeavesTheCursor) {
  Bytes fourSingles(18);
  fourSingles[0] = 4;
  const struct {
    const char* what;
    Bytes bytes;
    std::function<void(R&)> read;
    const char* error;
  } rows[] = {
      {"length below 0", {0xFF, 0xFF, 'a'}, [](R& r) { r.GetMeasurementString(); }, kOutOfRange},
      {"count below 0", {0, 0x80, 0, 0}, [](R& r) { r.GetFloat32Array(); }, kOutOfRange},
      {"largest count", {0xFF, 0x7F, 0, 0}, [](R& r) { r.GetFloat64Array(); }, kOutOfRange},
      {"unknown code", {6, 0, 0}, [](R& r) { r.GetMeasurementArray(); }, "Type mismatch"},
      {"step back", {0, 0}, [](R& r) { r.SkipMeasurementData(-1); }, kOutOfRange},
      {"step too far", {0, 0}, [](R& r) { r.SkipMeasurementData(kLargest); }, kOutOfRange},
      {"four values for three places", fourSingles, kIntoSingles, kOutOfRange},
  };
  for (const auto& row : rows) {
    Cursor cursor{0, static_cast<std::int32_t>(row.bytes.size())};
    const Cursor before = cursor;
    R reader(row.bytes, cursor.first, cursor.second);
    EXPECT_EQ(raised([&] { row.read(reader); }), row.error) << row.what;
    EXPECT_EQ(cursor, before) << row.what;
  }
}

TEST(ResultReader, RefusesACursorAndACountThatNameNoStretchOfTheBuffer) {
  const Bytes buffer(4);
  for (const Cursor& wrong :
       {Cursor(-1, 2), Cursor(5, 0), Cursor(4, 1), Cursor(0, 5), Cursor(0, -1), Cursor(3, -1),
        Cursor(kLargest, kLargest), Cursor(kSmallest, 4), Cursor(5, kSmallest)}) {
    Cursor cursor = wrong;
    EXPECT_EQ(raised([&] { R(buffer, cursor.first, cursor.second); }), kOutOfRange) << wrong.first;
    cursor = {0, 4};
    R reader(buffer, cursor.first, cursor.second);
    cursor = wrong;  // by the caller, between two reads
    EXPECT_EQ(raised([&] { reader.GetMeasurementUInt8(); }), kOutOfRange) << wrong.first;
    EXPECT_EQ(cursor, wrong);
  }
  for (Cursor right : {Cursor(0, 0), Cursor(4, 0), Cursor(3, 1), Cursor(0, 4)})
    EXPECT_EQ(raised([&] { R(buffer, right.first, right.second); }), "") << right.first;
}

TEST(ResultReader, CopiesAnArrayOfExactlyTheAskedElementType) {
  std::vector<float> singles{9};
  std::vector<double> doubles{9};
  EXPECT_FALSE(CopyVariantToArray(Variant::Doubles{1, 2}, singles));
  EXPECT_FALSE(CopyVariantToArray(Variant::Singles{1, 2}, doubles));
  EXPECT_EQ(singles.front() + doubles.front(), 18);
  EXPECT_TRUE(CopyVariantToArray(Variant::Singles{1, 2}, singles));
  EXPECT_TRUE(CopyVariantToArray(Variant::Doubles{3}, doubles));
  EXPECT_EQ(singles, (std::vector<float>{1, 2}));
  EXPECT_EQ(doubles, std::vector<double>{3});
}

// The example of docs/result-buffer.md.
const Bytes kExample{0x07, 0, 0,    0,                                          // hardware id 7
                     0x64, 0, 0,    0,                                          // measurement id 100
                     0x01, 0, 0,    0,                                          // sub-measurement id 1
                     0x19, 0, 0,    0,                                          // result type 25
                     0x0E, 0,                                                   // 14 bytes of data
                     0x03, 0, 0,    0,    0xA0, 0xC2,                           // three levels: -80 dBm,
                     0,    0, 0xC0, 0x7F, 0,    0,    0x2A, 0xC2,               // missing, -42.5 dBm
                     0,    0, 0,    0,    0,    0,    0,    0,    0, 0, 0, 0};  // the three ends

// A buffer opened as far as a level: 0 nothing, 1 hardware id, 2 measurement, 3 sub-measurement, 4 record.
W openedTo(int level) {
  W writer;
  if (level > 0) writer.HardwareId(7);
  if (level > 1) writer.BeginMeasurement(100);
  if (level > 2) writer.BeginSubMeasurement(1);
  if (level > 3) writer.BeginRecord(25);
  return writer;
}

Bytes closedFrom(W writer, int level) {
  if (level > 3) writer.EndRecord();
  if (level > 2) writer.EndSubMeasurement();
  if (level > 1) writer.EndMeasurement();
  if (level == 0) writer.HardwareId(7);
  return writer.Bytes();
}

TEST(ResultWriter, WritesTheDocumentedExampleByteForByteAndTheReaderReadsItBack) {
  W writer = openedTo(4);
  writer.Float32Array(std::array{-80.0F, NotANumber(), -42.5F});
  EXPECT_EQ(closedFrom(writer, 4), kExample);

  Cursor cursor{0, 44};
  R reader(kExample, cursor.first, cursor.second);
  EXPECT_EQ(reader.GetHardwareId(), 7);
  EXPECT_EQ(reader.GetMeasurementId(), 100);
  EXPECT_EQ(reader.GetSubMeasurementId(), 1);
  EXPECT_EQ(reader.PeekMeasurementTypeId(), 25);
  EXPECT_EQ(reader.GetMeasurementTypeId(), 25);
  EXPECT_EQ(reader.GetMeasurementInt16(), 14);
  std::array<float, 513> levels{};
  EXPECT_EQ(reader.GetFloat32Array(levels), 3U);
  EXPECT_TRUE(levels[0] == -80 && std::isnan(levels[1]) && levels[2] == -42.5F);
  EXPECT_EQ(reader.GetMeasurementTypeId() | reader.GetSubMeasurementId() | reader.GetMeasurementId(), 0);
  EXPECT_EQ(cursor, Cursor(44, 0));
  EXPECT_EQ(raised([&] { static_cast<void>(reader.PeekMeasurementTypeId()); }), kOutOfRange);
}

TEST(ResultWriter, WritesEveryFieldAsItIsRead) {
  for (const Field& field : kFields) {
    if (!field.write) continue;
    SCOPED_TRACE(&field - kFields);
    W writer = openedTo(4);
    field.write(writer);
    const Bytes bytes = closedFrom(writer, 4);
    EXPECT_EQ(bytes[16], field.bytes.size());  // behind four ids: the low byte of the length
    EXPECT_EQ(Bytes(bytes.begin() + 18, bytes.end() - 12), field.bytes);
  }
}

TEST(ResultWriter, RefusesWhatIsOutOfOrderOrDoesNotFitAndGoesOnAsIfItHadNotBeenAsked) {
  const std::vector<float> singles(8192);
  const std::string text(32766, 'a');
  const struct {
    const char* what;
    int level;
    std::function<void(W&)> call;
    const char* error;
  } rows[] = {
      {"a second hardware id", 1, [](W& w) { w.HardwareId(7); }, kInvalidCall},
      {"a record without a sub-measurement", 2, [](W& w) { w.BeginRecord(1); }, kInvalidCall},
      {"a record within a record", 4, [](W& w) { w.BeginRecord(1); }, kInvalidCall},
      {"measurement 0", 1, [](W& w) { w.BeginMeasurement(0); }, kInvalidCall},
      {"result type 0", 3, [](W& w) { w.BeginRecord(0); }, kInvalidCall},
      {"an array outside a record", 3, [](W& w) { w.Array(Variant::Bytes{1}); }, kInvalidCall},
      {"the end of no sub-measurement", 4, [](W& w) { w.EndSubMeasurement(); }, kInvalidCall},
      {"an open measurement", 2, [](W& w) { static_cast<void>(w.Bytes()); }, kInvalidCall},
      {"an empty buffer", 0, [](W& w) { static_cast<void>(w.Bytes()); }, kInvalidCall},
      {"an array of variants", 4, [](W& w) { w.Array(Variant::Variants{}); }, "Type mismatch"},
      {"too many values", 4, [&](W& w) { w.Float32Array(singles); }, "Overflow"},
      {"too long a text", 4, [&](W& w) { w.Text(text); }, "Overflow"},
  };
  for (const auto& row : rows) {
    W writer = openedTo(row.level);
    EXPECT_EQ(raised([&] { row.call(writer); }), row.error) << row.what;
    EXPECT_EQ(closedFrom(writer, row.level), closedFrom(openedTo(row.level), row.level)) << row.what;
  }
}

TEST(ResultWriter, FillsARecordUpToItsLargestLengthAndGoesOnBehindIt) {
  W writer = openedTo(4);
  writer.Text(std::string(32764, 'a'));
  writer.UInt8(1);
  EXPECT_EQ(raised([&] { writer.UInt8(1); }), "Overflow");
  writer.EndRecord();
  writer.BeginRecord(-1);
  const Bytes bytes = closedFrom(writer, 4);
  EXPECT_EQ(bytes.size(), 12U + 6 + 32767 + 6 + 12);
  EXPECT_EQ(Bytes(bytes.begin() + 16, bytes.begin() + 18), (Bytes{0xFF, 0x7F}));
  writer.Clear();
  writer.HardwareId(0);
  EXPECT_EQ(writer.Bytes(), Bytes(8));
  EXPECT_EQ(writer.Bytes(), Bytes(8));
}

}  // namespace
}  // namespace frontpanels
