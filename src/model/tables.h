// The constant tables that give names and capabilities to the numeric codes of the document.
#pragma once

#include "model/simulation.h"

#include <array>
#include <string>
#include <string_view>

struct ZephDeviceTypeRow {
    std::int32_t Code;
    std::string_view ShortName;
    std::string_view LongName;
};

inline constexpr std::array<ZephDeviceTypeRow, 7> ZephDeviceType{{
    {0, "None", "None"},
    {1, "Qen", "Kalvora Controller"},
    {2, "DIO", "Digital IO Card"},
    {3, "X10", "X10"},
    {4, "Dasher", "Dasher Controller"},
    {5, "Bsoft", "BSOFT Digital IO Card"},
    {7, "DMX", "DMX Universe"},
}};

// Names of a device type; "" for a code without a row.
std::string_view deviceShortName(std::int32_t deviceType) noexcept;
std::string_view deviceLongName(std::int32_t deviceType) noexcept;

// index 0..15: "Regular", then "Aux A" to "Aux O"; over 26 "Net " and the number, which the table never reaches.
std::string networkName(std::int32_t index);
// index 1..999: "Unv " and the number.
std::string universeName(std::int32_t index);

struct ZephFixtureTypeRow {
    std::string_view Name;
    bool AllowRGB;
    bool AllowSpecialType;
    bool UsesBulbSize;
    std::int32_t MaxChannels;  // rows 4 and 5 count channels on the controller, not slots of Channels
    bool ShowsSample;
};

inline constexpr std::array<ZephFixtureTypeRow, 5> kFixtureTypes{{
    {"Light Strings", true, true, true, 16, true},
    {"Flood Light", true, false, false, 1, true},
    {"Single Bulbs", true, true, true, 1, true},
    {"Kesh Strand", false, false, false, 157, true},
    {"DMX Pixels", false, false, false, 510, true},
}};
// row 1..5
constexpr const ZephFixtureTypeRow& ZephFixtureType(int row) {
    return kFixtureTypes.at(static_cast<std::size_t>(row - 1));
}

inline constexpr std::array<std::string_view, 2> kChannelTypeNames{"Normal", "RGB"};  // rows 1..2

struct ZephSpecialTypeRow {
    std::string_view Name;
    std::string_view Label;
    bool HasParameter;
    std::string_view ParameterLabel;
    std::int32_t Min;
    std::int32_t Max;
    bool MultiColor;
};

inline constexpr std::array<ZephSpecialTypeRow, 3> ZephSpecialType{{
    // row = Sub_Type
    {"", "", false, "", 0, 0, false},
    {"Strobes", "Strobe", true, "Speed", 1, 10, false},
    {"Multi Color", "Multi", true, "Colors", 1, 5, true},
}};

struct KeshResolutionRow {
    std::string_view Label;
    std::int32_t Count;  // what KeshResolutionToResolutionCount gives
    std::int32_t Group;  // channels of a colour in Sequential mode, and the value sent on channel 151
};

// Index 3 is labelled and grouped 16 but counts as 17: ribbons in the field do so, and sequences rely on it.
inline constexpr std::array<KeshResolutionRow, 8> kKeshResolutions{{
    {"50 Pixels", 50, 50},
    {"25 Pixels", 25, 25},
    {"17 Pixels", 17, 17},
    {"16 Pixels", 17, 16},
    {"10 Pixels", 10, 10},
    {"5 Pixels", 5, 5},
    {"2 Pixels", 2, 2},
    {"1 Pixel", 1, 1},
}};

inline constexpr std::array<std::string_view, 2> kKeshUnitModes{"Normal", "Legacy"};
inline constexpr std::array<std::string_view, 2> kKeshChannelModes{"Triples", "Sequential"};

// Pixels to a strand at a resolution index: any index outside 1..7 counts as 50.
std::int32_t KeshResolutionToResolutionCount(std::int32_t resolution) noexcept;
// The resolution index of a value on channel 151; any other value gives the fixture's own Resolution.
std::int32_t KeshResolutionCountToResolution(const ZephFixture& fixture, std::int32_t value) noexcept;

struct ZephBulbTypeRow {
    std::string_view Name;
    std::int32_t MinimumSize;  // smallest BulbSize at which the shape is recognisable
    bool IsPixel;              // kept out of the shape lists of ordinary fixtures
};

inline constexpr std::array<ZephBulbTypeRow, 11> kBulbTypes{{
    {"Round", 1, false},
    {"Triangle", 2, false},
    {"Square", 1, false},
    {"Pentagon", 4, false},
    {"Hexagon", 5, false},
    {"Octagon", 6, false},
    {"4 Point Star", 3, false},
    {"5 Point Star", 2, false},
    {"6 Point Star", 3, false},
    {"8 Point Star", 5, false},
    {"Pixel Bulb", 1, true},
}};
inline constexpr int kBulbShapes = static_cast<int>(kBulbTypes.size());
inline constexpr int kMaxBulbSize = 16;   // of every shape
inline constexpr int kMaxFloodSize = 64;  // of a flood
// row 1..11
constexpr const ZephBulbTypeRow& ZephBulbType(int row) {
    return kBulbTypes.at(static_cast<std::size_t>(row - 1));
}

inline constexpr std::array<std::string_view, 8> kFixtureTextLocations{
    "None", "First Point", "Center", "Left", "Right", "Top", "Bottom", "Pixel Num ONLY"};
inline constexpr std::array<std::string_view, 3> kRgbComponents{"Red", "Green", "Blue"};  // index 1..3
inline constexpr std::array<std::string_view, 5> kGridLines{"Off", "Solid", "Dotted", "Cross", "Dot"};
inline constexpr std::array<std::string_view, 3> kStartupActions{"Do Nothing", "Show Open File Dialog",
                                                                 "Automatically Open Last File"};
inline constexpr std::array<std::string_view, 13> kArchStyles{"Strings in a Wedge - No Base",
                                                              "Strings in a Wedge - With Base",
                                                              "Strings Up and Over",
                                                              "Strings Edge to Center",
                                                              "Strings Center to Edge",
                                                              "Kesh Edge to Center",
                                                              "Kesh Center to Edge",
                                                              "Kesh Edge to Center/Center To Edge",
                                                              "Kesh Center to Edge/Edge To Center",
                                                              "DMX Pixels Edge to Center",
                                                              "DMX Pixels Center to Edge",
                                                              "DMX Pixels Edge to Center/Center To Edge",
                                                              "DMX Pixels Center to Edge/Edge To Center"};
