// The document: one open simulation of up to 1024 fixtures, grouped into up to 512 props, on 16 levels over a
// background. Plain records; a field keeps the name that it has in the files. Every index counts from 1, 0 = none.
// What the lighting engine adds to a fixture at run time lies in arrays of its own, numbered alike.
#pragma once

#include "util/one_based.h"

#include <cstdint>
#include <memory>
#include <string>

inline constexpr int kMaxFixtures = 1024;
inline constexpr int kMaxProps = 512;
inline constexpr int kMaxFixturesInProp = 64;
inline constexpr int kMaxChannels = 16;
inline constexpr int kMaxPoints = 256;
inline constexpr int kLevels = 16;
inline constexpr int kMaxCanvasPixels = 2500;
inline constexpr int kMaxMultiColors = 5;
inline constexpr int kMaxRibbonPixels = 50;
inline constexpr int kMaxDmxPixels = 170;

inline constexpr std::int32_t kWhite = 0xFFFFFF;

// Device types; 6 is not used. A file's 99 is read as kDeviceCleared.
inline constexpr std::int32_t kDeviceNone = 0;
inline constexpr std::int32_t kDeviceQen = 1;
inline constexpr std::int32_t kDeviceX10 = 3;
inline constexpr std::int32_t kDeviceDmx = 7;
inline constexpr std::int32_t kDeviceCleared = -1;
inline constexpr std::int32_t kDeviceClearedInFile = 99;

inline constexpr std::int32_t kFixtureStrings = 1;
inline constexpr std::int32_t kFixtureFlood = 2;
inline constexpr std::int32_t kFixtureBulbs = 3;
inline constexpr std::int32_t kFixtureKesh = 4;
inline constexpr std::int32_t kFixtureDmxPixels = 5;

inline constexpr std::int32_t kChannelNormal = 1;
inline constexpr std::int32_t kChannelRgb = 2;

inline constexpr std::int32_t kSpecialNone = 0;
inline constexpr std::int32_t kSpecialStrobes = 1;
inline constexpr std::int32_t kSpecialMultiColor = 2;

inline constexpr std::int32_t kPointLine = 2;          // joined by a straight line to the point before
inline constexpr std::int32_t kPointMove = 6;          // first point of a stroke
inline constexpr std::int32_t kPointBulb = 16;         // a bulb of its own
inline constexpr std::int32_t kPointPlaceHolder = 32;  // a pixel without a location, X and Y 0

inline constexpr std::int32_t kBackgroundPicture = 2;

struct ZephChannel {
    std::int32_t DeviceType = 0;
    std::int32_t Network = 0;     // controller network 0..15; DMX universe 1..999
    std::int32_t Controller = 0;  // unit; the whole address of an X10 channel
    std::int32_t Channel = 0;     // circuit; address in a DMX universe
    std::string Name;
    std::int32_t Color = 0;
    std::int32_t Sub_Type = 0;  // row of the special type table, 0..2
    std::int32_t Sub_Parm = 0;  // strobe: flashes a second 1..10; Multi Color: colours 1..5
    OneBased<std::int32_t, kMaxMultiColors> Multi = [] {
        OneBased<std::int32_t, kMaxMultiColors> colors;
        colors.fill(kWhite);
        return colors;
    }();
    bool LED = false;

    bool operator==(const ZephChannel&) const = default;
};

struct ZephDrawPoint {
    std::int32_t Type = 0;  // kPoint...
    std::int32_t X = 0;     // twips
    std::int32_t Y = 0;     // twips

    bool operator==(const ZephDrawPoint&) const = default;
};

struct ZephKeshData {
    std::int32_t Physical_Pixel_Number = 1;  // position of the first pixel on the physical ribbon, from 1
    std::int32_t Network = 0;
    std::int32_t Base_Unit = 0;
    std::int32_t Unit_Mode = 0;     // 0 Normal, 1 Legacy
    std::int32_t Channel_Mode = 0;  // 0 Triples, 1 Sequential
    std::int32_t Resolution = 0;    // index 0..7 of the resolution table

    bool operator==(const ZephKeshData&) const = default;
};

struct ZephDmxPixelData {
    std::int32_t Physical_Pixel_Number = 1;
    std::int32_t Universe = 0;  // 1..999

    bool operator==(const ZephDmxPixelData&) const = default;
};

struct ZephSampleColor {
    std::int32_t Background_Color = 0;
    std::int32_t RGB_R = 0;  // 0..255 each, the colour that an RGB fixture shows while edited
    std::int32_t RGB_G = 0;
    std::int32_t RGB_B = 0;

