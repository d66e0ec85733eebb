#include "programs/tool/show_scenes.h"

#include "util/rounding.h"

#include <algorithm>
#include <cmath>

namespace {

// A flood lights a whole wall: at full strength it would drown the bulbs on it.
double strength(const ShowLight& light) {
    return light.fixtureType == kFixtureFlood ? 0.34 : 1;
}

bool isRibbon(const ShowLight& light) {
    return light.fixtureType == kFixtureKesh;
}

ShowColor propColor(const ShowLight& light, std::int32_t shift = 0) {
    const std::int32_t number = light.prop + (isRibbon(light) ? 0 : light.fixture) + shift;
    return festiveColor(number).scaled(strength(light));
}

// When the wash reaches a light, as a share of the scene.
double washStart(const ShowLight& light) {
    return 0.6 * (light.level - 1) / kLevels + 0.2 * light.x;
}

ShowColor spiral(const ShowLight& light, double seconds) {
    const double turn = light.propX + 1.6 * light.propY - 0.42 * seconds;
    const double band = 0.5 + 0.5 * std::sin(2 * M_PI * (light.propX * 1.5 + light.propY * 2.4 - 0.8 * seconds));
    return colorOfHue(turn, 0.9, (0.12 + 0.88 * band * band) * strength(light));
}

ShowColor sparkle(const ShowLight& light, std::int32_t timeMs) {
    if (light.fixtureType == kFixtureFlood) {  // a wall that sparkles is only restless
        return colorOfHue(timeMs / 9000.0 + 0.3 * light.x, 0.8, strength(light));
    }
    // Each light has a moment of its own in every period; the numbers only spread those moments.
    const auto self = static_cast<std::int32_t>(light.propX * 9973 + light.propY * 7919) + 31 * light.fixture;
    const std::int32_t beat = (timeMs + static_cast<std::int32_t>(900 * scatter(self, 1))) / 300;
    const double chance = scatter(self, beat);
    if (chance > 0.8) return ShowColor{1, 1, 1}.scaled(strength(light));
    return festiveColor(light.fixture + beat / 6).scaled((chance > 0.4 ? 0.5 : 0.14) * strength(light));
}

}  // namespace

void washScene(ShowStage& stage, ShowSpan span) {
    const std::int32_t rise = span.length() / 5;
    for (const std::int32_t number : stage.soloLights()) {
        const ShowLight& light = stage.light(number);
        stage.paintFrom(span.at(washStart(light)), number, rise, {}, propColor(light).scaled(0.85));
    }
    stage.animateUniverses(span, [&](const ShowLight& light, std::int32_t timeMs) {
        const double share = static_cast<double>(timeMs - span.at(washStart(light))) / rise;
        return propColor(light).scaled(0.85 * easeIn(share));
    });
}

void sweepScene(ShowStage& stage, ShowSpan span) {
    constexpr int kPasses = 4;
    constexpr double kTravel = 0.72;  // of a pass: the rest lets the last lights sink
    constexpr double kDim = 0.16;
    const auto passSpan = [&](int pass) {
        return ShowSpan{span.at(static_cast<double>(pass) / kPasses), span.at((pass + 1.0) / kPasses)};
    };
    const auto front = [](const ShowLight& light, int pass) { return pass % 2 == 0 ? light.x : 1 - light.x; };
    for (int pass = 0; pass < kPasses; ++pass) {
        const ShowSpan part = passSpan(pass);
        for (const std::int32_t number : stage.soloLights()) {
            const ShowLight& light = stage.light(number);
            const ShowColor color =
                pass < 2 ? festiveColor(2 + 3 * pass).scaled(strength(light)) : propColor(light, pass);
            stage.paintFrom(part.at(kTravel * front(light, pass)), number, part.length() / 3, color,
                            color.scaled(kDim));
        }
    }
    stage.animateUniverses(span, [&](const ShowLight& light, std::int32_t timeMs) {
        const int pass = std::clamp((timeMs - span.fromMs) * kPasses / std::max(1, span.length()), 0, kPasses - 1);
        const ShowSpan part = passSpan(pass);
        const double behind = static_cast<double>(timeMs - part.at(kTravel * front(light, pass))) / part.length();
        const double glow = behind < 0 ? kDim : std::max(kDim, 1 - 2.4 * behind);
        return (pass < 2 ? festiveColor(2 + 3 * pass) : propColor(light, pass)).scaled(glow);
    });
}

