#include "engine/blend.h"
#include "tests/support/masks.h"
#include "util/random_source.h"

#include <cmath>

TEST(BlendPixel, RoundsTheExactResultOnce) {
    // Every source, coverage and alpha in steps of 5 and 17, over three destinations; the formula in real numbers. No
    // tie can occur, since 65025 is odd.
    for (std::uint32_t alpha = 0; alpha <= 255; alpha += 5) {
        for (std::uint32_t coverage = 0; coverage <= 255; coverage += 17) {
            for (std::uint32_t color = 0; color <= 255; color += 17) {
                const std::uint32_t source = coveredPixel(0xFF000000U | color << 16 | (255 - color), coverage);
                for (const std::uint32_t d : {0U, 101U, 255U}) {
                    const std::uint32_t result = blendPixelReference(source, 0xFF000000U | d << 16 | d, alpha);
                    const double keep = 1 - coverage * alpha / 65025.0;
                    EXPECT_EQ(result >> 16 & 255,
                              std::lround((source >> 16 & 255) * alpha / 255.0 + d * keep));  // NOLINT
                    EXPECT_EQ(result >> 24, 255U);
                }
            }
        }
    }
    EXPECT_EQ(coveredPixel(0xFFFF8001U, 128), 0x80804000U);  // 128 x 128 / 255 = 64.25, 1 x 128 / 255 = 0.5
}

TEST(BlendKernels, AllFormsGiveThePixelsOfTheReference) {
    constexpr std::int32_t kWidth = 160;
    constexpr std::int32_t kHeight = 140;
    SeededRandom random(11);
    const auto pick = [&](std::int32_t low, std::int32_t high) { return ZephReturnRandomNumber(low, high, random); };
    ZephDimmingCurve anyCurve{};  // floods of any coverage
    for (std::uint8_t& level : anyCurve)
        level = static_cast<std::uint8_t>(pick(0, 255));
    const auto noisy = makeMasks(anyCurve);
    for (int round = 0; round < 600; ++round) {
        const BulbMask& mask = round % 3 == 0 ? noisy->ZephFloodMasks[pick(1, kMaxFloodSize)]
                                              : noisy->ZephBulbMasks[pick(1, kMaxBulbSize)][pick(1, kBulbShapes)];
        BulbImage image;
        makeBulbImage(&mask, pick(0, kWhite), image);
        const BulbSprite sprite = spriteOf(image);
        const auto alpha = static_cast<std::uint8_t>(pick(1, 4) == 1 ? 255 : pick(0, pick(1, 3) == 1 ? 3 : 255));
        std::vector<BulbItem> items(3);
        for (BulbItem& item : items) {
            item.Place.X = static_cast<std::int16_t>(pick(0, kWidth - 134));
            item.Place.Y = static_cast<std::int16_t>(pick(-20, kHeight - 1));
        }
        std::vector<std::uint32_t> before(kWidth * kHeight);
        for (std::uint32_t& pixel : before)
            pixel = 0xFF000000U | static_cast<unsigned>(pick(0, kWhite));
        const RowRange rows{pick(0, 60), pick(61, kHeight)};
        const auto blended = [&](BlendForm form) {
            std::vector<std::uint32_t> pixels = before;
            blendKernels(form).blendItems(items, &alpha, &sprite, rows, {pixels.data(), kWidth});
            return pixels;
        };
        for (const BlendForm form : {BlendForm::Portable, BlendForm::Avx2}) {
            if (!blendFormAvailable(form)) continue;
            ASSERT_EQ(blended(form), blended(BlendForm::Reference)) << "size " << mask.Size << " soft " << mask.Soft;
        }
    }
}
