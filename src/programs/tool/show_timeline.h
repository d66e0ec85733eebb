// The script of a demo show: what is sent when. Scenes write it in any order of time; it becomes the pieces of a
// capture, each one frame that fits a datagram.
#pragma once

#include "link/capture_file.h"
#include "programs/tool/show_cast.h"

#include <cstdint>
#include <map>
#include <vector>

enum class ShowEffect : std::int32_t { Plain = 0, Shimmer = 1, Twinkle = 2, Fine = 3 };  // the subtypes of a command

class ShowTimeline {
public:
    static constexpr std::int32_t kTickMs = 30;           // one piece a tick: 33 a second
    static constexpr std::size_t kLargestFrame = 1'400;   // bytes; fits one datagram
    static constexpr std::int32_t kLargestDelayMs = 300;  // a cue that waited so long goes out beside its tick's piece

    explicit ShowTimeline(const ShowCast& cast) : cast_(cast), present_(cast.channels.size()) {}

    // Intensities 0..100; kNoChannel is passed over. Fine sends them on the scale 0..255.
    void fade(std::int32_t timeMs, std::int32_t channel, std::int32_t durationMs, double from, double to,
              ShowEffect effect = ShowEffect::Plain);
    // From where the channel stands.
    void fadeTo(std::int32_t timeMs, std::int32_t channel, std::int32_t durationMs, double to,
                ShowEffect effect = ShowEffect::Plain);
    void set(std::int32_t timeMs, std::int32_t channel, double to) { fade(timeMs, channel, 0, to, to); }

    // Levels 0..255 from channel 1 of a universe, or circuit 1 of a controller, on.
    void dmxDump(std::int32_t timeMs, std::int32_t universe, std::vector<std::uint8_t> levels);
    void controllerDump(std::int32_t timeMs, std::int32_t network, std::int32_t unit, std::vector<std::uint8_t> levels);
    // Where a dump leaves a channel, so that a later fadeTo starts there. 0..100.
    void noteLevel(std::int32_t channel, double level) { present_[static_cast<std::size_t>(channel)] = level; }

    // Everything due by lengthMs, in order; a tick on which nothing is due sends an empty payload. Throws Failure
    // where an address does not fit the wire.
    std::vector<CapturePiece> pieces(std::int32_t lengthMs) const;

private:
    enum class CueKind { Command, DmxDump, ControllerDump };
    struct Cue {
        std::int32_t timeMs = 0;
        CueKind kind = CueKind::Command;
        std::int32_t channel = kNoChannel;
        ShowEffect effect = ShowEffect::Plain;
        ZephLightTiming timing;
        std::int32_t network = 0;  // universe, or network of the controller
        std::int32_t unit = 0;
        std::int32_t levels = 0;  // index in dumps_
    };

    std::size_t sizeOf(const Cue& cue) const;
    void write(const Cue& cue, class FrameWriter& frame) const;

    const ShowCast& cast_;
    std::vector<double> present_;  // level of each channel once all cues so far have run
    std::vector<Cue> cues_;
    std::vector<std::vector<std::uint8_t>> dumps_;
};
