// What looking up a name costs among as many as are held after 100,000 were offered, beside 100 of them.
#include <benchmark/benchmark.h>

#include <algorithm>
#include <chrono>
#include <cstdint>
#include <cstdio>
#include <string>
#include <vector>

#include "bench/allocation_count.h"
#include "framework/support/error_handler.h"
#include "pilot/cell_name_info.h"

namespace frontpanels::bench {
namespace {

constexpr int kFew = 100;
constexpr int kOffered = 100000;
constexpr int kHeld = 32767;
constexpr int kRounds = 301;
constexpr int kLookUpsARound = 1000;
// A large table lies in slower memory than a small one; a search would cost some 300 times as much.
constexpr double kLargestRatio = 10;

void fill(clsCellNameInfo& names, int offered) {
  for (int cell = 0; cell < offered; ++cell)
    names.SetCellName(cell, cell % 7, "Cell " + std::to_string(cell));
}

// The last in insertion order first, half of them by both identifiers, and one in ten that nobody has named.
double nanosecondsALookUp(const clsCellNameInfo& names, int held) {
  std::size_t characters = 0;
  const auto start = std::chrono::steady_clock::now();
  for (int i = 0; i < kLookUpsARound; ++i) {
    const int cell = i % 10 == 0 ? -1 - i : held - 1 - (i * 97) % held;
    characters += names.GetCellName(cell, i % 2 == 0 ? -1 : cell % 7).size();
  }
  const std::chrono::duration<double, std::nano> taken = std::chrono::steady_clock::now() - start;
  benchmark::DoNotOptimize(characters);
  return taken.count() / kLookUpsARound;
}

double median(std::vector<double> values) {
  std::nth_element(values.begin(), values.begin() + values.size() / 2, values.end());
  return values[values.size() / 2];
}

int compare() {
  reporting().silenceAssert = true;  // of those that the list has no room for
  clsCellNameInfo few;
  clsCellNameInfo many;
  fill(few, kFew);
  fill(many, kOffered);
  const bool right =
      many.GetCellName(kHeld - 1, -1) == "Cell 32766" && many.GetCellName(kHeld, -1) == "Unknown";
  std::vector<double> amongFew;
  std::vector<double> amongMany;
  amongFew.reserve(kRounds);
  amongMany.reserve(kRounds);
  const std::uint64_t before = allocationCount();
  for (int round = 0; round < kRounds; ++round) {
    amongFew.push_back(nanosecondsALookUp(few, kFew));
    amongMany.push_back(nanosecondsALookUp(many, kHeld));
  }
  const std::uint64_t allocations = allocationCount() - before;
  const double ratio = median(amongMany) / median(amongFew);
  std::printf("GetCellName: %.1f ns of %d, %.1f ns of %d names, ratio %.2f, %llu allocations%s\n",
              median(amongFew), kFew, median(amongMany), kHeld, ratio,
              static_cast<unsigned long long>(allocations), right ? "" : ", wrong names");
  return right && allocations == 0 && ratio < kLargestRatio ? 0 : 1;
}

}  // namespace
}  // namespace frontpanels::bench

int main() { return frontpanels::bench::compare(); }
