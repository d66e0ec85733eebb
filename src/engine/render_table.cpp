#include "engine/render_table.h"

#include "engine/bulb_walk.h"
#include "engine/ribbon_channels.h"
#include "engine/validation.h"
#include "util/text.h"
#include "util/units.h"

#include <algorithm>
#include <limits>
#include <optional>

namespace {

constexpr const char* kModule = "modZephRenderMainEngine";
constexpr int kStatusPanel = 2;
constexpr std::int32_t kMaxTriplets = 1001 + kMaxPoints;  // one past the highest triplet id of any fixture

// An address as it was met on the way through the fixtures; entries are made of these once all are known.
struct Address {
    std::int32_t key = 0;
    ZephRenderSlot slot;
    bool wantsGroup = false;  // the slot drives a colour of an RGB group
};

class TableBuilder {
public:
    explicit TableBuilder(RenderBuildContext& context)
        : context_(context), simulation_(context.simulation), tables_(context.tables) {}

    void gatherVirtualNames(int fixture);
    void addFixture(int fixture);
    bool empty() const { return addresses_.empty(); }
    void compile();

private:
    void RendTblSlotRegFixture(int fixture, int channel);
    void RendTblSlotKeshFixture(int fixture);
    void RendTblSlotPixelFixture(int fixture);
    std::int32_t BuildRegRenderKey(ZephChannel& channel);
    void BuildVirtualKey(const std::string& name);
    void slotAddress(std::int32_t key, int fixture, std::int32_t channel, std::int32_t triplet, bool skipZero);
    void report(const char* problem, const char* procedure, bool& reported);
    void assignGroups(const std::vector<bool>& kept);
    void listLevels();

