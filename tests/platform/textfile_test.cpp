#include "platform/textfile.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>

#include "tests/support/raised.h"

namespace frontpanels {
namespace {

namespace fs = std::filesystem;
using Lines = std::vector<std::string>;
using namespace std::string_literals;

// Each test has a folder of its own; the file's name is not ASCII.
class TextFileTest : public ::testing::Test {
 protected:
  TextFileTest() { fs::create_directories(folder_); }
  ~TextFileTest() override { fs::remove_all(folder_); }

  std::string write(const std::string& content) {
    const fs::path path = folder_ / u8"Gr\u00F6\u00DFe.csv";
    std::ofstream(path, std::ios::binary) << content;
    return utf8(path);
  }
  [[nodiscard]] std::string folder() const { return utf8(folder_); }

  // The lines, marked where they were cut or lack their end.
  static Lines lines(const std::string& path, std::size_t maxLineBytes) {
    const auto reader = systemTextFiles().open(path, maxLineBytes);
    Lines all;
    TextLine line;
    while (reader->readLine(line)) {
      all.push_back(line.text + (line.cut ? " CUT" : "") + (line.ended ? "" : " OPEN"));
      EXPECT_EQ(line.number, all.size());
    }
    EXPECT_FALSE(reader->readLine(line));
    EXPECT_EQ(reader->positionBytes(), reader->sizeBytes());
    return all;
  }
  static std::string errorOf(const std::string& path) {
    return testing::raised([&] { return systemTextFiles().open(path, 100); });
  }

 private:
  static std::string utf8(const fs::path& path) {
    const std::u8string text = path.u8string();
    return {text.begin(), text.end()};
  }

  fs::path folder_ =
      fs::temp_directory_path() / (std::string("frontpanels_textfile_") +
                                   ::testing::UnitTest::GetInstance()->current_test_info()->name());
};

TEST_F(TextFileTest, ReadsLinesThatEndInEitherWayAndCutsThemAtTheBoundWithoutTheirEnd) {
  const struct {
    std::string content;
    Lines lines;
  } rows[] = {{"", {}},
              {"one", {"one OPEN"}},
              {"one\ntwo\r\n", {"one", "two"}},
              {"\n\r\n\n", {"", "", ""}},
              {"a\rb\r\r\n", {"a\rb\r"}},  // only the CR right before the LF belongs to the end
              {"one\ntwo\r", {"one", "two\r OPEN"}},
              {"a\0b\n\0"s, {"a\0b"s, "\0 OPEN"s}},
              {"12345\nx\n", {"12345", "x"}},
              {"12345\r\nx\n", {"12345", "x"}},
              {"123456\nx\n", {"12345 CUT", "x"}},
              {"12345\r6\r\nx", {"12345 CUT", "x OPEN"}},
              {"123456\r\n", {"12345 CUT"}},
              {"12345\r", {"12345 CUT OPEN"}},
              {"12345\r\r\n\n", {"12345 CUT", ""}},
              {"123456789", {"12345 CUT OPEN"}}};
  for (const auto& row : rows) EXPECT_EQ(lines(write(row.content), 5), row.lines) << row.content;
}

TEST_F(TextFileTest, ALineOfManyBlocksHoldsNoMoreThanItsBound) {
  const auto reader = systemTextFiles().open(write(std::string(1'000'000, 'x') + "\nlast\n"), 10);
  TextLine line;
  ASSERT_TRUE(reader->readLine(line));
  EXPECT_EQ(line.text, "xxxxxxxxxx");
  EXPECT_TRUE(line.cut);
  EXPECT_LT(line.text.capacity(), 100U);
  EXPECT_EQ(reader->positionBytes(), 1'000'001U);
  EXPECT_EQ(reader->sizeBytes(), 1'000'006U);
  ASSERT_TRUE(reader->readLine(line));
  EXPECT_EQ(line.text, "last");
}

TEST_F(TextFileTest, ALineEndThatStraddlesTwoBlocksIsOneLineEnd) {
  const std::string path = write(std::string(65535, 'x') + "\r\nlast");  // blocks of 65536 bytes
  EXPECT_EQ(lines(path, 100'000), (Lines{std::string(65535, 'x'), "last OPEN"}));
}

TEST_F(TextFileTest, SaysWhyAFileCannotBeOpened) {
  EXPECT_EQ(errorOf(folder() + "/missing.csv"), "File not found");
  EXPECT_EQ(errorOf(write("x") + "/inside a file"), "File not found");
  EXPECT_EQ(errorOf(folder()), "Path/File access error");
  EXPECT_EQ(errorOf(folder() + "\0.csv"s), "Path/File access error");
  EXPECT_EQ(errorOf(""), "File not found");
}

}  // namespace
}  // namespace frontpanels