void spiralScene(ShowStage& stage, ShowSpan span) {
    constexpr std::int32_t kStepMs = 420;
    std::vector<std::int32_t> turns(kMaxFixtures + 1, 1);  // channels of each fixture
    for (const std::int32_t number : stage.soloLights()) {
        const ShowLight& light = stage.light(number);
        std::int32_t& count = turns[static_cast<std::size_t>(light.fixture)];
        count = std::max(count, light.turn0 + 1);
    }
    std::int32_t step = 0;
    for (std::int32_t timeMs = span.fromMs; timeMs < span.toMs; timeMs += kStepMs, ++step) {
        for (const std::int32_t number : stage.soloLights()) {
            const ShowLight& light = stage.light(number);
            const std::int32_t count = turns[static_cast<std::size_t>(light.fixture)];
            if (isRibbon(light)) {
                // A slow change of colour, a quarter of each ribbon at a time.
                if (step % 8 == static_cast<std::int32_t>(light.propX * 7.99)) {
                    stage.paint(timeMs, number, 4 * kStepMs, colorOfHue(0.13 * step + 0.4 * light.x, 0.85, 0.7));
                }
            } else if (count > 1) {
                const bool mine = (light.turn0 + step) % count == 0;
                const bool mineBefore = (light.turn0 + step + count - 1) % count == 0;
                if (mine || mineBefore)
                    stage.paint(timeMs, number, kStepMs / 2, ShowColor{1, 1, 1}.scaled(mine ? 1 : 0.1));
            } else if (step % 3 == (light.fixture + light.prop) % 3) {
                const double value = (step / 3 + light.fixture) % 2 == 0 ? 0.9 : 0.22;
                stage.paint(timeMs, number, 3 * kStepMs,
                            colorOfHue(0.05 * step + light.x, 0.8, value * strength(light)));
            }
        }
    }
    stage.animateUniverses(span, [&](const ShowLight& light, std::int32_t timeMs) {
        return spiral(light, (timeMs - span.fromMs) / 1000.0);
    });
}

void finaleScene(ShowStage& stage, ShowSpan span) {
    constexpr int kRounds = 3;
    for (int round = 0; round < kRounds; ++round) {
        const std::int32_t length = span.length() / kRounds;
        for (const std::int32_t number : stage.soloLights()) {
            const ShowLight& light = stage.light(number);
            const double lot = scatter(number, round);
            // Not all at once: a burst of commands would have to wait its turn on the wire.
            const std::int32_t start =
                span.at(static_cast<double>(round) / kRounds) + truncateToInt(0.7 * length * lot);
            const ShowEffect effect = lot < 0.4    ? ShowEffect::Twinkle
                                      : lot < 0.75 ? ShowEffect::Shimmer
                                                   : ShowEffect::Plain;
            const ShowColor color =
                (isRibbon(light) ? propColor(light, round) : festiveColor(number + round)).scaled(strength(light));
            stage.paint(start, number, length / 2, color, effect);
        }
    }
    stage.animateUniverses(span, sparkle);
}

void beatScene(ShowStage& stage, ShowSpan span) {
    constexpr int kBeats = 6;
    for (int beat = 0; beat <= kBeats; ++beat) {
        const std::int32_t timeMs = span.at(static_cast<double>(beat) / (kBeats + 1));
        const ShowShader shader = [&](const ShowLight& light, std::int32_t) {
            const bool lit = beat < kBeats && (light.fixture + light.turn0 + beat) % 2 == 0;
            return lit ? propColor(light, beat) : ShowColor{};
        };
        stage.dumpControllers(timeMs, shader);
        for (const std::int32_t number : stage.soloLights()) {
            const ShowLight& light = stage.light(number);
            if (light.channels[0] != kNoChannel && stage.onController(light.channels[0])) continue;
            const ShowColor color = shader(light, timeMs);
            stage.paintFrom(timeMs, number, span.length() / kBeats, color, color.scaled(0.3), ShowEffect::Fine);
        }
    }
    stage.animateUniverses(span, [&](const ShowLight& light, std::int32_t timeMs) {
        return spiral(light, (span.fromMs - timeMs) / 500.0);
    });
}

void fadeOutScene(ShowStage& stage, ShowSpan span) {
    restRibbons(stage, span.fromMs);
    const auto start = [&](const ShowLight& light) { return 0.05 + 0.35 * (kLevels - light.level) / kLevels; };
    const std::int32_t sink = span.length() * 2 / 5;
    for (const std::int32_t number : stage.soloLights()) {
        stage.paint(span.at(start(stage.light(number))), number, sink, {});
    }
    const ShowSpan sinking{span.fromMs, span.at(0.85)};
    stage.animateUniverses(sinking, [&](const ShowLight& light, std::int32_t timeMs) {
        const double share = static_cast<double>(timeMs - span.at(start(light))) / sink;
        return sparkle(light, timeMs).scaled(1 - easeIn(share));
    });
    stage.dumpUniverses(sinking.toMs, [](const ShowLight&, std::int32_t) { return ShowColor{}; });
}
