// clsNumericEntry: a numeric setting of a panel and the text it is shown as. Axes use it only to turn their
// values into text.
#pragma once

#include <string>
#include <string_view>

#include "entry/suffix_table.h"
#include "platform/variant.h"

namespace frontpanels {

class clsNumericEntry {
 public:
  static constexpr std::string_view kTypeName = "clsNumericEntry";

  // Unit suffixes. At most 10; one more is reported and refused. Without a numeric scale the scale is the
  // lower limit, or 1 where that is 0; a scale that is given and not numeric is reported as well.
  void suffix(std::string_view name, double lowerLimit, double upperLimit, const Variant& scale = {});
  [[nodiscard]] const SuffixTable& suffixes() const noexcept { return suffixes_; }

  // Suffix sets: each adds its records.
  void noSuffix() {}
  void chipSuffix();
  void offsetSuffix();
  void byteSuffix();
  void dBSuffix();
  void dBmSuffix();
  void degreeSuffix();
  void frequencySuffix();
  void meterSuffix();
  void percentSuffix();
  void timeSuffix();
  void longTimeSuffix();
  void voltSuffix();
  void meterPerSecSuffix();
  void milePerHourSuffix();
  void kmPerHourSuffix();
  void feetSuffix();

  // How a value is shown: (value - formatOffset) / formatScale, in the unit whose limits hold it, by the
  // number format (see entry/number_format.h), or in the general form when that is empty.
  [[nodiscard]] const std::string& formatString() const noexcept { return formatString_; }
  void formatString(std::string_view format) { formatString_ = format; }
  [[nodiscard]] double formatScale() const noexcept { return formatScale_; }
  void formatScale(double scale) noexcept { formatScale_ = scale; }
  [[nodiscard]] double formatOffset() const noexcept { return formatOffset_; }
  void formatOffset(double offset) noexcept { formatOffset_ = offset; }
  [[nodiscard]] bool suppressSuffix() const noexcept { return suppressSuffix_; }
  void suppressSuffix(bool suppress) noexcept { suppressSuffix_ = suppress; }

  // The text of a value. A failure (a scale of 0, an unusable number format) is reported and the text is
  // empty.
  [[nodiscard]] std::string formatter(double value) const;
  // The same into a text whose storage is used again.
  void formatter(double value, std::string& text) const;

  // Appends the text of a value by a number format of the caller's. Raises "Division by zero" for a scale of
  // 0 and what appendNumber raises; `text` is then as it was.
  void append(std::string& text, double value, std::string_view format, bool withUnit) const;
  // How many units of the value make one of what is shown: the scale times that of the unit chosen for
  // `value`.
  [[nodiscard]] double shownScale(double value) const noexcept;

 private:
  SuffixTable suffixes_;
  std::string formatString_;
  double formatScale_ = 1;
  double formatOffset_ = 0;
  bool suppressSuffix_ = false;
};

}  // namespace frontpanels
