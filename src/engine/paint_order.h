// The order in which frames paint: what every drawing surface lays its plan out by.
#pragma once

#include "engine/render_table.h"

#include <cstdint>
#include <vector>

// Place of a channel in an array by fixture 1..1024 and channel 1..16.
constexpr std::size_t channelSlot(std::int32_t fixture, std::int32_t channel) noexcept {
    return static_cast<std::size_t>(fixture * (kMaxChannels + 1) + channel);
}
inline constexpr std::size_t kChannelSlots = channelSlot(kMaxFixtures + 1, 0);

// The units of a plan, numbered from 1 in the order of painting; 0 = none.
struct UnitNumbers {
    std::vector<std::int32_t> OfChannel;  // [channelSlot]
    std::vector<std::int32_t> OfGroup;    // [RGBIndex]
};

// Numbers the units level by level in table order, the plain channels of a level before its RGB groups, as the render
// cycle calls for them, and calls the builder's addChannel(fixture, channel) or addGroup(fixture) for each as it
// gets its number. Numbers that no fixture or channel has are left out.
template <typename Builder>
void numberUnitsPainted(const ZephRenderTables& tables, Builder& builder, UnitNumbers& units) {
    units.OfChannel.assign(kChannelSlots, 0);
    units.OfGroup.assign(tables.RGBData.size(), 0);
    std::int32_t count = 0;
    const auto isNew = [&](std::int32_t& number) {
        if (number != 0) return false;
        number = ++count;
        return true;
    };
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
            if (!plain || slot.Channel < 1 || slot.Channel > kMaxChannels) return;
            if (isNew(units.OfChannel[channelSlot(slot.Fixture, slot.Channel)]))
                builder.addChannel(slot.Fixture, slot.Channel);
        });
        forEachSlot(level, [&](const ZephRenderSlot& slot) {
            if (!slot.isRGB()) return;
            // A group has a slot for each of its colours.
            if (isNew(units.OfGroup.at(static_cast<std::size_t>(slot.RGBIndex)))) builder.addGroup(slot.Fixture);
        });
    }
}
