#include "programs/tool/show_cast.h"

#include "engine/ribbon_channels.h"
#include "model/tables.h"
#include "util/text.h"

#include <algorithm>
#include <limits>
#include <map>
#include <optional>

namespace {

constexpr std::int32_t kLargestField = 999;      // network, unit and circuit are three digits on the wire
constexpr std::int32_t kLargestKeyLength = 999;  // so is the length of a virtual channel's name

std::optional<std::string> latin1(std::string_view utf8) {
    std::string bytes;
    for (std::size_t i = 0; i < utf8.size(); ++i) {
        const auto byte = static_cast<unsigned char>(utf8[i]);
        if (byte < 0x80) {
            bytes += utf8[i];
        } else if ((byte == 0xC2 || byte == 0xC3) && i + 1 < utf8.size()) {
            bytes += static_cast<char>((byte << 6 & 0xC0) | (static_cast<unsigned char>(utf8[++i]) & 0x3F));
        } else {
            return std::nullopt;
        }
    }
    return bytes;
}

// The address whose key this is, if a command can carry it.
std::optional<ShowChannel> channelOfKey(std::int32_t key, const ZephRenderTables& tables) {
    constexpr std::int32_t kDevice = 100'000'000;
    if (key <= 0) return std::nullopt;
    ShowChannel channel;
    channel.key = key;
    ZephLightCommand& address = channel.address;
    address.DeviceType = key / kDevice;
    if (address.DeviceType == kDeviceDmx) {
        address.Network = key % kDevice / 100'000;
        address.Circuit = key % 100'000;
    } else {
        address.Network = key % kDevice / 1'000'000;
        address.Unit = key / 1000 % 1000;
        address.Circuit = key % 1000;
    }
    if (address.DeviceType == kDeviceNone && address.Network == 0 && address.Unit == 0) {
        if (address.Circuit > tables.VirtualChannelCount) return std::nullopt;
        const auto name = latin1(tables.VirtualChannels[static_cast<std::size_t>(address.Circuit)]);
        if (!name || name->empty() || name->size() > kLargestKeyLength) return std::nullopt;
        if (name->find_first_of("\x01\x04") != std::string::npos) return std::nullopt;
        channel.name = *name;
        return channel;
    }
    if (address.Network > kLargestField || address.Circuit > kLargestField) return std::nullopt;
    return channel;
}

struct Extent {
    double low = std::numeric_limits<double>::max();
    double high = std::numeric_limits<double>::lowest();

    void add(double value) {
        low = std::min(low, value);
        high = std::max(high, value);
    }
    // Where the value lies, 0..1; in the middle where there is no extent.
    double share(double value) const { return high > low ? (value - low) / (high - low) : 0.5; }
};

class Gathering {
public:
    Gathering(const ZephSimulation& display, const ZephRenderTables& tables, const ZephFixtureStates& states)
        : display_(display), tables_(tables), states_(states), groupLight_(tables.RGBData.size(), kNoChannel),
          fixtureRibbon_(kMaxFixtures + 1, kNoChannel) {}

    ShowCast gather() {
        for (std::size_t entry = 1; entry < tables_.RenderData.size(); ++entry)
            addEntry(tables_.RenderData[entry]);
        placeLights();
        return std::move(cast_);
    }

private:
    void addEntry(const ZephRenderData& entry) {
        auto channel = channelOfKey(entry.Key, tables_);
        if (!channel) {
            cast_.unreachable.push_back(entry.Key);
            return;
        }
        const auto number = static_cast<std::int32_t>(cast_.channels.size());
        cast_.channels.push_back(std::move(*channel));
        if (entry.SlotCount == 0) return;
        // Fixtures that share a channel light up together; the first one tells where.
        const ZephRenderSlot& slot = tables_.Slots[static_cast<std::size_t>(entry.FirstSlot)];
        if (slot.KeshMagic != 0) {
            addMagic(slot, number);
        } else if (slot.isRGB() && slot.Channel >= 1 && slot.Channel <= 3) {
            std::int32_t& light = groupLight_[static_cast<std::size_t>(slot.RGBIndex)];
            if (light == kNoChannel) light = addLight(slot, true);
            cast_.lights[static_cast<std::size_t>(light)].channels[static_cast<std::size_t>(slot.Channel - 1)] = number;
        } else {
            cast_.lights[static_cast<std::size_t>(addLight(slot, false))].channels[0] = number;
        }
    }

