// Stands before every file of the library's build for tests: each barrier asks here whether it is to fail.
#pragma once

namespace frontpanels::testing {

// Raises what the test has asked for, when it is the turn of this barrier.
void faultPoint();

}  // namespace frontpanels::testing

#define FRONTPANELS_FAULT_POINT() ::frontpanels::testing::faultPoint()
