// Small pictures that show the pixel rules of a Gdi, drawn by portable code so that two implementations can
// be compared.
#pragma once

#include <cstdint>
#include <functional>
#include <string>
#include <vector>

#include "platform/gdi.h"

namespace frontpanels::testing {

inline constexpr Size kSceneSizePx{160, 120};

struct Scene {
  std::string name;
  std::function<void(Gdi& gdi, DcHandle dc, std::uint32_t seed)> draw;
  std::uint32_t seed = 0;
  bool text = false;  // compared by the position of the ink, not pixel by pixel
};

// `rounds` is how many times the scenes made of random shapes are drawn, each time with other shapes.
[[nodiscard]] std::vector<Scene> gdiScenes(std::uint32_t rounds);

// What the two sides agree on: the colours of the system, which differ from one to the other.
inline constexpr SystemColor kSceneSystemColors[] = {SystemColor::ButtonFace,   SystemColor::ButtonShadow,
                                                     SystemColor::ButtonText,   SystemColor::ButtonHighlight,
                                                     SystemColor::DarkShadow3d, SystemColor::Light3d};

}  // namespace frontpanels::testing
