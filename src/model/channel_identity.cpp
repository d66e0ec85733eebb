#include "model/channel_identity.h"

#include "model/tables.h"

#include <algorithm>

namespace {

constexpr int kMaxFixturesPerChannel = 16;

// The inner loop is bounded by the count of the fixture whose number is the channel slot, not by the fixture's own:
// displays were made against these very warnings, so the bound stays as it is.
int countSameChannel(const ZephSimulation& simulation, const ZephChannel& channel, int channelSlot) {
    const int bound = std::clamp(simulation.Fixtures[channelSlot].ChannelCount, 0, kMaxChannels);
    int count = 0;
    for (int f = 1; f <= kMaxFixtures; ++f) {  // every slot, in use or not
        for (int d = 1; d <= bound; ++d) {
            if (sameChannel(simulation.Fixtures[f].Channels[d], channel)) ++count;
        }
    }
    return count;
}

}  // namespace

bool sameChannel(const ZephChannel& left, const ZephChannel& right) {
    if (left.DeviceType != right.DeviceType) return false;
    switch (left.DeviceType) {
    case kDeviceNone:
        return left.Name == right.Name;
    case kDeviceQen:
        return left.Network == right.Network && left.Controller == right.Controller && left.Channel == right.Channel;
    case kDeviceX10:
        return left.Controller == right.Controller;
    case kDeviceDmx:
        return left.Network == right.Network && left.Channel == right.Channel;
    default:
        return left.Controller == right.Controller && left.Channel == right.Channel;
    }
}

std::string ZephReturnX10HouseCode(std::int32_t value) {
    return std::string(1, static_cast<char>('A' + (value & 255) / 16));
}

std::string ZephReturnX10UnitCode(std::int32_t value) {
    return std::to_string((value & 255) % 16 + 1);
}

std::string channelAddressLines(const ZephChannel& channel) {
    const std::string unit = "Unit:" + std::to_string(channel.Controller) + "\r\n";
    const std::string circuit = "Circuit:" + std::to_string(channel.Channel) + "\r\n";
    switch (channel.DeviceType) {
    case kDeviceNone:
        return "";  // its name is its address, and that is shown for every channel
    case kDeviceQen:
        return "Net:" + networkName(channel.Network) + "\r\n" + unit + circuit;
    case kDeviceX10:
        return "Unit:" + ZephReturnX10HouseCode(channel.Controller) +
               "\r\nCircuit:" + ZephReturnX10UnitCode(channel.Controller) + "\r\n";
    case kDeviceDmx:
        return "Univ:" + universeName(channel.Network) + "\r\nAddr:" + std::to_string(channel.Channel) + "\r\n";
    default:
        return unit + circuit;
    }
}

void ZephCheckFixturesPerChannel(const ZephSimulation& simulation, const ZephFixture& fixture, Host& host) {
    const int channels = std::clamp(fixture.ChannelCount, 0, kMaxChannels);
    for (int c = 1; c <= channels; ++c) {
        const ZephChannel& channel = fixture.Channels[c];
        if (channel.Name.empty()) continue;
        // Warned at 16 already, though the text says "more than 16": the sixteenth is the last that is simulated.
        if (countSameChannel(simulation, channel, c) < kMaxFixturesPerChannel) continue;
        const std::string limit = std::to_string(kMaxFixturesPerChannel);
        std::string text = "This channel...\r\n\r\nName:" + channel.Name + "\r\nDevice:";
        text.append(deviceShortName(channel.DeviceType)).append("\r\n");
        text += channelAddressLines(channel) + "\r\n...is in use by more than " + limit +
                " fixtures.\r\n\r\nYour data will be saved, however only the first " + limit +
                " fixtures will be simulated.";
        host.messageBox(boxTitle("-Max Simulation Fixtures"), text, BoxIcon::Information);
    }
}
