#include "programs/tool/show_stage.h"

#include "util/rounding.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr std::int32_t kLargestUniverse = 999;
constexpr std::int32_t kUniverseChannels = 512;
constexpr std::size_t kCrowd = 24;            // channels from which on a universe is painted by dumps
constexpr std::int32_t kLargestNetwork = 15;  // of the controllers that take a dump
constexpr std::int32_t kLargestUnit = 240;
constexpr std::int32_t kControllerCircuits = 320;
constexpr std::size_t kDumpBudget = 1'000;  // bytes a tick for universes; commands share the rest of the frame

}  // namespace

double ShowColor::brightness() const {
    return std::max({red, green, blue});
}

ShowColor colorOfHue(double hue, double saturation, double value) {
    const auto part = [&](double offset) {
        const double place = (hue + offset - std::floor(hue + offset)) * 6;
        const double share = std::clamp(std::abs(place - 3) - 1, 0.0, 1.0);
        return value * (1 - saturation * (1 - share));
    };
    return {part(0), part(2.0 / 3), part(1.0 / 3)};
}

ShowColor festiveColor(std::int32_t number) {
    static constexpr std::array<ShowColor, 7> kColors{{{1, 0.08, 0.06},
                                                       {0.1, 0.95, 0.2},
                                                       {1, 0.66, 0.1},
                                                       {0.25, 0.5, 1},
                                                       {0.85, 0.2, 1},
                                                       {0.4, 0.9, 1},
                                                       {1, 0.85, 0.6}}};
    const auto count = static_cast<std::int32_t>(kColors.size());
    return kColors[static_cast<std::size_t>((number % count + count) % count)];
}

double scatter(std::int32_t first, std::int32_t second) {
    // The finaliser of MurmurHash3 by Austin Appleby (public domain).
    std::uint32_t bits = static_cast<std::uint32_t>(first) * 0x9E3779B9U + static_cast<std::uint32_t>(second);
    bits ^= bits >> 16;
    bits *= 0x85EBCA6BU;
    bits ^= bits >> 13;
    bits *= 0xC2B2AE35U;
    bits ^= bits >> 16;
    return bits / 4294967296.0;
}

double easeIn(double share) {
    const double held = std::clamp(share, 0.0, 1.0);
    return held * held * (3 - 2 * held);
}

std::int32_t ShowSpan::at(double share) const {
    return fromMs + truncateToInt(length() * share);
}

ShowStage::ShowStage(const ShowCast& cast, ShowTimeline& timeline)
    : cast_(cast), timeline_(timeline), inUniverse_(cast.channels.size()), onController_(cast.channels.size()) {
    gatherTargets();
    for (std::size_t number = 0; number < cast.lights.size(); ++number) {
        const ShowLight& light = cast.lights[number];
        const bool solo = std::ranges::any_of(
            light.channels, [&](std::int32_t channel) { return channel != kNoChannel && !inUniverse(channel); });
        if (solo) soloLights_.push_back(static_cast<std::int32_t>(number));
    }
}

void ShowStage::gatherTargets() {
    std::vector<DumpTarget::Circuit> roles(cast_.channels.size());
    for (std::size_t number = 0; number < cast_.channels.size(); ++number) {
        roles[number].channel = static_cast<std::int32_t>(number);
    }
    for (std::size_t light = 0; light < cast_.lights.size(); ++light) {
        for (std::int32_t part = 0; part < 3; ++part) {
            const std::int32_t channel = cast_.lights[light].channels[static_cast<std::size_t>(part)];
            if (channel == kNoChannel) continue;
            roles[static_cast<std::size_t>(channel)].light = static_cast<std::int32_t>(light);
            roles[static_cast<std::size_t>(channel)].part = part;
        }
    }

    std::map<std::int32_t, std::vector<std::int32_t>> universes;
    std::map<std::pair<std::int32_t, std::int32_t>, std::vector<std::int32_t>> controllers;
    for (std::size_t number = 0; number < cast_.channels.size(); ++number) {
        const ZephLightCommand& address = cast_.channels[number].address;
        const auto channel = static_cast<std::int32_t>(number);
        if (address.DeviceType == kDeviceDmx && address.Network >= 1 && address.Network <= kLargestUniverse &&
            address.Circuit >= 1 && address.Circuit <= kUniverseChannels) {
            universes[address.Network].push_back(channel);
        } else if (address.DeviceType == kDeviceQen && address.Network <= kLargestNetwork && address.Unit >= 1 &&
                   address.Unit <= kLargestUnit && address.Circuit >= 1 && address.Circuit <= kControllerCircuits) {
            controllers[{address.Network, address.Unit}].push_back(channel);
        }
    }
    const auto fill = [&](DumpTarget& target, const std::vector<std::int32_t>& channels, std::vector<bool>& marks) {
        for (const std::int32_t channel : channels) {
            const auto circuit =
                static_cast<std::size_t>(cast_.channels[static_cast<std::size_t>(channel)].address.Circuit);
            if (target.circuits.size() < circuit) target.circuits.resize(circuit);
            target.circuits[circuit - 1] = roles[static_cast<std::size_t>(channel)];
            marks[static_cast<std::size_t>(channel)] = true;
        }
    };
    for (const auto& [universe, channels] : universes) {
        if (channels.size() < kCrowd) continue;
        fill(universes_.emplace_back(DumpTarget{universe, 0, {}}), channels, inUniverse_);
    }
    for (const auto& [unit, channels] : controllers) {
        fill(controllers_.emplace_back(DumpTarget{unit.first, unit.second, {}}), channels, onController_);
    }
}

