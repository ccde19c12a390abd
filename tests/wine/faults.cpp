// The library's build for tests: allocations are counted and fail when they are told to, and so do barriers.
#include <cstdlib>
#include <new>

#include "platform/runtime_error.h"
#include "tests/wine/fault_point.h"

namespace {

long liveBlocks = 0;
long allocationsLeft = 0;  // until one fails; 0 for never
bool goesOn = false;       // to fail, once one has
long allocationsFailed = 0;

enum Fault : int { kNone, kRuntimeError, kBadAlloc, kNumber };
int fault = kNone;
long barriersLeft = 0;  // that are passed before one fails
long barriersFailed = 0;

bool failsNow() noexcept {
  if (allocationsLeft == 0) return false;
  if (allocationsLeft > 1) return --allocationsLeft, false;
  if (!goesOn) allocationsLeft = 0;
  ++allocationsFailed;
  return true;
}

}  // namespace

void* operator new(std::size_t bytes) {
  void* const block = failsNow() ? nullptr : std::malloc(bytes > 0 ? bytes : 1);
  if (block == nullptr) throw std::bad_alloc();
  ++liveBlocks;
  return block;
}
void operator delete(void* block) noexcept {
  if (block != nullptr) --liveBlocks;
  std::free(block);
}
void operator delete(void* block, std::size_t) noexcept { operator delete(block); }

void frontpanels::testing::faultPoint() {
  if (fault == kNone || barriersLeft-- > 0) return;
  const int raised = fault;
  fault = kNone;
  ++barriersFailed;
  if (raised == kRuntimeError) throw RuntimeError(5, "A fault for the barrier");
  if (raised == kBadAlloc) throw std::bad_alloc();
  throw 1;
}

extern "C" {

__declspec(dllexport) long __stdcall FaultsLiveBlocks() { return liveBlocks; }
// The n-th allocation from now on fails, or all from there on; 0 ends it. Answers how many failed since the
// last call.
__declspec(dllexport) long __stdcall FaultsFailAllocation(long n, int andOn) {
  const long failed = allocationsFailed;
  allocationsFailed = 0;
  allocationsLeft = n;
  goesOn = andOn != 0;
  return failed;
}
// A barrier fails with a kind of fault, after some that do not. Answers as above.
__declspec(dllexport) long __stdcall FaultsFailBarrier(int kind, long after) {
  const long failed = barriersFailed;
  barriersFailed = 0;
  fault = kind;
  barriersLeft = after;
  return failed;
}

}  // extern "C"
