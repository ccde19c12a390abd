// What a panel stands on where there is no window: a view in memory with a caption above it, and what draws
// its fields.
#pragma once

#include <array>
#include <cstdint>
#include <string>

#include "framework/panel/headless.h"
#include "platform/control_set.h"
#include "platform/raster/raster_gdi.h"

namespace frontpanels {

struct PictureLook {
  Size sizePx{800, 600};  // caption included
  std::int32_t dpi = 96;
  bool fields = false;  // otherwise all of it is graph
  bool caption = true;
};

class PictureSurface {
 public:
  // Raises a run-time error when there is no memory for the picture.
  explicit PictureSurface(const PictureLook& look);
  ~PictureSurface();
  PictureSurface(const PictureSurface&) = delete;
  PictureSurface& operator=(const PictureSurface&) = delete;

  [[nodiscard]] Gdi& gdi() noexcept { return gdi_; }
  [[nodiscard]] HeadlessView& view() noexcept { return view_; }
  [[nodiscard]] ScreenMetrics metrics() const noexcept;

  // Panels leave margins round their graphs, where a window has its background.
  void clear();
  void drawFields(const ControlSet& fields);
  // The view under its caption. Valid until the next call of anything here.
  [[nodiscard]] PixelView picture(const std::string& caption);

 private:
  static constexpr std::size_t kFieldFonts = 4;  // by bold + 2 x italic

  [[nodiscard]] Size viewSizePx() const noexcept;
  [[nodiscard]] std::int32_t captionHeightPx() const noexcept { return look_.caption ? scaled(24) : 0; }
  [[nodiscard]] std::int32_t scaled(std::int32_t px) const noexcept;

  PictureLook look_;
  RasterGdi gdi_;
  HeadlessView view_;
  DcHandle picture_;
  FontHandle captionFont_;
  std::array<FontHandle, kFieldFonts> fieldFonts_;
};

}  // namespace frontpanels
