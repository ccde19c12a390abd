#include "traces/plot_colors.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace frontpanels {
namespace {

constexpr Color kBlack = rgb(0, 0, 0);
constexpr Color kWhite = rgb(255, 255, 255);
constexpr std::array kTraceStyles{PenStyle::Solid, PenStyle::Dash, PenStyle::Dot, PenStyle::DashDot,
                                  PenStyle::DashDotDot};
constexpr int kSteps = 16;  // from a colour to black or white

// The part that a channel has in the light of its colour, as a screen shows it.
double linear(std::uint8_t channel) noexcept {
  const double share = channel / 255.0;
  return share <= 0.04045 ? share / 12.92 : std::pow((share + 0.055) / 1.055, 2.4);
}

double luminance(Color color) noexcept {
  return 0.2126 * linear(color.red()) + 0.7152 * linear(color.green()) + 0.0722 * linear(color.blue());
}

Color farther(Color from) noexcept {
  return contrastRatio(from, kWhite) >= contrastRatio(from, kBlack) ? kWhite : kBlack;
}

std::uint8_t between(std::uint8_t from, std::uint8_t to, int step) noexcept {
  return static_cast<std::uint8_t>(from + (to - from) * step / kSteps);
}

}  // namespace

double contrastRatio(Color one, Color other) noexcept {
  const double a = luminance(one);
  const double b = luminance(other);
  return (std::max(a, b) + 0.05) / (std::min(a, b) + 0.05);
}

Color standingOut(Color own, Color background) noexcept {
  const Color end = farther(background);
  Color color = own;
  for (int step = 1; step <= kSteps && contrastRatio(color, background) < kGraphContrast; ++step)
    color = rgb(between(own.red(), end.red(), step), between(own.green(), end.green(), step),
                between(own.blue(), end.blue(), step));
  return color;
}

Color PlotColors::textOn(Color bar, Color own) const { return highContrast_ ? farther(bar) : own; }

PenStyle PlotColors::traceStyle(std::size_t index) const noexcept {
  return highContrast_ ? kTraceStyles[index % kTraceStyles.size()] : PenStyle::Solid;
}

}  // namespace frontpanels
