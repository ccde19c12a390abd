// Centre, span, start and stop of a sweep and how they follow each other. All in hertz.
#pragma once

#include <string_view>

namespace frontpanels {

// The widest sweep that the panel can be set to.
inline constexpr double kLowestFrequencyHz = 0.0;
inline constexpr double kHighestFrequencyHz = 6.0e9;

class FrequencyPlan {
 public:
  [[nodiscard]] double centerHz() const noexcept { return centerHz_; }
  [[nodiscard]] double spanHz() const noexcept { return spanHz_; }
  [[nodiscard]] double startHz() const noexcept { return startHz_; }
  [[nodiscard]] double stopHz() const noexcept { return stopHz_; }

  // Values outside the limits go to the nearer one; a value that is not finite changes nothing.
  // The centre takes start and stop along, the span stays.
  void setCenter(double centerHz) noexcept;
  // Start and stop move apart round the centre; where one of them would pass its limit, the centre gives way.
  void setSpan(double spanHz) noexcept;

  friend bool operator==(const FrequencyPlan&, const FrequencyPlan&) = default;

 private:
  void placeEdges() noexcept;

  double centerHz_ = 1.0e9;
  double spanHz_ = 10.0e6;
  double startHz_ = 995.0e6;
  double stopHz_ = 1005.0e6;
};

// Number format of the frequency axis for a span.
[[nodiscard]] std::string_view axisFormatForSpan(double spanHz) noexcept;

}  // namespace frontpanels
