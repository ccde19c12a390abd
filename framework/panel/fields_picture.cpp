#include "framework/panel/fields_picture.h"

#include <algorithm>
#include <optional>
#include <string>
#include <string_view>

#include "platform/gdi_scope.h"

namespace frontpanels {
namespace {

constexpr std::int32_t kEdgePx = 2;  // at any scale
// At 96 dots an inch.
constexpr std::int32_t kUsualDpi = 96;
constexpr std::int32_t kTextInsetPx = 4;
constexpr std::int32_t kCaptionInsetPx = 8;  // of a frame
constexpr std::int32_t kMarkPx = 13;         // box or ring before a caption
constexpr std::int32_t kMarkGapPx = 4;
constexpr std::int32_t kTickPx = 2;
constexpr std::int32_t kArrowPx = 16;  // button of a list that drops down

Rect shrunk(Rect rect, std::int32_t px) {
  return {rect.left + px, rect.top + px, std::max(rect.right - px, rect.left + px),
          std::max(rect.bottom - px, rect.top + px)};
}

Rect common(Rect a, Rect b) {
  return {std::max(a.left, b.left), std::max(a.top, b.top), std::min(a.right, b.right),
          std::min(a.bottom, b.bottom)};
}

bool empty(Rect rect) { return rect.right <= rect.left || rect.bottom <= rect.top; }

// Without the mark of the access key; two marks stand for one.
std::string shownText(std::string_view caption) {
  std::string text;
  for (std::size_t i = 0; i < caption.size(); ++i) {
    if (caption[i] == '&' && ++i == caption.size()) break;
    text += caption[i];
  }
  return text;
}

class FieldsPicture {
 public:
  FieldsPicture(Gdi& gdi, DcHandle dc, const ControlSet& controls, Size viewPx, std::int32_t dpi,
                const FieldFont& fontOf)
      : gdi_(gdi),
        dc_(dc),
        controls_(controls),
        view_{0, 0, viewPx.width, viewPx.height},
        dpi_(dpi),
        fontOf_(fontOf) {}

  void paint();

 private:
  struct Place {
    Rect all;    // of the control
    Rect shown;  // of it, what the areas that it lies in leave to be seen
  };
  enum class Align : std::uint8_t { Left, Middle, Right };

  [[nodiscard]] std::int32_t scaled(std::int32_t px) const { return px * dpi_ / kUsualDpi; }
  [[nodiscard]] Place placeOf(const Control& control) const;
  void fill(Rect rect, SystemColor color) { gdi_.fillRect(dc_, rect, gdi_.sysColorBrush(color)); }
  void line(std::initializer_list<Point> points, SystemColor color);
  void text(const Control& control, std::string_view text, Rect within, Align align, SystemColor color);
  void caption(const Control& control, Rect within, Align align = Align::Left);
  void sunkenField(const Place& place);
  void arrow(Rect button, bool up);

  // A number that an arrow steps stands at the right, beside it.
  [[nodiscard]] bool isStepped(const Control& box) const;

  void paint(const Control& control);
  void paintFrame(const Control& control, const Place& place);
  void paintSpin(const Place& place);
  void paintList(const ItemList& list, const Place& place);
  void paintMark(const Control& control, const Place& place, bool round, bool chosen);

