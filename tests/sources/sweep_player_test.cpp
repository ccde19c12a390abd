#include "sources/sweep_player.h"

#include <gtest/gtest.h>

#include "tests/support/memory_text_files.h"
#include "tests/support/raised.h"

namespace frontpanels {
namespace {

class SweepPlayerTest : public ::testing::Test {
 protected:
  SweepPlayerTest() {
    files.contents["two.csv"] =
        "2020-01-01,00:00:10,100,120,10.00,1,-1,-2\n"
        "2020-01-01,00:00:20,100,120,10.00,1,-3,-4\n";
    player.open("two.csv");
  }

  // The state and the number of the sweep.
  std::string now() {
    static constexpr const char* kStates[] = {"empty", "paused", "playing", "ended"};
    return kStates[static_cast<int>(player.state())] + (" " + std::to_string(player.sweepNumber()));
  }

  testing::MemoryTextFiles files;
  SweepPlayer player{files};
};

TEST_F(SweepPlayerTest, TakesOneSweepAStepAndEndsAfterTheLastOneWhichItKeepsShowing) {
  EXPECT_EQ(now(), "paused 0");
  EXPECT_EQ(player.percent(), 50);  // the first row is read when the format is recognised
  EXPECT_TRUE(player.step());
  EXPECT_EQ(now(), "paused 1");
  EXPECT_EQ(player.percent(), 100);  // the row after a sweep tells that it has ended
  EXPECT_EQ(player.sweepTime(), "2020-01-01 00:00:10");
  EXPECT_EQ(player.sweep().levelsDb[0], -1.0F);
  player.play();
  player.pause();
  EXPECT_EQ(now(), "paused 1");
  player.play();
  EXPECT_TRUE(player.step());  // plays on where it was paused
  EXPECT_EQ(now(), "playing 2");
  EXPECT_FALSE(player.step());
  EXPECT_FALSE(player.step());
  EXPECT_EQ(now(), "ended 2");
  EXPECT_EQ(player.sweep().levelsDb[0], -3.0F);
  player.play();
  EXPECT_EQ(now(), "playing 0");
  EXPECT_TRUE(player.step());
  EXPECT_EQ(now(), "playing 1");
}

TEST_F(SweepPlayerTest, RestartGoesBackAndKeepsPlayingOnlyWhatPlayed) {
  player.step();
  player.restart();
  EXPECT_EQ(now(), "paused 0");
  player.play();
  player.step();
  player.restart();
  EXPECT_EQ(now(), "playing 0");
  files.contents.clear();
  EXPECT_EQ(testing::raised([&] { player.restart(); }), "two.csv: File not found");
  EXPECT_EQ(now(), "ended 0");
}

TEST_F(SweepPlayerTest, KeepsItsRecordingWhenAnotherCannotBeOpened) {
  player.step();
  EXPECT_EQ(testing::raised([&] { player.open("missing.csv"); }), "missing.csv: File not found");
  EXPECT_EQ(player.recording()->path(), "two.csv");
  EXPECT_TRUE(player.step());
  EXPECT_EQ(now(), "paused 2");
}

TEST_F(SweepPlayerTest, DoesNothingWithoutARecording) {
  SweepPlayer empty(files);
  empty.play();
  empty.restart();
  empty.pause();
  EXPECT_FALSE(empty.step());
  EXPECT_EQ(empty.state(), SweepPlayer::State::Empty);
  EXPECT_EQ(empty.percent(), 0);
}

}  // namespace
}  // namespace frontpanels
