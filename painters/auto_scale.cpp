#include "painters/auto_scale.h"

#include <cmath>
#include <limits>

#include "framework/support/numeric.h"
#include "framework/support/utility.h"

namespace frontpanels {

bool axisFits(const ValueRange& axis, const ValueRange& data) noexcept {
  const double range = axis.maximum - axis.minimum;
  return data.maximum <= axis.maximum - 0.001 * range && data.maximum >= axis.maximum - 0.2 * range &&
         data.minimum <= axis.minimum + 0.2 * range && data.minimum >= axis.minimum + 0.001 * range;
}

FittedAxis axisFor(const ValueRange& data, std::int32_t divisions) {
  const double step = OneTwoFive((data.maximum - data.minimum) / 0.85 / divisions);
  const double span = step * divisions;
  const double unit = span * 0.1;
  const double center = (data.maximum + data.minimum + span) / 2;
  const double tenths = center / unit;
  const bool whole = std::fabs(tenths) <= std::numeric_limits<std::int32_t>::max();
  return {whole ? roundHalfEven(tenths) * unit : center, step};
}

}  // namespace frontpanels
