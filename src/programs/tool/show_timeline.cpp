#include "programs/tool/show_timeline.h"

#include "link/frame_writer.h"
#include "util/rounding.h"

#include <algorithm>

namespace {

constexpr std::size_t kFrameBytes = 9;     // SOH, payload count, frame length, EOT
constexpr std::size_t kCommandBytes = 29;  // without a name
constexpr std::size_t kDumpBytes = 15;     // without its levels

}  // namespace

void ShowTimeline::fade(std::int32_t timeMs, std::int32_t channel, std::int32_t durationMs, double from, double to,
                        ShowEffect effect) {
    if (channel == kNoChannel) return;
    const double scale = effect == ShowEffect::Fine ? 2.55 : 1;
    Cue cue;
    cue.timeMs = std::max(0, timeMs);
    cue.channel = channel;
    cue.effect = effect;
    cue.timing = {std::max(0, durationMs), roundHalfEven(std::clamp(from, 0.0, 100.0) * scale),
                  roundHalfEven(std::clamp(to, 0.0, 100.0) * scale)};
    cues_.push_back(cue);
    noteLevel(channel, to);
}

void ShowTimeline::fadeTo(std::int32_t timeMs, std::int32_t channel, std::int32_t durationMs, double to,
                          ShowEffect effect) {
    if (channel == kNoChannel) return;
    fade(timeMs, channel, durationMs, present_[static_cast<std::size_t>(channel)], to, effect);
}

void ShowTimeline::dmxDump(std::int32_t timeMs, std::int32_t universe, std::vector<std::uint8_t> levels) {
    Cue cue;
    cue.timeMs = timeMs;
    cue.kind = CueKind::DmxDump;
    cue.network = universe;
    cue.levels = static_cast<std::int32_t>(dumps_.size());
    dumps_.push_back(std::move(levels));
    cues_.push_back(cue);
}

void ShowTimeline::controllerDump(std::int32_t timeMs, std::int32_t network, std::int32_t unit,
                                  std::vector<std::uint8_t> levels) {
    Cue cue;
    cue.timeMs = timeMs;
    cue.kind = CueKind::ControllerDump;
    cue.network = network;
    cue.unit = unit;
    cue.levels = static_cast<std::int32_t>(dumps_.size());
    dumps_.push_back(std::move(levels));
    cues_.push_back(cue);
}

std::size_t ShowTimeline::sizeOf(const Cue& cue) const {
    if (cue.kind == CueKind::Command) {
        return kCommandBytes + cast_.channels[static_cast<std::size_t>(cue.channel)].name.size();
    }
    return kDumpBytes + 2 * dumps_[static_cast<std::size_t>(cue.levels)].size();
}

void ShowTimeline::write(const Cue& cue, FrameWriter& frame) const {
    if (cue.kind == CueKind::DmxDump) {
        frame.dmxDump(cue.network, dumps_[static_cast<std::size_t>(cue.levels)]);
    } else if (cue.kind == CueKind::ControllerDump) {
        frame.controllerDump(cue.network, cue.unit, dumps_[static_cast<std::size_t>(cue.levels)]);
    } else {
        const ShowChannel& channel = cast_.channels[static_cast<std::size_t>(cue.channel)];
        if (!channel.name.empty()) {
            frame.namedCommand(static_cast<std::int32_t>(cue.effect), channel.name, cue.timing);
        } else {
            ZephLightCommand address = channel.address;
            address.EffectType = static_cast<std::int32_t>(cue.effect);
            frame.command(address, cue.timing);
        }
    }
}

std::vector<CapturePiece> ShowTimeline::pieces(std::int32_t lengthMs) const {
    std::vector<const Cue*> order;
    order.reserve(cues_.size());
    for (const Cue& cue : cues_)
        order.push_back(&cue);
    std::ranges::stable_sort(order, {}, [](const Cue* cue) { return cue->timeMs; });

    std::vector<CapturePiece> pieces;
    std::size_t next = 0;
    for (std::int32_t tickMs = 0; tickMs <= lengthMs; tickMs += kTickMs) {
        const bool last = tickMs + kTickMs > lengthMs;
        bool more = true;
        while (more) {  // a crowded moment spills into the ticks behind it, but not further than is seen
            FrameWriter frame;
            std::size_t size = kFrameBytes;
            while (next < order.size() && (last || order[next]->timeMs <= tickMs)) {
                const std::size_t grown = size + sizeOf(*order[next]);
                if (grown > kLargestFrame && frame.payloadCount() > 0) break;
                size = grown;
                write(*order[next++], frame);
            }
            if (frame.payloadCount() == 0) frame.noOperation();
            pieces.push_back({tickMs, frame.takeFrame()});
            more = next < order.size() && (last || order[next]->timeMs + kLargestDelayMs < tickMs);
        }
    }
    return pieces;
}
