#include "platform/raster/font_cache.h"

#include <fontconfig/fontconfig.h>
#include <ft2build.h>
#include FT_FREETYPE_H
#include FT_GASP_H
#include FT_TRUETYPE_TABLES_H

#include <algorithm>
#include <cmath>
#include <string>

namespace frontpanels {
namespace {

constexpr std::int32_t kMaxEmHeightPx = 1000;
constexpr char32_t kReplacement = 0xFFFD;

struct FontFile {
  std::string path;
  int index = 0;
};

FontFile resolve(FcConfig* config, const FontSpec& spec) {
  FcPattern* wanted = FcPatternCreate();
  FcPatternAddString(wanted, FC_FAMILY, reinterpret_cast<const FcChar8*>(spec.face.c_str()));
  FcPatternAddInteger(wanted, FC_WEIGHT, FcWeightFromOpenType(spec.weight));
  FcPatternAddInteger(wanted, FC_SLANT, spec.italic ? FC_SLANT_ITALIC : FC_SLANT_ROMAN);
  FcPatternAddBool(wanted, FC_SCALABLE, FcTrue);
  FcConfigSubstitute(config, wanted, FcMatchPattern);
  FcDefaultSubstitute(wanted);
  FcResult result = FcResultNoMatch;
  FcPattern* match = FcFontMatch(config, wanted, &result);
  FontFile file;
  FcChar8* path = nullptr;
  if (match != nullptr && FcPatternGetString(match, FC_FILE, 0, &path) == FcResultMatch) {
    file.path = reinterpret_cast<const char*>(path);
    FcPatternGetInteger(match, FC_INDEX, 0, &file.index);
  }
  if (match != nullptr) FcPatternDestroy(match);
  FcPatternDestroy(wanted);
  return file;
}

class FreetypeFont final : public Font {
 public:
  FreetypeFont(FT_Face face, std::int32_t emHeightPx) : face_(face) {
    FT_Set_Pixel_Sizes(face_, 0, static_cast<FT_UInt>(emHeightPx));
    const FT_Int gasp = FT_Get_Gasp(face_, static_cast<FT_UInt>(emHeightPx));
    smooth_ = gasp == FT_GASP_NO_TABLE || (gasp & FT_GASP_DO_GRAY) != 0;
    const auto px = [&](FT_Long units) {
      return static_cast<std::int32_t>(
          std::lround(static_cast<double>(units) * emHeightPx / face_->units_per_EM));
    };
    // The cell is as high as Windows makes it.
    const auto* os2 = static_cast<const TT_OS2*>(FT_Get_Sfnt_Table(face_, FT_SFNT_OS2));
    ascentPx_ = px(os2 != nullptr ? os2->usWinAscent : face_->ascender);
    heightPx_ = ascentPx_ + px(os2 != nullptr ? os2->usWinDescent : -face_->descender);
  }
  ~FreetypeFont() override { FT_Done_Face(face_); }
  FreetypeFont(const FreetypeFont&) = delete;
  FreetypeFont& operator=(const FreetypeFont&) = delete;

  std::int32_t ascentPx() const override { return ascentPx_; }
  std::int32_t heightPx() const override { return heightPx_; }

  const Glyph& glyph(char32_t codePoint) override {
    if (codePoint < ascii_.size()) {
      std::unique_ptr<Glyph>& slot = ascii_[codePoint];
      if (slot == nullptr) slot = std::make_unique<Glyph>(load(codePoint));
      return *slot;
    }
    const auto found = others_.find(codePoint);
    return found != others_.end() ? found->second : others_.emplace(codePoint, load(codePoint)).first->second;
  }

