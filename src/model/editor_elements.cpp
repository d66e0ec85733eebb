#include "model/editor_elements.h"

#include "model/editor_records.h"

#include <QDateTime>
#include <QLocale>

#include <algorithm>

namespace {

void openElement(int blanks, std::string_view name, XmlText& text) {
    Indent(blanks, text);
    text.openStart(name);
}

void closeGroup(int blanks, std::string_view name, XmlText& text) {
    Indent(blanks, text);
    text.endTag(name);
}

// A start tag that is its own end when no children follow.
void endStartTag(bool hasChildren, XmlText& text) {
    if (hasChildren) {
        text.closeStart();
    } else {
        text.closeEmpty();
    }
}

}  // namespace

void CreateProcessingInstructions(XmlText& text) {
    text.raw("<?xml version='1.0' encoding='UTF-8'?>\r\n");
}

void CreateTopNode(std::string_view rootName, std::string_view version, std::string_view createdAt, XmlText& text) {
    text.openStart(rootName);
    text.attribute("zephSaveFileVersion", version);
    text.attribute("CreatedAt", createdAt);
}

void CreateBackgroundNode(const ZephBackground& background, const ZephPathService& paths, XmlText& text) {
    openElement(kIndentGroup, "Background", text);
    text.attribute("BackgroundType", background.BackgroundType);
    if (background.BackgroundType == kBackgroundPicture) {
        text.attribute("PicFileName", paths.CollapsePath(background.PicFileName, kPictureFolder));
    }
    text.attribute("PicIntensity", background.PicIntensity);
    text.attribute("EditorWidthTwips", background.EditorWidthTwips);
    text.attribute("EditorHeightTwips", background.EditorHeightTwips);
    text.closeEmpty();
}

void CreateLevelsGroupAndNode(const ZephSimulation& simulation, XmlText& text) {
    openElement(kIndentGroup, "Levels", text);
    text.attribute("Dimmed", simulation.Dimmed);
    text.closeStart();
    for (int id = 1; id <= kLevels; ++id) {
        const ZephLevel& level = simulation.Levels[id];
        openElement(kIndentRecord, "Level", text);
        text.attribute("ID", id);
        text.attribute("Edit_Enabled", level.Edit_Enabled);
        text.attribute("Sim_Enabled", level.Sim_Enabled);
        text.attribute("Name", level.Name);
        text.closeEmpty();
    }
    closeGroup(kIndentGroup, "Levels", text);
}

void CreateMasterPropsGroup(bool hasProps, XmlText& text) {
    openElement(kIndentGroup, "Items", text);
    endStartTag(hasProps, text);
}

void CloseMasterPropsGroup(bool hasProps, XmlText& text) {
    if (hasProps) closeGroup(kIndentGroup, "Items", text);
}

void CreatePropGroupAndNodes(int id, const ZephProp& prop, XmlText& text) {
    openElement(kIndentRecord, "Item", text);
    text.attribute("ID", id);
    text.attribute("Name", prop.Name);
    text.attribute("Locked", prop.Locked);
    text.attribute("Comment", prop.Comment);
    text.attribute("QvWU", prop.QvWU);
    text.attribute("QvFF", prop.QvFF);
    text.attribute("QvReverseOrder", prop.QvReverseOrder);
    text.attribute("QvForceRowColumn", prop.QvForceRowColumn);
    text.attribute("QvRow", prop.QvRow);
    text.attribute("QvColumn", prop.QvColumn);
    text.attribute("QvUseMyOrder", prop.QvUseMyOrder);
    text.attribute("QvStar", prop.QvStar);
    text.attribute("QvMatrixInd", prop.QvMatrixInd);
    text.attribute("QvPropColorTemp", prop.QvPropColorTemp);
    const int members = std::clamp(prop.AssignedCount, 0, kMaxFixturesInProp);
    endStartTag(members > 0, text);
    for (int slot = 1; slot <= members; ++slot) {
        openElement(kIndentPart, "AssignedObject", text);
        text.attribute("ID", slot);
        text.attribute("Object", prop.Object[slot]);
        text.closeEmpty();
    }
    if (members > 0) closeGroup(kIndentRecord, "Item", text);
}

void CreateMasterDrawObjectsGroup(bool hasFixtures, XmlText& text) {
    openElement(kIndentGroup, "DrawObjects", text);
    endStartTag(hasFixtures, text);
}

void CloseMasterDrawObjectsGroup(bool hasFixtures, XmlText& text) {
    if (hasFixtures) closeGroup(kIndentGroup, "DrawObjects", text);
}

void CreateDrawObjectGroup(int id, const ZephFixture& fixture, XmlText& text) {
    openElement(kIndentRecord, "DrawObject", text);
    text.attribute("ID", id);
    text.attribute("Name", fixture.Name);
    text.attribute("BulbSize", fixture.BulbSize);
    text.attribute("BulbSpacing", fixture.BulbSpacing);
    text.attribute("Comment", fixture.Comment);
    text.attribute("BulbShape", fixture.BulbShape);
    text.attribute("ZOrder", fixture.ZOrder);
    text.attribute("AssignedItem", fixture.AssignedItem);
    text.attribute("Locked", fixture.Locked);
    text.attribute("Fixture_Type", fixture.Fixture_Type);
    text.attribute("Channel_Type", fixture.Channel_Type);
    text.attribute("Max_Opacity", fixture.Max_Opacity);
    text.closeStart();
}

