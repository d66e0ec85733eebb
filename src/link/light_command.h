// One channel command as it comes off the wire, and where the link hands it to. The link does not know the engine.
#pragma once

#include <cstdint>
#include <span>
#include <string_view>

// How a channel is addressed and driven.
struct ZephLightCommand {
    std::int32_t CommandType = 0;  // payload type: 0 command, 1 expanded level dump
    std::int32_t EffectType = 0;   // 0 plain, 1 shimmer, 2 twinkle, 3 plain with levels given on the scale 0..255
    std::int32_t Network = 0;      // controller network; universe for DMX
    std::int32_t DeviceType = 0;
    std::int32_t Unit = 0;     // 0 for DMX and for virtual channels
    std::int32_t Circuit = 0;  // circuit, DMX channel, or position among the virtual channels

    bool operator==(const ZephLightCommand&) const = default;
};

struct ZephLightTiming {
    std::int32_t Duration = 0;        // ms; 0 or less = at once
    std::int32_t StartIntensity = 0;  // 0..100
    std::int32_t EndIntensity = 0;    // 0..100

    bool operator==(const ZephLightTiming&) const = default;
};

struct ZephChannelCommand {
    ZephLightCommand Command;
    ZephLightTiming Timing;

    bool operator==(const ZephChannelCommand&) const = default;
};

// What the link needs of whoever carries out its commands.
class CommandSink {
public:
    virtual ~CommandSink() = default;
    // Commands in the order of the wire, a batch at a time so that the receiver can look several keys up at once.
    virtual void addLightCommands(std::span<const ZephChannelCommand> commands) = 0;
    // Position of the virtual channel of that name (Latin-1 bytes, any case), from 1; 0 = none.
    virtual std::int32_t virtualChannelKey(std::string_view latin1Name) const = 0;
};
