// Canvas units: coordinates of the document are twips, drawing is in pixels. The one place of their ratio.
#pragma once

#include <cstdint>

inline constexpr std::int32_t TwipsPerPixelX = 15;
inline constexpr std::int32_t TwipsPerPixelY = 15;
