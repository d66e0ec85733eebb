// The readers of the records that stand in editor, fixture and prop files. Each takes one element, guards itself and
// gives false on a failure, which then has cost the rest of that element; what was read before stays in the record.
// Written once for every kind of element: XmlNode of a parsed document, ScannedNode of a text read in passing.
#pragma once

#include "model/document.h"
#include "model/xml_node.h"
#include "util/paths.h"

#include <array>
#include <concepts>

inline constexpr std::string_view kLoadModule = "modZephLoadSave";
inline constexpr int kPictureFolder = kPathBase;  // the kind of folder that a picture's stored path is relative to

// Names of the attributes of the five colours of a Multi Color channel.
inline constexpr std::array<std::string_view, kMaxMultiColors> kMultiAttributes{"Multi_1", "Multi_2", "Multi_3",
                                                                                "Multi_4", "Multi_5"};

template <typename Node>
bool LoadBackground(const Node& node, const ZephPathService& paths, FailureReport& failures,
                    ZephBackground& background) try {
    background.BackgroundType = longAttribute(node, "BackgroundType");
    if (background.BackgroundType == kBackgroundPicture) {
        background.PicFileName = paths.ExpandPath(textAttribute(node, "PicFileName"), kPictureFolder);
    }
    background.PicIntensity = longAttribute(node, "PicIntensity");
    background.EditorWidthTwips = longAttribute(node, "EditorWidthTwips");
    background.EditorHeightTwips = longAttribute(node, "EditorHeightTwips");
    return true;
}
ZEPH_GUARD(failures, kLoadModule, false)

template <typename Node>
bool LoadLevels(const Node& node, FailureReport& failures, ZephSimulation& simulation) try {
    simulation.Dimmed = longAttribute(node, "Dimmed");
    for (Node child = node.firstElement(); child; child = child.nextElement()) {
        if (child.name() != "Level") continue;
        ZephLevel& level = simulation.Levels[slotAttribute(child, kLevels)];
        level.Edit_Enabled = flagAttribute(child, "Edit_Enabled");
        level.Sim_Enabled = flagAttribute(child, "Sim_Enabled");
        level.Name = textAttribute(child, "Name");
    }
    return true;
}
ZEPH_GUARD(failures, kLoadModule, false)

namespace editor_records_detail {

// What a prop has in every version.
template <typename Node>
void readProp(const Node& node, ZephProp& prop) {
    prop.Name = textAttribute(node, "Name");
    prop.Locked = flagAttribute(node, "Locked");
    prop.Comment = textAttribute(node, "Comment");
    prop.QvWU = longAttributeOr(node, "QvWU", 0);
    prop.QvFF = node.attribute("QvWU") ? textAttribute(node, "QvFF") : std::string();
}

template <typename Node>
void readMembers(const Node& node, ZephProp& prop) {
    for (Node child = node.firstElement(); child; child = child.nextElement()) {
        if (child.name() != "AssignedObject") continue;
        const int slot = slotAttribute(child, kMaxFixturesInProp);
        prop.AssignedCount = slot;
        prop.Object[slot] = longAttribute(child, "Object");
    }
}

template <typename Node>
void readFixture(const Node& node, const ZephSettings& settings, ZephFixture& fixture) {
    InitializeFixture(settings, fixture);
    fixture.Name = textAttribute(node, "Name");
    fixture.BulbSize = longAttribute(node, "BulbSize");
    fixture.BulbSpacing = longAttribute(node, "BulbSpacing");
    fixture.Comment = textAttribute(node, "Comment");
    fixture.BulbShape = longAttribute(node, "BulbShape");
    fixture.ZOrder = longAttribute(node, "ZOrder");
    fixture.AssignedItem = longAttribute(node, "AssignedItem");
    fixture.Locked = flagAttribute(node, "Locked");
    if (!node.attribute("Channel_Type")) return;
    fixture.Fixture_Type = longAttribute(node, "Fixture_Type");
    fixture.Channel_Type = longAttribute(node, "Channel_Type");
    fixture.Max_Opacity = longAttribute(node, "Max_Opacity");
}

}  // namespace editor_records_detail

template <typename Node>
bool LoadProp200(const Node& node, FailureReport& failures, ZephProp& prop) try {
    editor_records_detail::readProp(node, prop);
    editor_records_detail::readMembers(node, prop);
    return true;
}
ZEPH_GUARD(failures, kLoadModule, false)

template <typename Node>
bool LoadProp300(const Node& node, FailureReport& failures, ZephProp& prop) try {
    editor_records_detail::readProp(node, prop);
    prop.QvReverseOrder = flagAttribute(node, "QvReverseOrder");
    prop.QvForceRowColumn = flagAttribute(node, "QvForceRowColumn");
    prop.QvRow = longAttribute(node, "QvRow");
    prop.QvColumn = longAttribute(node, "QvColumn");
    prop.QvUseMyOrder = flagAttribute(node, "QvUseMyOrder");
    prop.QvStar = flagAttribute(node, "QvStar");
    // Files of a time before QvMatrixInd could only say yes or no.
    prop.QvMatrixInd = node.attribute("QvMatrix") ? (flagAttribute(node, "QvMatrix") ? 1 : 2) : 0;
    prop.QvMatrixInd = longAttributeOr(node, "QvMatrixInd", prop.QvMatrixInd);
    prop.QvPropColorTemp = longAttributeOr(node, "QvPropColorTemp", 0);
    editor_records_detail::readMembers(node, prop);
    return true;
}
ZEPH_GUARD(failures, kLoadModule, false)

