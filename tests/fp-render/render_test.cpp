#include "fp-render/render.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <iterator>
#include <numeric>
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
  RenderTest() {
    fs::remove_all(folder);
    fs::create_directories(folder);
  }
  ~RenderTest() override { fs::remove_all(folder); }

  int run(std::vector<const char*> arguments) {
    output.str("");
    errors.str("");
    return render(arguments, files, output, errors);
  }
  int draw(const std::string& content, std::vector<const char*> more = {}) {
    files.contents["van/a.csv"] = content;
    std::vector<const char*> arguments = {"van/a.csv", "-o", out.c_str()};
    arguments.insert(arguments.end(), more.begin(), more.end());
    return run(arguments);
  }
  // The names of the pictures, a blank behind each.
  std::string pictures() const {
    std::set<std::string> names;
    for (const auto& entry : fs::directory_iterator(out))
      names.insert(entry.path().filename().string() + " ");
    return std::accumulate(names.begin(), names.end(), std::string());
  }
  std::string bytes(const char* name) const {
    std::ifstream file(fs::path(out) / name, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
  }

  fs::path folder =
      fs::temp_directory_path() /
      ("fp-render-" + std::string(::testing::UnitTest::GetInstance()->current_test_info()->name()));
  std::string out = (folder / "out").string();
  testing::MemoryTextFiles files;
  std::ostringstream output;
  std::ostringstream errors;
};

TEST_F(RenderTest, DrawsAPictureASweepIntoAFolderThatItMakes) {
  EXPECT_EQ(draw(kTwoSweeps), 0);
  EXPECT_EQ(pictures(), "a-sweep-0001.png a-sweep-0002.png ");
  EXPECT_TRUE(bytes("a-sweep-0001.png").starts_with("\x89PNG\r\n\x1a\n"));
  const std::string second = bytes("a-sweep-0002.png");
  EXPECT_NE(bytes("a-sweep-0001.png"), second);
  EXPECT_EQ(output.str(), out + "/a-sweep-0001.png  2020-01-01 00:00:10  100 to 103 MHz, 3 bins\n" + out +
                              "/a-sweep-0002.png  2020-01-01 00:00:11  100 to 103 MHz, 3 bins\n"
                              "2 pictures of a recording of rtl_power\n");
  EXPECT_EQ(errors.str(), "");

  fs::remove_all(out);  // a chosen sweep is drawn as it is among all
  EXPECT_EQ(draw(kTwoSweeps, {"--sweep", "2"}), 0);
  EXPECT_EQ(pictures(), "a-sweep-0002.png ");
  EXPECT_EQ(bytes("a-sweep-0002.png"), second);
}

TEST_F(RenderTest, KeepsTheGoodRowsNamesTheBadOnesAndDrawsNothingForASweepWithoutLevels) {
  EXPECT_EQ(draw(std::string(kAllMissing) + "what is this\n" + kTwoSweeps + kAllMissing), 0);
  EXPECT_EQ(pictures(), "a-sweep-0002.png a-sweep-0003.png ");
  EXPECT_EQ(errors.str(),
            "van/a.csv: 1 row could not be read, 1 row out of order\n"
            "  line 2: does not begin with a date and a time: \"what is this\"\n"
            "  line 5: its sweep is older than the one before\n"
            "van/a.csv: sweep 1: every level is missing, no picture\n"
            "van/a.csv: sweep 4: every level is missing, no picture\n");
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
  EXPECT_FALSE(fs::exists(out));
}

TEST_F(RenderTest, LeavesNoHalfPictureWhereItCannotWrite) {
  fs::create_directories(out + "/a-sweep-0001.png/in the way");
  EXPECT_EQ(draw(kTwoSweeps), 1);
  EXPECT_EQ(pictures(), "a-sweep-0001.png ");
  EXPECT_EQ(errors.str(), "fp-render: " + out + "/a-sweep-0001.png: cannot be written: Is a directory\n");
  fs::remove_all(out);
  std::ofstream(out) << "a file, not a folder";
  EXPECT_EQ(draw(kTwoSweeps), 1);
  EXPECT_EQ(errors.str(), "fp-render: " + out + ": cannot be created: Not a directory\n");
}

TEST_F(RenderTest, ExplainsItself) {
  EXPECT_EQ(run({"--version"}), 0);
  EXPECT_EQ(output.str(), "fp-render " FRONTPANELS_VERSION "\n");
  EXPECT_EQ(run({"--help"}), 0);
  EXPECT_TRUE(output.str().starts_with("usage: fp-render RECORDING [-o DIR] [--sweep N]\n"));
  EXPECT_EQ(run({"--sweep", "none", "a.csv"}), 2);
  EXPECT_TRUE(
      errors.str().starts_with("fp-render: --sweep needs a number from 1 on, not \"none\"\n\nusage: "));
}

}  // namespace
}  // namespace frontpanels
