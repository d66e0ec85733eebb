// The drawing surface by the plain rule: every frame from the whole background, bulb by bulb in the order of the calls,
// pixel by pixel by the reference formula. What the fast surface must agree with.
#pragma once

#include "engine/light_surface.h"
#include "engine/standard_surface.h"

class ReferenceSurface : public LightSurface {
public:
    explicit ReferenceSurface(const SurfaceScene& scene) : scene_(scene) {
        setBackground(scene.Background);
        const auto groups = static_cast<std::int32_t>(scene.Tables.RGBData.size());
        pool_.reserve(2 * groups, groups, kMaxFloodSize);
    }

    void setBackground(const QImage& background) { background_ = background.convertToFormat(QImage::Format_RGB32); }

    void beginFrame() override { image_ = background_.copy(); }
    void endFrame() override {}

    void drawChannel(const ChannelDraw& draw) override {
        const ZephFixture& fixture = scene_.Document.Fixtures[draw.Fixture];
        const ZephBulbLocations& bulbs = *bulbLocations(scene_.States[draw.Fixture], draw.Channel);
        for (std::int32_t b = 1; b <= bulbs.Count; ++b) {
            if (draw.BulbLit != nullptr && draw.BulbLit[b - 1] == 0) continue;
            drawBulb(channelImage(fixture, draw.Channel, b, scene_.Bulbs[draw.Fixture]), draw.Alpha,
                     bulbs.First + b - 1);
        }
    }

    void drawGroup(const GroupDraw& draw, ZephRGBData& group) override {
        if (draw.Alpha == 0 || (draw.Bulbs != nullptr && draw.BulbCount == 0)) return;
        if (RGBBulbRebuildNeeded(group) || group.Bulb == 0) {
            ZephUpdateRGBChannelBulb(scene_.Document.Fixtures[draw.Fixture], draw.Color, scene_.Masks, cache_, pool_,
                                     group);
        }
        const ZephBulbLocations& bulbs = *bulbLocations(scene_.States[draw.Fixture], 1);
        const std::int32_t count = draw.Bulbs != nullptr ? draw.BulbCount : bulbs.Count;
        for (std::int32_t i = 0; i < count; ++i) {
            const std::int32_t bulb = draw.Bulbs != nullptr ? draw.Bulbs[i] : i + 1;
            if (bulb >= 1 && bulb <= bulbs.Count) drawBulb(pool_.image(group.Bulb), draw.Alpha, bulbs.First + bulb - 1);
        }
    }

    const QImage& image() const { return image_; }

private:
    void drawBulb(const BulbImage& image, std::uint32_t alpha, std::int32_t pool0) {
        const ZephBulbLocation& bulb = scene_.Tables.BulbPool[static_cast<std::size_t>(pool0)];
        if (image.Mask == nullptr || bulb.Type == kPointPlaceHolder) return;
        const std::int32_t side = 2 * image.Mask->Size;
        for (std::int32_t y = 0; y < side; ++y) {
            for (std::int32_t x = 0; x < side; ++x) {
                const std::int64_t canvasX = std::int64_t{bulb.X} - image.Mask->Size + x;
                const std::int64_t canvasY = std::int64_t{bulb.Y} - image.Mask->Size + y;
                if (canvasX < 0 || canvasY < 0 || canvasX >= image_.width() || canvasY >= image_.height()) continue;
                const std::uint8_t coverage = image.Mask->Coverage[static_cast<std::size_t>(y * side + x)];
                auto* pixel = reinterpret_cast<std::uint32_t*>(image_.scanLine(static_cast<int>(canvasY))) + canvasX;
                *pixel = blendPixelReference(coveredPixel(image.Color, coverage), *pixel, alpha);
            }
        }
    }

    SurfaceScene scene_;
    QImage background_;
    QImage image_;
    ZephRGBBulbCache cache_;
    RGBBulbPool pool_;
};
