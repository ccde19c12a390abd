// The spectrum panel without a window: a picture in memory with the panel's caption above its graph.
#pragma once

#include <cstdint>
#include <string>

#include "framework/panel/headless.h"
#include "platform/data_server.h"
#include "platform/raster/raster_gdi.h"
#include "sources/resample.h"
#include "sources/vertical_scale.h"
#include "spectrum/spectrum_view.h"

namespace frontpanels {

class HeadlessPanel {
 public:
  static constexpr Size kPicturePx = {800, 600};

  // Every picture has this vertical scale. Raises a run-time error when there is no memory for the picture.
  explicit HeadlessPanel(const VerticalScale& scale);
  ~HeadlessPanel();
  HeadlessPanel(const HeadlessPanel&) = delete;
  HeadlessPanel& operator=(const HeadlessPanel&) = delete;

  void show(const DisplaySweep& sweep, const std::string& caption);
  // What is shown. Valid until the next call of anything here.
  [[nodiscard]] PixelView picture();

 private:
  void set(std::int16_t parameterType, const Variant& value);
  void drawCaption();

  RasterGdi gdi_;
  HeadlessView view_;
  DcHandle picture_;
  FontHandle captionFont_;
  HeadlessWindowing windowing_;
  HeadlessOwner owner_;
  DataHub hub_;
  SpectrumView panel_;
};

}  // namespace frontpanels
