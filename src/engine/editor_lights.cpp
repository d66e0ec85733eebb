#include "engine/editor_lights.h"

#include "engine/blend.h"
#include "engine/bulb_walk.h"

#include <algorithm>

namespace {

Canvas canvasOf(QImage& image) {
    const auto stride =
        static_cast<std::ptrdiff_t>(image.bytesPerLine() / static_cast<qsizetype>(sizeof(std::uint32_t)));
    return {{reinterpret_cast<std::uint32_t*>(image.bits()), stride}, image.width(), image.height()};
}

// Channels that are drawn: an RGB fixture has one look, whatever its three channels are.
std::int32_t drawnChannels(const ZephFixture& fixture) {
    return fixture.Channel_Type == kChannelRgb ? 1 : std::clamp(fixture.ChannelCount, 0, kMaxChannels);
}

void drawBulb(const BulbImage& image, std::uint8_t alpha, std::int32_t x, std::int32_t y, std::int32_t size,
              const Canvas& canvas) {
    if (image.Mask == nullptr) return;
    blendClipped(spriteOf(image), alpha, static_cast<std::int64_t>(x) - size, static_cast<std::int64_t>(y) - size,
                 canvas);
}

}  // namespace

void ZephDrawLights(const EditorLights& lights, int fixtureNumber, int channel, std::int32_t intensity, bool drawBlack,
                    std::int32_t pixelNumber, QImage& target) {
    const ZephFixture& fixture = lights.simulation.Fixtures[fixtureNumber];
    const ZephFixtureBulbs& bulbs = lights.bulbs[fixtureNumber];
    const bool black = drawBlack || drawnChannels(fixture) == 0;
    const std::int32_t shown =
        fixture.Fixture_Type == kFixtureFlood ? std::min(intensity, fixture.Max_Opacity) : intensity;
    const std::uint8_t alpha = lights.curve[static_cast<std::size_t>(levelCut(std::clamp(shown, 0, 100)))];
    const Canvas canvas = canvasOf(target);
    const auto imageOf = [&](std::int32_t bulb) -> const BulbImage& {
        return black ? bulbs.BlackBulb : channelImage(fixture, channel, bulb, bulbs);
    };
    if (fixture.Fixture_Type == kFixtureStrings) {
        // A stroke begins anew with the first colour, so the colour's number counts, not the bulb's.
        walkBulbs(fixture, channel, [&](const WalkedBulb& bulb) {
            drawBulb(imageOf(bulb.ColorIndex), alpha, bulb.X, bulb.Y, fixture.BulbSize, canvas);
        });
        return;
    }
    const std::int32_t points = usedPoints(fixture);
    const bool single = pixelNumber > 0 && pixelNumber <= points;
    for (std::int32_t p = single ? pixelNumber : 1; p <= (single ? pixelNumber : points); ++p) {
        const ZephDrawPoint& point = fixture.DrawPoints[p];
        drawBulb(imageOf(p), alpha, roundedPixelX(point.X), roundedPixelY(point.Y), fixture.BulbSize, canvas);
    }
}

void ZephDrawEditorLights(const EditorLights& lights, int fixtureNumber, QImage& target) {
    const ZephFixture& fixture = lights.simulation.Fixtures[fixtureNumber];
    const bool on =
        lights.simulation.Levels.contains(fixture.ZOrder) && lights.simulation.Levels[fixture.ZOrder].Edit_Enabled;
    const std::int32_t intensity = on ? 100 : lights.simulation.Dimmed;
    if (!on && lights.simulation.Dimmed < 1) return;
    const std::int32_t channels = drawnChannels(fixture);
    if (channels == 0 || !lights.settings.EditInColor) {
        ZephDrawLights(lights, fixtureNumber, 1, intensity, true, 0, target);
        return;
    }
    for (std::int32_t channel = 1; channel <= channels; ++channel) {
        ZephDrawLights(lights, fixtureNumber, channel, intensity, false, 0, target);
    }
}