template <typename Node>
bool LoadFixtureParms(const Node& node, const ZephSettings& settings, FailureReport& failures,
                      ZephFixture& fixture) try {
    editor_records_detail::readFixture(node, settings, fixture);
    return true;
}
ZEPH_GUARD(failures, kLoadModule, false)

// ledDefault: taken from the fixture when it says so, else left as it was.
template <typename Node>
bool LoadFixtureParms200(const Node& node, const ZephSettings& settings, FailureReport& failures, ZephFixture& fixture,
                         bool& ledDefault) try {
    editor_records_detail::readFixture(node, settings, fixture);
    if (node.attribute("LED")) ledDefault = flagAttribute(node, "LED");
    return true;
}
ZEPH_GUARD(failures, kLoadModule, false)

template <typename Node>
bool LoadSampleColors(const Node& node, FailureReport& failures, ZephFixture& fixture) try {
    fixture.Sample.Background_Color = longAttribute(node, "Background_Color");
    fixture.Sample.RGB_R = longAttribute(node, "RGB_R");
    fixture.Sample.RGB_G = longAttribute(node, "RGB_G");
    fixture.Sample.RGB_B = longAttribute(node, "RGB_B");
    return true;
}
ZEPH_GUARD(failures, kLoadModule, false)

template <typename Node>
bool LoadQvFixtureData(const Node& node, FailureReport& failures, ZephFixture& fixture) try {
    fixture.Novaline.QvReverseOrder = flagAttribute(node, "QvReverseOrder");
    fixture.Novaline.QvForceRowColumn = flagAttribute(node, "QvForceRowColumn");
    fixture.Novaline.QvRow = longAttribute(node, "QvRow");
    fixture.Novaline.QvColumn = longAttribute(node, "QvColumn");
    fixture.Novaline.QvLocations = textAttribute(node, "QvLocations");
    fixture.Novaline.QvColorTemp = longAttribute(node, "QvColorTemp");
    return true;
}
ZEPH_GUARD(failures, kLoadModule, false)

template <typename Node>
bool LoadKeshData(const Node& node, FailureReport& failures, ZephFixture& fixture) try {
    fixture.Kesh.Network = longAttribute(node, "Network");
    fixture.Kesh.Base_Unit = longAttribute(node, "Base_Unit");
    fixture.Kesh.Unit_Mode = longAttribute(node, "Unit_Mode");
    fixture.Kesh.Channel_Mode = longAttribute(node, "Channel_Mode");
    fixture.Kesh.Resolution = longAttribute(node, "Resolution");
    fixture.Kesh.Physical_Pixel_Number = longAttributeOr(node, "Physical_Pixel_Number", 1);
    return true;
}
ZEPH_GUARD(failures, kLoadModule, false)

template <typename Node>
bool LoadDMXData(const Node& node, FailureReport& failures, ZephFixture& fixture) try {
    fixture.DMX.Universe = longAttribute(node, "Universe");
    fixture.DMX.Physical_Pixel_Number = longAttributeOr(node, "Physical_Pixel_Number", 1);
    return true;
}
ZEPH_GUARD(failures, kLoadModule, false)

// channelsSeen: set when there is at least one channel, else left as it was.
template <typename Node>
bool LoadChannels(const Node& node, bool ledDefault, FailureReport& failures, ZephFixture& fixture,
                  bool& channelsSeen) try {
    for (Node child = node.firstElement(); child; child = child.nextElement()) {
        if (child.name() != "Channel") continue;
        channelsSeen = true;
        const int slot = slotAttribute(child, kMaxChannels);
        fixture.ChannelCount = slot;
        ZephChannel& channel = fixture.Channels[slot];
        channel.Name = textAttribute(child, "Name");
        channel.DeviceType = longAttribute(child, "DeviceType");
        if (channel.DeviceType == kDeviceClearedInFile) channel.DeviceType = kDeviceCleared;
        channel.Network = longAttribute(child, "Network");
        channel.Controller = longAttribute(child, "Controller");
        channel.Channel = longAttribute(child, "Channel");
        channel.Color = longAttribute(child, "Color");
        channel.Sub_Type = longAttributeOr(child, "Sub_Type", kSpecialNone);
        channel.Sub_Parm = child.attribute("Sub_Type") ? longAttribute(child, "Sub_Parm") : 0;
        for (int color = 1; color <= kMaxMultiColors; ++color) {
            const std::string_view name = kMultiAttributes[static_cast<std::size_t>(color - 1)];
            channel.Multi[color] = longAttributeOr(child, name, kWhite);
        }
        channel.LED = child.attribute("LED") ? flagAttribute(child, "LED") : ledDefault;
    }
    return true;
}
ZEPH_GUARD(failures, kLoadModule, false)

// A kind of element that can take the points in their usual spelling without looking at each attribute.
template <typename Node>
concept TakesPlainPoints = requires(const Node& node, ZephFixture& fixture) {
    node.takePlainPoints(fixture);
};

template <typename Node>
bool LoadPoints(const Node& node, FailureReport& failures, ZephFixture& fixture) try {
    if constexpr (TakesPlainPoints<Node>) node.takePlainPoints(fixture);
    for (Node child = node.firstElement(); child; child = child.nextElement()) {
        if (child.name() != "DrawPoint") continue;
        const int slot = slotAttribute(child, kMaxPoints);
        fixture.PointCount = slot;
        ZephDrawPoint& point = fixture.DrawPoints[slot];
        point.Type = longAttribute(child, "Type");
        point.X = longAttribute(child, "X");
        point.Y = longAttribute(child, "Y");
    }
    return true;
}
ZEPH_GUARD(failures, kLoadModule, false)
