// Fonts by their description, with the glyphs that were used. A face that is not installed is replaced by
// the one that fontconfig thinks nearest. Text is set as classic Windows text is: every letter hinted to
// whole pixels, smoothed only where the font asks for it at that size.
#pragma once

#include <array>
#include <cstdint>
#include <memory>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "platform/gdi.h"

namespace frontpanels {

struct Glyph {
  std::int32_t leftPx = 0;  // from the pen's place to the first column
  std::int32_t topPx = 0;   // from the baseline up to the first row
  std::int32_t advancePx = 0;
  Size sizePx{};
  std::vector<std::uint8_t> coverage;  // row by row, 255 is ink

  [[nodiscard]] const std::uint8_t* row(std::int32_t y) const { return coverage.data() + y * sizePx.width; }
};

// One face at one size.
class Font {
 public:
  virtual ~Font() = default;
  [[nodiscard]] virtual std::int32_t ascentPx() const = 0;
  [[nodiscard]] virtual std::int32_t heightPx() const = 0;  // of the cell: ascent and descent
  [[nodiscard]] virtual const Glyph& glyph(char32_t codePoint) = 0;
};

class FontCache {
 public:
  FontCache();
  ~FontCache();
  FontCache(const FontCache&) = delete;
  FontCache& operator=(const FontCache&) = delete;

  // Null when no font can be loaded. Lives as long as the cache.
  [[nodiscard]] Font* find(const FontSpec& spec);

 private:
  struct Library;
  struct Entry {
    FontSpec spec;
    std::unique_ptr<Font> font;
  };
  std::unique_ptr<Library> library_;
  std::vector<Entry> entries_;
};

// The code points of a UTF-8 text, one a call; what is malformed comes out as U+FFFD.
[[nodiscard]] char32_t nextCodePoint(std::string_view& utf8);

}  // namespace frontpanels
