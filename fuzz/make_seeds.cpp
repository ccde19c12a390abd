// Writes what each fuzz target starts from into a folder a target: result buffers as hosts send them,
// sessions with a panel, recordings, and the same with something wrong.
#include <algorithm>
#include <array>
#include <bit>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <string>
#include <type_traits>
#include <vector>

#include "hosting/settings_file.h"
#include "platform/result_reader.h"
#include "platform/result_writer.h"
#include "sources/capture_format.h"

namespace frontpanels::fuzz {
namespace {

using Bytes = std::vector<std::uint8_t>;

struct Seed {
  std::string name;
  Bytes bytes;
};
using Seeds = std::vector<Seed>;

constexpr std::int32_t kHardwareId = 7;
constexpr std::int32_t kMeasurementId = 100;
constexpr std::int32_t kSweep = 25;
constexpr std::int32_t kOther = 50;
constexpr std::size_t kLengthAt = 16;  // of the first record: behind four ids
constexpr std::size_t kCountAt = 18;   // of its array

// Numbers as they lie in memory, texts and bytes as they are, one behind the other.
template <class... Parts>
Bytes joined(const Parts&... parts) {
  Bytes bytes;
  const auto append = [&bytes]<class T>(const T& part) {
    if constexpr (std::is_class_v<T>) {
      bytes.insert(bytes.end(), part.begin(), part.end());
    } else {
      const auto raw = std::bit_cast<std::array<std::uint8_t, sizeof(T)>>(part);
      bytes.insert(bytes.end(), raw.begin(), raw.end());
    }
  };
  (append(parts), ...);
  return bytes;
}

template <class T>
std::uint8_t sizeByte(const T& part) {
  return static_cast<std::uint8_t>(part.size());
}

// --- Result buffers

void sweepRecord(ResultWriter& writer, std::size_t points) {
  std::vector<float> levels(points, -80);
  if (points > 2) levels[1] = NotANumber();
  writer.BeginRecord(kSweep);
  writer.Float32Array(levels);
  writer.EndRecord();
}

void mixedRecord(ResultWriter& writer) {
  writer.BeginRecord(kOther);
  writer.Int8(-1);
  writer.UInt8(2);
  writer.Int16(-3);
  writer.Int32(4);
  writer.Float32(0.5F);
  writer.Float64(0.25);
  writer.Text("dBµV");
  writer.Float64Array(std::array{1.0, 2.0});
  writer.Array(Variant::Bytes{1, 2, 3});
  writer.Array(Variant::Int16s{1, -1});
  writer.Array(Variant::Int32s{});
  writer.Array(Variant::Singles{1.5F});
  writer.Array(Variant::Doubles{1.5});
  writer.EndRecord();
}

// Measurements of sub-measurements of records, as many on each level.
template <class Record>
Bytes buffer(int measurements, int subMeasurements, int records, Record record) {
  ResultWriter writer;
  writer.HardwareId(kHardwareId);
  for (int m = 0; m < measurements; ++m) {
    writer.BeginMeasurement(kMeasurementId + m);
    for (int s = 1; s <= subMeasurements; ++s) {
      writer.BeginSubMeasurement(s);
      for (int r = 0; r < records; ++r) record(writer);
      writer.EndSubMeasurement();
    }
    writer.EndMeasurement();
  }
  return writer.Bytes();
}

Seeds wholeBuffers() {
  const auto sweep = [](std::size_t points) {
    return [points](ResultWriter& writer) { sweepRecord(writer, points); };
  };
  const auto both = [](ResultWriter& writer) {
    mixedRecord(writer);
    sweepRecord(writer, 3);
  };
  return {{"empty", buffer(0, 0, 0, mixedRecord)},
          {"empty_measurement", buffer(2, 0, 0, mixedRecord)},
          {"empty_sub_measurement", buffer(1, 2, 0, mixedRecord)},
          {"three_levels", buffer(1, 1, 1, sweep(3))},
          {"no_level", buffer(1, 1, 1, sweep(0))},
          {"whole_sweep", buffer(1, 1, 1, sweep(513))},
          {"one_level_too_many", buffer(1, 1, 1, sweep(514))},
          {"twice_the_levels", buffer(1, 1, 1, sweep(1026))},  // beyond the panel's own object
          {"mixed", buffer(1, 1, 1, mixedRecord)},
          {"several_records", buffer(1, 1, 3, both)},
          {"nested", buffer(2, 2, 2, both)}};
}

Bytes patched(Bytes bytes, std::size_t at, int value) {
  bytes[at] = static_cast<std::uint8_t>(value);
  bytes[at + 1] = static_cast<std::uint8_t>(value >> 8);
  return bytes;
}

Seeds damagedBuffers() {
  const Bytes whole = buffer(1, 1, 2, [](ResultWriter& writer) { sweepRecord(writer, 3); });
  Seeds seeds;
  for (const std::size_t size : {0, 3, 4, 8, 12, 15, 16, 17, 18, 19, 20, 23, 31, 32, 35, 36})
    seeds.push_back({"cut_at_" + std::to_string(size), Bytes(whole.begin(), whole.begin() + size)});
  for (const int length : {-32768, -1, 0, 1, 13, 15, 30, 32767})
    seeds.push_back({"length_" + std::to_string(length), patched(whole, kLengthAt, length)});
  for (const int count : {-32768, -1, 0, 2, 4, 7, 32767})
    seeds.push_back({"count_" + std::to_string(count), patched(whole, kCountAt, count)});
  return seeds;
}

Seeds buffers() {
  Seeds seeds = wholeBuffers();
  std::ranges::move(damagedBuffers(), std::back_inserter(seeds));
  return seeds;
}

// --- Targets

// Reads by their places in the table of result_reader_fuzz.cpp.
Seeds resultReaderSeeds() {
  const Bytes ids{0, 1, 2, 4, 3, 8};  // down to a record's length
  const Bytes inARecord[] = {
      {14, 4, 3, 2, 1}, {16, 3, 2, 1}, {9, 10, 8, 7, 6, 5, 11, 15, 18, 18, 18, 18, 18}, {12, 13, 17}};
  Seeds seeds;
  for (std::size_t i = 0; i < std::size(inARecord); ++i) {
    const Bytes script = joined(ids, inARecord[i]);
    for (const Seed& seed : buffers())  // the cursor at the buffer's begin
      seeds.push_back({seed.name + "_" + std::to_string(i),
                       joined(sizeByte(script), script, std::uint8_t{0}, seed.bytes)});
  }
  return seeds;
}

// The bits of the first byte stand in display_data_fuzz.cpp.
Seeds displayDataSeeds() {
  constexpr std::uint8_t kResourceKnownTraceAdded = 3;
  constexpr std::uint8_t kCursorGivenTwice = 4 | 8;
  Seeds seeds;
  for (const Seed& seed : buffers()) {
    const auto size = static_cast<std::int32_t>(seed.bytes.size());
    seeds.push_back({seed.name, joined(kResourceKnownTraceAdded, seed.bytes)});
    seeds.push_back({seed.name + "_placed", joined(kCursorGivenTwice, std::int32_t{0}, size, seed.bytes)});
  }
  return seeds;
}

// Calls by their places in the table of entry_points_fuzz.cpp, values by theirs in fuzz_variant.cpp.
enum class Call : std::uint8_t { vfpOp, vfpSet, Publish, Resize, Paint, MouseDown, MouseMove, MouseUp };
enum class Kind : std::uint8_t { Empty = 0, Boolean = 2, Int16 = 4, Double = 8, Text = 9, Singles = 17 };
constexpr std::uint8_t kKeyDown = 11;
constexpr std::uint8_t kAddMarker = 12;
constexpr std::uint8_t kMarkerToMax = 13;
constexpr std::uint8_t kMarkerToMin = 14;
constexpr std::uint8_t kFlags = 15;
constexpr std::uint8_t kShown = 64;  // one of them
constexpr std::uint8_t kObeys = 128;
constexpr std::uint8_t kDisplayData = 16;
constexpr std::uint8_t kPopUpClick = 18;
constexpr std::uint8_t kAddTraceObject = 30;  // up to it each call is a seed of its own
constexpr std::uint8_t kPublishFrame = 38;
constexpr std::uint8_t kKinds = 20;
constexpr std::int16_t kButtons[] = {1, 9, 21, 900, 901, 1002};

constexpr std::int16_t kParameterCodes[] = {11,  13,  14,  15,  18,  43,  44,  45,  230, 312, 314, 315, 322,
                                            500, 502, 728, 729, 730, 731, 732, 750, 751, 775, 776, 780, 803,
                                            804, 700, 701, 702, 703, 704, 705, 706, 714, 716, 717, 719, 722,
                                            726, 727, 735, 736, 737, 740, 741, 742, 743, 744, 799, 810};

Bytes operation(std::int16_t code, const Bytes& parameter) {
  return joined(Call::vfpOp, kHardwareId, code, parameter);
}

Bytes parameter(std::int16_t code, const Bytes& value) {
  return joined(Call::vfpSet, kHardwareId, code, std::int16_t{0}, value);
}

Bytes mouse(Call event, std::int16_t xTwips, std::int16_t yTwips) {
  return joined(event, std::int8_t{1}, std::int8_t{0}, xTwips, yTwips);
}

// A panel with a trace and levels in it.
Bytes running() {
  Bytes levels;
  for (int i = 0; i < 16; ++i) levels = joined(levels, static_cast<float>(-100 + 7 * (i % 5)));
  return joined(kFlags, kShown, operation(10, joined(Kind::Int16, std::int16_t{10})),
                operation(12, joined(Kind::Empty)), Call::Publish, Kind::Singles, std::uint8_t{16}, levels);
}

template <class... Calls>
Bytes session(const Calls&... calls) {
  return joined(running(), calls..., Call::Paint);
}

// Three traces, and the pointer taken down the view: the bar between them is under it somewhere.
Bytes draggedBar() {
  Bytes bytes =
      joined(running(), kAddTraceObject, std::int16_t{26}, kAddTraceObject, std::int16_t{27}, Call::Paint);
  for (std::int16_t y = 900; y < 1800; y = static_cast<std::int16_t>(y + 60)) {
    const auto to = static_cast<std::int16_t>(y + 300);
    bytes = joined(bytes, mouse(Call::MouseMove, 1800, y), mouse(Call::MouseDown, 1800, y),
                   mouse(Call::MouseMove, 1800, to), mouse(Call::MouseUp, 1800, to));
  }
  return bytes;
}

// A frame of three pilots for each server. The byte before the values says which path is strange: none.
Bytes pilotFrames() {
  struct Server {
    std::uint8_t paths;
    std::uint8_t noneStrange;
  };
  constexpr Server kServers[] = {{2, 3}, {2, 3}, {7, 13}, {7, 13}, {3, 5}};
  Bytes bytes = joined(kFlags, kShown);
  for (std::uint8_t server = 0; server < 5; ++server) {
    bytes = joined(bytes, kPublishFrame, server, std::uint8_t{3}, kServers[server].noneStrange);
    for (int value = 0; value < 3 * kServers[server].paths; ++value)
      bytes.push_back(static_cast<std::uint8_t>(value * 11));
  }
  return bytes;
}

// Each session on both panels.
Seeds onBothPanels(const Seeds& sessions) {
  Seeds seeds;
  for (const Seed& seed : sessions) {
    seeds.push_back({seed.name, joined(std::uint8_t{0}, seed.bytes)});
    seeds.push_back({seed.name + "_pilots", joined(std::uint8_t{1}, pilotFrames(), seed.bytes)});
  }
  return seeds;
}

Seeds entryPointSeeds() {
  const Bytes one = joined(Kind::Int16, std::int16_t{1});
  const Bytes yes = joined(Kind::Boolean, std::uint8_t{1});
  const Bytes obeying = joined(kFlags, std::uint8_t{kShown | kObeys});
  Seeds seeds{{"markers", session(kAddMarker, kMarkerToMax, kAddMarker, kMarkerToMin, kKeyDown,
                                  std::int16_t{39}, std::int8_t{0})},
              {"drag", session(kAddMarker, mouse(Call::MouseDown, 1800, 1300),
                               mouse(Call::MouseMove, 900, 1300), mouse(Call::MouseUp, 900, 1300))},
              {"markers_by_code",
               session(parameter(740, one), parameter(741, yes), parameter(744, one), parameter(743, one),
                       parameter(742, one), parameter(735, one), parameter(737, one))},
              {"saving", session(obeying, operation(9, one), operation(13, one))},
              {"bar", draggedBar()},
              {"two_traces", session(running(), Call::Resize, std::int16_t{320}, std::int16_t{200})}};
  const auto add = [&seeds](const std::string& name, int number, const Bytes& bytes) {
    seeds.push_back({name + "_" + std::to_string(number), bytes});
  };
  for (std::int16_t code = 0; code <= 22; ++code) add("operation", code, session(operation(code, one)));
  for (const std::int16_t code : kParameterCodes) {
    const std::string name = "parameter_" + std::to_string(code);
    seeds.push_back({name + "_number", session(parameter(code, joined(Kind::Double, 2.5)))});
    seeds.push_back({name + "_text", session(parameter(code, joined(Kind::Text, std::uint8_t{2}, '1', '2')),
                                             parameter(code, yes))});
  }
  for (const std::int16_t button : kButtons)
    add("button", button, session(obeying, kPopUpClick, kHardwareId, button));
  for (std::uint8_t call = 0; call <= kAddTraceObject; ++call) add("call", call, session(call, 0, 0, 0, 0));
  for (const Seed& seed : wholeBuffers())
    seeds.push_back({"display_" + seed.name,
                     session(kDisplayData, static_cast<std::uint16_t>(seed.bytes.size()), seed.bytes)});
  for (std::uint8_t kind = 0; kind < kKinds; ++kind)
    add("value", kind, session(parameter(717, joined(kind, std::uint8_t{2}, 1.5, 2.5))));
  return onBothPanels(seeds);
}

// Steps by their places in the table of entry_parser_fuzz.cpp.
Seeds entryParserSeeds() {
  constexpr std::uint8_t kLeave = 0;
  constexpr std::uint8_t kKey = 1;
  constexpr std::uint8_t kMaximum = 7;
  constexpr std::uint8_t kFirstOfClicks = 19;
  constexpr std::uint8_t kFirstOfUnits = 24;
  Seeds seeds;
  for (const std::string text : {"98.1", "900k", "1.6 GHz", "-5e3 m", "1,5", "1e400", "nan", "k", ""})
    for (std::uint8_t units = kFirstOfUnits; units < kFirstOfUnits + 5; ++units)
      seeds.push_back({"typed_" + std::to_string(seeds.size()),
                       joined(units, kMaximum, 1e9, kLeave, sizeByte(text), text, kKey, sizeByte(text), text,
                              std::int16_t{13}, kFirstOfClicks, std::uint8_t{kFirstOfClicks + 1})});
  return seeds;
}

// --- Recordings

Frame capturedFrame(std::size_t bins, bool hasPilots) {
  Frame frame;
  frame.time = "2020-01-01 00:00:10";
  frame.sweep.emplace();
  frame.sweep->startHz = 88e6;
  frame.sweep->stepHz = 1e4;
  frame.sweep->levelsDb.assign(bins, -60);
  if (!hasPilots) return frame;
  PilotFrame& pilots = frame.pilots.emplace();
  pilots.allPilots = PilotLevels{-60, {-3, kGap, -12}};
  pilots.zoomedPilots = PilotLevels{-60, {-3}};
  pilots.topN = PilotBars{-60, {{12, -3, 1, -2, 0.5F, 1}, {100, -9, 2, -8, 0.5F, 1}}};
  pilots.userList = PilotBars{-60, {}};
  pilots.carrier = CarrierState{-12, 2, 1};
  return frame;
}

// The first byte is that of capture_fuzz.cpp.
Seeds captureSeeds() {
  constexpr std::uint8_t kAsItIs = 0;
  constexpr std::uint8_t kPutRight = 1;
  std::vector<char> sweep;
  std::vector<char> all;
  if (!encodeFrame(capturedFrame(4, false), sweep) || !encodeFrame(capturedFrame(2, true), all)) return {};
  const Bytes file = joined(kAsItIs, sweep, all, sweep);
  Seeds seeds{{"none", joined(kAsItIs)},
              {"whole", file},
              {"to_put_right", joined(kPutRight, all, sweep)},
              {"passed_over", joined(kAsItIs, sweep, std::string("between"), all)}};
  for (const std::size_t size : {5, 20, 30, 100, 150, 200})
    seeds.push_back({"cut_at_" + std::to_string(size), Bytes(file.begin(), file.begin() + size)});
  for (const std::size_t at : {1, 5, 9, 13, 17, 25, 80}) {
    Bytes damaged = file;
    damaged[at] ^= 16;
    seeds.push_back({"damaged_at_" + std::to_string(at), damaged});
  }
  return seeds;
}

Seeds recordingSeeds() {
  const std::string rtl =
      "2020-01-01,00:00:10,100,120,10.00,1,-1.5,-2.25\n2020-01-01,00:00:10,120,140,10.00,1,-3,nan\n"
      "2020-01-01,00:00:20,100,120,10.00,1,-1.5,-2.25,-2.25\n";
  const std::string hackrf =
      "2020-01-01, 00:00:10.25, 10000000, 15000000, 2500000.00, 8, -1, -2\r\n"
      "2020-01-01, 00:00:10.25, 20000000, 25000000, 2500000.00, 8, -1, -2\r\n"
      "2020-01-01, 00:00:10.50, 10000000, 15000000, 2500000.00, 8, -1, -2\r\n";
  Seeds seeds;
  for (const std::string& text : {rtl, hackrf, rtl + hackrf, "heading\n\n" + rtl + "what\n" + rtl,
                                  rtl.substr(0, 90), "\xef\xbb\xbf" + rtl, std::string("\n")})
    seeds.push_back({"recording_" + std::to_string(seeds.size()), joined(text)});
  return seeds;
}

// What a host writes, what people make of it, and what each may be damaged to.
Seeds settingsSeeds() {
  SettingsFile file;
  SettingsSection& window = file.section("window");
  window.set("left", 0.1);
  window.set("path = #[1]", "C:\\100%\n\x1b");
  file.section("spectrum set-up 3")
      .settings({{13, 0, 881.5e6},
                 {740, -1, std::int16_t{1}},
                 {314, 0, "a \"b\""},
                 {7, 0, Variant::null()},
                 {8, 0, Variant::Singles{0.5F, 1}},
                 {9, 0, DateValue{1.5}},
                 {10, 0, true},
                 {11, 0, 0.1F}});
  const std::string text = file.text();
  const std::string whole[] = {text,
                               "\xEF\xBB\xBF" + text,
                               text + "\r\n",
                               SettingsFile().text(),
                               text.substr(0, text.size() / 2),
                               text.substr(1)};
  Seeds seeds;
  for (const std::string& one : whole)
    seeds.push_back({"settings_" + std::to_string(seeds.size()), Bytes(one.begin(), one.end())});
  return seeds;
}

bool write(const std::filesystem::path& folder, const Seeds& seeds) {
  std::filesystem::create_directories(folder);
  return std::ranges::all_of(seeds, [&folder](const Seed& seed) {
    std::ofstream file(folder / seed.name, std::ios::binary);
    file.write(reinterpret_cast<const char*>(seed.bytes.data()),
               static_cast<std::streamsize>(seed.bytes.size()));
    return file.good();
  });
}

}  // namespace
}  // namespace frontpanels::fuzz

int main(int argc, char** argv) {
  using namespace frontpanels::fuzz;
  if (argc != 2) {
    std::fprintf(stderr, "usage: make_seeds FOLDER\n");
    return 2;
  }
  const std::filesystem::path corpus(argv[1]);
  const bool written = write(corpus / "result_reader_fuzz", resultReaderSeeds()) &&
                       write(corpus / "display_data_fuzz", displayDataSeeds()) &&
                       write(corpus / "entry_points_fuzz", entryPointSeeds()) &&
                       write(corpus / "entry_parser_fuzz", entryParserSeeds()) &&
                       write(corpus / "capture_fuzz", captureSeeds()) &&
                       write(corpus / "recording_fuzz", recordingSeeds()) &&
                       write(corpus / "settings_fuzz", settingsSeeds());
  return written ? 0 : 1;
}
