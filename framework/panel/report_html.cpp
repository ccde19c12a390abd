#include "framework/panel/report_html.h"

#include <algorithm>

#include "framework/support/html_text.h"

namespace frontpanels {
namespace {

constexpr std::string_view kBase64Digits = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";

std::string cell(std::string_view tag, std::string_view text) {
  const std::string name(tag);
  return "<" + name + ">" + htmlEscaped(text) + "</" + name + ">";
}

}  // namespace

std::string base64(std::span<const std::uint8_t> bytes) {
  std::string text;
  text.reserve((bytes.size() + 2) / 3 * 4);
  for (std::size_t i = 0; i < bytes.size(); i += 3) {
    const std::size_t taken = std::min<std::size_t>(bytes.size() - i, 3);
    std::uint32_t group = 0;
    for (std::size_t k = 0; k < 3; ++k) group = group << 8U | (k < taken ? bytes[i + k] : 0U);
    for (std::size_t k = 0; k < 4; ++k) text += k <= taken ? kBase64Digits[group >> (18 - 6 * k) & 63U] : '=';
  }
  return text;
}

std::string reportHtml(const PanelReport& report) {
  std::string html = "<div class=\"front-panel\">\n" + cell("h2", report.caption) + "\n<table>\n";
  for (const PanelReport::Setting& setting : report.settings)
    html += "<tr>" + cell("th", setting.name) + cell("td", setting.value) + "</tr>\n";
  html += "</table>\n";
  if (!report.readings.empty()) {
    html += "<table>\n<tr>" + cell("th", "Marker") + cell("th", report.xTitle) + cell("th", report.yTitle) +
            "</tr>\n";
    for (const PanelReport::Reading& reading : report.readings)
      html += "<tr>" + cell("td", reading.marker) + cell("td", reading.x) + cell("td", reading.y) + "</tr>\n";
    html += "</table>\n";
  }
  if (!report.picturePng.empty())
    html += "<img alt=\"" + htmlEscaped(report.caption) + "\" src=\"data:image/png;base64," +
            base64(report.picturePng) + "\">\n";
  return html + "</div>\n";
}

}  // namespace frontpanels
