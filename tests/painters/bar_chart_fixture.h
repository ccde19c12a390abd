// A bar chart on a recording surface: items of key and value, in arrival order until a test sorts them.
#pragma once

#include <limits>
#include <string>
#include <utility>
#include <vector>

#include "painters/bar_chart_painter.h"
#include "platform/variant.h"
#include "tests/support/recording_gdi.h"
#include "tests/support/reporting_fixture.h"

namespace frontpanels::testing {

inline constexpr float kNoNumber = std::numeric_limits<float>::quiet_NaN();

class BarChartTest : public ReportingTest {
 protected:
  using Items = std::vector<std::pair<float, float>>;  // key and value

  BarChartTest() : chart(gdi) { chart.barSortByMode(0); }

  void update(const Variant::Singles& values, std::int32_t items, std::int32_t elements) {
    chart.numberOfMeasurements(items);
    chart.dataChanged(true);
    chart.trace(Variant(values));
    chart.elementsPerValue(elements);
    chart.processData();
  }
  void update(const Items& items) {
    Variant::Singles values;
    for (const auto& [key, value] : items) {
      values.push_back(key);
      values.push_back(value);
    }
    update(values, static_cast<std::int32_t>(items.size()), 2);
  }
  // `text` of each bar, in order, "5 9 17".
  template <class Text>
  [[nodiscard]] std::string each(Text text) const {
    std::string all;
    for (const HeldBar& bar : chart.bars()) all += (all.empty() ? "" : " ") + text(bar);
    return all;
  }
  [[nodiscard]] std::string keys() const {
    return each([](const HeldBar& bar) { return numberToText(bar.key); });
  }
  [[nodiscard]] std::string values() const {
    return each([](const HeldBar& bar) { return numberToText(bar.value); });
  }
  [[nodiscard]] std::string others() const {
    return each([](const HeldBar& bar) { return numberToText(bar.other); });
  }
  // "5:1 9:2": identity 1 has key 5.
  [[nodiscard]] std::string keysAndIds() const {
    return each([](const HeldBar& bar) { return numberToText(bar.key) + ":" + std::to_string(bar.barId); });
  }

  RecordingGdi gdi;
  DcHandle dc = gdi.viewDc();
  clsBarChartPainter chart;
};

}  // namespace frontpanels::testing
