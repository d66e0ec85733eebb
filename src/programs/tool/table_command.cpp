#include "programs/tool/table_command.h"

#include "engine/render_table.h"
#include "programs/tool/json_text.h"
#include "programs/tool/tool_document.h"

namespace {

QJsonObject slotJson(const ZephRenderSlot& slot) {
    return {{"Fixture", slot.Fixture},    {"Channel", slot.Channel},   {"Level", slot.Level},
            {"IsRGB", slot.isRGB()},      {"RGBIndex", slot.RGBIndex}, {"Triplet", slot.Triplet},
            {"KeshMagic", slot.KeshMagic}};
}

QJsonObject entryJson(const ZephRenderData& entry, const ZephRenderTables& tables) {
    QJsonArray levels;
    for (int level = 0; level <= kLevels; ++level) {
        if (entry.LevelUsed >> level & 1) levels.append(level);
    }
    QJsonArray slotList;
    for (std::int32_t s = entry.FirstSlot; s < entry.FirstSlot + entry.SlotCount; ++s) {
        slotList.append(slotJson(tables.Slots[static_cast<std::size_t>(s)]));
    }
    return {{"Key", entry.Key}, {"Levels", levels}, {"Slots", slotList}};
}

QJsonArray locationsJson(const CompiledDocument& compiled) {
    QJsonArray locations;
    for (int f = 1; f <= compiled.document->simulation->FixtureCount; ++f) {
        const ZephFixtureState& state = (*compiled.states)[f];
        for (std::int32_t c = 1; c <= state.LocationCount; ++c) {
            const ZephBulbLocations& channel = state.BulbLocations[static_cast<std::size_t>(c)];
            QJsonArray bulbs;
            for (std::int32_t b = channel.First; b < channel.First + channel.Count; ++b) {
                const ZephBulbLocation& bulb = compiled.tables.BulbPool[static_cast<std::size_t>(b)];
                bulbs.append(QJsonArray{bulb.Type, bulb.X, bulb.Y});
            }
            locations.append(QJsonObject{{"Fixture", f}, {"Channel", c}, {"Locs", bulbs}});
        }
    }
    return locations;
}

QJsonObject tableJson(const CompiledDocument& compiled) {
    const ZephRenderTables& tables = compiled.tables;
    QJsonArray names;
    for (std::size_t n = 1; n < tables.VirtualChannels.size(); ++n)
        names.append(jsonText(tables.VirtualChannels[n]));
    QJsonArray entries;
    for (std::size_t e = 1; e < tables.RenderData.size(); ++e)
        entries.append(entryJson(tables.RenderData[e], tables));
    QJsonArray groups;
    for (std::size_t g = 1; g < tables.RGBData.size(); ++g)
        groups.append(QJsonObject{{"Key", tables.RGBData[g].Key}});
    return {{"Ok", compiled.ok()},
            {"Errors", jsonText(compiled.document->host.compileErrors())},
            {"Messages", jsonMessages(compiled.document->host)},
            {"VirtualChannels", names},
            {"Entries", entries},
            {"RGB", groups},
            {"BulbLocations", locationsJson(compiled)}};
}

void printTable(const CompiledDocument& compiled) {
    const ZephRenderTables& tables = compiled.tables;
    std::printf("%d channel keys, %zu RGB groups, %d virtual channels, %zu bulbs\n", tables.RenderDataCount,
                tables.RGBData.empty() ? 0 : tables.RGBData.size() - 1, tables.VirtualChannelCount,
                tables.BulbPool.size());
    for (std::size_t e = 1; e < tables.RenderData.size(); ++e) {
        const ZephRenderData& entry = tables.RenderData[e];
        std::printf("%11d ", entry.Key);
        for (std::int32_t s = entry.FirstSlot; s < entry.FirstSlot + entry.SlotCount; ++s) {
            const ZephRenderSlot& slot = tables.Slots[static_cast<std::size_t>(s)];
            const std::string& name = compiled.document->simulation->Fixtures[slot.Fixture].Name;
            std::printf(" [%s channel %d level %d%s]", name.c_str(), slot.Channel, slot.Level,
                        slot.KeshMagic != 0 ? " magic"
                        : slot.isRGB()      ? " RGB"
                                            : "");
        }
        std::printf("\n");
    }
}

}  // namespace

int runTable(const ToolOptions& options) {
    const CompiledDocument compiled = compileToolDocument(options.file);
    if (options.json) {
        printJson(tableJson(compiled));
    } else {
        printTable(compiled);
    }
    return compiled.ok() ? 0 : 1;
}
