// A user, a panel and its host, round and round: what is typed into the panel's fields reaches the host once,
// tunes its receiver, comes back, and changes the picture. Prints a line a check, at the end "N passed, N
// failed".
#include <windows.h>

#include <ole2.h>

#include <cmath>
#include <cstdlib>
#include <string>
#include <utility>
#include <vector>

#include "sources/receiver.h"
#include "tests/wine/com_client.h"
#include "tests/wine/full_container.h"
#include "tests/wine/panel_user.h"

namespace frontpanels::testing {
namespace {

constexpr SIZE kSizePx{1000, 700};

// 860 to 900 MHz, a bin every 20 kHz, and one carrier at 881.52 MHz.
Sweep recordedSweep() {
  Sweep sweep;
  sweep.startHz = 860e6;
  sweep.stepHz = 20e3;
  sweep.levelsDb.assign(2001, -100.0F);
  sweep.levelsDb[1076] = -30.0F;
  return sweep;
}

// Answers inside the event; tells the panel, and shows it the sweep anew, after it.
class Host final : public Listener {
 public:
  std::vector<std::string> heard;  // "set 13 881520000" or "op 2"

  explicit Host(const Hosted& panel) : panel_(panel), sweep_(recordedSweep()) {}
  HRESULT STDMETHODCALLTYPE Invoke(DISPID member, REFIID, LCID, WORD, DISPPARAMS* parameters, VARIANT*,
                                   EXCEPINFO*, UINT*) override;
  void show();
  void answer();

 private:
  const Hosted& panel_;
  Receiver receiver_;
  Sweep sweep_;
};

HRESULT Host::Invoke(DISPID member, REFIID, LCID, WORD, DISPPARAMS* parameters, VARIANT*, EXCEPINFO*, UINT*) {
  const VARIANT* const arguments = parameters->rgvarg;  // the last comes first
  if (member == 1) {
    heard.push_back("op " + std::to_string(V_I2(&arguments[2])));
  } else if (member == 2 && V_VT(&arguments[1]) == VT_R8) {
    const SHORT code = V_I2(&arguments[3]);
    const double value = V_R8(&arguments[1]);
    heard.push_back("set " + std::to_string(code) + " " + std::to_string(std::llround(value)));
    *V_I4REF(&arguments[0]) = receiver_.request(code, value) ? 0 : -8;
  } else {
    heard.push_back("event " + std::to_string(member));
  }
  return S_OK;
}

void Host::show() {
  const std::span<const float> levels = receiver_.receive(sweep_).shown();
  publish({levels.begin(), levels.end()});
  pumpMessages();
}

void Host::answer() {
  pumpMessages();
  for (const ReceiverSetting& answer : receiver_.takeAnswers())
    panel_.call(L"vfpSet", {0, static_cast<int>(answer.code), 0, answer.value});
  show();
}

// --- The picture

using Columns = std::pair<int, int>;

bool hasTrace(HDC dc, int x, int y) { return GetPixel(dc, x, y) == kTraceColor; }

// The first and the last column of the trace. The fields beside the graph have its colour as well.
Columns traceColumns(HWND panel) {
  RECT fields{};
  GetWindowRect(buttonWith(panel, L"<Trace>"), &fields);
  MapWindowPoints(nullptr, panel, reinterpret_cast<POINT*>(&fields), 2);
  const HDC dc = GetDC(panel);
  const auto traced = [dc](int x) { return pixelsOf(dc, {x, 0, x + 1, kSizePx.cy}, kTraceColor) > 0; };
  int left = 0;
  int right = fields.left - 1;
  while (left < right && !traced(left)) ++left;
  while (right > left && !traced(right)) --right;
  ReleaseDC(panel, dc);
  return {left, right};
}

// How far right the trace's highest pixel is, in thousandths of the graph.
int carrierPlace(HWND panel, Columns graph) {
  const HDC dc = GetDC(panel);
  int place = -1;
  for (int y = 0; y < kSizePx.cy && place < 0; ++y)
    for (int x = graph.first; x <= graph.second && place < 0; ++x)
      if (hasTrace(dc, x, y)) place = MulDiv(x - graph.first, 1000, graph.second - graph.first);
  ReleaseDC(panel, dc);
  return place;
}

// --- Checks

struct Step {
  const wchar_t* label;
  const wchar_t* typed;
  const char* heard;
  const wchar_t* text;    // of the field, once the host has answered
  int carrierThousandth;  // where the carrier then stands
};

// Centre and span are 880 and 40 MHz at first: the carrier stands at 21.52 / 40.
constexpr Step kSteps[] = {
    {L"<Center>", L"881.52M", "set 13 881520000", L"881.52 MHz", 500},
    {L"<Span>", L"8M", "set 14 8000000", L"8 MHz", 500},
    {L"<Center>", L"880.52M", "set 13 880520000", L"880.52 MHz", 625},  // 5 of 8 MHz
    {L"<RBW>", L"30k", "set 16 30000", L"30 kHz", 625},
    {L"<Center>", L"880.52M", "", L"880.52 MHz", 625},
    {L"<Start>", L"880M", "set 13 882260000, set 14 4520000", L"880 MHz", 336},  // 1.52 of 4.52 MHz
};

void eachEntryGoesRoundOnce(HWND view, Host& host) {
  const Columns graph = traceColumns(view);
  expect(std::abs(carrierPlace(view, graph) - 538) <= 4, "at first the carrier stands where it was recorded");
  for (const Step& step : kSteps) {
    const HWND box = boxBeside(view, step.label);
    host.heard.clear();
    typeInto(box, step.typed);
    host.answer();
    host.answer();
    std::string all;
    for (const std::string& one : host.heard) all += (all.empty() ? "" : ", ") + one;
    const int place = carrierPlace(view, graph);
    const bool good =
        all == step.heard && textOf(box) == step.text && std::abs(place - step.carrierThousandth) <= 4;
    const std::wstring typed = std::wstring(step.label) + L" " + step.typed;
    const std::wstring shown = textOf(box);
    expect(good, std::string(typed.begin(), typed.end()) + ": [" + all + "], " +
                     std::string(shown.begin(), shown.end()) + ", the carrier at " + std::to_string(place));
  }
}

void buttonsAskForSweeps(HWND view, Host& host) {
  host.heard.clear();
  for (const wchar_t* button : {L"<Single>", L"<Cont.>", L"<Stop>"}) {
    click(buttonWith(view, button));
    pumpMessages();
  }
  expect(host.heard == std::vector<std::string>{"op 2", "op 3", "op 4"},
         "the buttons ask for one sweep, for sweeps, and for none");
}

void goesRound(HWND window) {
  Sited hosted(window);
  hosted.container.place = {0, 0, kSizePx.cx, kSizePx.cy};
  hosted.verb(OLEIVERB_UIACTIVATE);
  Host host(hosted);
  hosted.advise(host);
  for (const auto& [code, value] : {std::pair{13, 880e6}, {14, 40e6}})
    hosted.call(L"vfpSet", {0, code, 0, value});
  host.show();
  expect(host.heard.empty(), "what a host sends does not come back to it");
  eachEntryGoesRoundOnce(hosted.window(), host);
  buttonsAskForSweeps(hosted.window(), host);
  hosted.close();  // before its host goes
}

}  // namespace
}  // namespace frontpanels::testing

int main() {
  using namespace frontpanels::testing;
  chapter("closed loop");
  return runChecks({kSizePx.cx + 20, kSizePx.cy + 40}, [](const Desk& desk) { goesRound(desk.window); });
}
