// Arbitrary bytes as a recording of rtl_power or hackrf_sweep. The input is the file.
#include "fuzz/fuzz_files.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  frontpanels::fuzz::FuzzFiles files({data, size});
  static_cast<void>(frontpanels::fuzz::playEverything(files));
  return 0;
}