    RenderBuildContext& context_;
    ZephSimulation& simulation_;
    ZephRenderTables& tables_;
    std::vector<Address> addresses_;
    bool reportedKey_ = false;
    bool reportedLevel_ = false;
    bool reportedStrobe_ = false;
};

// A fault that many records of a damaged file share is reported once in a build.
void TableBuilder::report(const char* problem, const char* procedure, bool& reported) {
    if (reported) return;
    reported = true;
    context_.failures.ErrReport(problem, procedureName(kModule, procedure), 0);
}

void TableBuilder::BuildVirtualKey(const std::string& name) {
    if (tables_.VirtualChannelCount >= kMaxVirtualChannels) {
        // Even a name that is held triggers the message: the count is what is tested, and users know the box so.
        if (!tables_.VirtualChannelWarning) return;
        tables_.VirtualChannelWarning = false;
        context_.host.messageBox(boxTitle("-Max Virtual Channels"),
                                 "You have 255 or more virtual channels.\r\nOnly the first 255 will be simulated.",
                                 BoxIcon::Information);
        return;
    }
    std::string lower = lowerCase(name);
    const auto held = std::find(tables_.VirtualChannels.begin() + 1, tables_.VirtualChannels.end(), lower);
    if (held != tables_.VirtualChannels.end()) return;
    tables_.VirtualChannels.push_back(std::move(lower));
    ++tables_.VirtualChannelCount;
}

void TableBuilder::gatherVirtualNames(int fixture) {
    const ZephFixture& record = simulation_.Fixtures[fixture];
    for (int c = 1; c <= record.ChannelCount; ++c) {
        if (record.Channels[c].DeviceType == kDeviceNone) BuildVirtualKey(record.Channels[c].Name);
    }
}

void TableBuilder::slotAddress(std::int32_t key, int fixture, std::int32_t channel, std::int32_t triplet,
                               bool skipZero) {
    if (key == 0 && skipZero) return;
    const ZephFixture& record = simulation_.Fixtures[fixture];
    // Level 0 has a place in the table and is never drawn, as the level of a fixture whose file says so.
    if (record.ZOrder < 0 || record.ZOrder > kLevels) {
        report("Subscript out of range", "AddRenderData", reportedLevel_);
        return;
    }
    Address address;
    address.key = key;
    address.slot.Fixture = fixture;
    address.slot.Channel = channel;
    address.slot.Level = record.ZOrder;
    if (channel >= kFirstMagicChannel && record.Fixture_Type == kFixtureKesh) {
        address.slot.KeshMagic = channel;
    } else if (record.Channel_Type == kChannelRgb) {
        address.wantsGroup = true;
        address.slot.Triplet = triplet;
    }
    addresses_.push_back(address);
}

std::int32_t TableBuilder::BuildRegRenderKey(ZephChannel& channel) {
    // Stays in the document: a device that was cleared in an old file is marked as such from its first run on.
    if (channel.DeviceType == kDeviceClearedInFile) channel.DeviceType = kDeviceCleared;
    std::int32_t last = channel.Channel;
    if (channel.DeviceType == kDeviceNone) {
        last = ZephReturnVirtualChannelKey(channel.Name, tables_);
        if (last == 0) return 0;
    }
    const std::optional<std::int32_t> key = packedKey(channel.DeviceType, channel.Network, channel.Controller, last);
    if (!key) report("Overflow", "BuildRegRenderKey", reportedKey_);
    // A cleared device must stay below every key of the stream, whatever its other fields add.
    if (channel.DeviceType == kDeviceCleared && key.value_or(0) >= 0) return 0;
    return key.value_or(0);
}

void TableBuilder::RendTblSlotRegFixture(int fixture, int channel) {
    ZephChannel& record = simulation_.Fixtures[fixture].Channels[channel];
    const std::int32_t key = BuildRegRenderKey(record);
    slotAddress(key, fixture, channel, 0, true);
    if (record.Sub_Type != kSpecialStrobes) return;
    // Set even where the slot is dropped as the seventeenth of its key: the fields belong to the channel.
    ZephChannelState& strobe = context_.states[fixture].Channels[static_cast<std::size_t>(channel)];
    strobe.StrobeRunning = false;
    strobe.StrobeFireTime = context_.settings.StrobeFireTime;
    if (record.Sub_Parm != 0) {
        strobe.StrobeInterval = 1000 / record.Sub_Parm;
    } else {
        report("Division by zero", "RendTblSlotRegFixture", reportedStrobe_);
        strobe.StrobeInterval = 0;
    }
}

void TableBuilder::RendTblSlotKeshFixture(int fixture) {
    const ZephKeshData& kesh = simulation_.Fixtures[fixture].Kesh;
    const auto keyOf = [&](std::int32_t index) {
        const RibbonAddress address = ribbonAddress(kesh, index);
        const std::optional<std::int32_t> key = packedKey(kDeviceQen, kesh.Network, address.unit, address.circuit);
        if (!key) report("Overflow", "BuildKeshRenderKey", reportedKey_);
        return key;
    };
    for (std::int32_t index = 1; index < kFirstMagicChannel; ++index) {
        const RibbonPixel place = ReturnKeshTripletKey(index, kesh.Channel_Mode, kesh.Resolution);
        slotAddress(keyOf(index).value_or(0), fixture, place.colour, place.pixel, true);
    }
    for (std::int32_t index = kFirstMagicChannel; index <= kLastMagicChannel; ++index) {
        // A key of 0 is not tested here: the table of a display with such an address is one entry longer.
        const std::optional<std::int32_t> key = keyOf(index);
        if (key) slotAddress(*key, fixture, index, 0, false);
    }
    context_.states[fixture].Kesh.KeshResolution = kesh.Resolution;
}

void TableBuilder::RendTblSlotPixelFixture(int fixture) {
    const ZephFixture& record = simulation_.Fixtures[fixture];
    for (std::int32_t i = 1; i <= 3 * record.PointCount; ++i) {
        const std::int32_t triplet = (i - 1) / 3 + kFirstPixelTriplet;
        const std::int32_t colour = i - 3 * (triplet - kFirstPixelTriplet);
        const std::optional<std::int32_t> key = packedKey(kDeviceDmx, record.DMX.Universe, 0, i);
        if (!key) report("Overflow", "BuildPixelRenderKey", reportedKey_);
        slotAddress(key.value_or(0), fixture, colour, triplet, true);
    }
}

void TableBuilder::addFixture(int fixture) {
    const ZephFixture& record = simulation_.Fixtures[fixture];
    switch (record.Fixture_Type) {
    // A child ribbon or pixel run has no channels of its own: its points lie on the main fixture by now.
    case kFixtureKesh:
        if (record.Kesh.Physical_Pixel_Number == 1) RendTblSlotKeshFixture(fixture);
        break;
    case kFixtureDmxPixels:
        if (record.DMX.Physical_Pixel_Number == 1) RendTblSlotPixelFixture(fixture);
        break;
    default:
        for (int c = 1; c <= record.ChannelCount; ++c)
            RendTblSlotRegFixture(fixture, c);
    }
}

// Groups are numbered in the order in which their first kept slot was met.
void TableBuilder::assignGroups(const std::vector<bool>& kept) {
    std::vector<std::int32_t> groupOfTriplet(kMaxTriplets, 0);
    std::vector<std::int32_t> used;
    std::int32_t fixture = 0;
    tables_.RGBData.assign(1, {});
    for (std::size_t i = 0; i < addresses_.size(); ++i) {
        ZephRenderSlot& slot = addresses_[i].slot;
        if (!addresses_[i].wantsGroup || !kept[i]) continue;
        if (slot.Fixture != fixture) {
            for (const std::int32_t triplet : used)
                groupOfTriplet[static_cast<std::size_t>(triplet)] = 0;
            used.clear();
            fixture = slot.Fixture;
        }
        std::int32_t& group = groupOfTriplet[static_cast<std::size_t>(slot.Triplet)];
        if (group == 0) {
            used.push_back(slot.Triplet);
            group = static_cast<std::int32_t>(tables_.RGBData.size());
            ZephRGBData& data = tables_.RGBData.emplace_back();
            const std::int32_t base = simulation_.Fixtures[fixture].Fixture_Type == kFixtureDmxPixels ? 1'024'000 : 0;
            data.Key = slot.Triplet + fixture * 1'000 + base;
        }
        slot.RGBIndex = group;
    }
}

void TableBuilder::listLevels() {
    std::vector<bool> listed(tables_.RGBData.size(), false);
    for (std::int32_t e = 1; e <= static_cast<std::int32_t>(tables_.RenderData.size()) - 1; ++e) {
        const ZephRenderData& entry = tables_.RenderData[static_cast<std::size_t>(e)];
        for (std::size_t level = 1; level <= kLevels; ++level) {
            if (entry.LevelUsed >> level & 1) tables_.LevelEntries[level].push_back(e);
        }
        for (std::int32_t s = entry.FirstSlot; s < entry.FirstSlot + entry.SlotCount; ++s) {
            const ZephRenderSlot& slot = tables_.Slots[static_cast<std::size_t>(s)];
            if (!slot.isRGB() || listed[static_cast<std::size_t>(slot.RGBIndex)]) continue;
            listed[static_cast<std::size_t>(slot.RGBIndex)] = true;
            tables_.LevelGroups[static_cast<std::size_t>(slot.Level)].push_back(
                {slot.Fixture, slot.RGBIndex, slot.Triplet});
        }
    }
}

void TableBuilder::compile() {
    // Key and order of arrival in one number: sorting it keeps the fixture order within a key.
    std::vector<std::uint64_t> order(addresses_.size());
    for (std::size_t i = 0; i < order.size(); ++i) {
        order[i] = (static_cast<std::uint64_t>(static_cast<std::uint32_t>(addresses_[i].key) ^ 0x80000000u) << 32) | i;
    }
    std::ranges::sort(order);
    const auto arrival = [&](std::size_t sorted) { return static_cast<std::uint32_t>(order[sorted]); };

    // The seventeenth and later fixtures of a key are dropped in silence; the editor has warned of them.
    std::vector<bool> kept(addresses_.size(), false);
    std::size_t run = 0;
    for (std::size_t i = 0; i < order.size(); ++i) {
        if (i > 0 && addresses_[arrival(i)].key != addresses_[arrival(i - 1)].key) run = i;
        kept[arrival(i)] = i - run < kMaxSlots;
    }
    assignGroups(kept);

    tables_.Keys.assign(1, 0);
    tables_.RenderData.assign(1, {});
    tables_.Slots.reserve(order.size());
    for (std::size_t i = 0; i < order.size(); ++i) {
        const Address& address = addresses_[arrival(i)];
        if (!kept[arrival(i)]) continue;
        if (tables_.Keys.size() == 1 || tables_.Keys.back() != address.key) {
            tables_.Keys.push_back(address.key);
            ZephRenderData& entry = tables_.RenderData.emplace_back();
            entry.Key = address.key;
            entry.FirstSlot = static_cast<std::int32_t>(tables_.Slots.size());
        }
        ZephRenderData& entry = tables_.RenderData.back();
        ++entry.SlotCount;
        entry.LevelUsed |= 1u << address.slot.Level;
        tables_.Slots.push_back(address.slot);
    }

    tables_.Search.build(std::span(tables_.Keys).subspan(1));
    tables_.Live.assign(tables_.RenderData.size(), {});
    tables_.Twinkle.assign(tables_.RenderData.size(), {});
    tables_.CommandState.assign(tables_.RenderData.size(), 0);
    tables_.NewEntries.assign(tables_.RenderData.size(), 0);
    listLevels();
}

void addBulb(const ZephBulbLocation& bulb, bool flashes, ZephBulbLocations& channel, ZephRenderTables& tables) {
    ++channel.Count;
    tables.BulbPool.push_back(bulb);
    if (flashes) tables.StrobePool.emplace_back();
}

ZephBulbLocations openChannel(bool flashes, const ZephRenderTables& tables) {
    ZephBulbLocations channel;
    channel.First = static_cast<std::int32_t>(tables.BulbPool.size());
    channel.FirstStrobe = flashes ? static_cast<std::int32_t>(tables.StrobePool.size()) : -1;
    return channel;
}

void locateFixture(const ZephFixture& fixture, ZephFixtureState& state, ZephRenderTables& tables) {
    const bool rgb = fixture.Channel_Type == kChannelRgb;
    if (fixture.ChannelCount < 1 && !rgb) return;
    if (fixture.Fixture_Type == kFixtureStrings) {
        state.LocationCount = walkedChannels(fixture);
        for (std::int32_t c = 1; c <= state.LocationCount; ++c) {
            const bool flashes = fixture.Channels[c].Sub_Type == kSpecialStrobes;
            ZephBulbLocations& channel = state.BulbLocations[static_cast<std::size_t>(c)];
            channel = openChannel(flashes, tables);
            walkBulbs(fixture, c, [&](const WalkedBulb& bulb) {
                addBulb({0, bulb.X, bulb.Y}, flashes, channel, tables);
            });
        }
        return;
    }
    state.LocationCount = 1;
    const bool flashes = fixture.Channels[1].Sub_Type != kSpecialNone;
    ZephBulbLocations& channel = state.BulbLocations[1];
    channel = openChannel(flashes, tables);
    for (std::int32_t p = 1; p <= fixture.PointCount; ++p) {
        const ZephDrawPoint& point = fixture.DrawPoints[p];
        // Cut off, where the bulbs of a string are rounded: a single bulb has always stood on the pixel of its point.
        addBulb({point.Type, point.X / TwipsPerPixelX, point.Y / TwipsPerPixelY}, flashes, channel, tables);
    }
}

void BuildSimulationBulbLocations(RenderBuildContext& context) {
    std::int32_t longest = 0;
    for (int f = 1; f <= context.simulation.FixtureCount; ++f) {
        ZephFixtureState& state = context.states[f];
        locateFixture(context.simulation.Fixtures[f], state, context.tables);
        for (std::int32_t c = 1; c <= state.LocationCount; ++c) {
            const ZephBulbLocations& channel = state.BulbLocations[static_cast<std::size_t>(c)];
            if (channel.FirstStrobe >= 0) longest = std::max(longest, channel.Count);
        }
    }
    context.tables.BulbLit.assign(static_cast<std::size_t>(longest), 0);
}

// Step by step, each told in the status bar. False when there is nothing to simulate.
bool buildTables(RenderBuildContext& context) {
    const auto status = [&](std::string_view text) { context.host.setStatusPanel(kStatusPanel, text); };
    ZephRenderTables& tables = context.tables;
    eraseRenderTables(tables);
    tables.VirtualChannelWarning = true;
    tables.VirtualChannels.assign(1, {});

    status("Reset Rendering Parms");
    context.states.fill({});
    TableBuilder builder(context);
    for (int f = 1; f <= context.simulation.FixtureCount; ++f) {
        status("Building Virtual Keys");
        builder.gatherVirtualNames(f);
    }
    std::sort(tables.VirtualChannels.begin() + 1, tables.VirtualChannels.end());

    status("Compiling Master/Slave Keshs");
    if (!ValidateKeshs(context)) return false;
    status("Compiling Master/Slave Pixel Universes");
    if (!ValidatePixels(context)) return false;

    for (int f = 1; f <= context.simulation.FixtureCount; ++f) {
        status("Creating Channel Table for Fixture-" + std::to_string(f));
        builder.addFixture(f);
    }
    status("Pre-build all bulb locations");
    BuildSimulationBulbLocations(context);
    status("Finishing up");
    if (builder.empty()) {
        context.host.messageBox(boxTitle("-Error"), "There are no channels to simulate.", BoxIcon::Critical);
        return false;
    }
    builder.compile();
    tables.RenderDataCount = static_cast<std::int32_t>(tables.RenderData.size()) - 1;
    return true;
}

}  // namespace

