#include "entry/host_data_version.h"

namespace frontpanels {
namespace {

double& currentVersion() noexcept {
  static double version = kHostDataWithOrders;
  return version;
}

}  // namespace

double hostDataVersion() noexcept { return currentVersion(); }

void hostDataVersion(double version) noexcept { currentVersion() = version; }

}  // namespace frontpanels
