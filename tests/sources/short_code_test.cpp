#include "sources/short_code.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <numeric>

#include "sources/code_profile.h"

namespace frontpanels {
namespace {

// Of the chips +1 and -1 but for the inserted zero, the last one.
int periodicCorrelation(std::span<const std::uint8_t> code, std::size_t lag) {
  const std::size_t period = code.size() - 1;
  int sum = 0;
  for (std::size_t chip = 0; chip < period; ++chip) sum += code[chip] == code[(chip + lag) % period] ? 1 : -1;
  return sum;
}

TEST(ShortCode, IsAShiftRegisterSequenceOfFullLengthWithAZeroMore) {
  for (const CodeBranch branch : {CodeBranch::InPhase, CodeBranch::Quadrature}) {
    const std::span<const std::uint8_t> code = shortCode(branch);
    ASSERT_EQ(code.size(), 32768U);
    EXPECT_EQ(std::accumulate(code.begin(), code.end(), 0), 16384);  // as many ones as zeros
    EXPECT_EQ(code.front(), 1);
    EXPECT_EQ(std::accumulate(code.end() - 15, code.end(), 0), 0);
    EXPECT_EQ(code[code.size() - 16], 1);
    // What no sequence of a shorter period does: -1 at every other lag.
    for (const std::size_t lag : {1U, 2U, 15U, 64U, 151U, 4681U, 16384U, 32766U})
      EXPECT_EQ(periodicCorrelation(code, lag), -1) << lag;
  }
  EXPECT_FALSE(std::equal(shortCode(CodeBranch::InPhase).begin(), shortCode(CodeBranch::InPhase).end(),
                          shortCode(CodeBranch::Quadrature).begin()));
}

// Chips that are not the filter's add up like noise: by their root.
TEST(ShortCode, HasSideLobesOfThePowerThatAPartOfItLeaves) {
  const std::span<const std::complex<float>> correlation = codeCorrelation();
  ASSERT_EQ(correlation.size(), 32768U);
  EXPECT_EQ(correlation[0], std::complex<float>(1, 0));
  double sum = 0;
  float largest = 0;
  for (const std::complex<float>& value : correlation.subspan(1)) {
    sum += static_cast<double>(std::norm(value));
    largest = std::max(largest, std::norm(value));
  }
  EXPECT_NEAR(sum / 32767 * 2048, 1, 0.03);
  EXPECT_LT(largest, 14.0F / 2048);
}

// 0.3 squared, and a correlation that is straight down to the side lobes one chip off.
TEST(CodeProfile, ShowsAPathAtItsPlaceAndAsWideAsAChip) {
  const CodeRay rays[] = {{1000.25, {0, 0.3F}}, {32767.5, {0.3F, 0}}};
  CodeProfile profile(1);
  profile.begin(1, rays, 1e-9);
  const struct {
    double chips;
    float level;
  } rows[] = {{1000.25, 0.09F}, {1000.75, 0.0225F}, {999.75, 0.0225F}, {1001.25, 0}, {998, 0},
              {32767.5, 0.09F}, {0, 0.0225F},       {32767, 0.0225F},  {64, 0}};
  for (const auto& row : rows) EXPECT_NEAR(profile.level(row.chips), row.level, 0.0035F) << row.chips;
  EXPECT_EQ(profile.peak(960, 1024).chips, 1000.25);
  EXPECT_EQ(profile.peak(32704, 32768).chips, 32767.5);
  EXPECT_LT(profile.peak(1024, 1088).level, 0.002F);
}

}  // namespace
}  // namespace frontpanels
