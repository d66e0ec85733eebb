#include "engine/ribbon_channels.h"

#include "model/tables.h"

RibbonAddress LegacyKeshIDs(std::int32_t index, std::int32_t baseUnit) noexcept {
    const std::int32_t unit0 = (index - 1) / 16;
    return {std::int64_t{baseUnit} + unit0, index - 16 * unit0};
}

RibbonAddress ribbonAddress(const ZephKeshData& kesh, std::int32_t index) noexcept {
    return kesh.Unit_Mode == kUnitLegacy ? LegacyKeshIDs(index, kesh.Base_Unit) : RibbonAddress{kesh.Base_Unit, index};
}

RibbonPixel ReturnKeshTripletKey(std::int32_t index, std::int32_t channelMode, std::int32_t resolution) noexcept {
    if (channelMode != kModeSequential) {
        const std::int32_t pixel = (index - 1) / 3 + 1;
        return {pixel, index - 3 * pixel + 3};
    }
    const std::size_t row = resolution >= 1 && resolution <= 7 ? static_cast<std::size_t>(resolution) : 0;
    const std::int32_t group = kKeshResolutions[row].Group;
    const std::int32_t colour = (index - 1) / group + 1;
    return {index - group * (colour - 1), colour};
}

std::int32_t AbsoluteKeshChannelID(std::int32_t channelMode, std::int32_t resolution, std::int32_t pixel,
                                   std::int32_t colour) noexcept {
    if (channelMode != kModeSequential) return colour + 3 * pixel - 3;
    return KeshResolutionToResolutionCount(resolution) * (colour - 1) + pixel;
}
