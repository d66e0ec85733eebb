#include "programs/tool/show_scenes.h"
#include "util/rounding.h"

#include <algorithm>
#include <array>

namespace {

constexpr std::size_t kResolution = 0;  // of ShowRibbon::magic
constexpr std::size_t kMotion = 1;
constexpr std::size_t kParameter = 2;
constexpr std::size_t kPosition = 3;
constexpr std::size_t kColorEffect = 4;
constexpr std::size_t kSpeed = 5;
constexpr std::size_t kIntensity = 6;

// A motion with the parameter and the run of the position that show it well. The chases take on and off pixels as the
// two digits of the parameter; the strobe takes the length of its dark phase.
struct Motion {
    double number;
    double parameter;
    double fromPosition;
    double toPosition;
};
constexpr std::array kMotions{Motion{1, 12, 0, 100}, Motion{5, 33, 60, 95}, Motion{2, 0, 0, 100},
                              Motion{3, 8, 0, 100},  Motion{6, 42, 60, 95}, Motion{4, 0, 0, 100},
                              Motion{9, 23, 0, 100}, Motion{7, 10, 0, 100}, Motion{10, 51, 0, 100},
                              Motion{8, 0, 0, 100},  Motion{11, 50, 96, 96}};

constexpr int kColorEffects = 26;

void showMotions(ShowStage& stage, ShowSpan span) {
    ShowTimeline& timeline = stage.timeline();
    for (std::size_t step = 0; step < kMotions.size(); ++step) {
        const auto steps = static_cast<double>(kMotions.size());
        const std::int32_t start = span.at(static_cast<double>(step) / steps);
        const std::int32_t length = span.at((static_cast<double>(step) + 1) / steps) - start;
        for (std::size_t r = 0; r < stage.cast().ribbons.size(); ++r) {
            const ShowRibbon& ribbon = stage.cast().ribbons[r];
            const Motion& motion = kMotions[(step + r / 3) % kMotions.size()];  // neighbours move alike
            // The value is the present level of the channel, so a fade moves the block along the strand.
            timeline.set(start, ribbon.magic[kParameter], motion.parameter);
            timeline.fade(start, ribbon.magic[kPosition], length, motion.fromPosition, motion.toPosition);
            timeline.set(start, ribbon.magic[kMotion], motion.number);
        }
    }
    for (const ShowRibbon& ribbon : stage.cast().ribbons)
        timeline.set(span.toMs, ribbon.magic[kMotion], 0);
}

void showColorEffects(ShowStage& stage, ShowSpan span) {
    ShowTimeline& timeline = stage.timeline();
    constexpr int kSteps = 4;
    constexpr std::array<double, kSteps> kResolutionValues{50, 25, 10, 5};
    int effect0 = 0;
    for (int step = 0; step < kSteps; ++step) {
        const std::int32_t start = span.at(static_cast<double>(step) / kSteps);
        for (const ShowRibbon& ribbon : stage.cast().ribbons) {
            timeline.set(start, ribbon.magic[kResolution],
                         std::min<double>(kResolutionValues[static_cast<std::size_t>(step)], ribbon.ownResolution));
            timeline.set(start, ribbon.magic[kSpeed], 60 + 10 * step);
            timeline.set(start, ribbon.magic[kIntensity], 100);
            timeline.set(start, ribbon.magic[kColorEffect], 1 + effect0++ % kColorEffects);
        }
    }
}

// Ends the colour effects. A pixel that an effect has let go of takes orders again only from a command that is new in
// a frame in which no lower level is alive; so the ribbons are put out in the dark, the lowest level first.
void wakeRibbons(ShowStage& stage, ShowSpan span) {
    ShowTimeline& timeline = stage.timeline();
    restRibbons(stage, span.fromMs);
    std::vector<std::int32_t> ribbonLights;
    for (const std::int32_t number : stage.soloLights()) {
        if (stage.light(number).fixtureType == kFixtureKesh) ribbonLights.push_back(number);
    }
    std::ranges::stable_sort(ribbonLights, {}, [&](std::int32_t number) { return stage.light(number).level; });
    constexpr double kLightsATick = 15;  // what a frame carries
    constexpr std::int32_t kPauseMs = 90;
    double timeMs = span.fromMs + kPauseMs;
    std::int32_t level = 0;
    for (const std::int32_t number : ribbonLights) {
        const ShowLight& light = stage.light(number);
        if (level != 0 && light.level != level) timeMs += kPauseMs;
        level = light.level;
        for (const std::int32_t channel : light.channels)
            timeline.set(truncateToInt(timeMs), channel, 0);
        timeMs += ShowTimeline::kTickMs / kLightsATick;
    }
}

}  // namespace

void restRibbons(ShowStage& stage, std::int32_t timeMs) {
    for (const ShowRibbon& ribbon : stage.cast().ribbons) {
        // A resolution of 0 is the ribbon's own; and a channel at 0 goes to sleep, which keeps its level quiet.
        for (const std::int32_t channel : ribbon.magic)
            stage.timeline().set(timeMs, channel, 0);
    }
}

void ribbonScene(ShowStage& stage, ShowSpan span) {
    for (const std::int32_t number : stage.soloLights()) {
        const ShowLight& light = stage.light(number);
        const bool ribbon = light.fixtureType == kFixtureKesh;
        // The rest of the display steps back and leaves the stage to the ribbons.
        const ShowColor color = ribbon ? festiveColor(light.fixture) : festiveColor(light.prop).scaled(0.22);
        stage.paint(span.at(0.02 + 0.04 * light.x), number, 600, color);
    }
    showMotions(stage, {span.at(0.08), span.at(0.57)});
    showColorEffects(stage, {span.at(0.57), span.at(0.82)});
    const ShowSpan closing{span.at(0.8), span.at(0.84)};
    for (const std::int32_t number : stage.soloLights()) {
        if (stage.light(number).fixtureType != kFixtureKesh) stage.paint(closing.fromMs, number, closing.length(), {});
    }
    wakeRibbons(stage, {span.at(0.87), span.toMs});
    stage.animateUniverses({span.fromMs, closing.toMs}, [&](const ShowLight& light, std::int32_t timeMs) {
        const double wave = light.propX + 0.5 * light.propY - (timeMs - span.fromMs) / 2600.0;
        const double glow = 0.18 + 0.2 * easeIn(colorOfHue(wave, 1, 1).red);
        const double left = 1 - easeIn(static_cast<double>(timeMs - closing.fromMs) / std::max(1, closing.length()));
        return colorOfHue(0.55 + 0.12 * wave, 0.8, glow * left);
    });
    stage.dumpUniverses(closing.toMs, [](const ShowLight&, std::int32_t) { return ShowColor{}; });
}
