#include "engine/blend.h"
#include "tests/support/masks.h"
#include "util/random_source.h"

#include <cmath>

namespace {

constexpr std::int32_t kWidth = 160;
constexpr std::int32_t kHeight = 140;

}  // namespace

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
    SeededRandom random(11);
    ZephDimmingCurve anyCurve{};  // floods of any coverage
    for (std::uint8_t& level : anyCurve)
        level = static_cast<std::uint8_t>(ZephReturnRandomNumber(0, 255, random));
    const auto noisy = makeMasks(anyCurve);
    for (std::int32_t round = 0; round < 600; ++round) {
        const std::int32_t shape = ZephReturnRandomNumber(1, kBulbShapes, random);
        const BulbMask& mask = round % 3 == 0
                                   ? noisy->ZephFloodMasks[ZephReturnRandomNumber(1, kMaxFloodSize, random)]
                                   : noisy->ZephBulbMasks[ZephReturnRandomNumber(1, kMaxBulbSize, random)][shape];
        BulbImage image;
        makeBulbImage(&mask, ZephReturnRandomNumber(0, kWhite, random), image);
        const BulbSprite sprite = spriteOf(image);
        const std::int32_t kind = ZephReturnRandomNumber(1, 4, random);
        const auto alpha = static_cast<std::uint8_t>(kind == 1   ? 255
                                                     : kind == 2 ? ZephReturnRandomNumber(1, 3, random)
                                                                 : ZephReturnRandomNumber(0, 255, random));
        std::vector<BulbItem> items(3);
        for (BulbItem& item : items)
            item.Place = {static_cast<std::int16_t>(ZephReturnRandomNumber(0, kWidth - 134, random)),
                          static_cast<std::int16_t>(ZephReturnRandomNumber(-20, kHeight - 1, random))};
        std::vector<std::uint32_t> before(kWidth * kHeight);
        for (std::uint32_t& pixel : before)
            pixel = 0xFF000000U | static_cast<unsigned>(ZephReturnRandomNumber(0, kWhite, random));
        const RowRange rows{ZephReturnRandomNumber(0, 60, random), ZephReturnRandomNumber(61, kHeight, random)};

        const auto blended = [&](BlendForm form) {
            std::vector<std::uint32_t> pixels = before;
            blendKernels(form).blendItems(items, &alpha, &sprite, rows, {pixels.data(), kWidth});
            return pixels;
        };
        const std::vector<std::uint32_t> expected = blended(BlendForm::Reference);
        ASSERT_EQ(blended(BlendForm::Portable), expected) << "size " << mask.Size << " soft " << mask.Soft;
        if (blendFormAvailable(BlendForm::Avx2)) {
            ASSERT_EQ(blended(BlendForm::Avx2), expected) << "size " << mask.Size << " soft " << mask.Soft;
        }
    }
}
