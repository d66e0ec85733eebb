// What the lighting engine keeps for each fixture beside the document's record: the places of its bulbs, the state of
// its strobes and of its ribbon. Lies in an array numbered as the fixtures are and is made anew at each entry into
// simulation, apart from SavedPointCount, which undoes the assembly of ribbons.
#pragma once

#include "model/simulation.h"

#include <array>
#include <cstdint>
#include <vector>

struct ZephBulbLocation {
    std::int32_t Type = 0;  // kPoint..., as the point; 0 for a bulb placed along a line
    std::int32_t X = 0;     // pixels, the centre of the bulb
    std::int32_t Y = 0;
};

// Schedule of one flashing bulb; all ms of the light clock.
struct ZephStrobeBulb {
    std::int32_t NextOnTime = 0;
    std::int32_t NextOffTime = 0;
    std::int32_t Spare = 0;  // never read; sequences of displays in the field were timed with three arrays a bulb
    bool BulbOn = false;
};

// The bulbs of one channel: contiguous runs in the pools of ZephRenderTables.
struct ZephBulbLocations {
    std::int32_t First = 0;         // index of the first bulb in BulbPool
    std::int32_t Count = 0;         // bulbs
    std::int32_t FirstStrobe = -1;  // index of the first schedule in StrobePool, -1 = the channel does not flash
};

struct ZephChannelState {
    std::int32_t StrobeInterval = 0;  // ms
    std::int32_t StrobeFireTime = 0;  // ms that a flash lasts
    bool StrobeRunning = false;
};

struct ZephKeshState {
    std::int32_t KeshResolution = 0;  // present resolution index 0..7
    bool KeshResolutionChanged = false;
    std::int32_t KeshSpeed = 0;      // 100 - value of channel 156, 0..100
    std::int32_t KeshIntensity = 0;  // value of channel 157, per cent
    std::int32_t KeshFlipTime = 0;
    std::int32_t KeshColorEffect = 0;  // last value of channel 155
    std::int32_t KeshMotionPos = 0;    // value of channel 154
    std::int32_t KeshMotionPosLast = 0;
    std::int32_t KeshMotion = 0;  // value of channel 152
    std::int32_t KeshMotionLast = 0;
    std::int32_t KeshMotionParm = 0;  // value of channel 153
    std::int32_t KeshMotionParmLast = 0;
    bool KeshFlip = false;
    std::int32_t ChaseTime = 0;  // 0 = no mask yet
    std::int32_t ChaseStep = 0;
    std::array<bool, 128> ChaseMask{};  // 1..ChaseLength; a length is at most 19 (10 on, 9 off)
    std::int32_t ChaseLength = 0;
    std::int32_t KeshStrobeNext = 0;
    bool KeshStrobeOn = false;
};

struct ZephFixtureState {
    std::int32_t SavedPointCount = 0;
    bool Assembled = false;  // this run assembled pieces onto the fixture, so SavedPointCount holds
    std::int32_t LocationCount = 0;
    std::array<ZephBulbLocations, kMaxChannels + 1> BulbLocations{};  // 1..LocationCount
    std::array<ZephChannelState, kMaxChannels + 1> Channels{};        // 1..
    ZephKeshState Kesh;
};

using ZephFixtureStates = OneBased<ZephFixtureState, kMaxFixtures>;
