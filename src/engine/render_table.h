// The render table: the document compiled into an index from channel key to bulbs. Made at entry into simulation,
// erased when it is left. All arrays count from 1; index 0 exists and stays empty.
#pragma once

#include "engine/fixture_state.h"
#include "util/failure.h"
#include "util/host.h"

#include <array>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

inline constexpr int kMaxSlots = 16;             // fixtures that one channel drives
inline constexpr int kMaxVirtualChannels = 255;  // channels without a device, found by name
inline constexpr int kFirstMagicChannel = 151;   // of a ribbon, up to 157
inline constexpr int kLastMagicChannel = 157;

struct ZephRenderSlot {
    std::int32_t Fixture = 0;
    std::int32_t Channel = 0;    // plain: channel index; RGB: colour 1 red, 2 green, 3 blue; magic: 151..157
    std::int32_t Level = 0;      // 1..16, the fixture's at build time
    std::int32_t RGBIndex = 0;   // index into RGBData, 0 = a plain or magic slot
    std::int32_t Triplet = 0;    // 0 plain RGB fixture, ribbon pixel, or 1001 upward for a DMX pixel
    std::int32_t KeshMagic = 0;  // 151..157, else 0

    bool isRGB() const noexcept { return RGBIndex != 0; }
};

// The unchanging half of an entry. Its slots are Slots[FirstSlot] onward.
struct ZephRenderData {
    std::int32_t Key = 0;
    std::int32_t FirstSlot = 0;
    std::int32_t SlotCount = 0;   // 0..16
    std::uint32_t LevelUsed = 0;  // bit of the level number set for each level on which a slot lies
};

// The live half of an entry: what its channel is doing. In an array of its own, so that filing a command touches one
// cache line.
struct ZephRenderLive {
    std::int32_t CommandType = 0;
    std::int32_t EffectType = 0;  // 0 plain, 1 shimmer, 2 twinkle
    std::int32_t StartTime = 0;   // ms of the light clock
    std::int32_t StartIntensity = 0;
    std::int32_t EndIntensity = 0;     // 0..100
    std::int32_t Duration = 0;         // ms
    std::int32_t LastEffectTime = 0;   // 0 before the first effect step
    std::int32_t NextTwinkleTime = 0;  // 0 = not started
    bool CommandActive = false;
    bool NewCommand = false;
    bool TwinkleOn = false;
};

struct ZephRGBData {
    std::int32_t Key = 0;
    std::array<std::int32_t, 4> Level{};           // 1..3: present level 0..255 of red, green, blue
    std::array<std::int32_t, 4> LastLevel{};       // levels for which the bulb image was made
    std::array<std::int32_t, 4> EffectLevel{};     // target of the shimmer effect
    std::array<std::int32_t, 4> Mode{0, 1, 1, 1};  // bit 1 plain commands, bit 2 a colour effect, 4 neither
    bool Changed = false;                          // to be drawn in this pass
    std::int32_t EffectMask = 0;
    std::int32_t Bulb = 0;  // handle of the coloured image, kept by the drawing surface; 0 = none yet
};

struct ZephRenderTables {
    std::int32_t RenderDataCount = 0;  // 0 until a build has ended well
    std::vector<std::int32_t> Keys;    // ascending; beside RenderData and Live, in the same order
    std::vector<ZephRenderData> RenderData;
    std::vector<ZephRenderLive> Live;
    std::vector<ZephRenderSlot> Slots;
    std::vector<ZephRGBData> RGBData;
    std::int32_t VirtualChannelCount = 0;
    std::vector<std::string> VirtualChannels;  // lower case UTF-8, ascending once gathered
    bool VirtualChannelWarning = false;
    std::array<bool, kLevels + 1> LevelChanged{};
    std::vector<ZephBulbLocation> BulbPool;
    std::vector<ZephStrobeBulb> StrobePool;
};