 private:
  [[nodiscard]] Glyph load(char32_t codePoint) const {
    Glyph glyph;
    const FT_GlyphSlot slot = face_->glyph;
    // A letter is as wide as when it is smoothed, also where it is not.
    if (FT_Load_Char(face_, codePoint, FT_LOAD_TARGET_NORMAL) != 0) return glyph;
    glyph.advancePx = static_cast<std::int32_t>((slot->advance.x + 32) >> 6);
    const FT_Int32 target = smooth_ ? FT_LOAD_TARGET_NORMAL : FT_LOAD_TARGET_MONO;
    if (FT_Load_Char(face_, codePoint, FT_LOAD_RENDER | target) != 0) return glyph;
    const FT_Bitmap& bitmap = slot->bitmap;
    glyph.leftPx = slot->bitmap_left;
    glyph.topPx = slot->bitmap_top;
    glyph.sizePx = {static_cast<std::int32_t>(bitmap.width), static_cast<std::int32_t>(bitmap.rows)};
    glyph.coverage.reserve(static_cast<std::size_t>(bitmap.width) * bitmap.rows);
    for (unsigned y = 0; y < bitmap.rows; ++y) {
      const unsigned char* row = bitmap.buffer + static_cast<std::ptrdiff_t>(y) * bitmap.pitch;
      for (unsigned x = 0; x < bitmap.width; ++x) {
        const bool ink = (row[x / 8] & (0x80U >> x % 8)) != 0;
        glyph.coverage.push_back(bitmap.pixel_mode == FT_PIXEL_MODE_MONO ? (ink ? 255 : 0) : row[x]);
      }
    }
    return glyph;
  }

  FT_Face face_;
  bool smooth_ = true;
  std::int32_t ascentPx_ = 0;
  std::int32_t heightPx_ = 0;
  std::array<std::unique_ptr<Glyph>, 128> ascii_;
  std::unordered_map<char32_t, Glyph> others_;
};

}  // namespace

struct FontCache::Library {
  FT_Library freetype = nullptr;
  FcConfig* config = FcInitLoadConfigAndFonts();

  Library() { FT_Init_FreeType(&freetype); }
  ~Library() {
    if (config != nullptr) FcConfigDestroy(config);
    FT_Done_FreeType(freetype);
  }
  Library(const Library&) = delete;
  Library& operator=(const Library&) = delete;
};

FontCache::FontCache() = default;
FontCache::~FontCache() { entries_.clear(); }

Font* FontCache::find(const FontSpec& spec) {
  const auto same = [&](const Entry& entry) { return entry.spec == spec; };
  const auto found = std::find_if(entries_.begin(), entries_.end(), same);
  if (found != entries_.end()) return found->font.get();
  if (spec.emHeightPx < 1 || spec.emHeightPx > kMaxEmHeightPx) return nullptr;
  if (library_ == nullptr) library_ = std::make_unique<Library>();
  if (library_->freetype == nullptr || library_->config == nullptr) return nullptr;
  const FontFile file = resolve(library_->config, spec);
  FT_Face face = nullptr;
  if (file.path.empty() || FT_New_Face(library_->freetype, file.path.c_str(), file.index, &face) != 0)
    return nullptr;
  entries_.push_back({spec, std::make_unique<FreetypeFont>(face, spec.emHeightPx)});
  return entries_.back().font.get();
}

char32_t nextCodePoint(std::string_view& utf8) {
  const auto lead = static_cast<unsigned char>(utf8.front());
  utf8.remove_prefix(1);
  if (lead < 0x80) return lead;
  const std::size_t trailing = lead >= 0xF0 ? 3 : lead >= 0xE0 ? 2 : 1;
  if (lead < 0xC2 || lead > 0xF4) return kReplacement;
  char32_t codePoint = lead & (0x3FU >> trailing);
  for (std::size_t i = 0; i < trailing; ++i) {
    if (utf8.empty() || (static_cast<unsigned char>(utf8.front()) & 0xC0) != 0x80) return kReplacement;
    codePoint = codePoint << 6 | (static_cast<unsigned char>(utf8.front()) & 0x3FU);
    utf8.remove_prefix(1);
  }
  return codePoint;
}

}  // namespace frontpanels
