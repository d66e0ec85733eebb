// Where the fields of a light command stand in its payload. All rows are alike today; the table stays because a later
// variant of the format would change a row and nothing else.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>

struct PacketParm {
    std::int32_t TotalFixedLength = 0;  // characters; a virtual channel's key follows them
    std::int32_t DurationColumn = 0;    // columns count from 1
    std::int32_t DurationWidth = 0;
    std::int32_t StartLevelColumn = 0;
    std::int32_t StartLevelWidth = 0;
    std::int32_t EndLevelColumn = 0;
    std::int32_t EndLevelWidth = 0;

    bool operator==(const PacketParm&) const = default;
};

// Indexed by packetIndex(cmd, sub). The rows of cmd 1 stay zero and are never read.
using ZephPacketParms = std::array<PacketParm, 8>;

constexpr std::size_t packetIndex(std::int32_t cmd, std::int32_t sub) noexcept {
    return static_cast<std::size_t>(cmd + 2 * sub);
}

inline constexpr PacketParm kLightCommandParm{29, 16, 8, 24, 3, 27, 3};

// Fills the table; called once at form load.
void ZephSetUpPacketParms(ZephPacketParms& parms) noexcept;

// Whether the four rows of cmd 0 are kLightCommandParm, the layout for which the fast forms are built.
bool hasStandardLayout(const ZephPacketParms& parms) noexcept;