    void addMagic(const ZephRenderSlot& slot, std::int32_t channel) {
        std::int32_t& ribbon = fixtureRibbon_[static_cast<std::size_t>(slot.Fixture)];
        if (ribbon == kNoChannel) {
            ribbon = static_cast<std::int32_t>(cast_.ribbons.size());
            ShowRibbon added;
            added.fixture = slot.Fixture;
            const std::int32_t resolution = std::clamp(display_.Fixtures[slot.Fixture].Kesh.Resolution, 0, 7);
            added.ownResolution = kKeshResolutions[static_cast<std::size_t>(resolution)].Group;
            cast_.ribbons.push_back(added);
        }
        cast_.ribbons[static_cast<std::size_t>(ribbon)]
            .magic[static_cast<std::size_t>(slot.KeshMagic - kFirstMagicChannel)] = channel;
    }

    std::int32_t addLight(const ZephRenderSlot& slot, bool rgb) {
        const ZephFixture& fixture = display_.Fixtures[slot.Fixture];
        ShowLight light;
        light.fixture = slot.Fixture;
        light.fixtureType = fixture.Fixture_Type;
        light.level = slot.Level;
        light.prop = fixture.AssignedItem > 0 ? fixture.AssignedItem : kMaxProps + slot.Fixture;
        light.rgb = rgb;
        if (!rgb && OneBased<ZephChannel, kMaxChannels>::contains(slot.Channel)) {
            light.color = fixture.Channels[slot.Channel].Color;
            light.turn0 = slot.Channel - 1;
        }
        middleOf(slot, fixture, light);
        cast_.lights.push_back(light);
        return static_cast<std::int32_t>(cast_.lights.size()) - 1;
    }

    // The middle of the light's bulbs in pixels.
    void middleOf(const ZephRenderSlot& slot, const ZephFixture& fixture, ShowLight& light) const {
        const bool string = fixture.Fixture_Type == kFixtureStrings && fixture.Channel_Type != kChannelRgb;
        const ZephBulbLocations* bulbs = bulbLocations(states_[slot.Fixture], string ? slot.Channel : 1);
        if (bulbs == nullptr || bulbs->Count == 0) return;
        std::int32_t first0 = 0;
        std::int32_t count = bulbs->Count;
        if (slot.Triplet >= kFirstPixelTriplet) {
            first0 = std::min(slot.Triplet - kFirstPixelTriplet, bulbs->Count - 1);
            count = 1;
        } else if (slot.Triplet > 0) {
            const std::int32_t groups = KeshResolutionToResolutionCount(fixture.Kesh.Resolution);
            const std::int32_t pixels = std::max(1, kMaxRibbonPixels / groups);
            first0 = std::min((slot.Triplet - 1) * pixels, bulbs->Count - 1);
            count = std::min(pixels, bulbs->Count - first0);
        }
        double x = 0;
        double y = 0;
        for (std::int32_t bulb0 = first0; bulb0 < first0 + count; ++bulb0) {
            const ZephBulbLocation& place = tables_.BulbPool[static_cast<std::size_t>(bulbs->First + bulb0)];
            x += place.X;
            y += place.Y;
        }
        light.x = x / count;
        light.y = y / count;
    }

    // From pixels to shares of the whole display and of each prop.
    void placeLights() {
        Extent wide;
        Extent high;
        std::map<std::int32_t, std::pair<Extent, Extent>> props;
        for (const ShowLight& light : cast_.lights) {
            wide.add(light.x);
            high.add(light.y);
            props[light.prop].first.add(light.x);
            props[light.prop].second.add(light.y);
        }
        for (ShowLight& light : cast_.lights) {
            const auto& [across, down] = props[light.prop];
            light.propX = across.share(light.x);
            light.propY = down.share(light.y);
            light.x = wide.share(light.x);
            light.y = high.share(light.y);
        }
    }

    const ZephSimulation& display_;
    const ZephRenderTables& tables_;
    const ZephFixtureStates& states_;
    std::vector<std::int32_t> groupLight_;     // light of an RGBData entry
    std::vector<std::int32_t> fixtureRibbon_;  // ribbon of a fixture
    ShowCast cast_;
};

}  // namespace

ShowCast gatherShowCast(const ZephSimulation& display, const ZephRenderTables& tables,
                        const ZephFixtureStates& states) {
    return Gathering(display, tables, states).gather();
}
