#include "engine/editor_lights.h"

#include "engine/blend.h"
#include "engine/bulb_walk.h"
#include "util/rounding.h"

#include <algorithm>

namespace {

// Draws images on a picture, by the fast kernels wherever their overreach lies in the picture.
class CanvasPainter {
public:
    CanvasPainter(std::uint8_t alpha, QImage& canvas)
        : alpha_(alpha),
          kernels_(fastestBlendKernels()), canvas_{{reinterpret_cast<std::uint32_t*>(canvas.bits()),
                                                    canvas.bytesPerLine() /
                                                        static_cast<std::ptrdiff_t>(sizeof(std::uint32_t))},
                                                   canvas.width(),
                                                   canvas.height()} {}

    // x, y: the middle of the bulb, in pixels.
    void draw(const BulbImage& image, std::int32_t x, std::int32_t y) const {
        if (image.Mask == nullptr) return;
        const BulbSprite sprite = spriteOf(image);
        const std::int64_t left = std::int64_t{x} - image.Mask->Size;
        const std::int64_t top = std::int64_t{y} - image.Mask->Size;
        const std::int64_t side = 2 * image.Mask->Size;
        if (left >= 0 && top >= 0 && left + side + kBlendOverreach <= canvas_.Width && top + side <= canvas_.Height) {
            const BulbItem item{{static_cast<std::int16_t>(left), static_cast<std::int16_t>(top)}, 0, 0};
            kernels_.blendItems({&item, 1}, &alpha_, &sprite, {0, canvas_.Height}, canvas_.Target);
        } else {
            blendClipped(sprite, alpha_, left, top, canvas_);
        }
    }

private:
    std::uint8_t alpha_;
    const BlendKernels& kernels_;
    Canvas canvas_;
};

bool drawable(const EditorLightsContext& context, std::int32_t fixture, const QImage& canvas) noexcept {
    return OneBased<ZephFixture, kMaxFixtures>::contains(fixture) && fixture <= context.Document.FixtureCount &&
           canvas.format() == QImage::Format_RGB32 && canvas.width() <= INT16_MAX && canvas.height() <= INT16_MAX;
}

std::int32_t drawnChannels(const ZephFixture& fixture) noexcept {
    return fixture.Channel_Type == kChannelRgb ? 1 : std::clamp(fixture.ChannelCount, 0, kMaxChannels);
}

void drawString(const ZephFixture& fixture, const ZephFixtureBulbs& bulbs, const LightsDraw& draw, bool black,
                const CanvasPainter& painter) {
    walkBulbs(fixture, draw.Channel, [&](const WalkedBulb& bulb) {
        // A Multi Color channel counts its colours anew at each stroke here, as the walk does, not bulb by bulb.
        const BulbImage& image = black ? bulbs.BlackBulb : channelImage(fixture, draw.Channel, bulb.ColorIndex, bulbs);
        painter.draw(image, bulb.X, bulb.Y);
    });
}

void drawPoints(const ZephFixture& fixture, const ZephFixtureBulbs& bulbs, const LightsDraw& draw, bool black,
                const CanvasPainter& painter) {
    const std::int32_t points = usedPoints(fixture);
    const bool alone = draw.PixelNumber > 0 && draw.PixelNumber <= points;
    const std::int32_t channel = fixture.Channel_Type == kChannelRgb ? 1 : draw.Channel;
    for (std::int32_t p = alone ? draw.PixelNumber : 1; p <= (alone ? draw.PixelNumber : points); ++p) {
        const ZephDrawPoint& point = fixture.DrawPoints[p];
        if (point.Type == kPointPlaceHolder) continue;  // a pixel that is not on the canvas
        painter.draw(black ? bulbs.BlackBulb : channelImage(fixture, channel, p, bulbs), roundedPixelX(point.X),
                     roundedPixelY(point.Y));
    }
}

}  // namespace

void ZephDrawEditorLights(const EditorLightsContext& context, std::int32_t fixture, QImage& canvas) {
    if (!drawable(context, fixture, canvas)) return;
    const ZephFixture& record = context.Document.Fixtures[fixture];
    // A damaged file's level is open, so that the fixture can be seen and mended.
    const bool open =
        !OneBased<ZephLevel, kLevels>::contains(record.ZOrder) || context.Document.Levels[record.ZOrder].Edit_Enabled;
    if (!open && context.Document.Dimmed < 1) return;

    LightsDraw draw{.Fixture = fixture, .Intensity = open ? 100 : context.Document.Dimmed};
    const std::int32_t channels = drawnChannels(record);
    if (channels < 1 || !context.EditInColor) {
        draw.DrawBlack = true;
        ZephDrawLights(context, draw, canvas);
        return;
    }
    for (draw.Channel = 1; draw.Channel <= channels; ++draw.Channel)
        ZephDrawLights(context, draw, canvas);
}

void ZephDrawLights(const EditorLightsContext& context, const LightsDraw& draw, QImage& canvas) {
    if (!drawable(context, draw.Fixture, canvas) || draw.Channel < 1 || draw.Channel > kMaxChannels) return;
    const ZephFixture& fixture = context.Document.Fixtures[draw.Fixture];
    const ZephFixtureBulbs& bulbs = context.Bulbs[draw.Fixture];
    const bool black = draw.DrawBlack || drawnChannels(fixture) == 0;
    const std::int32_t intensity =
        fixture.Fixture_Type == kFixtureFlood ? std::min(draw.Intensity, fixture.Max_Opacity) : draw.Intensity;
    const std::uint8_t alpha = context.Curve[static_cast<std::size_t>(levelCut(std::clamp(intensity, 0, 100)))];
    const CanvasPainter painter(alpha, canvas);

    if (fixture.Fixture_Type == kFixtureStrings) {
        drawString(fixture, bulbs, draw, black, painter);
    } else if (fixture.Fixture_Type >= kFixtureFlood && fixture.Fixture_Type <= kFixtureDmxPixels) {
        drawPoints(fixture, bulbs, draw, black, painter);
    }
}