    bool operator==(const ZephSampleColor&) const = default;
};

struct ZephQvFixtureData {
    bool QvReverseOrder = false;
    bool QvForceRowColumn = false;
    std::int32_t QvRow = 0;
    std::int32_t QvColumn = 0;
    std::string QvLocations;
    std::int32_t QvColorTemp = 0;

    bool operator==(const ZephQvFixtureData&) const = default;
};

struct ZephFixture {
    std::int32_t Fixture_Type = 0;  // row of the fixture type table, 1..5
    std::string Name;
    std::string Comment;
    std::int32_t AssignedItem = 0;  // owning prop, 0 = stands alone
    std::string AssignedItemName;   // copy of the prop's name, never in a file
    std::int32_t BulbSpacing = 0;   // pixels between bulbs
    std::int32_t BulbSize = 0;      // pixels, the radius of a bulb
    std::int32_t BulbShape = 0;     // row of the bulb type table, 1..11
    std::int32_t Channel_Type = 0;  // 1 Normal, 2 RGB
    std::int32_t ChannelCount = 0;  // slots of Channels in use; 3 for an assigned RGB fixture (red, green, blue)
    OneBased<ZephChannel, kMaxChannels> Channels;
    ZephKeshData Kesh;     // Fixture_Type 4 only
    ZephDmxPixelData DMX;  // Fixture_Type 5 only
    std::int32_t PointCount = 0;
    OneBased<ZephDrawPoint, kMaxPoints> DrawPoints;
    ZephSampleColor Sample;
    std::int32_t ZOrder = 0;  // level 1..16
    bool Locked = false;
    std::int32_t Max_Opacity = 0;  // per cent, the top opacity of a flood
    ZephQvFixtureData Novaline;

    bool operator==(const ZephFixture&) const = default;
};

struct ZephProp {
    std::string Name;
    std::string Comment;
    bool Locked = false;
    std::int32_t AssignedCount = 0;
    bool QvReverseOrder = false;
    bool QvForceRowColumn = false;
    std::int32_t QvRow = 0;
    std::int32_t QvColumn = 0;
    bool QvUseMyOrder = false;
    bool QvStar = false;
    std::int32_t QvMatrixInd = 0;  // 0 not stated, 1 matrix, 2 not a matrix
    std::int32_t QvPropColorTemp = 0;
    std::int32_t QvWU = 0;
    std::string QvFF;
    OneBased<std::int32_t, kMaxFixturesInProp> Object;  // fixture numbers

    bool operator==(const ZephProp&) const = default;
};

struct ZephLevel {
    bool Edit_Enabled = true;
    bool Sim_Enabled = true;
    std::string Name;

    bool operator==(const ZephLevel&) const = default;
};

struct ZephBackground {
    std::int32_t BackgroundType = 0;  // 2 = a picture, other values show the blank picture
    std::string PicFileName;          // full path
    std::int32_t PicIntensity = 100;  // 0..100
    std::int32_t EditorWidthTwips = 0;
    std::int32_t EditorHeightTwips = 0;

    bool operator==(const ZephBackground&) const = default;
};

// Canvas size in pixels: the twips divided and cut off, at least one pixel.
std::int32_t widthPixels(const ZephBackground& background) noexcept;
std::int32_t heightPixels(const ZephBackground& background) noexcept;

// About 6 MB: made once, on the heap.
struct ZephSimulation {
    OneBased<ZephFixture, kMaxFixtures> Fixtures;
    std::int32_t FixtureCount = 0;
    OneBased<ZephProp, kMaxProps> Props;
    std::int32_t PropCount = 0;
    ZephBackground Background;
    OneBased<ZephLevel, kLevels> Levels;
    std::int32_t Dimmed = 0;          // per cent at which fixtures on levels closed to editing are drawn; 0 hides them
    std::string FilePath;             // folder with its separator
    std::string FileName;             // bare name
    std::string zephSaveFileVersion;  // as the file read last states it, known or not
    bool SimulationDirty = false;
    bool SimulationOpen = false;
    bool ChecksumMismatch = false;
    bool FileUpgraded = false;
    // Stands in for a channel without LED of its own. It outlives loads on purpose: an old file sets it, and every
    // later file that says nothing inherits it.
    bool FixtureLedDefault = false;

    bool operator==(const ZephSimulation&) const = default;
};
