// The render table: the document compiled into an index from channel key to bulbs. Made at entry into simulation,
// erased when it is left. All arrays count from 1; index 0 exists and stays empty.
#pragma once

#include "engine/channel_key.h"
#include "engine/fixture_state.h"
#include "engine/key_search.h"
#include "model/settings.h"
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

// The live half of an entry: the command that its channel carries out, as it was filed. Filing writes it whole and
// reads nothing of it, four of them share a cache line.
struct ZephRenderLive {
    std::int32_t StartTime = 0;       // ms of the light clock
    std::int32_t Duration = 0;        // ms
    std::int32_t LastEffectTime = 0;  // 0 before the first effect step
    std::uint8_t CommandType = 0;
    std::uint8_t EffectType = 0;      // 0 plain, 1 shimmer, 2 twinkle
    std::uint8_t StartIntensity = 0;  // 0..100
    std::uint8_t EndIntensity = 0;    // 0..100
};
static_assert(sizeof(ZephRenderLive) == 16);

// Bits of ZephRenderTables::CommandState.
inline constexpr std::uint8_t kCommandActive = 1;  // a command runs on the entry
inline constexpr std::uint8_t kCommandNew = 2;     // NewCommand: no pass has seen it yet

// The phase of an entry's twinkle. It goes on across commands, so filing leaves it alone.
struct ZephTwinklePhase {
    std::int32_t NextTwinkleTime = 0;  // ms of the light clock, 0 = not started
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

// One RGB group of a level, in the order in which groups are drawn.
struct ZephLevelGroup {
    std::int32_t Fixture = 0;
    std::int32_t RGBIndex = 0;
    std::int32_t Triplet = 0;
};

struct ZephRenderTables {
    std::int32_t RenderDataCount = 0;  // 0 until a build has ended well
    std::vector<std::int32_t> Keys;    // ascending; beside RenderData and Live, in the same order
    KeySearch Search;                  // finds a key's place in Keys
    std::vector<ZephRenderData> RenderData;
    std::vector<ZephRenderLive> Live;
    std::vector<ZephTwinklePhase> Twinkle;
    std::vector<std::uint8_t> CommandState;  // kCommandActive, kCommandNew; bytes, since every pass scans them
    std::vector<std::int32_t> NewEntries;    // the first NewEntryCount: entries whose command is new
    std::size_t NewEntryCount = 0;
    std::vector<ZephRenderSlot> Slots;
    std::vector<ZephRGBData> RGBData;
    std::int32_t VirtualChannelCount = 0;
    std::vector<std::string> VirtualChannels;  // lower case UTF-8, ascending once gathered
    bool VirtualChannelWarning = false;
    std::uint32_t LevelChanged = 0;  // bit of the level number: a channel on it has something to show
    std::array<std::vector<std::int32_t>, kLevels + 1> LevelEntries;   // entries that use a level, in key order
    std::array<std::vector<ZephLevelGroup>, kLevels + 1> LevelGroups;  // groups of a level, in key order
    std::vector<ZephBulbLocation> BulbPool;
    std::vector<ZephStrobeBulb> StrobePool;
    std::vector<std::uint8_t> BulbLit;  // as many as the longest flashing channel has bulbs: work space of a pass
};

// What the compiler of the table reads and changes.
struct RenderBuildContext {
    const ZephSettings& settings;
    Host& host;
    FailureReport& failures;
    ZephSimulation& simulation;  // a cleared device is marked in it, and ribbons are assembled
    ZephFixtureStates& states;
    ZephRenderTables& tables;
};

// Compiles the document. RenderDataCount stays 0 when it fails validation (the list of faults was shown) or has no
// channels (a box said so).
void ZephBuildRenderTable(RenderBuildContext context);

// Erases the tables. The points that assembly added to main ribbons go with restoreAssembledPoints.
void eraseRenderTables(ZephRenderTables& tables);

// Gives every main ribbon and pixel fixture that this run assembled its own points back.
void restoreAssembledPoints(ZephSimulation& simulation, ZephFixtureStates& states);

// Position of a name among the virtual channels, from 1; 0 = absent. Any case; UTF-8.
std::int32_t ZephReturnVirtualChannelKey(std::string_view name, const ZephRenderTables& tables);

// Index of a key in RenderData, 0 = absent.
inline std::int32_t FindCommandData(std::int32_t key, const ZephRenderTables& tables) {
    return tables.Search.find(key);
}

// The bulbs of a channel, or nullptr where the fixture has none for it.
const ZephBulbLocations* bulbLocations(const ZephFixtureState& state, std::int32_t channel);
