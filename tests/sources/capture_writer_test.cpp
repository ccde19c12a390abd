#include "sources/capture_writer.h"

#include <sys/resource.h>

#include <csignal>
#include <cstdlib>
#include <functional>
#include <limits>

#include "tests/sources/capture_fixture.h"

namespace frontpanels {
namespace {

namespace fs = std::filesystem;
using testing::sweepFrame;
using testing::textOfAll;

class CaptureWriterTest : public testing::CaptureFixture {
 protected:
  [[nodiscard]] std::string refusal() const {
    return testing::raised([this] { return CaptureWriter(path()); });
  }
  static std::string appendError(CaptureWriter& writer, const Frame& frame) {
    return testing::raised([&] { return writer.append(frame), 0; });
  }
  // What `body` finds with files of at most so many bytes; true in a process of its own, which ends with it.
  static void exitWithin(std::size_t bytes, const std::function<bool()>& body) {
    std::signal(SIGXFSZ, SIG_IGN);
    limitFiles(bytes);
    std::exit(body() ? 0 : 1);
  }
  static void limitFiles(rlim_t bytes) {
    rlimit limit{};
    getrlimit(RLIMIT_FSIZE, &limit);
    limit.rlim_cur = bytes;
    setrlimit(RLIMIT_FSIZE, &limit);
  }
};

TEST_F(CaptureWriterTest, ContinuesACapture) {
  threeFrames();
  CaptureWriter writer(path());
  writer.append(sweepFrame("four", {}));
  EXPECT_EQ(writer.frames(), 1U);
  EXPECT_EQ(writer.path(), path());
  EXPECT_EQ(textOfAll(*open(bytes())), kFirst + second() + third() + "4 four sweep 100 10 1\n");
}

TEST_F(CaptureWriterTest, ContinuesBehindTheLastWholeBlockWhereverACaptureWasCut) {
  const std::string whole = threeFrames();
  fs::remove(native());
  CaptureWriter(path()).append(sweepFrame("new", {-9}));
  const std::string block = bytes().substr(16);  // the header of the file is before it
  // Each block is 20 bytes and its payload: 4 for what there is, 4 and the text of the time, then the parts.
  const std::size_t first = 16 + 20 + (4 + 4 + 3) + (8 + 8 + 8 + 4 + 3 * 4);
  const std::size_t third = whole.size() - (20 + 4 + 4 + 5);
  for (std::size_t size = 0; size <= whole.size(); ++size) {
    setBytes(whole.substr(0, size));
    CaptureWriter(path()).append(sweepFrame("new", {-9}));
    const std::size_t kept = size < first ? 16 : size < third ? first : size < whole.size() ? third : size;
    EXPECT_EQ(bytes(), whole.substr(0, kept) + block) << size;
  }
}

TEST_F(CaptureWriterTest, TakesNothingAwayThatIsDamagedRatherThanCut) {
  std::string damaged = threeFrames();
  damaged[damaged.size() - 20] ^= 1;  // in the header of the last block
  setBytes(damaged);
  CaptureWriter(path()).append(sweepFrame("new", {-9}));
  EXPECT_TRUE(bytes().starts_with(damaged));
  EXPECT_EQ(textOfAll(*open(bytes())), kFirst + second() + "3 new sweep 100 10 1 -9\n");
}

TEST_F(CaptureWriterTest, RefusesWhatIsNoCaptureOfItsVersionAndLeavesItAsItIs) {
  std::string later = threeFrames();
  ++later[8];
  const std::string contents[] = {"2020-01-01,00:00:10,100,120,10.00,1,-1,-2\n", "x", later};
  for (const std::string& content : contents) {
    setBytes(content);
    EXPECT_EQ(refusal(), path() + ": not a capture that can be continued");
    EXPECT_EQ(bytes(), content);
  }
  fs::remove(native());
  fs::create_directory(native());
  EXPECT_EQ(refusal(), path() + ": Path/File access error");
  fs::remove(native());
  const std::string inside = path() + "/a";
  EXPECT_EQ(testing::raised([&] { return CaptureWriter(inside); }),
            inside + ": cannot be written: No such file or directory");
}

TEST_F(CaptureWriterTest, RefusesAFrameWhoseBinsHaveNoFrequenciesOrThatIsTooLong) {
  const std::string whole = threeFrames();
  CaptureWriter writer(path());
  const std::string error = path() + ": cannot hold a frame of this length or with frequencies like these";
  for (const double stepHz : {0.0, -1.0, 1e14, std::numeric_limits<double>::quiet_NaN()}) {
    Frame frame = sweepFrame("", {-1});
    frame.sweep->stepHz = stepHz;
    EXPECT_EQ(appendError(writer, frame), error) << stepHz;
  }
  EXPECT_EQ(appendError(writer, sweepFrame("", std::vector<float>((1U << 22) + 1))), error);
  Frame talkative;
  talkative.time.assign(std::size_t{32} << 20, 'x');
  EXPECT_EQ(appendError(writer, talkative), error);
  EXPECT_EQ(bytes(), whole);
  EXPECT_EQ(writer.frames(), 0U);
}

TEST_F(CaptureWriterTest, OnAFullDiskSaysSoTakesTheHalfBlockAwayAndGoesOnLater) {
  const std::string whole = threeFrames();
  const auto body = [&] {
    CaptureWriter writer(path());
    const std::string error = appendError(writer, sweepFrame("four", {-4}));
    const bool kept = bytes() == whole && writer.frames() == 0;
    limitFiles(whole.size() + 1000);
    writer.append(sweepFrame("four", {-4}));
    return kept && error == path() + ": cannot be written: File too large";
  };
  for (const std::size_t room : {0U, 1U, 30U}) {
    setBytes(whole);
    EXPECT_EXIT(exitWithin(whole.size() + room, body), ::testing::ExitedWithCode(0), "") << room;
  }
  EXPECT_EQ(textOfAll(*open(bytes())), kFirst + second() + third() + "4 four sweep 100 10 1 -4\n");
}

TEST_F(CaptureWriterTest, LeavesNoFileThatItCouldNotEvenBegin) {
  EXPECT_EXIT(exitWithin(10, [&] { return !refusal().empty() && !fs::exists(native()); }),
              ::testing::ExitedWithCode(0), "");
}

TEST_F(CaptureWriterTest, SaysWhenItsFileIsGone) {
  CaptureWriter writer(path());
  fs::remove(native());
  EXPECT_EQ(appendError(writer, sweepFrame("", {})),
            path() + ": cannot be written: No such file or directory");
}

}  // namespace
}  // namespace frontpanels
