#include "sources/frame_player.h"

#include <gtest/gtest.h>

#include <functional>

#include "tests/support/memory_text_files.h"
#include "tests/support/raised.h"

namespace frontpanels {
namespace {

class FramePlayerTest : public ::testing::Test {
 protected:
  FramePlayerTest() {
    files.contents["three.csv"] =
        "2020-01-01,00:00:10,100,120,10.00,1,-1,-2\n"
        "2020-01-01,00:00:20,100,120,10.00,1,-3,-4\n"
        "2020-01-01,00:00:30,100,120,10.00,1,-5,-6\n";
    player.open(openRecording(files, "three.csv"));
  }

  // The state and the number of the frame.
  std::string now() {
    static constexpr const char* kStates[] = {"empty", "paused", "playing", "ended"};
    return kStates[static_cast<int>(player.state())] + (" " + std::to_string(player.frameNumber()));
  }

  testing::MemoryTextFiles files;
  FramePlayer player;
};

TEST_F(FramePlayerTest, DoesWhatTheKeysOfARecorderDo) {
  FramePlayer& p = player;
  const struct {
    const char* key;
    std::function<void()> press;
    const char* now;
  } kPresses[] = {
      {"at first", [] {}, "paused 0"},
      {"back before the first", [&] { p.stepBack(); }, "paused 0"},
      {"step", [&] { EXPECT_TRUE(p.step()); }, "paused 1"},
      {"back at the first", [&] { p.stepBack(); }, "paused 1"},
      {"play", [&] { p.play(); }, "playing 1"},
      {"step", [&] { EXPECT_TRUE(p.step()); }, "playing 2"},
      {"back while playing", [&] { p.stepBack(); }, "playing 1"},
      {"pause", [&] { p.pause(); }, "paused 1"},
      {"seek", [&] { p.seek(3); }, "paused 3"},
      {"step at the end", [&] { EXPECT_FALSE(p.step()); }, "ended 3"},
      {"once more", [&] { EXPECT_FALSE(p.step()); }, "ended 3"},
      {"pause at the end", [&] { p.pause(); }, "ended 3"},
      {"back from the end", [&] { p.stepBack(); }, "paused 2"},
      {"seek too far", [&] { p.seek(99); }, "paused 3"},
      {"seek to nothing", [&] { p.seek(0); }, "paused 1"},
      {"restart", [&] { p.restart(); }, "paused 0"},
      {"play", [&] { p.play(); }, "playing 0"},
      {"seek while playing", [&] { p.seek(2); }, "playing 2"},
      {"restart while playing", [&] { p.restart(); }, "playing 0"},
      {"seek to the last", [&] { p.seek(3); }, "playing 3"},
      {"step at the end", [&] { EXPECT_FALSE(p.step()); }, "ended 3"},
      {"play from the end", [&] { p.play(); }, "playing 0"},
      {"step", [&] { EXPECT_TRUE(p.step()); }, "playing 1"},
      {"seek to the last", [&] { p.seek(3); }, "playing 3"},
      {"step in a loop",
       [&] {
         p.loop(true);
         EXPECT_TRUE(p.step());
       },
       "playing 1"},
      {"pause and seek",
       [&] {
         p.pause();
         p.seek(3);
       },
       "paused 3"},
      {"step in a loop", [&] { EXPECT_TRUE(p.step()); }, "paused 1"},
      {"end",
       [&] {
         p.loop(false);
         p.seek(3);
         EXPECT_FALSE(p.step());
       },
       "ended 3"},
      {"step on in a loop",
       [&] {
         p.loop(true);
         EXPECT_TRUE(p.step());
       },
       "paused 1"},
      {"nothing to open", [&] { p.open(nullptr); }, "paused 1"},
      {"close", [&] { p.close(); }, "empty 0"},
      {"all keys without a source",
       [&] {
         p.play();
         p.pause();
         p.restart();
         p.stepBack();
         p.seek(1);
         EXPECT_FALSE(p.step());
       },
       "empty 0"},
  };
  for (const auto& press : kPresses) {
    press.press();
    EXPECT_EQ(now(), press.now) << press.key;
  }
}

TEST_F(FramePlayerTest, StaysAtTheEndOfTheOnlyFrameWhenThereIsNoneBefore) {
  files.contents["one.csv"] = "2020-01-01,00:00:10,100,120,10.00,1,-1,-2\n";
  player.open(openRecording(files, "one.csv"));
  EXPECT_TRUE(player.step());
  EXPECT_FALSE(player.step());
  player.stepBack();
  EXPECT_EQ(now(), "ended 1");
}

TEST_F(FramePlayerTest, ShowsTheFrameAndHowFarItIs) {
  EXPECT_EQ(player.percent(), 0);
  EXPECT_EQ(player.frameCount(), 3U);
  player.seek(2);
  EXPECT_EQ(player.frame().time, "2020-01-01 00:00:20");
  EXPECT_EQ(player.frame().sweep->levelsDb[0], -3.0F);
  EXPECT_EQ(player.percent(), 66);  // 2 of 3
  player.step();
  EXPECT_EQ(player.percent(), 100);
  player.step();
  EXPECT_EQ(player.frame().sweep->levelsDb[0], -5.0F);  // the last one stays
  player.restart();
  EXPECT_EQ(player.frame().time, "");
  player.close();
  EXPECT_EQ(player.percent(), 0);
  EXPECT_EQ(player.frameCount(), std::nullopt);
  EXPECT_EQ(player.source(), nullptr);
  EXPECT_FALSE(player.frame().sweep);
}

TEST_F(FramePlayerTest, StandsAtTheEndWhenTheFileIsGoneAndKeepsTheFrame) {
  const std::function<void()> kKeys[] = {[&] { player.restart(); }, [&] { player.seek(1); },
                                         [&] { player.stepBack(); }};
  const auto contents = files.contents;
  for (const auto& press : kKeys) {
    player.seek(2);
    player.play();
    files.contents.clear();
    EXPECT_EQ(testing::raised([&] { return press(), 0; }), "three.csv: File not found");
    EXPECT_EQ(now(), "ended 2");
    files.contents = contents;
  }
  player.seek(3);
  player.loop(true);
  files.contents.clear();
  EXPECT_EQ(testing::raised([&] { return player.step(); }), "three.csv: File not found");
  EXPECT_EQ(now(), "ended 3");
}

}  // namespace
}  // namespace frontpanels
