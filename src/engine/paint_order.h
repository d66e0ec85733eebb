// The order in which frames paint: what every drawing surface lays its plan out by.
#pragma once

#include "engine/render_table.h"

#include <cstdint>

// Place of a channel in an array by fixture 1..1024 and channel 1..16.
constexpr std::size_t channelSlot(std::int32_t fixture, std::int32_t channel) noexcept {
    return static_cast<std::size_t>(fixture * (kMaxChannels + 1) + channel);
}
inline constexpr std::size_t kChannelSlots = channelSlot(kMaxFixtures + 1, 0);

// Level by level in table order, the plain channels of a level before its RGB groups, as the render cycle calls for
// them: visitChannel(fixture, channel), visitGroup(fixture, rgbIndex). A group is visited once for each of its colours;
// numbers that no fixture or channel has are left out.
template <typename VisitChannel, typename VisitGroup>
void forEachUnitPainted(const ZephRenderTables& tables, VisitChannel visitChannel, VisitGroup visitGroup) {
    const auto forEachSlot = [&](std::int32_t level, auto visit) {
        for (const ZephRenderData& entry : tables.RenderData) {
            if ((entry.LevelUsed >> level & 1U) == 0) continue;
            for (std::int32_t s = 0; s < entry.SlotCount; ++s) {
                const ZephRenderSlot& slot = tables.Slots[static_cast<std::size_t>(entry.FirstSlot + s)];
                if (slot.Level == level && OneBased<ZephFixture, kMaxFixtures>::contains(slot.Fixture)) visit(slot);
            }
        }
    };
    for (std::int32_t level = 1; level <= kLevels; ++level) {
        forEachSlot(level, [&](const ZephRenderSlot& slot) {
            const bool plain = !slot.isRGB() && slot.KeshMagic == 0;
            if (plain && slot.Channel >= 1 && slot.Channel <= kMaxChannels) visitChannel(slot.Fixture, slot.Channel);
        });
        forEachSlot(level, [&](const ZephRenderSlot& slot) {
            if (slot.isRGB()) visitGroup(slot.Fixture, slot.RGBIndex);
        });
    }
}
