#include "hosting/whole_file.h"

#include <gtest/gtest.h>
#include <sys/resource.h>
#include <sys/wait.h>

#include <array>
#include <atomic>
#include <csignal>
#include <functional>
#include <random>

#include "hosting/settings_file.h"
#include "tests/support/raised.h"
#include "tests/support/temp_folder.h"

namespace frontpanels {
namespace {

namespace fs = std::filesystem;

// A program of its own that runs `body` and ends; what it sends comes through a pipe.
class Child {
 public:
  using Send = std::function<void(const std::string&)>;
  explicit Child(const std::function<void(const Send&)>& body) {
    std::array<int, 2> pipeEnds{};
    if (pipe(pipeEnds.data()) != 0) throw std::runtime_error("no pipe");
    process_ = fork();
    if (process_ == 0) {
      body([&](const std::string& text) {
        if (write(pipeEnds[1], text.data(), text.size()) < 0) _exit(2);
      });
      _exit(0);
    }
    close(pipeEnds[1]);
    from_ = pipeEnds[0];
  }
  ~Child() { close(from_); }
  Child(const Child&) = delete;
  Child& operator=(const Child&) = delete;

  // As many bytes, or what it sends until it ends.
  std::string receive(std::size_t count) const {
    std::string text;
    for (char c = 0; text.size() < count && read(from_, &c, 1) == 1;) text += c;
    return text;
  }
  void killNow() const { kill(process_, SIGKILL); }
  // 0 for one that ended well.
  [[nodiscard]] int wait() const {
    int status = -1;
    waitpid(process_, &status, 0);
    return status;
  }

 private:
  pid_t process_ = -1;
  int from_ = -1;
};

class WholeFileTest : public ::testing::Test {
 protected:
  std::string problemOf(const std::string& file, std::string_view text) const {
    return testing::raised([&] { return saveWhole(folder.pathOf(file), text), 0; });
  }

  testing::TempFolder folder;
};

TEST_F(WholeFileTest, TakesThePlaceOfWhatWasThereAndLeavesNothingElse) {
  EXPECT_EQ(problemOf("a \u00E4", "a longer first text"), "");
  EXPECT_EQ(problemOf("a \u00E4", "second"), "");
  EXPECT_EQ(folder.read("a \u00E4"), "second");
  EXPECT_EQ(problemOf("empty", ""), "");
  EXPECT_EQ(folder.names(), "a \u00E4 empty ");
}

TEST_F(WholeFileTest, WritesOverWhatAKilledProgramLeft) {
  folder.write("a.part", "half of a much longer text");
  EXPECT_EQ(problemOf("a", "whole"), "");
  EXPECT_EQ(folder.read("a") + " " + folder.names(), "whole a ");
}

TEST_F(WholeFileTest, ALinkStaysOneAndPermissionsStay) {
  folder.write("target", "old");
  fs::permissions(folder.pathOf("target"), fs::perms::owner_read | fs::perms::owner_write);
  fs::create_symlink("target", folder.pathOf("link"));
  EXPECT_EQ(problemOf("link", "new"), "");
  EXPECT_TRUE(fs::is_symlink(folder.pathOf("link")));
  EXPECT_EQ(folder.read("target"), "new");
  EXPECT_EQ(fs::status(folder.pathOf("target")).permissions(),
            fs::perms::owner_read | fs::perms::owner_write);
}

TEST_F(WholeFileTest, SaysWhatItCannotWriteAndWhy) {
  const std::string longName(252, 'x');  // ".part" behind it makes more than the 255 bytes of a name
  fs::create_directories(folder.pathOf("folder/inside"));
  const std::pair<std::string, std::string> rows[] = {{"none/a", "No such file or directory"},
                                                      {"folder", "Is a directory"},
                                                      {longName, "File name too long"}};
  for (const auto& [name, reason] : rows)
    EXPECT_EQ(problemOf(name, "text"), folder.pathOf(name) + ": cannot be written: " + reason);
  EXPECT_EQ(folder.names(), "folder ");
}

TEST_F(WholeFileTest, OnAFullDiskTheOldFileStays) {
  folder.write("a", "old");
  const Child child([&](const Child::Send& send) {
    const rlimit bytes{1000, 1000};
    signal(SIGXFSZ, SIG_IGN);  // so that writing fails instead
    if (setrlimit(RLIMIT_FSIZE, &bytes) == 0) send(problemOf("a", std::string(5000, 'x')));
  });
  EXPECT_EQ(child.receive(1000), folder.pathOf("a") + ": cannot be written: File too large");
  EXPECT_EQ(child.wait(), 0);
  EXPECT_EQ(folder.read("a") + " " + folder.names(), "old a ");
}

TEST_F(WholeFileTest, ProgramsThatSaveAtOnceDoNotMix) {
  const auto saver = [this](char letter, std::size_t bytes) {
    return [this, letter, bytes](const Child::Send& send) {
      for (int i = 0; i < 60; ++i) send(problemOf("a", std::string(bytes, letter)));
    };
  };
  const Child shortOne(saver('a', 100));
  const Child longOne(saver('b', 300000));
  EXPECT_EQ(shortOne.receive(1000) + longOne.receive(1000), "");
  EXPECT_EQ(shortOne.wait() + longOne.wait(), 0);
  const std::string last = folder.read("a");
  EXPECT_TRUE(last == std::string(100, 'a') || last == std::string(300000, 'b')) << last.size();
  EXPECT_EQ(folder.names(), "a ");
}

SettingsFile settingsOf(std::int32_t values) {
  SettingsFile file;
  for (std::int32_t i = 0; i < values; ++i) file.section("window").set("value " + std::to_string(i), i);
  return file;
}

TEST_F(WholeFileTest, SettingsSurviveAKillAtAnyMoment) {
  const SettingsFile few = settingsOf(3);
  const SettingsFile many = settingsOf(400);
  const std::string path = folder.pathOf("a.settings");
  std::mt19937 random(20240501);
  int inTheMiddle = 0;
  for (int round = 0; round < 100; ++round) {
    const Child child([&](const Child::Send& send) {
      for (int save = 0;; ++save) {
        saveSettings(path, save % 2 == 0 ? many : few);
        send(".");
      }
    });
    EXPECT_NE(child.receive(1 + random() % 3), "");
    std::atomic<unsigned> spins = 1U << random() % 19;
    while (spins-- > 0) {
    }
    child.killNow();
    EXPECT_TRUE(WIFSIGNALED(child.wait()));
    inTheMiddle += fs::exists(path + ".part") ? 1 : 0;
    const LoadedSettings loaded = loadSettings(path);
    EXPECT_EQ(loaded.problem, "");
    EXPECT_TRUE(loaded.settings == few || loaded.settings == many);
    EXPECT_FALSE(loaded.settings.changedByHand());
  }
  EXPECT_GT(inTheMiddle, 5);  // or the kills would have missed the saving
  saveSettings(path, few);
  EXPECT_EQ(folder.names(), "a.settings ");
}

}  // namespace
}  // namespace frontpanels
