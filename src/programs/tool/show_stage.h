// What the scenes of a demo show share: colours, the lights as they are driven, and whole universes and controllers
// that are painted by level dumps.
#pragma once

#include "programs/tool/show_timeline.h"

#include <functional>

// Parts 0..1.
struct ShowColor {
    double red = 0;
    double green = 0;
    double blue = 0;

    ShowColor scaled(double by) const { return {red * by, green * by, blue * by}; }
    double brightness() const;  // the largest part
};

// hue 0..1 around the circle, any number wraps; saturation and value 0..1.
ShowColor colorOfHue(double hue, double saturation, double value);
// One of a few colours that go well together; any number.
ShowColor festiveColor(std::int32_t number);
// 0..1, the same for the same numbers, without a visible pattern.
double scatter(std::int32_t first, std::int32_t second);
// 0 below 0, 1 above 1, smooth between.
double easeIn(double share);

struct ShowSpan {
    std::int32_t fromMs = 0;
    std::int32_t toMs = 0;

    std::int32_t length() const { return toMs - fromMs; }
    // The time at a share 0..1 of the span.
    std::int32_t at(double share) const;
};

// A universe or controller whose channels are sent together, from channel 1 on.
struct DumpTarget {
    struct Circuit {
        std::int32_t light = -1;  // -1: no light; the channel is then held at 0
        std::int32_t part = 0;    // 0 red or plain, 1 green, 2 blue
        std::int32_t channel = kNoChannel;
    };
    std::int32_t network = 0;  // universe, or network of the controller
    std::int32_t unit = 0;     // 0 for a universe
    std::vector<Circuit> circuits;
};

// The colour of a light at a time.
using ShowShader = std::function<ShowColor(const ShowLight& light, std::int32_t timeMs)>;

class ShowStage {
public:
    ShowStage(const ShowCast& cast, ShowTimeline& timeline);

    const ShowCast& cast() const { return cast_; }
    ShowTimeline& timeline() { return timeline_; }

    // Lights that single commands drive; those of crowded universes are painted by dumps.
    const std::vector<std::int32_t>& soloLights() const { return soloLights_; }
    const ShowLight& light(std::int32_t number) const { return cast_.lights[static_cast<std::size_t>(number)]; }

    // Fades a light from where it is, or from a colour, to a colour. A plain light takes the brightness.
    void paint(std::int32_t timeMs, std::int32_t light, std::int32_t durationMs, ShowColor to,
               ShowEffect effect = ShowEffect::Plain);
    void paintFrom(std::int32_t timeMs, std::int32_t light, std::int32_t durationMs, ShowColor from, ShowColor to,
                   ShowEffect effect = ShowEffect::Plain);

    // Sends the crowded universes in turn, as many as leave room for commands, each as the shader paints it then.
    void animateUniverses(ShowSpan span, const ShowShader& shader);
    // Every universe once, one behind the other, from the time on.
    void dumpUniverses(std::int32_t timeMs, const ShowShader& shader);
    // Every controller once. Controllers keep their last dump and carry it out again with each dump that follows, so
    // all of them are sent together and commands stay away meanwhile.
    void dumpControllers(std::int32_t timeMs, const ShowShader& shader);
    bool onController(std::int32_t channel) const { return onController_[static_cast<std::size_t>(channel)]; }
    bool inUniverse(std::int32_t channel) const { return inUniverse_[static_cast<std::size_t>(channel)]; }

private:
    void gatherTargets();
    std::vector<std::uint8_t> levels(const DumpTarget& target, std::int32_t timeMs, const ShowShader& shader);

    const ShowCast& cast_;
    ShowTimeline& timeline_;
    std::vector<DumpTarget> universes_;
    std::vector<DumpTarget> controllers_;
    std::vector<bool> inUniverse_;    // by channel
    std::vector<bool> onController_;  // by channel
    std::vector<std::int32_t> soloLights_;
};