void CloseDrawObjectGroup(XmlText& text) {
    closeGroup(kIndentRecord, "DrawObject", text);
}

void CreateSampleColorsNode(const ZephFixture& fixture, XmlText& text) {
    openElement(kIndentPart, "Sample", text);
    text.attribute("Background_Color", fixture.Sample.Background_Color);
    text.attribute("RGB_R", fixture.Sample.RGB_R);
    text.attribute("RGB_G", fixture.Sample.RGB_G);
    text.attribute("RGB_B", fixture.Sample.RGB_B);
    text.closeEmpty();
}

void CreateQvFixtureNode(const ZephFixture& fixture, XmlText& text) {
    openElement(kIndentPart, "Novaline_Data", text);
    text.attribute("QvReverseOrder", fixture.Novaline.QvReverseOrder);
    text.attribute("QvForceRowColumn", fixture.Novaline.QvForceRowColumn);
    text.attribute("QvRow", fixture.Novaline.QvRow);
    text.attribute("QvColumn", fixture.Novaline.QvColumn);
    text.attribute("QvLocations", fixture.Novaline.QvLocations);
    text.attribute("QvColorTemp", fixture.Novaline.QvColorTemp);
    text.closeEmpty();
}

void CreateKeshNode(const ZephFixture& fixture, XmlText& text) {
    openElement(kIndentPart, "Kesh", text);
    text.attribute("Network", fixture.Kesh.Network);
    text.attribute("Base_Unit", fixture.Kesh.Base_Unit);
    text.attribute("Unit_Mode", fixture.Kesh.Unit_Mode);
    text.attribute("Channel_Mode", fixture.Kesh.Channel_Mode);
    text.attribute("Resolution", fixture.Kesh.Resolution);
    text.attribute("Physical_Pixel_Number", fixture.Kesh.Physical_Pixel_Number);
    text.closeEmpty();
}

void CreateDMXPixelNode(const ZephFixture& fixture, XmlText& text) {
    openElement(kIndentPart, "DMX", text);
    text.attribute("Universe", fixture.DMX.Universe);
    text.attribute("Physical_Pixel_Number", fixture.DMX.Physical_Pixel_Number);
    text.closeEmpty();
}

void CreateDrawObjectChannelGroup(const ZephFixture& fixture, XmlText& text) {
    const int channels = std::clamp(fixture.ChannelCount, 0, kMaxChannels);
    openElement(kIndentPart, "AssignedChannels", text);
    endStartTag(channels > 0, text);
    for (int id = 1; id <= channels; ++id)
        CreateChannelNode(id, fixture.Channels[id], text);
    if (channels > 0) closeGroup(kIndentPart, "AssignedChannels", text);
}

void CreateChannelNode(int id, const ZephChannel& channel, XmlText& text) {
    openElement(kIndentMember, "Channel", text);
    text.attribute("ID", id);
    text.attribute("Name", channel.Name);
    text.attribute("DeviceType", channel.DeviceType);
    text.attribute("Network", channel.Network);
    text.attribute("Controller", channel.Controller);
    text.attribute("Channel", channel.Channel);
    text.attribute("Color", channel.Color);
    text.attribute("Sub_Type", channel.Sub_Type);
    text.attribute("Sub_Parm", channel.Sub_Parm);
    for (int color = 1; color <= kMaxMultiColors; ++color)
        text.attribute(kMultiAttributes[static_cast<std::size_t>(color - 1)], channel.Multi[color]);
    text.attribute("LED", channel.LED);
    text.closeEmpty();
}

void CreateDrawPointsGroupAndNode(const ZephFixture& fixture, XmlText& text) {
    const int points = std::clamp(fixture.PointCount, 0, kMaxPoints);
    openElement(kIndentPart, "DrawPoints", text);
    endStartTag(points > 0, text);
    for (int id = 1; id <= points; ++id) {
        const ZephDrawPoint& point = fixture.DrawPoints[id];
        openElement(kIndentMember, "DrawPoint", text);
        text.attribute("ID", id);
        text.attribute("Type", point.Type);
        text.attribute("X", point.X);
        text.attribute("Y", point.Y);
        text.closeEmpty();
    }
    if (points > 0) closeGroup(kIndentPart, "DrawPoints", text);
}

void CreateHardwareNode(const ZephFixture& fixture, bool withChannels, XmlText& text) {
    if (fixture.Fixture_Type == kFixtureKesh) {
        CreateKeshNode(fixture, text);
    } else if (fixture.Fixture_Type == kFixtureDmxPixels) {
        CreateDMXPixelNode(fixture, text);
    } else if (withChannels) {
        CreateDrawObjectChannelGroup(fixture, text);
    }
}

std::string createdAtNow() {
    const QDateTime now = QDateTime::currentDateTime();
    const QLocale locale = QLocale::system();
    QString timeFormat = locale.timeFormat(QLocale::ShortFormat);
    // Most short formats stop at the minute; two saves within one should not look the same.
    if (!timeFormat.contains('s')) timeFormat.replace("mm", "mm:ss");
    const QString date = locale.toString(now.date(), QLocale::ShortFormat);
    return (date + ' ' + locale.toString(now.time(), timeFormat)).toStdString();
}
