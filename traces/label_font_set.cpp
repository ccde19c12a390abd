#include "traces/label_font_set.h"

#include "framework/support/numeric.h"

namespace frontpanels {
namespace {

constexpr std::string_view kFace = "Arial";
constexpr double kTwipsPerPoint = 20.0;
constexpr std::int32_t kBold = 700;
constexpr std::int32_t kNormal = 400;

struct FontRow {
  LabelFont font;
  double points;
};
// Small panels are read beside a large one: one point less.
constexpr FontRow kFonts[] = {
    {LabelFont::SmallAxis, 8.0},
    {LabelFont::ActiveAxis, 9.0},
    {LabelFont::SmallCorner, 8.0},
    {LabelFont::ActiveCorner, 9.0},
};

}  // namespace

bool boldLabels(std::string_view commandLine) noexcept {
  return commandLine.find("NormalLabels") == std::string_view::npos;
}

LabelFontSet::LabelFontSet(Gdi& gdi, ScreenMetrics metrics, bool bold) : gdi_(gdi), bold_(bold) {
  for (const FontRow& row : kFonts) {
    const std::int32_t emHeightPx =
        toInt32(row.points * kTwipsPerPoint / static_cast<double>(metrics.twipsPerPixelY));
    handles_[static_cast<std::size_t>(row.font)] =
        gdi_.createFont({std::string(kFace), emHeightPx, bold ? kBold : kNormal, false});
  }
}

LabelFontSet::~LabelFontSet() {
  for (const FontHandle font : handles_)
    if (font) gdi_.deleteObject(font);
}

}  // namespace frontpanels
