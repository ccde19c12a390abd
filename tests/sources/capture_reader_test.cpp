#include "sources/capture_reader.h"

#include <algorithm>
#include <set>

#include "sources/crc32c.h"
#include "tests/sources/capture_fixture.h"

namespace frontpanels {
namespace {

using CaptureReaderTest = testing::CaptureFixture;
using testing::textOfAll;

// Where blocks end, read from their lengths.
std::vector<std::size_t> blockEnds(const std::string& capture) {
  std::vector<std::size_t> ends{16};  // the header of the file
  const auto byteAt = [&capture](std::size_t at) { return static_cast<unsigned char>(capture[at]); };
  while (ends.back() < capture.size())
    ends.push_back(ends.back() + 20 + byteAt(ends.back() + 8) + 256U * byteAt(ends.back() + 9));
  return ends;
}

TEST(Crc32c, IsTheOneOfTheStandardAndGoesOnBehindOthers) {
  const std::string_view digits = "123456789";
  EXPECT_EQ(crc32c(digits), 0xE3069283U);  // the check value that everybody publishes
  EXPECT_EQ(crc32c(std::string(32, '\0')), 0x8A9136AAU);
  EXPECT_EQ(crc32c(digits.substr(4), crc32c(digits.substr(0, 4))), 0xE3069283U);
}

TEST_F(CaptureReaderTest, PlaysWhatWasCaptured) {
  const auto source = open(threeFrames());
  EXPECT_EQ(textOfAll(*source), kFirst + second() + third());
  EXPECT_EQ(source->frameCount(), 3U);
  EXPECT_STREQ(source->formatName(), "capture");
  EXPECT_EQ(source->name(), "a");
  EXPECT_TRUE(source->hasSweeps());
  EXPECT_TRUE(source->hasPilots());
  EXPECT_EQ(source->problemReport(), "");
}

TEST_F(CaptureReaderTest, CutAnywherePlaysTheWholeFramesBeforeTheCutAndSaysSo) {
  const std::string whole = threeFrames();
  const std::vector<std::size_t> ends = blockEnds(whole);
  ASSERT_EQ(ends.size(), 4U);
  const std::string frames[] = {kFirst, second(), third()};
  for (std::size_t size = 1; size <= whole.size(); ++size) {
    const auto source = open(whole.substr(0, size));
    std::string played;
    std::size_t count = 0;
    for (; count < 3 && ends[count + 1] <= size; ++count) played += frames[count];
    EXPECT_EQ(textOfAll(*source), played) << size;
    const bool atAnEnd = std::find(ends.begin(), ends.end(), size) != ends.end();
    EXPECT_EQ(source->problemReport(), atAnEnd ? "" : "a: cut short after frame " + std::to_string(count))
        << size;
  }
  EXPECT_EQ(testing::raised([&] { return open(""); }), "a: the file is empty");
}

TEST_F(CaptureReaderTest, WithAnyByteChangedPlaysNoWrongFrameAndSaysWhere) {
  const std::string whole = threeFrames();
  const std::vector<std::size_t> ends = blockEnds(whole);
  // What is left when a block is lost: of the first, the second, the third.
  const std::string left[] = {second(1) + third(2), kFirst + third(2), kFirst + second()};
  for (std::size_t at = 0; at < whole.size(); ++at) {
    std::string damaged = whole;
    damaged[at] = static_cast<char>(damaged[at] ^ (1 << at % 8));
    const std::size_t block =
        std::count_if(ends.begin(), ends.end(), [at](std::size_t end) { return end <= at; });
    if (at < 8) {  // the mark of the file
      EXPECT_NE(testing::raised([&] { return open(damaged); }), "") << at;
      continue;
    }
    const auto source = open(damaged);
    EXPECT_EQ(textOfAll(*source), block == 0 ? kFirst + second() + third() : left[block - 1]) << at;
    const std::string place = block == 0 ? "0" : std::to_string(ends[block - 1]);
    EXPECT_TRUE(source->problemReport().starts_with("a: damaged in 1 place\n  byte " + place + ": "))
        << at << source->problemReport();
  }
}

}  // namespace
}  // namespace frontpanels
