#include "engine/blend.h"

#include <algorithm>
#include <cstring>

namespace {

constexpr std::uint32_t kFull = 255;
constexpr std::uint32_t kFullSquared = 65025;
constexpr std::uint32_t kHalfSquared = 32512;  // of 65025, cut off: rounds to the nearest

std::uint32_t sourcePixel(const BulbSprite& sprite, std::int32_t x, std::int32_t y) noexcept {
    if (sprite.Mask->Soft) return sprite.Pixels[y * sprite.Mask->Stride + x];
    return sprite.Color & sprite.Mask->Lanes[static_cast<std::size_t>(y * sprite.Mask->Stride + x)];
}

// Exact for value <= 65152: cuts value / 255 off.
constexpr std::uint32_t cutBy255(std::uint32_t value) noexcept {
    return (value + 1 + (value >> 8)) >> 8;
}
static_assert(cutBy255(254) == 0 && cutBy255(255) == 1 && cutBy255(65024) == 254 && cutBy255(65152) == 255);

// Two channels at once: each half of the number is at most 65025, so nothing carries over.
constexpr std::uint32_t kPairs = 0x00FF00FF;
constexpr std::uint32_t pairsRoundedBy255(std::uint32_t pairs) noexcept {
    const std::uint32_t t = pairs + 0x00800080;
    return (t + (t >> 8 & kPairs)) >> 8 & kPairs;
}

constexpr std::uint32_t blendHard(std::uint32_t color, std::uint32_t destination, std::uint32_t alpha) noexcept {
    const std::uint32_t keep = kFull - alpha;
    const std::uint32_t even = pairsRoundedBy255((color & kPairs) * alpha + (destination & kPairs) * keep);
    const std::uint32_t odd = pairsRoundedBy255((color >> 8 & kPairs) * alpha + (destination >> 8 & kPairs) * keep);
    return even | odd << 8;
}

// The two divisions by 255 cut off one after the other give the same as one by 65025.
std::uint32_t blendSoft(std::uint32_t source, std::uint32_t destination, std::uint32_t alpha) noexcept {
    const std::uint32_t keep = kFullSquared - (source >> 24) * alpha;
    const auto part = [&](int shift) {
        const std::uint32_t s = (source >> shift) & 255U;
        const std::uint32_t d = (destination >> shift) & 255U;
        return cutBy255((s * alpha * kFull + d * keep + kHalfSquared) / kFull) << shift;
    };
    return part(0) | part(8) | part(16) | part(24);
}

RowRange rowsOf(const BulbSprite& sprite, std::int32_t y, RowRange rows) noexcept {
    return {std::max(0, rows.Top - y), std::min(2 * sprite.Mask->Size, rows.Bottom - y)};
}

void blendReference(std::span<const BulbItem> items, const std::uint8_t* alphas, const BulbSprite* sprites,
                    RowRange rows, const PixelTarget& target) noexcept {
    for (const BulbItem& item : items) {
        const BulbSprite& sprite = sprites[item.Sprite];
        const RowRange drawn = rowsOf(sprite, item.Place.Y, rows);
        for (std::int32_t y = drawn.Top; y < drawn.Bottom; ++y) {
            std::uint32_t* to = target.Origin + (item.Place.Y + y) * target.Stride + item.Place.X;
            for (std::int32_t x = 0; x < 2 * sprite.Mask->Size; ++x) {
                to[x] = blendPixelReference(sourcePixel(sprite, x, y), to[x], alphas[item.Unit]);
            }
        }
    }
}

void blendRow(const BulbSprite& sprite, std::int32_t y, std::uint32_t alpha, std::uint32_t* to) noexcept {
    const BulbMask& mask = *sprite.Mask;
    const MaskBlocks blocks = mask.Blocks[static_cast<std::size_t>(y)];
    const std::int32_t end = std::min(8 * blocks.End, 2 * mask.Size);
    if (mask.Soft) {
        const std::uint32_t* from = sprite.Pixels + y * mask.Stride;
        for (std::int32_t x = 8 * blocks.First; x < end; ++x)
            to[x] = blendSoft(from[x], to[x], alpha);
    } else {
        const std::uint32_t* lanes = mask.Lanes.data() + y * mask.Stride;
        for (std::int32_t x = 8 * blocks.First; x < end; ++x)
            to[x] ^= (to[x] ^ blendHard(sprite.Color, to[x], alpha)) & lanes[x];
    }
}

void blendPortable(std::span<const BulbItem> items, const std::uint8_t* alphas, const BulbSprite* sprites,
                   RowRange rows, const PixelTarget& target) noexcept {
    for (const BulbItem& item : items) {
        if (alphas[item.Unit] == 0) continue;
        const BulbSprite& sprite = sprites[item.Sprite];
        const RowRange drawn = rowsOf(sprite, item.Place.Y, rows);
        for (std::int32_t y = drawn.Top; y < drawn.Bottom; ++y) {
            blendRow(sprite, y, alphas[item.Unit], target.Origin + (item.Place.Y + y) * target.Stride + item.Place.X);
        }
    }
}

void copyRow(const std::uint32_t* from, std::uint32_t* to, std::int32_t pixels) noexcept {
    std::memcpy(to, from, static_cast<std::size_t>(pixels) * sizeof(std::uint32_t));
}

void nothingToEnd() noexcept {}

constexpr BlendKernels kReferenceKernels{blendReference, copyRow, nothingToEnd};
constexpr BlendKernels kPortableKernels{blendPortable, copyRow, nothingToEnd};

}  // namespace

