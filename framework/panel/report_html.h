// A panel's report: one fragment of HTML that needs no other file, with the caption, the settings, the marker
// readings as a table and the picture inline.
#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace frontpanels {

struct PanelReport {
  struct Setting {
    std::string name;
    std::string value;
  };
  struct Reading {
    std::string marker;
    std::string x;
    std::string y;
  };

  std::string caption;
  std::vector<Setting> settings;
  std::vector<Reading> readings;
  std::string xTitle;  // column titles of the readings
  std::string yTitle;
  std::vector<std::uint8_t> picturePng;  // no picture when empty
};

// Texts may hold any characters; they are escaped.
[[nodiscard]] std::string reportHtml(const PanelReport& report);

[[nodiscard]] std::string base64(std::span<const std::uint8_t> bytes);

}  // namespace frontpanels
