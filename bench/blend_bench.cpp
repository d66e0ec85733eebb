// Blending alone, on a canvas that stays in the cache: our kernels beside QPainter drawing the same images with
// opacity, pixman and a plain loop. Every bulb has an opacity of its own, and all lie whole on the canvas.
#include "bench/bench_report.h"
#include "bench/peers.h"
#include "engine/bulb_masks.h"
#include "engine/pixel_store.h"
#include "model/dimming_curve.h"
#include "util/random_source.h"

#include <QPainter>

#include <span>
#include <string>

namespace {

constexpr int kRuns = 21;
constexpr int kPeerRuns = 5;
constexpr std::int32_t kSide = 256;  // pixels, of the canvas: 256 KB
constexpr std::int32_t kColor = 0x4080FF;

struct BlendScene {
    BulbImage image;
    std::vector<BulbItem> items;       // each a unit of its own
    std::vector<std::uint8_t> alphas;  // [unit]
    QImage picture;

    BlendScene(const BulbMask& mask, std::int32_t bulbs) {
        makeBulbImage(&mask, kColor, image);
        picture = asPicture(image);
        SeededRandom random(11);
        const auto place = [&] {
            return static_cast<std::int16_t>(ZephReturnRandomNumber(0, kSide - 2 * mask.Size, random));
        };
        for (std::int32_t b = 0; b < bulbs; ++b) {
            const std::int16_t x = place();
            items.push_back({{x, place()}, b, 0});
            alphas.push_back(static_cast<std::uint8_t>(ZephReturnRandomNumber(1, 255, random)));
        }
    }

    std::uint8_t alphaOf(const BulbItem& item) const { return alphas[static_cast<std::size_t>(item.Unit)]; }
};

double kernelTime(const BlendScene& scene, BlendForm form) {
    PixelStore canvas;
    canvas.resize(kSide, kSide);
    const BulbSprite sprite = spriteOf(scene.image);
    const BlendKernels& kernels = blendKernels(form);
    return medianMicroseconds(kRuns, [&] {
        kernels.blendItems(scene.items, scene.alphas.data(), &sprite, {0, kSide}, {canvas.row(0), canvas.stride()});
    });
}

double painterTime(const BlendScene& scene) {
    QImage canvas(kSide, kSide, QImage::Format_RGB32);
    canvas.fill(Qt::black);
    return medianMicroseconds(kPeerRuns, [&] {
        QPainter painter(&canvas);
        for (const BulbItem& item : scene.items) {
            painter.setOpacity(scene.alphaOf(item) / 255.0);
            painter.drawImage(item.Place.X, item.Place.Y, scene.picture);
        }
    });
}

double pixmanTime(BlendScene& scene) {
    QImage pixels(kSide, kSide, QImage::Format_RGB32);
    pixels.fill(Qt::black);
    const PixmanImage canvas = pixmanView(pixels, PIXMAN_x8r8g8b8);
    const PixmanImage sprite = pixmanView(scene.picture, PIXMAN_a8r8g8b8);
    const std::vector<PixmanImage> opacities = pixmanOpacities();
    const int side = scene.picture.width();
    return medianMicroseconds(kPeerRuns, [&] {
        for (const BulbItem& item : scene.items) {
            pixman_image_composite32(PIXMAN_OP_OVER, sprite.get(), opacities[scene.alphaOf(item)].get(), canvas.get(),
                                     0, 0, 0, 0, item.Place.X, item.Place.Y, side, side);
        }
    });
}

double loopTime(const BlendScene& scene) {
    QImage canvas(kSide, kSide, QImage::Format_RGB32);
    canvas.fill(Qt::black);
    return medianMicroseconds(kPeerRuns, [&] {
        for (const BulbItem& item : scene.items)
            blendPlainly(scene.picture, scene.alphaOf(item), item.Place.X, item.Place.Y, canvas);
    });
}

void measure(const std::string& group, const BulbMask& mask, std::int32_t bulbs, BenchReport& report) {
    BlendScene scene(mask, bulbs);
    report.row(group, "our kernel", kernelTime(scene, BlendForm::Avx2));
    report.row(group, "our kernel, portable form", kernelTime(scene, BlendForm::Portable));
    report.row(group, "QPainter, drawImage with opacity", painterTime(scene));
    report.row(group, "pixman, OVER with a constant mask", pixmanTime(scene));
    report.row(group, "plain loop over pixels", loopTime(scene));
}

}  // namespace

void benchBlend(BenchReport& report) {
    if (!blendFormAvailable(BlendForm::Avx2)) return;
    const auto masks = std::make_unique<ZephMasks>();
    ZephSetUpMasks(
        ZephCreateDummyDimmingCurve(), [](std::string_view) {}, *masks);
    measure("Blend 10,000 round bulbs of size 2", masks->ZephBulbMasks[2][1], 10'000, report);
    measure("Blend 10,000 round bulbs of size 8", masks->ZephBulbMasks[8][1], 10'000, report);
    measure("Blend 200 floods of size 64", masks->ZephFloodMasks[64], 200, report);
}