void ZephBuildRenderTable(RenderBuildContext context) try {
    const BusyPointer busy(context.host);
    buildTables(context);
} catch (...) {
    eraseRenderTables(context.tables);
    reportCaughtFailure(context.failures, kModule, __func__, __LINE__);
}

void eraseRenderTables(ZephRenderTables& tables) {
    tables = ZephRenderTables{};
}

void restoreAssembledPoints(ZephSimulation& simulation, ZephFixtureStates& states) {
    for (int f = 1; f <= simulation.FixtureCount; ++f) {
        if (!states[f].Assembled) continue;
        simulation.Fixtures[f].PointCount = states[f].SavedPointCount;
        states[f].Assembled = false;
    }
}

std::int32_t ZephReturnVirtualChannelKey(std::string_view name, const ZephRenderTables& tables) {
    if (tables.VirtualChannelCount == 0) return 0;
    const std::string lower = lowerCase(name);
    const auto first = tables.VirtualChannels.begin() + 1;  // bisected from 1: slot 0 is no name
    const auto found = std::lower_bound(first, tables.VirtualChannels.end(), lower);
    if (found == tables.VirtualChannels.end() || *found != lower) return 0;
    return static_cast<std::int32_t>(found - tables.VirtualChannels.begin());
}

const ZephBulbLocations* bulbLocations(const ZephFixtureState& state, std::int32_t channel) {
    if (channel < 1 || channel > state.LocationCount) return nullptr;
    return &state.BulbLocations[static_cast<std::size_t>(channel)];
}
