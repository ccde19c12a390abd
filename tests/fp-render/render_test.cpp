#include "fp-render/render.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <iterator>
#include <set>
#include <sstream>
#include <vector>

#include "tests/support/memory_text_files.h"

namespace frontpanels {
namespace {

namespace fs = std::filesystem;

constexpr const char* kTwoSweeps =
    "2020-01-01,00:00:10,100000000,103000000,1000000.00,1,-60,-20,-50,-50\n"
    "2020-01-01,00:00:11,100000000,103000000,1000000.00,1,-61,-21,-51,-51\n";
constexpr const char* kAllMissing = "2020-01-01,00:00:10,100000000,102000000,1000000.00,1,nan,nan\n";

class RenderTest : public ::testing::Test {
 protected:
  void SetUp() override {
    const auto* const test = ::testing::UnitTest::GetInstance()->current_test_info();
    folder = fs::temp_directory_path() / ("fp-render-" + std::string(test->name()));
    fs::remove_all(folder);
    fs::create_directories(folder);
  }
  void TearDown() override { fs::remove_all(folder); }

  int run(std::vector<const char*> arguments) {
    output.str("");
    errors.str("");
    return render(arguments, files, output, errors);
  }
  int draw(const std::string& content, std::vector<const char*> more = {}) {
    files.contents["van/a.csv"] = content;
    const std::string directory = (folder / "out").string();
    std::vector<const char*> arguments = {"van/a.csv", "-o", directory.c_str()};
    arguments.insert(arguments.end(), more.begin(), more.end());
    return run(arguments);
  }
  std::set<std::string> pictures() const {
    std::set<std::string> names;
    for (const auto& entry : fs::directory_iterator(folder / "out"))
      names.insert(entry.path().filename().string());
    return names;
  }
  std::string bytes(const char* name) const {
    std::ifstream file(folder / "out" / name, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
  }

  fs::path folder;
  testing::MemoryTextFiles files;
  std::ostringstream output;
  std::ostringstream errors;
};

TEST_F(RenderTest, DrawsAPictureASweepIntoAFolderThatItMakes) {
  EXPECT_EQ(draw(kTwoSweeps), 0);
  EXPECT_EQ(pictures(), (std::set<std::string>{"a-sweep-0001.png", "a-sweep-0002.png"}));
  EXPECT_TRUE(bytes("a-sweep-0001.png").starts_with("\x89PNG\r\n\x1a\n"));
  EXPECT_NE(bytes("a-sweep-0001.png"), bytes("a-sweep-0002.png"));
  const std::string out = (folder / "out").string();
  EXPECT_EQ(output.str(), out + "/a-sweep-0001.png  2020-01-01 00:00:10  100 to 103 MHz, 3 bins\n" + out +
                              "/a-sweep-0002.png  2020-01-01 00:00:11  100 to 103 MHz, 3 bins\n"
                              "2 pictures of a recording of rtl_power\n");
  EXPECT_EQ(errors.str(), "");
}

TEST_F(RenderTest, DrawsAChosenSweepAsItDrawsItAmongAll) {
  ASSERT_EQ(draw(kTwoSweeps), 0);
  const std::string amongAll = bytes("a-sweep-0002.png");
  fs::remove_all(folder / "out");
  EXPECT_EQ(draw(kTwoSweeps, {"--sweep", "2"}), 0);
  EXPECT_EQ(pictures(), std::set<std::string>{"a-sweep-0002.png"});
  EXPECT_EQ(bytes("a-sweep-0002.png"), amongAll);
}

TEST_F(RenderTest, KeepsTheGoodRowsAndNamesTheBadOnes) {
  EXPECT_EQ(draw(std::string(kTwoSweeps) + "what is this\n" + kTwoSweeps), 0);
  EXPECT_EQ(pictures().size(), 4U);
  EXPECT_EQ(errors.str(),
            "van/a.csv: 1 row could not be read, 1 row out of order\n"
            "  line 3: does not begin with a date and a time: \"what is this\"\n"
            "  line 4: its sweep is older than the one before\n");
}

TEST_F(RenderTest, DrawsNothingForASweepWithoutLevels) {
  EXPECT_EQ(draw(std::string(kAllMissing) + kTwoSweeps), 0);
  EXPECT_EQ(pictures(), (std::set<std::string>{"a-sweep-0002.png", "a-sweep-0003.png"}));
  EXPECT_EQ(errors.str(), "van/a.csv: sweep 1: every level is missing, no picture\n");
}

TEST_F(RenderTest, AnswersOneAndSaysWhyWhenNothingCanBeDrawn) {
  EXPECT_EQ(run({"absent.csv"}), 1);
  EXPECT_EQ(errors.str(), "fp-render: absent.csv: File not found\n");
  EXPECT_EQ(draw(""), 1);
  EXPECT_EQ(errors.str(), "fp-render: van/a.csv: the file is empty\n");
  EXPECT_EQ(draw(kAllMissing), 1);
  EXPECT_EQ(errors.str(), "van/a.csv: every level is missing, there is nothing to draw\n");
  EXPECT_EQ(draw(kTwoSweeps, {"--sweep", "3"}), 1);
  EXPECT_EQ(errors.str(), "van/a.csv: has 2 sweeps, no sweep 3\n");
  EXPECT_FALSE(fs::exists(folder / "out"));
}

TEST_F(RenderTest, LeavesNoHalfPictureWhereItCannotWrite) {
  fs::create_directories(folder / "out" / "a-sweep-0001.png" / "in the way");
  EXPECT_EQ(draw(kTwoSweeps), 1);
  EXPECT_EQ(pictures(), std::set<std::string>{"a-sweep-0001.png"});
  const std::string picture = (folder / "out" / "a-sweep-0001.png").string();
  EXPECT_EQ(errors.str(), "fp-render: " + picture + ": cannot be written: Is a directory\n");

  fs::remove_all(folder / "out");
  std::ofstream(folder / "out") << "a file, not a folder";
  EXPECT_EQ(draw(kTwoSweeps), 1);
  EXPECT_EQ(errors.str(),
            "fp-render: " + (folder / "out").string() + ": cannot be created: Not a directory\n");
}

TEST_F(RenderTest, ExplainsItself) {
  EXPECT_EQ(run({"--version"}), 0);
  EXPECT_EQ(output.str(), "fp-render 0.1.0\n");
  EXPECT_EQ(run({"--help"}), 0);
  EXPECT_TRUE(output.str().starts_with("usage: fp-render RECORDING [-o DIR] [--sweep N]\n"));
  EXPECT_EQ(run({"--sweep", "none", "a.csv"}), 2);
  EXPECT_TRUE(
      errors.str().starts_with("fp-render: --sweep needs a number from 1 on, not \"none\"\n\nusage: "));
}

}  // namespace
}  // namespace frontpanels