  Gdi& gdi_;
  DcHandle dc_;
  const ControlSet& controls_;
  Rect view_;
  std::int32_t dpi_;
  const FieldFont& fontOf_;
};

// As the windows: frames hold none, so that places within them add up in twips; an area has whole pixels.
FieldsPicture::Place FieldsPicture::placeOf(const Control& control) const {
  ControlPlace place = control.place();
  const Control* area = control.parent();
  for (; area != nullptr && area->kind() != ControlKind::Picture; area = area->parent()) {
    place.leftTwips += area->place().leftTwips;
    place.topTwips += area->place().topTwips;
  }
  const Place around = area == nullptr ? Place{{}, view_} : placeOf(*area);
  const Rect all{around.all.left + pixelsOfTwips(place.leftTwips, dpi_),
                 around.all.top + pixelsOfTwips(place.topTwips, dpi_),
                 around.all.left + pixelsOfTwips(place.leftTwips + place.widthTwips, dpi_),
                 around.all.top + pixelsOfTwips(place.topTwips + place.heightTwips, dpi_)};
  const bool cutsOff = control.kind() == ControlKind::Picture;
  return {all, cutsOff ? common(all, around.shown) : around.shown};
}

void FieldsPicture::line(std::initializer_list<Point> points, SystemColor color) {
  const SelectedPen pen(gdi_, dc_, PenStyle::Solid, 1, gdi_.sysColor(color));
  gdi_.polyline(dc_, {points.begin(), points.size()});
}

// Cut off at the field's edge, as its window would.
void FieldsPicture::text(const Control& control, std::string_view text, Rect within, Align align,
                         SystemColor color) {
  if (text.empty()) return;
  const Rect visible = common(within, placeOf(control).shown);
  if (empty(visible)) return;
  const SelectedFont font(gdi_, dc_, fontOf_(control));
  const Size size = gdi_.textExtent(dc_, text);
  const std::int32_t free = within.width() - size.width;
  const std::int32_t before = align == Align::Middle ? free / 2 : align == Align::Right ? free : 0;
  const std::int32_t left = within.left + std::max(before, 0);
  const std::int32_t top = within.top + (within.height() - size.height) / 2;
  const RegionHandle region = gdi_.createRectRgn(visible);
  gdi_.selectClipRgn(dc_, region);
  {
    const std::optional<Color> own = gdi_.highContrast() ? std::nullopt : control.ForeColor();
    const Color shown =
        control.reallyEnabled() ? own.value_or(gdi_.sysColor(color)) : gdi_.sysColor(SystemColor::GrayText);
    const TextStyleScope style(gdi_, dc_, shown, BackgroundMode::Transparent);
    gdi_.textOut(dc_, {left, top}, text);
  }
  gdi_.selectClipRgn(dc_, {});
  if (region) gdi_.deleteObject(region);
}

void FieldsPicture::caption(const Control& control, Rect within, Align align) {
  text(control, shownText(control.Caption()), within, align, SystemColor::ButtonText);
}

void FieldsPicture::sunkenField(const Place& place) {
  fill(place.all, SystemColor::Window);
  gdi_.drawEdge(dc_, place.all, kEdgeSunken, kAllSides);
}

void FieldsPicture::arrow(Rect button, bool up) {
  fill(button, SystemColor::ButtonFace);
  gdi_.drawEdge(dc_, button, kEdgeRaised, kAllSides);
  const std::int32_t half = std::max(std::min(button.width(), button.height()) / 4, 1);
  const Point middle{(button.left + button.right) / 2, (button.top + button.bottom) / 2};
  const std::int32_t tip = up ? -half / 2 - 1 : half / 2 + 1;
  line({{middle.x - half, middle.y - tip / 2},
        {middle.x, middle.y + tip / 2 + (up ? -1 : 1)},
        {middle.x + half + 1, middle.y - tip / 2}},
       SystemColor::ButtonText);
}

// The line runs through the middle of the caption, which interrupts it.
void FieldsPicture::paintFrame(const Control& control, const Place& place) {
  const std::string title = shownText(control.Caption());
  const SelectedFont font(gdi_, dc_, fontOf_(control));
  const Size size = gdi_.textExtent(dc_, title.empty() ? "X" : title);
  const Rect& all = place.all;
  const std::int32_t top = all.top + size.height / 2;
  const auto ring = [&](std::int32_t by, SystemColor color) {
    const Rect r{all.left + by, top + by, all.right - 2 + by, all.bottom - 2 + by};
    line({{r.left, r.top}, {r.right, r.top}, {r.right, r.bottom}, {r.left, r.bottom}, {r.left, r.top}},
         color);
  };
  ring(1, SystemColor::ButtonHighlight);
  ring(0, SystemColor::ButtonShadow);
  if (title.empty()) return;
  const std::int32_t left = all.left + scaled(kCaptionInsetPx);
  const Rect gap{left, all.top, left + size.width + 2, all.top + size.height};
  fill(gap, SystemColor::ButtonFace);
  caption(control, {gap.left + 1, gap.top, std::min(gap.right, all.right), gap.bottom});
}

void FieldsPicture::paintSpin(const Place& place) {
  const std::int32_t middle = (place.all.top + place.all.bottom) / 2;
  arrow({place.all.left, place.all.top, place.all.right, middle}, true);
  arrow({place.all.left, middle, place.all.right, place.all.bottom}, false);
}

void FieldsPicture::paintList(const ItemList& list, const Place& place) {
  sunkenField(place);
  Rect inner = shrunk(place.all, kEdgePx);
  if (list.kind() == ControlKind::ComboBox) {
    const std::int32_t left = std::max(inner.right - scaled(kArrowPx), inner.left);
    arrow({left, inner.top, inner.right, inner.bottom}, false);
    text(list, list.Text(), {inner.left + scaled(kTextInsetPx) - kEdgePx, inner.top, left, inner.bottom},
         Align::Left, SystemColor::WindowText);
    return;
  }
  const SelectedFont font(gdi_, dc_, fontOf_(list));
  const std::int32_t linePx = std::max(gdi_.textExtent(dc_, "X").height, 1);
  for (std::int32_t i = 0; i < list.ListCount() && inner.top < inner.bottom; ++i, inner.top += linePx)
    text(list, list.item(i).text,
         {inner.left + 1, inner.top, inner.right, std::min(inner.top + linePx, inner.bottom)}, Align::Left,
         SystemColor::WindowText);
}

void FieldsPicture::paintMark(const Control& control, const Place& place, bool round, bool chosen) {
  const std::int32_t px = scaled(kMarkPx);
  const std::int32_t top = (place.all.top + place.all.bottom - px) / 2;
  const Rect mark{place.all.left, top, place.all.left + px, top + px};
  const Rect in = shrunk(mark, scaled(round ? 4 : 3));
  if (round) {
    const std::int32_t third = px / 3;
    line({{mark.left + third, mark.top},
          {mark.right - third, mark.top},
          {mark.right, mark.top + third},
          {mark.right, mark.bottom - third},
          {mark.right - third, mark.bottom},
          {mark.left + third, mark.bottom},
          {mark.left, mark.bottom - third},
          {mark.left, mark.top + third},
          {mark.left + third, mark.top}},
         SystemColor::ButtonShadow);
    if (chosen) fill(in, SystemColor::WindowText);
  } else {
    sunkenField({mark, mark});
    const std::int32_t foot = in.left + in.width() / 3;
    const std::int32_t tick = scaled(kTickPx);
    for (std::int32_t below = 0; chosen && below < tick; ++below)
      line({{in.left, in.top + tick + below},
            {foot, in.bottom - tick + below},
            {in.right, in.top - 1 + below}},
           SystemColor::WindowText);
  }
  caption(control, {mark.right + scaled(kMarkGapPx), place.all.top, place.all.right, place.all.bottom});
}

bool FieldsPicture::isStepped(const Control& box) const {
  const auto all = controls_.controls();
  return std::any_of(all.begin(), all.end(), [&box](const std::unique_ptr<Control>& other) {
    const auto* const spin = dynamic_cast<const SpinButton*>(other.get());
    return spin != nullptr && spin->buddy() == &box;
  });
}

void FieldsPicture::paint() {
  for (const std::unique_ptr<Control>& control : controls_.controls())
    if (control->reallyVisible()) paint(*control);
}

void FieldsPicture::paint(const Control& control) {
  const Place place = placeOf(control);
  if (empty(common(place.all, place.shown))) return;
  switch (control.kind()) {
    case ControlKind::Picture:
      return fill(place.shown, SystemColor::ButtonFace);
    case ControlKind::Frame:
      return paintFrame(control, place);
    case ControlKind::Label:
      return caption(control, place.all);
    case ControlKind::TextBox:
      sunkenField(place);
      return text(control, static_cast<const TextBox&>(control).Text(),
                  shrunk(place.all, scaled(kTextInsetPx) - 1),
                  isStepped(control) ? Align::Right : Align::Left, SystemColor::WindowText);
    case ControlKind::SpinButton:
      return paintSpin(place);
    case ControlKind::ComboBox:
    case ControlKind::ListBox:
      return paintList(static_cast<const ItemList&>(control), place);
    case ControlKind::CheckBox:
      return paintMark(control, place, false, static_cast<const CheckBox&>(control).Value() != 0);
    case ControlKind::OptionButton:
      return paintMark(control, place, true, static_cast<const OptionButton&>(control).Value());
    case ControlKind::PushButton:
      fill(place.all, SystemColor::ButtonFace);
      gdi_.drawEdge(dc_, place.all, kEdgeRaised, kAllSides);
      return caption(control, shrunk(place.all, kEdgePx), Align::Middle);
  }
}

}  // namespace

void paintFields(Gdi& gdi, DcHandle dc, const ControlSet& controls, Size viewPx, std::int32_t dpi,
                 const FieldFont& fontOf) {
  FieldsPicture(gdi, dc, controls, viewPx, dpi, fontOf).paint();
}

}  // namespace frontpanels