void ShowStage::paint(std::int32_t timeMs, std::int32_t number, std::int32_t durationMs, ShowColor to,
                      ShowEffect effect) {
    const ShowLight& shown = light(number);
    if (!shown.rgb) {
        timeline_.fadeTo(timeMs, shown.channels[0], durationMs, 100 * to.brightness(), effect);
        return;
    }
    timeline_.fadeTo(timeMs, shown.channels[0], durationMs, 100 * to.red, effect);
    timeline_.fadeTo(timeMs, shown.channels[1], durationMs, 100 * to.green, effect);
    timeline_.fadeTo(timeMs, shown.channels[2], durationMs, 100 * to.blue, effect);
}

void ShowStage::paintFrom(std::int32_t timeMs, std::int32_t number, std::int32_t durationMs, ShowColor from,
                          ShowColor to, ShowEffect effect) {
    const ShowLight& shown = light(number);
    if (!shown.rgb) {
        timeline_.fade(timeMs, shown.channels[0], durationMs, 100 * from.brightness(), 100 * to.brightness(), effect);
        return;
    }
    timeline_.fade(timeMs, shown.channels[0], durationMs, 100 * from.red, 100 * to.red, effect);
    timeline_.fade(timeMs, shown.channels[1], durationMs, 100 * from.green, 100 * to.green, effect);
    timeline_.fade(timeMs, shown.channels[2], durationMs, 100 * from.blue, 100 * to.blue, effect);
}

std::vector<std::uint8_t> ShowStage::levels(const DumpTarget& target, std::int32_t timeMs, const ShowShader& shader) {
    std::vector<std::uint8_t> bytes;
    bytes.reserve(target.circuits.size());
    std::int32_t shaded = -1;  // the light whose colour is at hand: its three parts lie side by side
    ShowColor color;
    for (const DumpTarget::Circuit& circuit : target.circuits) {
        double level = 0;
        if (circuit.light >= 0) {
            const ShowLight& shown = light(circuit.light);
            if (circuit.light != shaded) color = shader(shown, timeMs);
            shaded = circuit.light;
            const double part = !shown.rgb          ? color.brightness()
                                : circuit.part == 0 ? color.red
                                : circuit.part == 1 ? color.green
                                                    : color.blue;
            level = 100 * std::clamp(part, 0.0, 1.0);
        }
        if (circuit.channel != kNoChannel) timeline_.noteLevel(circuit.channel, level);
        bytes.push_back(static_cast<std::uint8_t>(clampByte(roundHalfEven(level * 2.55))));
    }
    return bytes;
}

void ShowStage::animateUniverses(ShowSpan span, const ShowShader& shader) {
    if (universes_.empty()) return;
    std::size_t turn = 0;
    for (std::int32_t timeMs = span.fromMs; timeMs < span.toMs; timeMs += ShowTimeline::kTickMs) {
        std::size_t spent = 0;
        for (std::size_t sent = 0; sent < universes_.size(); ++sent) {
            const DumpTarget& target = universes_[turn % universes_.size()];
            spent += 2 * target.circuits.size();
            if (sent > 0 && spent > kDumpBudget) break;
            timeline_.dmxDump(timeMs, target.network, levels(target, timeMs, shader));
            ++turn;
        }
    }
}

void ShowStage::dumpUniverses(std::int32_t timeMs, const ShowShader& shader) {
    for (const DumpTarget& target : universes_) {
        timeline_.dmxDump(timeMs, target.network, levels(target, timeMs, shader));
    }
}

void ShowStage::dumpControllers(std::int32_t timeMs, const ShowShader& shader) {
    for (const DumpTarget& target : controllers_) {
        timeline_.controllerDump(timeMs, target.network, target.unit, levels(target, timeMs, shader));
    }
}
