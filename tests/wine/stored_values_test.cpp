#include "activex/stored_values.h"

#include <gtest/gtest.h>
#include <oleauto.h>

#include <map>
#include <optional>
#include <string>

#include "activex/barrier.h"
#include "platform/win32/com_pointer.h"
#include "tests/wine/full_container.h"

namespace frontpanels::activex {
namespace {

constexpr StoredProperty kProperties[] = {{L"Visible", true}, {L"Paths", ""}, {L"Title", "Untitled"}};
const StoredValues kUsual = {true, "", "Untitled"};
const StoredValues kOthers = {false,
                              "a/b\x1b"
                              "Gr\xC3\xBC\xC3\x9F",
                              ""};

ComPointer<IStream> streamOf(const std::string& bytes) {
  ComPointer<IStream> stream;
  CreateStreamOnHGlobal(nullptr, TRUE, stream.receive());
  stream->Write(bytes.data(), static_cast<ULONG>(bytes.size()), nullptr);
  stream->Seek({}, STREAM_SEEK_SET, nullptr);
  return stream;
}

// The values, or none where the stream is refused.
std::optional<StoredValues> valuesIn(const std::string& bytes) {
  try {
    return readStored(*streamOf(bytes).get(), kProperties).values;
  } catch (const ComFailure&) {
    return std::nullopt;
  }
}

std::string bytesOf(const StoredValues& values) { return storedBytes({{5000, 4000}, values}); }

// Magic, version, count, 16 by 16: what stands before the values.
std::string header(char version, char count) {
  return std::string("FPPL") + version + '\0' + count + std::string("\0\x10\0\0\0\x10\0\0\0", 9);
}

TEST(StoredValuesTest, ComeBackFromAStreamThatGoesOnBehindThem) {
  const auto stream = streamOf(bytesOf(kOthers) + "rest");
  const StoredState state = readStored(*stream.get(), kProperties);
  EXPECT_EQ(state.values, kOthers);
  EXPECT_TRUE(state.extentHimetric.cx == 5000 && state.extentHimetric.cy == 4000);
  char rest[8] = {};
  stream->Read(rest, sizeof rest, nullptr);
  EXPECT_STREQ(rest, "rest");
  const std::string path(200000, 'x');
  EXPECT_EQ(valuesIn(bytesOf({true, path, ""})), (StoredValues{true, path, ""}));
}

TEST(StoredValuesTest, StreamsOfOtherVersionsAreReadAndDamagedOnesRefused) {
  const auto text = [](char length, const std::string& bytes) {
    return std::string("\2") + length + std::string(3, '\0') + bytes;
  };
  const std::string no("\0", 1);
  const struct {
    std::string bytes;
    std::optional<StoredValues> values;
  } cases[] = {
      {header(1, 1) + no, StoredValues{false, "", "Untitled"}},
      {header(1, 1) + "\x80", kUsual},
      {header(2, 0), kUsual},
      {header(2, 2) + no + text(1, "p"), StoredValues{false, "p", "Untitled"}},
      {header(2, 4) + "\1" + text(0, "") + text(0, "") + "\1", StoredValues{true, "", ""}},  // one unknown
      {header(1, 2) + "\1\1", std::nullopt},        // a boolean for a text
      {header(2, 1) + text(1, "p"), std::nullopt},  // a text for a boolean
      {header(2, 1) + "\3", std::nullopt},          // no kind
      {header(2, 2) + "\1" + text(2, "p"), std::nullopt},
      {header(2, 2) + "\1\2\xFF\xFF\xFF\xFFp", std::nullopt},  // 4 GB announced
      {header(2, 2) + "\1" + text(1, "\xFF"), std::nullopt},   // no text
      {header(3, 1) + "\1", std::nullopt},
      {header(2, 65) + std::string(65, '\1'), std::nullopt},
      {"FPPM" + header(2, 0).substr(4), std::nullopt},
      {header(2, 0).substr(0, 15) + "\x80", std::nullopt},  // a height below 0
  };
  for (const auto& [bytes, values] : cases)
    EXPECT_EQ(valuesIn(bytes), values) << ::testing::PrintToString(bytes);
  const std::string whole = bytesOf(kOthers);
  for (std::size_t length = 0; length < whole.size(); ++length)
    EXPECT_EQ(valuesIn(whole.substr(0, length)), std::nullopt) << length;
}

TEST(StoredValuesTest, ComeBackFromABag) {
  testing::TextBag bag;
  writeStored(bag, kProperties, kUsual, false);
  EXPECT_TRUE(bag.texts.empty());
  EXPECT_EQ(readStored(bag, nullptr, kProperties), kUsual);
  writeStored(bag, kProperties, kUsual, true);
  EXPECT_EQ(bag.texts.size(), 3U);
  writeStored(bag, kProperties, kOthers, false);
  EXPECT_EQ(bag.texts[L"Paths"], L"a/b\x1bGr\u00FC\u00DF");
  EXPECT_EQ(readStored(bag, nullptr, kProperties), kOthers);
  bag.texts[L"Visible"] = L"perhaps";
  EXPECT_EQ(readStored(bag, nullptr, kProperties).front(), Variant(true));
}

}  // namespace
}  // namespace frontpanels::activex
