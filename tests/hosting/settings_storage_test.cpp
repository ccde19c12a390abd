#include <gtest/gtest.h>

#include "hosting/settings_file.h"
#include "tests/support/raised.h"
#include "tests/support/temp_folder.h"

namespace frontpanels {
namespace {

class SettingsStorageTest : public ::testing::Test {
 protected:
  LoadedSettings load(const std::string& file) { return loadSettings(folder.pathOf(file)); }

  testing::TempFolder folder;
};

TEST_F(SettingsStorageTest, ThereIsNothingToSayWithoutAFile) {
  for (const char* const file : {"a.settings", "none/a.settings"}) {
    const LoadedSettings loaded = load(file);
    EXPECT_EQ(loaded.problem, "");
    EXPECT_EQ(loaded.settings, SettingsFile());
    EXPECT_TRUE(loaded.mayBeReplaced);
  }
}

TEST_F(SettingsStorageTest, FindsWhatItSavedInAFolderThatItMade) {
  SettingsFile file;
  file.section("window").set("left", 0.1);
  saveSettings(folder.pathOf("b/c/a.settings"), file);
  EXPECT_EQ(load("b/c/a.settings").settings, file);
  EXPECT_EQ(load("b/c/a.settings").problem, "");
}

TEST_F(SettingsStorageTest, WhatCannotBeUsedIsKeptUnderTheNextFreeName) {
  const std::string texts[] = {"cut", "# Front Panels settings, format 2\n",
                               std::string((1U << 20U) + 1, '#')};
  const std::string reasons[] = {"line 1: these are no settings of Front Panels",
                                 "line 1: settings of format 2, and this program reads format 1",
                                 "the file is larger than 1 MB"};
  folder.write("a.settings.damaged-2", "of long ago");
  const std::string names[] = {"a.settings.damaged-1", "a.settings.damaged-3", "a.settings.damaged-4"};
  for (int i = 0; i < 3; ++i) {
    folder.write("a.settings", texts[i]);
    const LoadedSettings loaded = load("a.settings");
    EXPECT_EQ(loaded.problem, folder.pathOf("a.settings") + ": " + reasons[i] +
                                  ". Nothing of it is used; the file was kept as " + names[i] + ".");
    EXPECT_EQ(loaded.settings, SettingsFile());
    EXPECT_TRUE(loaded.mayBeReplaced);
    EXPECT_EQ(folder.read(names[i]), texts[i]);
  }
  EXPECT_EQ(folder.names(),
            "a.settings.damaged-1 a.settings.damaged-2 a.settings.damaged-3 a.settings.damaged-4 ");
}

TEST_F(SettingsStorageTest, WhatCannotBeKeptAsideMustNotBeReplaced) {
  const std::string longName(250, 'x');  // ".damaged-1" behind it makes more than the 255 bytes of a name
  std::filesystem::create_directory(folder.pathOf("folder"));
  folder.write(longName, "cut");
  const std::pair<std::string, std::string> rows[] = {
      {longName, "line 1: these are no settings of Front Panels"}, {"folder", "this is no file"}};
  for (const auto& [name, reason] : rows) {
    const LoadedSettings loaded = load(name);
    EXPECT_EQ(loaded.problem,
              folder.pathOf(name) + ": " + reason +
                  ". Nothing of it is used; the file could not be renamed, stays as it is and will not be "
                  "written over.");
    EXPECT_FALSE(loaded.mayBeReplaced);
  }
  EXPECT_EQ(folder.read(longName), "cut");
}

TEST_F(SettingsStorageTest, SaysWhichFolderCannotBeMade) {
  folder.write("b", "a file");
  EXPECT_EQ(testing::raised([&] { return saveSettings(folder.pathOf("b/c/a.settings"), SettingsFile()), 0; }),
            folder.pathOf("b/c") + ": cannot be created: Not a directory");
}

}  // namespace
}  // namespace frontpanels
