// The dimming curve: output 0..255 for each input 0..255, through which every level becomes an opacity.
#pragma once

#include <array>
#include <cstdint>

using ZephDimmingCurve = std::array<std::uint8_t, 256>;
