// The blend kernels for processors with AVX2. Hard masks: sixteen channels at a time in 16 bits, since a covered pixel
// comes to (s x alpha + d x (255 - alpha)) / 255. Soft ones: sourceAlpha x alpha is split into 255 x whole - part,
// which keeps both divisions by 255 within 16 bits. Division by 255, cut off, is exact in the upper half of a product
// with 32897, shifted by 7 (for any 16-bit number).
#include "engine/blend.h"

#include <algorithm>

#if defined(__x86_64__)

#include <immintrin.h>

#define ZEPH_AVX2 __attribute__((target("avx2")))
#define ZEPH_AVX2_INLINE __attribute__((target("avx2"), always_inline)) inline

namespace {

constexpr int kBlock = 8;  // pixels

ZEPH_AVX2_INLINE __m256i load(const std::uint32_t* from) noexcept {
    return _mm256_loadu_si256(reinterpret_cast<const __m256i*>(from));
}
ZEPH_AVX2_INLINE void store(std::uint32_t* to, __m256i pixels) noexcept {
    _mm256_storeu_si256(reinterpret_cast<__m256i*>(to), pixels);
}
// Of numbers that are one more than what is to be divided.
ZEPH_AVX2_INLINE __m256i cutBy255(__m256i wordsPlusOne) noexcept {
    return _mm256_mulhi_epu16(wordsPlusOne, _mm256_set1_epi16(257));
}

// What one colour at one alpha adds and keeps.
struct HardBlend {
    __m256i add;   // s x alpha + 128, four channels over and over
    __m256i keep;  // 255 - alpha
};

ZEPH_AVX2_INLINE HardBlend hardBlend(std::uint32_t color, std::uint8_t alpha) noexcept {
    const __m256i channels = _mm256_unpacklo_epi8(_mm256_set1_epi32(static_cast<int>(color)), _mm256_setzero_si256());
    const __m256i scaled = _mm256_mullo_epi16(channels, _mm256_set1_epi16(alpha));
    return {_mm256_add_epi16(scaled, _mm256_set1_epi16(128)), _mm256_set1_epi16(static_cast<short>(255 - alpha))};
}

// Eight pixels, all as if covered.
ZEPH_AVX2_INLINE __m256i blendAll(__m256i destination, const HardBlend& blend) noexcept {
    const __m256i zero = _mm256_setzero_si256();
    const __m256i low = _mm256_unpacklo_epi8(destination, zero);
    const __m256i high = _mm256_unpackhi_epi8(destination, zero);
    return _mm256_packus_epi16(cutBy255(_mm256_add_epi16(_mm256_mullo_epi16(low, blend.keep), blend.add)),
                               cutBy255(_mm256_add_epi16(_mm256_mullo_epi16(high, blend.keep), blend.add)));
}

ZEPH_AVX2_INLINE void blendBlock(std::uint32_t* to, __m256i lanes, const HardBlend& blend) noexcept {
    const __m256i destination = load(to);
    store(to, _mm256_blendv_epi8(destination, blendAll(destination, blend), lanes));
}

// Two rows of four pixels.
ZEPH_AVX2_INLINE void blendRowPair(std::uint32_t* to, std::ptrdiff_t stride, __m256i lanes,
                                   const HardBlend& blend) noexcept {
    auto* upper = reinterpret_cast<__m128i*>(to);
    auto* lower = reinterpret_cast<__m128i*>(to + stride);
    const __m256i destination =
        _mm256_inserti128_si256(_mm256_castsi128_si256(_mm_loadu_si128(upper)), _mm_loadu_si128(lower), 1);
    const __m256i result = _mm256_blendv_epi8(destination, blendAll(destination, blend), lanes);
    _mm_storeu_si128(upper, _mm256_castsi256_si128(result));
    _mm_storeu_si128(lower, _mm256_extracti128_si256(result, 1));
}

// The rows first..end - 1 of the image, whose upper left corner lies at corner.
ZEPH_AVX2 void blendHardRows(const BulbMask& mask, const HardBlend& blend, std::int32_t first, std::int32_t end,
                             std::uint32_t* corner, std::ptrdiff_t stride) noexcept {
    const std::uint32_t* lanes = mask.Lanes.data() + first * mask.Stride;
    std::uint32_t* to = corner + first * stride;
    for (std::int32_t y = first; y < end; ++y) {
        if (mask.Stride < kBlock) {
            alignas(32) std::uint32_t row[kBlock] = {};
            std::copy_n(lanes, mask.Stride, row);
            blendBlock(to, load(row), blend);
        } else {
            for (std::int32_t x = 0; x < mask.Stride; x += kBlock)
                blendBlock(to + x, load(lanes + x), blend);
        }
        lanes += mask.Stride;
        to += stride;
    }
}

// Four pixels of a soft image as sixteen words.
struct SoftHalf {
    __m256i add;    // s x alpha + 128
    __m256i whole;  // 255 - ceiling of sourceAlpha x alpha / 255
    __m256i part;   // what that ceiling is too high by, 0..254
};

ZEPH_AVX2_INLINE SoftHalf softHalf(__m256i source, __m256i alpha) noexcept {
    // The alpha word of each pixel in all its four words.
    const __m256i sourceAlpha = _mm256_shufflehi_epi16(_mm256_shufflelo_epi16(source, 0xFF), 0xFF);
    const __m256i product = _mm256_mullo_epi16(sourceAlpha, alpha);
    const __m256i ceiling = cutBy255(_mm256_add_epi16(product, _mm256_set1_epi16(255)));
    const __m256i scaled = _mm256_sub_epi16(_mm256_slli_epi16(ceiling, 8), ceiling);
    return {_mm256_add_epi16(_mm256_mullo_epi16(source, alpha), _mm256_set1_epi16(128)),
            _mm256_sub_epi16(_mm256_set1_epi16(255), ceiling), _mm256_sub_epi16(scaled, product)};
}

ZEPH_AVX2_INLINE __m256i blendSoftHalf(__m256i destination, const SoftHalf& soft) noexcept {
    const __m256i carried =
        cutBy255(_mm256_add_epi16(_mm256_mullo_epi16(destination, soft.part), _mm256_set1_epi16(128)));
    const __m256i sum = _mm256_add_epi16(soft.add, _mm256_mullo_epi16(destination, soft.whole));
    return cutBy255(_mm256_add_epi16(sum, carried));
}

ZEPH_AVX2_INLINE void blendSoftBlock(std::uint32_t* to, const SoftHalf& low, const SoftHalf& high) noexcept {
    const __m256i zero = _mm256_setzero_si256();
    const __m256i destination = load(to);
    store(to, _mm256_packus_epi16(blendSoftHalf(_mm256_unpacklo_epi8(destination, zero), low),
                                  blendSoftHalf(_mm256_unpackhi_epi8(destination, zero), high)));
}

// A flood's rows are the same from above and from below, so what a row of the image comes to serves two rows of pixels.
ZEPH_AVX2 void blendSoft(const BulbSprite& sprite, std::uint8_t alpha, std::int32_t first, std::int32_t end,
                         std::uint32_t* corner, std::ptrdiff_t stride) noexcept {
    const BulbMask& mask = *sprite.Mask;
    const __m256i zero = _mm256_setzero_si256();
    const __m256i alphas = _mm256_set1_epi16(alpha);
    for (std::int32_t y = 0; y < mask.Size; ++y) {
        const std::int32_t mirror = 2 * mask.Size - 1 - y;
        const bool drawUpper = y >= first && y < end;
        const bool drawLower = mirror >= first && mirror < end;
        if (!drawUpper && !drawLower) continue;
        const std::uint32_t* from = sprite.Pixels + y * mask.Stride;
        std::uint32_t* upper = corner + y * stride;
        std::uint32_t* lower = corner + mirror * stride;
        const MaskBlocks blocks = mask.Blocks[static_cast<std::size_t>(y)];
        for (std::int32_t x = kBlock * blocks.First; x < kBlock * blocks.End; x += kBlock) {
            const __m256i source = load(from + x);
            const SoftHalf low = softHalf(_mm256_unpacklo_epi8(source, zero), alphas);
            const SoftHalf high = softHalf(_mm256_unpackhi_epi8(source, zero), alphas);
            if (drawUpper) blendSoftBlock(upper + x, low, high);
            if (drawLower) blendSoftBlock(lower + x, low, high);
        }
    }
}

// The masks of sizes 1 and 2 fit two registers. Most bulbs are that small, and neighbours mostly share their mask.
struct SmallMask {
    const BulbMask* mask = nullptr;
    std::int32_t side = 0;
    __m256i upper;
    __m256i lower;
};

ZEPH_AVX2 void blendItems(std::span<const BulbItem> items, const std::uint8_t* alphas, const BulbSprite* sprites,
                          RowRange rows, const PixelTarget& target) noexcept {
    const PixelTarget to = target;
    SmallMask small{nullptr, 0, _mm256_setzero_si256(), _mm256_setzero_si256()};
    for (const BulbItem& item : items) {
        const std::uint8_t alpha = alphas[item.Unit];
        if (alpha == 0) continue;
        const BulbSprite& sprite = sprites[item.Sprite];
        const BulbMask& mask = *sprite.Mask;
        std::uint32_t* corner = to.Origin + item.Place.Y * to.Stride + item.Place.X;
        if (&mask != small.mask && !mask.Soft && mask.Size <= 2) {
            small = {&mask, 2 * mask.Size, load(mask.Lanes.data()),
                     mask.Size == 2 ? load(mask.Lanes.data() + kBlock) : _mm256_setzero_si256()};
        }
        if (&mask == small.mask && item.Place.Y >= rows.Top && item.Place.Y + small.side <= rows.Bottom) {
            const HardBlend blend = hardBlend(sprite.Color, alpha);
            blendRowPair(corner, to.Stride, small.upper, blend);
            if (small.side == 4) blendRowPair(corner + 2 * to.Stride, to.Stride, small.lower, blend);
            continue;
        }
        const std::int32_t first = std::max(0, rows.Top - item.Place.Y);
        const std::int32_t end = std::min(2 * mask.Size, rows.Bottom - item.Place.Y);
        if (mask.Soft) {
            blendSoft(sprite, alpha, first, end, corner, to.Stride);
        } else {
            blendHardRows(mask, hardBlend(sprite.Color, alpha), first, end, corner, to.Stride);
        }
    }
}

ZEPH_AVX2 void streamRow(const std::uint32_t* from, std::uint32_t* to, std::int32_t pixels) noexcept {
    for (std::int32_t x = 0; x < pixels; x += 2 * kBlock) {
        const __m256i first = _mm256_load_si256(reinterpret_cast<const __m256i*>(from + x));
        const __m256i second = _mm256_load_si256(reinterpret_cast<const __m256i*>(from + x + kBlock));
        _mm256_stream_si256(reinterpret_cast<__m256i*>(to + x), first);
        _mm256_stream_si256(reinterpret_cast<__m256i*>(to + x + kBlock), second);
    }
}

void endStreaming() noexcept {
    _mm_sfence();
}

}  // namespace

const BlendKernels kAvx2Kernels{blendItems, streamRow, endStreaming};

bool avx2Available() noexcept {
    return __builtin_cpu_supports("avx2") != 0;
}

#else

bool avx2Available() noexcept {
    return false;
}

const BlendKernels kAvx2Kernels = blendKernels(BlendForm::Portable);

#endif
