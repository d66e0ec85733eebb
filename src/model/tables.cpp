#include "model/tables.h"

namespace {

const ZephDeviceTypeRow* deviceRow(std::int32_t deviceType) noexcept {
    for (const ZephDeviceTypeRow& row : ZephDeviceType) {
        if (row.Code == deviceType) return &row;
    }
    return nullptr;
}

}  // namespace

std::string_view deviceShortName(std::int32_t deviceType) noexcept {
    const ZephDeviceTypeRow* row = deviceRow(deviceType);
    return row ? row->ShortName : std::string_view();
}

std::string_view deviceLongName(std::int32_t deviceType) noexcept {
    const ZephDeviceTypeRow* row = deviceRow(deviceType);
    return row ? row->LongName : std::string_view();
}

std::string networkName(std::int32_t index) {
    if (index == 0) return "Regular";
    if (index >= 1 && index <= 26) return std::string("Aux ") + static_cast<char>('A' + index - 1);
    return "Net " + std::to_string(index);
}

std::string universeName(std::int32_t index) {
    return "Unv " + std::to_string(index);
}

std::int32_t KeshResolutionToResolutionCount(std::int32_t resolution) noexcept {
    if (resolution < 1 || resolution > 7) return kKeshResolutions[0].Count;
    return kKeshResolutions[static_cast<std::size_t>(resolution)].Count;
}

std::int32_t KeshResolutionCountToResolution(const ZephFixture& fixture, std::int32_t value) noexcept {
    for (std::size_t index = 0; index < kKeshResolutions.size(); ++index) {
        if (kKeshResolutions[index].Group == value) return static_cast<std::int32_t>(index);
    }
    return fixture.Kesh.Resolution;
}
