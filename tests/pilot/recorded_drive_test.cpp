// A drive that others recorded and published, played through the panel where the file is at hand.
#include <filesystem>
#include <map>
#include <set>
#include <sstream>

#include "tests/pilot/pilot_fixture.h"

namespace frontpanels::testing {
namespace {

constexpr std::size_t kPilotsOfFrame = 12;
constexpr std::size_t kQualityColumn = 11;
constexpr std::size_t kCodeColumn = 16;

// Tab-separated rows, one pilot each: its scrambling code, 0 to 511, and its Ec/No in dB.
class RecordedDrive {
 public:
  explicit RecordedDrive(const std::string& path) : reader_(systemTextFiles().open(path, 4096)) {
    reader_->readLine(line_);  // titles
  }
  // False at the end; rows of other networks hold no code and are passed over.
  bool next(float& code, float& quality) {
    while (reader_->readLine(line_)) {
      std::vector<std::string> columns;
      std::istringstream row(line_.text);
      for (std::string column; std::getline(row, column, '\t');) columns.push_back(column);
      double codeNumber = 0;
      double qualityDb = 0;
      if (columns.size() <= kCodeColumn || !textToNumber(columns[kCodeColumn], codeNumber) ||
          !textToNumber(columns[kQualityColumn], qualityDb) || codeNumber > 511)
        continue;
      code = static_cast<float>(codeNumber);
      quality = static_cast<float>(qualityDb);
      return true;
    }
    return false;
  }

 private:
  std::unique_ptr<TextReader> reader_;
  TextLine line_;
};

// A frame holds the codes heard last, the latest first.
TEST_F(PilotTest, ARecordedDriveKeepsEveryPilotsIdentityWhileItIsOnTheChart) {
  const std::string path = FRONTPANELS_TEST_DATA "/14_umts_drive_psc_ecno.txt";
  if (!std::filesystem::exists(path)) GTEST_SKIP() << "the recording is not at hand";
  RecordedDrive drive(path);
  std::vector<Pilot> heard;
  std::map<float, std::int16_t> before;
  std::size_t frames = 0;
  for (Pilot pilot{}; drive.next(pilot.pn, pilot.ecIo); ++frames) {
    std::erase_if(heard, [&](const Pilot& other) { return other.pn == pilot.pn; });
    heard.insert(heard.begin(), pilot);
    if (heard.size() > kPilotsOfFrame) heard.pop_back();
    publishFrame(kTopNPath, heard);
    std::map<float, std::int16_t> now;
    std::set<std::int16_t> identities;
    for (const Bar& bar : bars(203)->bars()) {
      now[bar.key] = bar.barId;
      identities.insert(bar.barId);
      const auto known = before.find(bar.key);
      ASSERT_EQ(known == before.end() ? bar.barId : known->second, bar.barId) << "frame " << frames;
    }
    ASSERT_EQ(identities.size(), heard.size());
    // A code that comes takes over from the one that goes: there are never more identities than bars.
    ASSERT_LE(*identities.rbegin(), static_cast<std::int16_t>(kPilotsOfFrame));
    before = std::move(now);
  }
  EXPECT_GT(frames, 1000U);
  EXPECT_EQ(messages(), Messages{});
}

}  // namespace
}  // namespace frontpanels::testing
