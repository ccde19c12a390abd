// A panel without a window, as a host keeps one: settings go in, frames go in, pictures come out.
#pragma once

#include <cstdint>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "fp-render/option_values.h"
#include "fp-render/picture_surface.h"
#include "framework/panel/field_panel.h"
#include "painters/multi_trace_painter.h"
#include "platform/data_server.h"
#include "sources/drive_simulator.h"
#include "sources/frame.h"
#include "sources/vertical_scale.h"

namespace frontpanels {

// Where a marker is to stand: in Hz, or a PN offset.
struct WantedMarker {
  double place = 0;
  std::optional<double> delta;  // of its delta marker
};

struct WantedMarkers {
  std::vector<WantedMarker> at;
  bool peak = false;  // one more at the highest level
  [[nodiscard]] bool any() const noexcept { return peak || !at.empty(); }
};

class PanelPicture {
 public:
  virtual ~PanelPicture();
  PanelPicture(const PanelPicture&) = delete;
  PanelPicture& operator=(const PanelPicture&) = delete;

  // The order of use: settings, then the whole recording to survey, then the scale and the markers; from then
  // on frames to show.

  // False when the panel cannot use it; it has then reported why.
  [[nodiscard]] virtual bool set(const StoredSetting& setting);
  // The receiver of a simulated drive is set as the panel asks for it.
  virtual void tune(DriveSimulator& drive) = 0;
  virtual void survey(const Frame& frame) = 0;
  // Whether a frame that was surveyed has a level to show.
  [[nodiscard]] bool hasLevels() const;
  // Why there is none, in words.
  [[nodiscard]] virtual std::string missingLevels() { return "every level is missing"; }
  // One vertical scale for all pictures: what is given, and else what fits the frames surveyed, but for a
  // scale that came as a setting.
  void fitScale(std::optional<double> topDb, std::optional<double> dbPerDivision);
  // Raises a run-time error when the panel shows nothing that markers stand on.
  void markers(const WantedMarkers& wanted);

  // What the frame has to show; none of the frame before. False, and nothing has changed, without a level.
  [[nodiscard]] virtual bool show(const Frame& frame) = 0;
  // Valid until the next call of anything here.
  [[nodiscard]] PixelView picture(const std::string& caption);
  // What the markers in the picture read, in words: "Marker 1: 98.1 MHz, -43.2 dBm".
  [[nodiscard]] std::vector<std::string> markerReadings();
  // Where markers were wanted outside of what is shown, in words: these are not in the picture.
  [[nodiscard]] const std::vector<std::string>& markersLeftOut() const noexcept { return leftOut_; }

 protected:
  explicit PanelPicture(const PictureLook& look) : surface_(look), fields_(look.fields) {}

  [[nodiscard]] virtual FieldPanel& panel() = 0;
  // Of the panel as it is without a recording: kept where it holds all levels.
  [[nodiscard]] virtual bool ownScaleWhereItFits() const = 0;
  // The trace that markers stand on, null for none.
  [[nodiscard]] virtual clsMultiTracePainter* markedTrace() = 0;

  // For the panel's construction.
  [[nodiscard]] PanelEnvironment environment();
  // Once the panel has its displays: the areas, and the scales that it has of its own.
  void open();
  void setOwn(std::int16_t code, const Variant& value);  // raises a run-time error when it is refused
  void levels(std::int16_t resultType, std::span<const float> levelsDb, float addedDb = 0);
  // The settings that the panel took.
  [[nodiscard]] const std::vector<StoredSetting>& settings() const noexcept { return settings_; }
  [[nodiscard]] bool isSet(std::int16_t code) const;
  // What is shown has moved: markers go to where they belong.
  void placeMarkers();

  DataHub hub_;
  HeadlessOwner owner_;

 private:
  struct Marker {
    MarkerPointer marker;
    std::optional<double> place;  // the highest level without one
  };
  [[nodiscard]] std::vector<PlotPainter*> displays();
  void addMarker(clsMultiTracePainter& painter, std::int32_t number, bool delta, std::optional<double> place);
  [[nodiscard]] bool placeMarker(clsMultiTracePainter& painter, const Marker& wanted);
  void activateFirstMarker(clsMultiTracePainter& painter);

  PictureSurface surface_;
  HeadlessWindowing windowing_;
  bool fields_;
  std::vector<StoredSetting> settings_;
  std::map<std::int16_t, VerticalScale> scales_;  // by result type: as the panel had them of its own
  std::map<std::int16_t, LevelRange> levels_;
  std::vector<Marker> markers_;  // each delta marker behind its partner
  bool activeIsOurs_ = false;    // no setting has chosen an active marker
  std::vector<std::string> leftOut_;
};

[[nodiscard]] std::unique_ptr<PanelPicture> makeSpectrumPicture(const PictureLook& look);
// `sets` are on display from the beginning to the end; frames without one of them show it empty.
[[nodiscard]] std::unique_ptr<PanelPicture> makePilotPicture(const PictureLook& look, const ShownSets& sets);

}  // namespace frontpanels
