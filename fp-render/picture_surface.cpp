#include "fp-render/picture_surface.h"

#include "framework/panel/fields_picture.h"
#include "platform/gdi_scope.h"
#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

constexpr std::int32_t kUsualDpi = 96;
constexpr float kTwipsPerInch = 1440;
constexpr const char* kFace = "Arial";
constexpr std::int32_t kNormal = 400;
constexpr std::int32_t kBold = 700;
constexpr std::int32_t kCaptionFontPx = 13;
constexpr std::int32_t kCaptionIndentPx = 8;
constexpr std::int32_t kFieldFontPx = 11;  // 8 points, as in dialogs
constexpr std::string_view kEllipsis = "...";

// Without a letter cut in two: as much of the text as there is room for, and the sign that some is missing.
std::string fitted(Gdi& gdi, DcHandle dc, std::string text, std::int32_t roomPx) {
  if (gdi.textExtent(dc, text).width <= roomPx) return text;
  const auto continues = [](char byte) { return (static_cast<unsigned char>(byte) & 0xC0U) == 0x80U; };
  while (!text.empty()) {
    while (continues(text.back())) text.pop_back();
    text.pop_back();
    std::string shortened = text + std::string(kEllipsis);
    if (gdi.textExtent(dc, shortened).width <= roomPx) return shortened;
  }
  return text;
}

}  // namespace

PictureSurface::PictureSurface(const PictureLook& look)
    : look_(look),
      view_(gdi_.createScreen(viewSizePx()), viewSizePx()),
      picture_(gdi_.createScreen(look.sizePx)),
      captionFont_(gdi_.createFont({kFace, scaled(kCaptionFontPx), kBold})) {
  if (!view_.hdc() || !picture_) raiseOutOfMemory();
  for (std::size_t i = 0; i < kFieldFonts; ++i)
    fieldFonts_[i] =
        gdi_.createFont({kFace, scaled(kFieldFontPx), (i & 1U) != 0 ? kBold : kNormal, (i & 2U) != 0});
  clear();
}

PictureSurface::~PictureSurface() {
  if (captionFont_) gdi_.deleteObject(captionFont_);
  for (const FontHandle font : fieldFonts_)
    if (font) gdi_.deleteObject(font);
}

std::int32_t PictureSurface::scaled(std::int32_t px) const noexcept { return px * look_.dpi / kUsualDpi; }

Size PictureSurface::viewSizePx() const noexcept {
  return {look_.sizePx.width, look_.sizePx.height - captionHeightPx()};
}

ScreenMetrics PictureSurface::metrics() const noexcept {
  const float twipsPerPixel = kTwipsPerInch / static_cast<float>(look_.dpi);
  return {twipsPerPixel, twipsPerPixel};
}

void PictureSurface::clear() {
  gdi_.fillRect(view_.hdc(), {0, 0, view_.sizePx.width, view_.sizePx.height},
                gdi_.sysColorBrush(SystemColor::ButtonFace));
}

void PictureSurface::drawFields(const ControlSet& fields) {
  paintFields(gdi_, view_.hdc(), fields, view_.sizePx, look_.dpi, [this](const Control& control) {
    return fieldFonts_[(control.Bold() ? 1U : 0U) + (control.Italic() ? 2U : 0U)];
  });
}

PixelView PictureSurface::picture(const std::string& caption) {
  const Rect row{0, 0, look_.sizePx.width, captionHeightPx()};
  if (!row.empty()) {
    gdi_.fillRect(picture_, row, gdi_.sysColorBrush(SystemColor::ButtonFace));
    const SelectedFont font(gdi_, picture_, captionFont_);
    const TextStyleScope style(gdi_, picture_, gdi_.sysColor(SystemColor::ButtonText),
                               BackgroundMode::Transparent);
    const std::int32_t indentPx = scaled(kCaptionIndentPx);
    const std::string shown = fitted(gdi_, picture_, caption, row.width() - 2 * indentPx);
    const Size textPx = gdi_.textExtent(picture_, shown);
    gdi_.textOut(picture_, {indentPx, (row.height() - textPx.height) / 2}, shown);
  }
  gdi_.bitBlt(picture_, {0, row.bottom, look_.sizePx.width, look_.sizePx.height}, view_.hdc(), {0, 0},
              RasterOp::SourceCopy);
  return gdi_.pixels(picture_);
}

}  // namespace frontpanels