BulbSprite spriteOf(const BulbImage& image) noexcept {
    return {image.Mask, image.Color, image.Pixels.data()};
}

std::uint32_t blendPixelReference(std::uint32_t source, std::uint32_t destination, std::uint32_t alpha) noexcept {
    const std::uint32_t sourceAlpha = source >> 24;
    std::uint32_t result = 0xFF000000U;
    for (int shift = 0; shift < 24; shift += 8) {
        const std::uint32_t s = (source >> shift) & 255U;
        const std::uint32_t d = (destination >> shift) & 255U;
        const std::uint32_t sum = s * alpha * kFull + d * (kFullSquared - sourceAlpha * alpha);
        result |= (sum + kHalfSquared) / kFullSquared << shift;
    }
    return result;
}

bool blendFormAvailable(BlendForm form) noexcept {
    return form != BlendForm::Avx2 || avx2Available();
}

const BlendKernels& blendKernels(BlendForm form) noexcept {
    switch (form) {
    case BlendForm::Reference:
        return kReferenceKernels;
    case BlendForm::Portable:
        return kPortableKernels;
    case BlendForm::Avx2:
        return kAvx2Kernels;
    }
    return kPortableKernels;
}

const BlendKernels& fastestBlendKernels() noexcept {
    return blendKernels(blendFormAvailable(BlendForm::Avx2) ? BlendForm::Avx2 : BlendForm::Portable);
}

void blendClipped(const BulbSprite& sprite, std::uint8_t alpha, std::int64_t x, std::int64_t y,
                  const Canvas& canvas) noexcept {
    const BulbMask& mask = *sprite.Mask;
    const std::int64_t side = 2 * mask.Size;
    const std::int64_t left = std::max<std::int64_t>(0, -x);
    const std::int64_t right = std::min<std::int64_t>(side, canvas.Width - x);
    const std::int64_t bottom = std::min<std::int64_t>(side, canvas.Height - y);
    for (std::int64_t row = std::max<std::int64_t>(0, -y); row < bottom; ++row) {
        std::uint32_t* to = canvas.Target.Origin + (y + row) * canvas.Target.Stride + x;
        for (std::int64_t column = left; column < right; ++column) {
            const std::uint32_t source =
                sourcePixel(sprite, static_cast<std::int32_t>(column), static_cast<std::int32_t>(row));
            if (source != 0) to[column] = blendSoft(source, to[column], alpha);
        }
    }
}
