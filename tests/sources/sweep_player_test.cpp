#include "sources/sweep_player.h"

#include <gtest/gtest.h>

#include "platform/runtime_error.h"
#include "tests/support/memory_text_files.h"

namespace frontpanels {
namespace {

using testing::MemoryTextFiles;
using State = SweepPlayer::State;

// Two sweeps of two bins.
constexpr const char* kTwoSweeps =
    "2020-01-01,00:00:10,100,120,10.00,1,-1,-2\n"
    "2020-01-01,00:00:20,100,120,10.00,1,-3,-4\n";

class SweepPlayerTest : public ::testing::Test {
 protected:
  void SetUp() override {
    files.contents["two.csv"] = kTwoSweeps;
    player.open("two.csv");
  }

  MemoryTextFiles files;
  SweepPlayer player{files};
};

TEST_F(SweepPlayerTest, StandsPausedBeforeTheFirstSweepOfWhatItOpened) {
  EXPECT_EQ(player.state(), State::Paused);
  EXPECT_EQ(player.sweepNumber(), 0U);
}

TEST_F(SweepPlayerTest, StepTakesOneSweepAndStaysPaused) {
  EXPECT_TRUE(player.step());
  EXPECT_EQ(player.sweepNumber(), 1U);
  EXPECT_EQ(player.sweepTime(), "2020-01-01 00:00:10");
  EXPECT_EQ(player.display().values[0], -1.0F);
  EXPECT_EQ(player.state(), State::Paused);
}

TEST_F(SweepPlayerTest, EndsAfterTheLastSweepAndKeepsShowingIt) {
  player.play();
  EXPECT_TRUE(player.step());
  EXPECT_TRUE(player.step());
  EXPECT_EQ(player.state(), State::Playing);
  EXPECT_FALSE(player.step());
  EXPECT_EQ(player.state(), State::Ended);
  EXPECT_EQ(player.sweepNumber(), 2U);
  EXPECT_EQ(player.display().values[0], -3.0F);
  EXPECT_FALSE(player.step());
}

TEST_F(SweepPlayerTest, PlaysFromTheBeginningWhenItStoodAtTheEnd) {
  player.step();
  player.step();
  player.step();
  player.play();
  EXPECT_EQ(player.state(), State::Playing);
  EXPECT_TRUE(player.step());
  EXPECT_EQ(player.sweepNumber(), 1U);
}

TEST_F(SweepPlayerTest, PlaysOnWhereItWasPaused) {
  player.play();
  player.step();
  player.pause();
  player.play();
  player.step();
  EXPECT_EQ(player.sweepNumber(), 2U);
}

TEST_F(SweepPlayerTest, RestartGoesBackAndKeepsPlayingOnlyWhatPlayed) {
  player.step();
  player.restart();
  EXPECT_EQ(player.state(), State::Paused);
  EXPECT_EQ(player.sweepNumber(), 0U);
  player.play();
  player.step();
  player.restart();
  EXPECT_EQ(player.state(), State::Playing);
}

TEST_F(SweepPlayerTest, KeepsItsRecordingWhenAnotherCannotBeOpened) {
  player.step();
  EXPECT_THROW(player.open("missing.csv"), RuntimeError);
  EXPECT_EQ(player.recording()->path(), "two.csv");
  EXPECT_TRUE(player.step());
  EXPECT_EQ(player.sweepNumber(), 2U);
}

TEST_F(SweepPlayerTest, StandsAtTheEndWhenTheFileIsGoneAtARestart) {
  player.play();
  files.contents.clear();
  EXPECT_THROW(player.restart(), RuntimeError);
  EXPECT_EQ(player.state(), State::Ended);
}

TEST(SweepPlayer, DoesNothingWithoutARecording) {
  MemoryTextFiles files;
  SweepPlayer player(files);
  player.play();
  player.restart();
  player.pause();
  EXPECT_FALSE(player.step());
  EXPECT_EQ(player.state(), State::Empty);
  EXPECT_EQ(player.percent(), 0);
}

TEST_F(SweepPlayerTest, TellsHowFarTheReadingIs) {
  EXPECT_EQ(player.percent(), 50);  // the first row is read when the format is recognised
  player.step();
  EXPECT_EQ(player.percent(), 100);  // the row after a sweep tells that it has ended
}

}  // namespace
}  // namespace frontpanels
