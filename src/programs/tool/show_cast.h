// Who takes part in a demo show: every channel of a compiled display, and the lights that the channels make up, each
// with its place on the canvas. Made from the render table, so nothing that a simulation can reach is left out.
#pragma once

#include "engine/render_table.h"
#include "link/light_command.h"

#include <array>
#include <cstdint>
#include <string>
#include <vector>

inline constexpr std::int32_t kNoChannel = -1;

struct ShowChannel {
    std::int32_t key = 0;      // of the render table
    ZephLightCommand address;  // EffectType is not set
    std::string name;          // Latin-1, of a virtual channel; "" = the channel has an address
};

// The least that can be lit by itself: a plain channel, an RGB fixture, a pixel or a group of pixels.
struct ShowLight {
    std::int32_t fixture = 0;
    std::int32_t fixtureType = 0;
    std::int32_t level = 0;
    std::int32_t prop = 0;        // a fixture that stands alone counts as a prop of its own, numbered over kMaxProps
    std::int32_t turn0 = 0;       // plain: which of its fixture's channels, from 0
    bool rgb = false;             // else one channel of a fixed colour
    std::int32_t color = kWhite;  // of a plain channel
    std::array<std::int32_t, 3> channels{kNoChannel, kNoChannel, kNoChannel};  // red, green, blue; plain: the first
    double x = 0;                                                              // middle, 0..1 across the whole display
    double y = 0;                                                              // 0 top, 1 bottom
    double propX = 0;                                                          // 0..1 across its prop
    double propY = 0;
};

// The seven channels of a ribbon that hold no light but run its motions and effects.
struct ShowRibbon {
    std::int32_t fixture = 0;
    std::array<std::int32_t, 7> magic{kNoChannel, kNoChannel, kNoChannel, kNoChannel,
                                      kNoChannel, kNoChannel, kNoChannel};  // 151..157
    std::int32_t ownResolution = 0;  // value of channel 151 that stands for the Resolution of the document
};

struct ShowCast {
    std::vector<ShowChannel> channels;  // those that a command can address
    std::vector<ShowLight> lights;
    std::vector<ShowRibbon> ribbons;
    std::vector<std::int32_t> unreachable;  // keys that no command can address: a cleared device, a field too long
};

// tables and states as ZephBuildRenderTable left them for the display.
ShowCast gatherShowCast(const ZephSimulation& display, const ZephRenderTables& tables, const ZephFixtureStates& states);
