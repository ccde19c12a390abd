#include "fp-render/options.h"

#include <gtest/gtest.h>

#include <vector>

namespace frontpanels {
namespace {

TEST(RenderOptions, AreReadInAnyOrder) {
  const std::vector<const char*> kOrders[] = {{"a.csv", "-o", "out", "--sweep", "12"},
                                              {"--sweep", "12", "-o", "out", "a.csv"},
                                              {"-o", "out", "--sweep", "12", "--", "a.csv"}};
  for (const auto& arguments : kOrders) {
    RenderOptions options;
    std::string problem;
    EXPECT_TRUE(parseOptions(arguments, options, problem)) << problem;
    EXPECT_EQ(options.recording, "a.csv");
    EXPECT_EQ(options.directory, "out");
    EXPECT_EQ(options.sweep, 12U);
  }
}

TEST(RenderOptions, ThatMakeNoSenseAreRefusedWithTheReason) {
  const struct {
    std::vector<const char*> arguments;
    const char* problem;
  } kCases[] = {
      {{}, "no recording named"},
      {{"a.csv", "b.csv"}, "more than one recording"},
      {{""}, "the recording's name is empty"},
      {{"a.csv", "-o"}, "-o needs a value"},
      {{"a.csv", "-o", ""}, "-o needs a folder"},
      {{"a.csv", "--sweep", "0"}, "--sweep needs a number from 1 on, not \"0\""},
      {{"a.csv", "--sweep", "-1"}, "--sweep needs a number from 1 on, not \"-1\""},
      {{"a.csv", "--sweep", "3x"}, "--sweep needs a number from 1 on, not \"3x\""},
      {{"a.csv", "--sweep", "18446744073709551616"},
       "--sweep needs a number from 1 on, not \"18446744073709551616\""},
      {{"a.csv", "-x"}, "unknown option -x"},
  };
  for (const auto& testCase : kCases) {
    RenderOptions options;
    std::string problem;
    EXPECT_FALSE(parseOptions(testCase.arguments, options, problem)) << testCase.problem;
    EXPECT_EQ(problem, testCase.problem);
  }
}

}  // namespace
}  // namespace frontpanels
