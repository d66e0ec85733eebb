#include "programs/tool/info_command.h"

#include "model/tables.h"
#include "programs/tool/json_text.h"
#include "programs/tool/tool_document.h"

#include <algorithm>

namespace {

QJsonObject backgroundJson(const ZephBackground& background) {
    return {{"BackgroundType", background.BackgroundType},       {"PicFileName", jsonText(background.PicFileName)},
            {"PicIntensity", background.PicIntensity},           {"EditorWidthTwips", background.EditorWidthTwips},
            {"EditorHeightTwips", background.EditorHeightTwips}, {"WidthPixels", widthPixels(background)},
            {"HeightPixels", heightPixels(background)}};
}

QJsonArray levelsJson(const ZephSimulation& simulation) {
    QJsonArray levels;
    for (int id = 1; id <= kLevels; ++id) {
        const ZephLevel& level = simulation.Levels[id];
        levels.append(QJsonObject{{"ID", id},
                                  {"Edit_Enabled", level.Edit_Enabled},
                                  {"Sim_Enabled", level.Sim_Enabled},
                                  {"Name", jsonText(level.Name)}});
    }
    return levels;
}

QJsonObject propJson(int id, const ZephProp& prop) {
    QJsonArray members;
    for (int slot = 1; slot <= prop.AssignedCount; ++slot)
        members.append(prop.Object[slot]);
    return {{"ID", id},
            {"Name", jsonText(prop.Name)},
            {"Comment", jsonText(prop.Comment)},
            {"Locked", prop.Locked},
            {"QvReverseOrder", prop.QvReverseOrder},
            {"QvForceRowColumn", prop.QvForceRowColumn},
            {"QvRow", prop.QvRow},
            {"QvColumn", prop.QvColumn},
            {"QvUseMyOrder", prop.QvUseMyOrder},
            {"QvStar", prop.QvStar},
            {"QvMatrixInd", prop.QvMatrixInd},
            {"QvPropColorTemp", prop.QvPropColorTemp},
            {"QvWU", prop.QvWU},
            {"QvFF", jsonText(prop.QvFF)},
            {"Object", members}};
}

QJsonObject channelJson(int id, const ZephChannel& channel) {
    QJsonArray multi;
    for (const std::int32_t color : channel.Multi)
        multi.append(color);
    return {{"ID", id},
            {"Name", jsonText(channel.Name)},
            {"DeviceType", channel.DeviceType},
            {"Network", channel.Network},
            {"Controller", channel.Controller},
            {"Channel", channel.Channel},
            {"Color", channel.Color},
            {"Sub_Type", channel.Sub_Type},
            {"Sub_Parm", channel.Sub_Parm},
            {"Multi", multi},
            {"LED", channel.LED}};
}

QJsonObject fixtureJson(int id, const ZephFixture& fixture) {
    QJsonArray channels;
    for (int c = 1; c <= fixture.ChannelCount; ++c)
        channels.append(channelJson(c, fixture.Channels[c]));
    QJsonArray points;
    for (int p = 1; p <= fixture.PointCount; ++p) {
        const ZephDrawPoint& point = fixture.DrawPoints[p];
        points.append(QJsonArray{point.Type, point.X, point.Y});
    }
    const ZephKeshData& kesh = fixture.Kesh;
    const ZephQvFixtureData& novaline = fixture.Novaline;
    return {{"ID", id},
            {"Fixture_Type", fixture.Fixture_Type},
            {"Name", jsonText(fixture.Name)},
            {"Comment", jsonText(fixture.Comment)},
            {"AssignedItem", fixture.AssignedItem},
            {"AssignedItemName", jsonText(fixture.AssignedItemName)},
            {"BulbSpacing", fixture.BulbSpacing},
            {"BulbSize", fixture.BulbSize},
            {"BulbShape", fixture.BulbShape},
            {"Channel_Type", fixture.Channel_Type},
            {"ZOrder", fixture.ZOrder},
            {"Locked", fixture.Locked},
            {"Max_Opacity", fixture.Max_Opacity},
            {"ChannelCount", fixture.ChannelCount},
            {"Channels", channels},
            {"Kesh", QJsonObject{{"Physical_Pixel_Number", kesh.Physical_Pixel_Number},
                                 {"Network", kesh.Network},
                                 {"Base_Unit", kesh.Base_Unit},
                                 {"Unit_Mode", kesh.Unit_Mode},
                                 {"Channel_Mode", kesh.Channel_Mode},
                                 {"Resolution", kesh.Resolution}}},
            {"DMX", QJsonObject{{"Physical_Pixel_Number", fixture.DMX.Physical_Pixel_Number},
                                {"Universe", fixture.DMX.Universe}}},
            {"Sample", QJsonObject{{"Background_Color", fixture.Sample.Background_Color},
                                   {"RGB_R", fixture.Sample.RGB_R},
                                   {"RGB_G", fixture.Sample.RGB_G},
                                   {"RGB_B", fixture.Sample.RGB_B}}},
            {"Novaline_Data", QJsonObject{{"QvReverseOrder", novaline.QvReverseOrder},
                                          {"QvForceRowColumn", novaline.QvForceRowColumn},
                                          {"QvRow", novaline.QvRow},
                                          {"QvColumn", novaline.QvColumn},
                                          {"QvLocations", jsonText(novaline.QvLocations)},
                                          {"QvColorTemp", novaline.QvColorTemp}}},
            {"PointCount", fixture.PointCount},
            {"DrawPoints", points}};
}

QJsonObject documentJson(const ToolDocument& document) {
    const ZephSimulation& simulation = *document.simulation;
    QJsonArray props;
    for (int p = 1; p <= simulation.PropCount; ++p)
        props.append(propJson(p, simulation.Props[p]));
    QJsonArray fixtures;
    for (int f = 1; f <= simulation.FixtureCount; ++f)
        fixtures.append(fixtureJson(f, simulation.Fixtures[f]));
    return {{"FilePath", jsonText(simulation.FilePath)},
            {"FileName", jsonText(simulation.FileName)},
            {"zephSaveFileVersion", jsonText(simulation.zephSaveFileVersion)},
            {"Loaded", document.loaded},
            {"ChecksumMismatch", simulation.ChecksumMismatch},
            {"FileUpgraded", simulation.FileUpgraded},
            {"Background", backgroundJson(simulation.Background)},
            {"Dimmed", simulation.Dimmed},
            {"Levels", levelsJson(simulation)},
            {"PropCount", simulation.PropCount},
            {"Props", props},
            {"FixtureCount", simulation.FixtureCount},
            {"Fixtures", fixtures},
            {"Messages", jsonMessages(document.host)}};
}

const char* yesNo(bool flag) {
    return flag ? "yes" : "no";
}

void printSummary(const ToolDocument& document) {
    const ZephSimulation& simulation = *document.simulation;
    std::printf("%s%s\n", simulation.FilePath.c_str(), simulation.FileName.c_str());
    std::printf("version %s, loaded whole: %s, checksum mismatch: %s\n",
                simulation.zephSaveFileVersion.empty() ? "unknown" : simulation.zephSaveFileVersion.c_str(),
                yesNo(document.loaded), yesNo(simulation.ChecksumMismatch));
    std::printf("canvas %d x %d pixels, background %s at %d %%\n", widthPixels(simulation.Background),
                heightPixels(simulation.Background),
                simulation.Background.PicFileName.empty() ? "blank" : simulation.Background.PicFileName.c_str(),
                simulation.Background.PicIntensity);
    std::printf("%d fixtures in %d props\n", simulation.FixtureCount, simulation.PropCount);
    for (int f = 1; f <= simulation.FixtureCount; ++f) {
        const ZephFixture& fixture = simulation.Fixtures[f];
        const bool known = fixture.Fixture_Type >= 1 && fixture.Fixture_Type <= static_cast<int>(kFixtureTypes.size());
        const std::string type(known ? ZephFixtureType(fixture.Fixture_Type).Name : "unknown type");
        std::printf("%5d  %-28s %-14s level %2d  %3d points  %2d channels%s%s\n", f, fixture.Name.c_str(), type.c_str(),
                    fixture.ZOrder, fixture.PointCount, fixture.ChannelCount,
                    fixture.AssignedItemName.empty() ? "" : "  in ", fixture.AssignedItemName.c_str());
    }
}

}  // namespace

int runInfo(const ToolOptions& options) {
    const std::unique_ptr<ToolDocument> document = loadToolDocument(options.file);
    if (options.json) {
        printJson(documentJson(*document));
    } else {
        printSummary(*document);
    }
    return document->loaded ? 0 : 1;
}
